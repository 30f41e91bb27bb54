#pragma once

#include <atomic>
#include <cstddef>

namespace zebtell::http {

// How much memory the large requests of all connections may take at a time. The first kFree bytes
// of each connection are not counted, so that small forms have room whatever others send. For any
// thread; a Share is for one at a time.
class BodyBudget {
  public:
    static constexpr std::size_t kFree = std::size_t{16} * 1024;

    explicit BodyBudget(std::size_t most) : most_(most) {}

    class Share {
      public:
        explicit Share(BodyBudget& budget) : budget_(budget) {}
        ~Share() { Resize(0); }
        Share(const Share&) = delete;
        Share& operator=(const Share&) = delete;

        // What the connection holds now. False when there is no room for more; the share then
        // stays as it was.
        bool Resize(std::size_t bytes) {
            const std::size_t wanted = bytes > kFree ? bytes - kFree : 0;
            if (wanted <= counted_) {
                budget_.used_ -= counted_ - wanted;
            } else if ((budget_.used_ += wanted - counted_) > budget_.most_) {
                budget_.used_ -= wanted - counted_;
                return false;
            }
            counted_ = wanted;
            return true;
        }

      private:
        BodyBudget& budget_;
        std::size_t counted_ = 0;
    };

  private:
    const std::size_t most_;
    std::atomic<std::size_t> used_ = 0;
};

}  // namespace zebtell::http
