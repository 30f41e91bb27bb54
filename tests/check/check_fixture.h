#pragma once

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <sstream>

#include "app/page_vocabulary.h"
#include "check/check_portal.h"
#include "demo/sql_files.h"
#include "tests/demo/sql.h"
#include "tests/support/temp_folder.h"

namespace zebtell::check {

// A portal without rows whose templates are all empty, so that it has no faults but those that a
// test makes.
class CheckTest : public testing::Test {
  protected:
    static constexpr std::string_view kSettings = "[DataBase]\r\nPath=company.db\r\n";

    void SetUp() override {
        folder.Write("ZEBTell.ini", kSettings);
        for (const CheckedPage& page : pages) folder.Write(page.template_file, "");
        folder.Write("company.db", "");
        Change(std::string(demo::kSchemaSql) + std::string(demo::kViewsSql));
    }

    void Change(const std::string& sql) const { demo::Sql(folder.path() / "company.db").Rows(sql); }

    // The findings as they are printed, one a line.
    std::string Faults(const std::filesystem::path& templates = {}) const {
        std::ostringstream out;
        for (const Finding& finding : CheckPortal({folder.path(), templates, {}}, pages)) {
            out << finding << "\n";
        }
        return out.str();
    }

    const TempFolder folder;
    const std::vector<CheckedPage> pages = app::PageVocabulary();
};

}  // namespace zebtell::check
