#include "catalogue/option_lists.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "tests/tags/session.h"

namespace zebtell::catalogue {
namespace {

using ::testing::HasSubstr;
using ::testing::Not;

const base::DateTime kDate = *base::DateTime::FromIso("2026-02-21 14:05:09");

TEST(OptionLists, CategoriesWithAllAndFavourites) {
    struct Case {
        const char* label;
        std::int32_t chosen;
        const char* options;
    };
    const Case cases[] = {
        {"all",
         0,
         "<OPTION SELECTED VALUE=\"0\">Kõik\r\n<OPTION VALUE=\"-1\">Lemmikud\r\n"
         "<OPTION VALUE=\"1\">Mutrid &amp; &lt;muu&gt;\r\n<OPTION VALUE=\"12\">Poldid\r\n"},
        {"favourites",
         -1,
         "<OPTION VALUE=\"0\">Kõik\r\n<OPTION SELECTED VALUE=\"-1\">Lemmikud\r\n"
         "<OPTION VALUE=\"1\">Mutrid &amp; &lt;muu&gt;\r\n<OPTION VALUE=\"12\">Poldid\r\n"},
        {"a category whose ID begins as another's",
         1,
         "<OPTION VALUE=\"0\">Kõik\r\n<OPTION VALUE=\"-1\">Lemmikud\r\n"
         "<OPTION SELECTED VALUE=\"1\">Mutrid &amp; &lt;muu&gt;\r\n<OPTION "
         "VALUE=\"12\">Poldid\r\n"},
        {"a category that is gone",
         5,
         "<OPTION VALUE=\"0\">Kõik\r\n<OPTION VALUE=\"-1\">Lemmikud\r\n"
         "<OPTION VALUE=\"1\">Mutrid &amp; &lt;muu&gt;\r\n<OPTION VALUE=\"12\">Poldid\r\n"},
    };
    tags::Session session;
    session.application->lists["GRArticleCat"] =
        fake::MakeList({{{"ID", 1}, {"Name", "Mutrid & <muu>"}}, {{"ID", 12}, {"Name", "Poldid"}}});
    session.state.catalogue.EmptyGroupText = "Kõik";
    session.state.catalogue.FavouritesGroupText = "Lemmikud";
    for (const Case& c : cases) {
        session.state.catalogue.CategoryId = c.chosen;
        EXPECT_EQ(CategoryOptions(session.state, ""), c.options) << c.label;
    }
    EXPECT_EQ(session.application->asked.size(), 1U) << "read once a session";
}

TEST(OptionLists, CategoriesOfAGroupAndByTheTemplatesFilter) {
    tags::Session session;
    auto& application = *session.application;
    application.lists["GRArticleCat|Category like 'A'"] =
        fake::MakeList({{{"ID", 1}, {"Name", "Mutrid"}}});
    application.lists["GRArticleCat|Category like 'B'"] =
        fake::MakeList({{{"ID", 2}, {"Name", "Poldid"}}});
    session.state.catalogue.GroupQueryText = "Category like 'B'";
    // Neither text was declared: the categories only.
    EXPECT_EQ(CategoryOptions(session.state, "A"), "<OPTION VALUE=\"1\">Mutrid\r\n");
    EXPECT_EQ(CategoryOptions(session.state, ""), "<OPTION VALUE=\"2\">Poldid\r\n");
    EXPECT_EQ(application.asked.front(), "OpenList GRArticleCat|Category like 'A'|Name");
}

TEST(OptionLists, RecordsOfAList) {
    const auto list = fake::MakeList({{{"ID", 5}, {"Name", "a\"b"}},
                                      {{"ID", 6}, {"Name", base::Value::Null()}},
                                      {{"ID", 7}, {"Name", 1.5}}});
    EXPECT_EQ(RecordOptions(*list, "Name", 7, base::RegionFor("et")),
              "<OPTION VALUE=\"5\">a&quot;b\r\n<OPTION VALUE=\"6\">\r\n"
              "<OPTION SELECTED VALUE=\"7\">1,5\r\n");
}

TEST(OptionLists, DaysOfFebruaryGoOnTo31) {
    const std::string days = DayOptions(kDate);
    EXPECT_THAT(days, HasSubstr("<OPTION VALUE=\"1\">1\r\n<OPTION VALUE=\"2\">2\r\n"));
    EXPECT_THAT(days, HasSubstr("<OPTION SELECTED VALUE=\"21\">21\r\n"));
    EXPECT_TRUE(days.ends_with("<OPTION VALUE=\"31\">31\r\n"));
}

TEST(OptionLists, MonthsInTheUsersLanguage) {
    struct Case {
        const char* label;
        host::UserLanguage language;
        const char* beginning;
        const char* some_more;
    };
    const Case cases[] = {
        {"Estonian",
         host::UserLanguage::kEstonian,
         "<OPTION VALUE=\"1\">Jaanuar\r\n<OPTION SELECTED VALUE=\"2\">Veebruar\r\n"
         "<OPTION VALUE=\"3\">Märts\r\n",
         "<OPTION VALUE=\"10\">Oktoober\r\n"},
        {"English",
         host::UserLanguage::kEnglish,
         "<OPTION VALUE=\"1\">January\r\n<OPTION SELECTED VALUE=\"2\">February\r\n"
         "<OPTION VALUE=\"3\">March\r\n",
         "<OPTION VALUE=\"12\">December\r\n"},
        {"Latvian",
         host::UserLanguage::kLatvian,
         "<OPTION VALUE=\"1\">Janvāris\r\n<OPTION SELECTED VALUE=\"2\">Februāris\r\n"
         "<OPTION VALUE=\"3\">Marts\r\n",
         "<OPTION VALUE=\"7\">Jūlijs\r\n"},
    };
    for (const Case& c : cases) {
        const std::string months = MonthOptions(kDate, c.language);
        EXPECT_TRUE(months.starts_with(c.beginning)) << c.label << months;
        EXPECT_THAT(months, HasSubstr(c.some_more)) << c.label;
        EXPECT_THAT(months, Not(HasSubstr("\"13\""))) << c.label;
    }
}

TEST(OptionLists, YearsUpToTheClocks) {
    const auto today = *base::DateTime::FromIso("2027-01-01");
    const std::string years = YearOptions(kDate, today);
    EXPECT_TRUE(years.starts_with("<OPTION VALUE=\"2017\">2017\r\n")) << years;
    EXPECT_TRUE(
        years.ends_with("<OPTION SELECTED VALUE=\"2026\">2026\r\n<OPTION VALUE=\"2027\">2027\r\n"))
        << years;
    EXPECT_THAT(YearOptions(*base::DateTime::FromIso("1999-01-01"), today),
                Not(HasSubstr("SELECTED")));
}

}  // namespace
}  // namespace zebtell::catalogue
