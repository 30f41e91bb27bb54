#pragma once

#include <exception>

namespace zebtell::orders {

// For things of which one may fail without the others: each is tried, and the first error is
// thrown when all are done.
class FirstError {
  public:
    template <class Work>
    void Try(Work&& work) {
        try {
            work();
        } catch (const std::exception&) {
            if (!error_) error_ = std::current_exception();
        }
    }

    void Rethrow() const {
        if (error_) std::rethrow_exception(error_);
    }

  private:
    std::exception_ptr error_;
};

}  // namespace zebtell::orders
