#pragma once

#include "erp/connection_pool.h"

namespace zebtell::erp {

// A write transaction: rolled back unless it is committed. Then the connection is given up too,
// since after an error (no room, a sync that failed) nobody knows what it and the disk hold.
class Transaction {
  public:
    explicit Transaction(ConnectionPool& pool) : lease_(pool.Write()) { lease_->Begin(); }
    ~Transaction() {
        if (!committed_) {
            lease_->Rollback();
            lease_.Drop();
        }
    }
    Transaction(const Transaction&) = delete;
    Transaction& operator=(const Transaction&) = delete;

    Connection& connection() const { return *lease_; }

    // Throws when the database did not say that all is stored; never tried again, since it may be
    // stored all the same.
    void Commit() {
        lease_->Commit();
        committed_ = true;
    }

  private:
    Lease lease_;
    bool committed_ = false;
};

// The result of `work`(Connection&), run as one transaction: once more, from its beginning, when
// the database has rolled it back in favour of another one.
template <class Work>
auto InTransaction(ConnectionPool& pool, const Work& work) {
    const auto run = [&] {
        Transaction transaction(pool);
        auto result = work(transaction.connection());
        transaction.Commit();
        return result;
    };
    try {
        return run();
    } catch (const TransientError& error) {
        if (error.kind() != TransientError::Kind::kDeadlock) {
            throw;
        }
    }
    return run();
}

}  // namespace zebtell::erp
