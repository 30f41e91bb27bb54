#include "demo/demo_company.h"

#include <gtest/gtest.h>

#include "base/runtime_error.h"
#include "data/document_loaders.h"
#include "data/price_query_text.h"
#include "erp/database.h"
#include "tests/erp/company_kit.h"

namespace zebtell::erp {
namespace {

// The runtime over the demo company, whose documents come from another hand.
class DemoCompanyTest : public testing::Test {
  protected:
    static std::string Path() {
        static const TempFolder folder;
        static const std::string path = [] {
            const auto file = folder.path() / "demo.db";
            demo::DemoOptions options;
            options.articles = 300;
            options.companies = 12;
            options.years = 1;
            options.order_rows = 1000;
            options.today = *base::DateTime::FromIso("2026-03-15");
            demo::MakeDemoCompany(file, options);
            return file.string();
        }();
        return path;
    }
    void LogOn(const char* user, const char* password) {
        portal_ = databases_.NewApplication();
        portal_->Initialise("ZEBTell", "WEBUser", "WEBGuest", "Külaline");
        user_ = portal_->Logon(data::DatabaseType::kSqlite, Path(), user, password);
    }
    // The session's price list as the log-on finds it.
    std::int64_t PriceList() {
        for (const char* field : {"Partner.IDGRPriceList", "Partner.SettlCompany.IDGRPriceList"}) {
            const base::Value list = user_->GetField(field);
            if (!list.IsNull()) {
                return list.ToInteger64();
            }
        }
        return portal_->DefaultLink("SDOrder", "GRPriceList");
    }

    Databases databases_{[] { return *base::DateTime::FromIso("2026-03-15 10:00:00"); }};
    std::unique_ptr<data::DataApplication> portal_;
    std::shared_ptr<data::Record> user_;
};

TEST_F(DemoCompanyTest, OrderRowsCostWhatThePriceQueryShows) {
    const struct {
        const char *user, *password;
    } users[] = {{"mari", "mari-demo"}, {"janis", "janis-demo"}, {"WebGuest", ""}};
    for (const auto& user : users) {
        LogOn(user.user, user.password);
        const std::string list = std::to_string(PriceList());
        const auto lines = portal_->OpenList(
            "GRPriceListRel",
            "{GRPriceListRel.Price<>0 AND GRPriceListRel.ID IN (select P5.ID from SQPriceList5 P5"
            " inner join GRArticle on P5.IDGRArticle=GRArticle.ID where (GRArticle.name LIKE '*'"
            " OR GRArticle.code LIKE '*') AND (IDGRPriceList=" +
                list + "))}",
            "GRArticle.Code");
        ASSERT_GT(lines->Count(), 200) << user.user;
        std::string articles = "0";
        for (std::int64_t i = 1; i <= lines->Count(); ++i) {
            articles += "," + Text(*lines->Item(i), "IDGRArticle");
        }
        std::string sql =
            base::ReplacedNoCase(data::DefaultPriceQueryText(), "#P", Text(*user_, "IDPartner"));
        sql = base::ReplacedNoCase(sql, "#H", list);
        const auto prices = portal_->OpenQuery(base::ReplacedNoCase(sql, "#A", articles), 0, 0);
        EXPECT_EQ(prices->Count(), lines->Count()) << user.user;
        const auto order = portal_->OpenTable("SDOrder")->Open(0);
        for (std::int64_t i = 1; i <= lines->Count(); i += 3) {
            const std::string article = Text(*lines->Item(i), "IDGRArticle");
            const auto row = order->Rows()->AddRow();
            row->SetField("IDGRArticle", article);
            const auto shown = prices->Find("idgrarticle=" + article);
            ASSERT_NE(shown, nullptr) << article;
            EXPECT_EQ(row->GetField("Price").ToCurrency(),
                      shown->GetField("finalprice").ToCurrency())
                << user.user << " " << article;
        }
    }
}

TEST_F(DemoCompanyTest, StoredDocumentsAddUp) {
    LogOn("mari", "mari-demo");
    const auto orders = portal_->OpenList("SDOrder", "", "DocDate desc");
    ASSERT_GT(orders->Count(), 3);
    for (std::int64_t i = 1; i <= orders->Count(); ++i) {
        const auto stored = orders->Item(i);
        const auto opened =
            portal_->OpenTable("SDOrder")->Open(stored->GetField("ID").ToInteger64());
        for (const char* sum : {"Amount", "TaxAmount", "AmountWTax"}) {
            EXPECT_EQ(opened->GetField(sum), stored->GetField(sum))
                << sum << " of order " << Text(*stored, "Number");
        }
    }
    data::ShownDocument invoice;
    const auto invoices = portal_->OpenList("SDInvoice", "", "DocDate");
    ASSERT_GT(invoices->Count(), 0);
    data::LoadInvoice(*portal_, "ID=" + Text(*invoices->Item(1), "ID"), invoice);
    EXPECT_GT(invoice.RowCount, 0);
    EXPECT_GT(invoice.TaxCount, 0);
    EXPECT_FALSE(invoice.Rows->Item(1)->GetField("GRArticle.Name").IsBlank());
}

TEST_F(DemoCompanyTest, AnOrderIsTakenAgain) {
    LogOn("mari", "mari-demo");
    const auto order = portal_->OpenTable("SDOrder")->Open(0);
    const auto row = order->Rows()->AddRow();
    row->SetField(
        "IDGRArticle",
        portal_->OpenList("GRPriceListRel", "Price>0", "ID")->Item(1)->GetField("IDGRArticle"));
    row->SetField("Quantity", 2);
    row->Update(0);
    order->Save();
    data::BasketValues basket;
    data::LoadOrderAsBasket(*portal_, "ID_" + Text(*order->Header(), "ID"), basket);
    EXPECT_EQ(basket.BasketRowCount, 1);
    EXPECT_EQ(basket.BasketQuantity, 2);
    EXPECT_EQ(basket.BasketTotal, order->GetField("Amount").ToCurrency());
}

}  // namespace
}  // namespace zebtell::erp
