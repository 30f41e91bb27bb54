#pragma once

#include <gtest/gtest.h>

#include <atomic>
#include <filesystem>
#include <functional>
#include <memory>
#include <mutex>
#include <string>
#include <vector>

#include "erp/connection.h"
#include "erp/database.h"
#include "tests/support/temp_folder.h"

namespace zebtell::erp {

// What happens between the runtime and a database: counted, and made to fail.
class Watch {
  public:
    void Start() { count_ = 0; }
    int statements() const { return count_; }
    // From now on the n-th statement (a begin or a commit counts as one) fails; 0: none.
    void FailAt(int n) {
        count_ = 0;
        fail_at_ = n;
    }
    // The next commit is carried out, but its answer is lost.
    void LoseAnswer() { lose_answer_ = true; }

    void Statement();
    bool TakeLostAnswer() { return lose_answer_.exchange(false); }

  private:
    std::atomic<int> count_ = 0;
    std::atomic<int> fail_at_ = 0;
    std::atomic<bool> lose_answer_ = false;
};

std::unique_ptr<Backend> Watched(std::unique_ptr<Backend> backend, std::shared_ptr<Watch> watch);

// A small company in a database of its own:
//   lists      1 "Jae" (the default), 2 "Hulgi", 3 "Hulgi kaudu" (its lines are those of list 2)
//   companies  1 Puit OÜ (list 3, parent 2, employee 1, price category 1), 2 Ema AS,
//              3 Võõras AS (no list), 4 Jaeklient (no list)
//   users      mari of 1, Õie of 3, WebGuest of 4 (a guest), endine of 1 (disabled); all with the
//              password "sala"
//   articles   1 to 45, codes A001 to A045, at 1.00 to 45.00 in list 2 (lines 101 to 145) and at
//              twice that in list 1 (lines 201 to 245); 46 in no list. Odd ones have 20 % tax and
//              article price category 1 (-12.5 % in list 2 for company 1), even ones 9 % and none.
//   orders     11 of company 1 (State 0) with rows 1, 2 and the fixed row 3; 12 of company 1
//              (State 1); 13 of company 3
class Company {
  public:
    virtual ~Company() = default;

    virtual data::DatabaseType type() const = 0;
    virtual std::string path() const = 0;
    virtual std::unique_ptr<Backend> MakeBackend() const = 0;
    // A statement on a connection of its own, as staff would run it.
    void Run(const std::string& sql) const;
    // The result of a select statement: values separated by blanks, rows by ";".
    std::string Show(const std::string& sql) const;
};

struct DatabaseKind {
    std::string name;
    std::function<std::unique_ptr<Company>()> make;
};

inline void PrintTo(const DatabaseKind& kind, std::ostream* out) {
    *out << kind.name;
}

// The kinds of database that the conformance tests run on.
std::vector<DatabaseKind> DatabaseKinds();

// The portal over one company, at 2026-03-15 10:00:00.
class PortalTest : public testing::TestWithParam<DatabaseKind> {
  protected:
    PortalTest();

    std::unique_ptr<data::DataApplication> LogOn(const std::string& user = "mari",
                                                 const std::string& password = "sala");

    std::unique_ptr<Company> company_;
    std::shared_ptr<Watch> watch_ = std::make_shared<Watch>();
    std::unique_ptr<Databases> databases_;
    std::shared_ptr<data::Record> user_;  // who logged on last
};

std::string Text(data::Record& record, std::string_view field);
int ErrorOf(const std::function<void()>& work);  // its number, 0: none

}  // namespace zebtell::erp
