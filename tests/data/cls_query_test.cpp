#include "data/cls_query.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "tests/support/fake_data.h"

namespace zebtell::data {
namespace {

using base::Value;
using testing::ElementsAre;

class ClsQuery : public testing::Test {
  protected:
    ClsQuery() {
        query_.Query = "SQPrices";
        query_.ZEBApp = &application_;
    }

    fake::Application application_;
    clsQuery query_;
};

TEST_F(ClsQuery, SqlText) {
    const struct {
        const char* label;
        const char* mode;
        const char* criteria;
        clsQuery::FilterValue value;
        const char* order;
        const char* expected;
    } rows[] = {
        {"no filter without a value", "", "ID", Value(), "", "SELECT * FROM SQPrices"},
        {"no filter without a column", "", "", Value(5), "", "SELECT * FROM SQPrices"},
        {"one value", "", "ID", Value(5), "", "SELECT * FROM SQPrices WHERE ID=5"},
        {"zero is a value", "", "ID", Value(0), "", "SELECT * FROM SQPrices WHERE ID=0"},
        {"text as it is", "x", "Code", Value("'A'"), "", "SELECT * FROM SQPrices WHERE Code='A'"},
        {"one value as a list",
         "LIST",
         "ID",
         Value(5),
         "",
         "SELECT * FROM SQPrices WHERE ID IN (5)"},
        {"a list",
         "list",
         "ID",
         std::vector<Value>{3, 5, 8},
         "",
         "SELECT * FROM SQPrices WHERE ID IN (3,5,8)"},
        {"numbers of no region",
         "list",
         "Q",
         std::vector<Value>{1.5, base::Currency::FromScaled(25000)},
         "",
         "SELECT * FROM SQPrices WHERE Q IN (1.5,2.5)"},
        {"order", "", "", Value(), "Name desc", "SELECT * FROM SQPrices ORDER BY Name desc"},
        {"order trimmed, nothing to comment with",
         "",
         "ID",
         Value(5),
         "  Na/*me--  ",
         "SELECT * FROM SQPrices WHERE ID=5 ORDER BY Na*me"},
        {"no order for ever", "", "", Value(), " (None) ", "SELECT * FROM SQPrices"},
    };
    for (const auto& row : rows) {
        clsQuery query = query_;
        query.Mode = row.mode;
        query.Criteria = row.criteria;
        query.MasterValue = row.value;
        query.SetOrder(row.order);
        query.Records();
        EXPECT_EQ(application_.asked.back(), std::string("OpenQuery ") + row.expected) << row.label;
    }
}

TEST_F(ClsQuery, RunsAgainOnlyWhenItMust) {
    query_.Criteria = "Code";
    EXPECT_TRUE(query_.notCreated());
    query_.Records(Value("abc"));
    query_.Records(Value("ABC"));
    query_.Records();
    query_.SetOrder("Name");
    EXPECT_TRUE(query_.notCreated());
    query_.Records();
    query_.SetOrder(" NAME- ");
    query_.Records();
    query_.Records(std::vector<Value>{"abc"});
    EXPECT_EQ(application_.asked.size(), 2U);

    query_.Records(Value("d"));
    query_.RecNo = 7;
    EXPECT_TRUE(query_.Requery());
    EXPECT_EQ(query_.RecNo, 1);
    query_.Records();
    EXPECT_THAT(application_.asked,
                ElementsAre("OpenQuery SELECT * FROM SQPrices WHERE Code=abc",
                            "OpenQuery SELECT * FROM SQPrices WHERE Code=abc ORDER BY Name",
                            "OpenQuery SELECT * FROM SQPrices WHERE Code=d ORDER BY NAME",
                            "OpenQuery SELECT * FROM SQPrices WHERE Code=d ORDER BY NAME"));
}

TEST_F(ClsQuery, OrderNoneStays) {
    query_.SetOrder("(NONE)");
    query_.Records();
    query_.SetOrder("Name");
    EXPECT_FALSE(query_.notCreated());
    EXPECT_EQ(query_.Order(), "");
}

TEST_F(ClsQuery, FailuresLeaveNoResult) {
    application_.error = base::RuntimeError(base::errors::kNoSuchTable);
    EXPECT_THROW(query_.Records(), base::RuntimeError);
    EXPECT_TRUE(query_.notCreated());

    application_.error.reset();
    query_.Criteria = "ID";
    EXPECT_THROW(query_.Records(std::vector<Value>{1, 2}), base::RuntimeError) << "not a list";

    query_.ZEBApp = nullptr;
    try {
        query_.Records(Value(1));
        FAIL() << "ran without an application";
    } catch (const base::RuntimeError& error) {
        EXPECT_EQ(error.number(), base::errors::kObjectNotSet);
    }
}

}  // namespace
}  // namespace zebtell::data
