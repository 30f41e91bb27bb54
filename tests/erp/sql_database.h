#pragma once

#include <cstdint>
#include <memory>
#include <string>
#include <string_view>
#include <vector>

#include "base/runtime_error.h"
#include "erp/access.h"
#include "erp/connection.h"
#include "erp/translator.h"

namespace zebtell::erp {

// A company database of two customers (partners 1 and 2, partner 1 has parent 3), three articles
// and a few documents of each customer, in a file that is gone with the object. Texts of customer 2
// hold the word "foreign".
class TwoCompanies {
  public:
    // With `changes` made to the rows.
    explicit TwoCompanies(std::string_view changes = {});
    ~TwoCompanies();
    TwoCompanies(const TwoCompanies&) = delete;
    TwoCompanies& operator=(const TwoCompanies&) = delete;

    const Schema& schema() const { return *schema_; }
    Translator translator() const { return {*schema_, Dialect::kSqlite}; }

    // The rows of a statement, fields with "|" between them, rows with ";".
    std::string Run(const BoundSql& sql) const;

  private:
    std::string path_;
    std::unique_ptr<Connection> connection_;
    std::unique_ptr<Schema> schema_;
};

// One for all tests of the program, which only read it.
const TwoCompanies& Database();

// "text <- value, value"; what a call threw as its description.
std::string Shown(const BoundSql& sql);
template <class Call>
std::string ShownOrError(Call call) {
    try {
        return Shown(call());
    } catch (const base::RuntimeError& error) {
        return error.number() == base::errors::kNoSuchTable ? "no such table" : error.what();
    }
}

// User of partner 1: price list 20, which takes its lines from list 10; settled by company 3.
Reader FirstCustomer();
// A guest without partner, price list 11 (the default one), who has stored order 101.
Reader GuestReader();

}  // namespace zebtell::erp
