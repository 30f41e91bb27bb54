#include <gtest/gtest.h>

#include <thread>

#include "base/runtime_error.h"
#include "tests/erp/company_kit.h"

namespace zebtell::erp {
namespace {

class ListsTest : public PortalTest {
  protected:
    // The codes of the list's rows from `first` to `last`, with the statements that it took.
    std::string Page(data::RecordList& list, std::int64_t first, std::int64_t last) {
        watch_->Start();
        std::string shown;
        for (std::int64_t i = first; i <= last; ++i) {
            const auto line = list.Item(i);
            shown += Text(*line, "GRArticle.Code") + "=" + Text(*line, "Price") + " ";
        }
        return shown + std::to_string(watch_->statements());
    }
};
INSTANTIATE_TEST_SUITE_P(Databases,
                         ListsTest,
                         testing::ValuesIn(DatabaseKinds()),
                         [](const auto& test) { return test.param.name; });

TEST_P(ListsTest, AListIsOneStatementAndAPageOneMore) {
    const auto portal = LogOn();
    watch_->Start();
    portal->OpenList("GRPriceListRel", "", "Price");
    EXPECT_EQ(watch_->statements(), 1);
    // The order of the linked records is a statement of its own.
    watch_->Start();
    const auto list = portal->OpenList("GRPriceListRel", "", "GRArticle.Code");
    EXPECT_EQ(watch_->statements(), 2);
    EXPECT_EQ(list->Count(), 45);
    // The first reader of a path has its window read again; everybody after reads it at once.
    EXPECT_EQ(Page(*list, 1, 2), "A001=1 A002=2 2");
    EXPECT_EQ(Page(*list, 1, 2), "A001=1 A002=2 0");
    EXPECT_EQ(Page(*list, 21, 22), "A021=21 A022=22 1");
    EXPECT_EQ(Page(*list, 44, 45), "A044=44 A045=45 0");
    EXPECT_EQ(Page(*list, 19, 20), "A019=19 A020=20 1");
    EXPECT_EQ(ErrorOf([&] { list->Item(0); }), base::errors::kSubscript);
    EXPECT_EQ(ErrorOf([&] { list->Item(46); }), base::errors::kSubscript);
}

TEST_P(ListsTest, RowsStandInTheOrderOfTheirLinkedRecords) {
    const auto portal = LogOn();
    const auto ids = [&](const char* table, const char* filter, const char* order) {
        const auto list = portal->OpenList(table, filter, order);
        std::string text;
        for (std::int64_t i = 1; i <= list->Count(); ++i) {
            text += Text(*list->Item(i), "ID") + " ";
        }
        return text;
    };
    company_->Run("update GRArticle set Name = 'A' where ID = 4");
    company_->Run("update GRArticle set Name = 'B' where ID in (1, 3)");
    company_->Run("update GRArticle set Name = 'C', IDGRTax = 2 where ID = 2");
    const char* four = "IDGRArticle in (1, 2, 3, 4)";
    EXPECT_EQ(ids("GRPriceListRel", four, "GRArticle.Name"), "104 101 103 102 ");
    EXPECT_EQ(ids("GRPriceListRel", four, "grarticle.name desc"), "102 101 103 104 ");
    EXPECT_EQ(ids("GRPriceListRel", "ID = 0", "GRArticle.Name"), "");
    // Records that several rows link to, and rows that link to none.
    EXPECT_EQ(ids("GRArticle", "ID in (1, 2, 3)", "GRTax.TaxPercent"),
              ids("GRArticle", "ID in (1, 2, 3)", "GRTax.TaxPercent, ID"));
    company_->Run("update GRArticle set IDGRArticlePriceCat = null where ID = 2");
    for (const char* order : {"GRArticlePriceCat.Name", "GRArticlePriceCat.Name desc"}) {
        EXPECT_EQ(ids("GRArticle", "ID < 9", order),
                  ids("GRArticle", "ID < 9", (order + std::string(", ID")).c_str()))
            << order;
    }
}

TEST_P(ListsTest, AWholeWalkTakesFewStatements) {
    const auto portal = LogOn();
    const auto list = portal->OpenList("GRArticle", "", "ID desc");
    watch_->Start();
    for (std::int64_t i = 1; i <= list->Count(); ++i) {
        EXPECT_EQ(list->Item(i)->GetField("ID").ToInteger64(), 47 - i);
    }
    EXPECT_EQ(watch_->statements(), 2);
}

TEST_P(ListsTest, SessionsShareWhatHasNotChanged) {
    const auto mari = LogOn();
    const auto list = mari->OpenList("GRPriceListRel", "", "GRArticle.Code");
    Page(*list, 1, 20);
    const auto colleague = LogOn();
    watch_->Start();
    const auto same = colleague->OpenList("GRPriceListRel", "", "GRArticle.Code");
    EXPECT_EQ(watch_->statements(), 0);
    EXPECT_EQ(Page(*same, 2, 2), "A002=2 1");
    const auto again = colleague->OpenList("GRPriceListRel", "", "GRArticle.Code");
    EXPECT_EQ(Page(*again, 1, 1), "A001=1 0");
    // Staff change a price: lists opened and pages shown from now on have it.
    company_->Run("update GRPriceListRel set Price = 1.5 where ID = 101");
    company_->Run("delete from GRPriceListRel where ID = 102");
    const auto fresh = colleague->OpenList("GRPriceListRel", "", "GRArticle.Code");
    EXPECT_EQ(fresh->Count(), 44);
    EXPECT_EQ(Page(*fresh, 1, 2), "A001=1.5 A003=3 1");
    // A list that was opened before keeps its rows and, with its next page, takes their new
    // values; rows that are gone have none.
    std::this_thread::sleep_for(std::chrono::milliseconds(600));
    EXPECT_EQ(list->Count(), 45);
    EXPECT_EQ(Text(*list->Item(1), "Price"), "1.5");
    EXPECT_TRUE(list->Item(2)->GetField("Price").IsNull());
}

TEST_P(ListsTest, FindLooksUpByColumnOrKey) {
    const auto portal = LogOn();
    const auto list = portal->OpenList("GRPriceListRel", "ID > 105", "ID desc");
    EXPECT_EQ(Text(*list->Find("ID=110"), "Price"), "10");
    EXPECT_EQ(Text(*list->Find("idgrarticle = 17"), "ID"), "117");
    EXPECT_EQ(list->Find("IDGRArticle=5"), nullptr);
    EXPECT_EQ(list->Find("ID=-1"), nullptr);
    EXPECT_EQ(ErrorOf([&] { list->Find("Nothing=1"); }), base::errors::kStatementFailed);
    for (const char* criterion : {"ID", "ID=", "=1", "ID=1 or 1=1", "ID=1.5", ""}) {
        EXPECT_EQ(ErrorOf([&] { list->Find(criterion); }), base::errors::kInvalidCall) << criterion;
    }
    // The column comes with the keys of the lists opened afterwards.
    const auto other = portal->OpenList("GRPriceListRel", "ID > 110", "");
    EXPECT_EQ(other->Find("IDGRArticle=10"), nullptr);
    watch_->Start();
    EXPECT_NE(other->Find("IDGRArticle=11"), nullptr);
    EXPECT_EQ(watch_->statements(), 1);
}

TEST_P(ListsTest, WrongTextsEndInErrors) {
    const auto portal = LogOn();
    const struct {
        const char *table, *filter, *order;
        int error;
    } rows[] = {
        {"Nothing", "", "", base::errors::kNoSuchTable},
        {"sqlite_master", "", "", base::errors::kNoSuchTable},
        {"SDOrder", "Nothing=1", "", base::errors::kStatementFailed},
        {"SDOrder", "{1=1) or (1=1}", "", base::errors::kStatementFailed},
        {"SDOrder", "", "Nothing", base::errors::kStatementFailed},
        {"SDOrder",
         "ID in (select ID from SYUser where PasswordHash like '*')",
         "",
         base::errors::kStatementFailed},
    };
    for (const auto& row : rows) {
        EXPECT_EQ(ErrorOf([&] { portal->OpenList(row.table, row.filter, row.order); }), row.error)
            << row.table << " " << row.filter << " " << row.order;
    }
}

}  // namespace
}  // namespace zebtell::erp
