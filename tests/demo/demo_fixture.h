#pragma once

#include <gtest/gtest.h>

#include <memory>

#include "base/date_time.h"
#include "demo/demo_company.h"
#include "tests/demo/sql.h"
#include "tests/support/temp_folder.h"

namespace zebtell::demo {

inline DemoOptions OnAFriday() {
    DemoOptions options;
    options.today = *base::DateTime::FromIso("2026-11-20");
    return options;
}

inline DemoOptions SmallCompany() {
    DemoOptions options = OnAFriday();
    options.articles = 300;
    options.companies = 12;
    options.years = 1;
    options.order_rows = 500;
    return options;
}

// The company of the default size, made once for all tests of a suite.
class DemoCompanyTest : public testing::Test {
  protected:
    static void SetUpTestSuite() {
        folder_ = std::make_unique<TempFolder>();
        MakeDemoCompany(folder_->path() / "demo.db", OnAFriday());
        sql_ = std::make_unique<Sql>(folder_->path() / "demo.db");
    }
    static void TearDownTestSuite() {
        sql_.reset();
        folder_.reset();
    }
    static const Sql& sql() { return *sql_; }

  private:
    static inline std::unique_ptr<TempFolder> folder_;
    static inline std::unique_ptr<Sql> sql_;
};

}  // namespace zebtell::demo
