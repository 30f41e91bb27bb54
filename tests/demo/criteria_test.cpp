#include <gtest/gtest.h>

#include <string>

#include "tests/demo/demo_fixture.h"

namespace zebtell::demo {
namespace {

// What the catalogue asks the database, in SQLite's words.
class CriteriaTest : public DemoCompanyTest {
  protected:
    static std::string List(const std::string& criterion) {
        return "select GRPriceListRel.ID from GRPriceListRel inner join GRArticle on "
               "GRArticle.ID = GRPriceListRel.IDGRArticle where " +
               criterion + " order by GRArticle.Code";
    }
    static std::string PriceQuery(int company, int list, const std::string& articles) {
        const std::string partner = std::to_string(company);
        return "select s5.idgrarticle, s5.price, ifnull(pricecut, 0) as pricecut, round(price * "
               "(100 + ifnull(pricecut, 0)), 0) / 100 as finalprice from sqpricelist5 s5 left "
               "join (select rel.pricecut, rel.idgrpricelist, gc.id as idgrcompany, ga.id as "
               "idgrarticle from grpricecatrel rel inner join grarticle ga on "
               "ga.idgrarticlepricecat=rel.idgrarticlepricecat inner join grcompany gc on "
               "gc.idgrcompanypricecat=rel.idgrcompanypricecat where gc.id=" +
               partner +
               ") rc on s5.idgrarticle=rc.idgrarticle and s5.idsrcpricelist=rc.idgrpricelist "
               "where s5.idgrpricelist=" +
               std::to_string(list) + " and s5.idgrarticle in (" + articles + ")";
    }
};

const std::string kSearch =
    "GRPriceListRel.ID IN (select P5.ID from SQPriceList5 P5 inner join GRArticle on "
    "P5.IDGRArticle=GRArticle.ID where (GRArticle.name LIKE '#N' OR GRArticle.code LIKE '#C') AND "
    "(IDGRPriceList=#L))";
const std::string kCategory =
    "GRPriceListRel.Price<>0 AND GRPriceListRel.ID IN (select ID from SQCatPriceList5 where "
    "(IDGRArticleCat IN (#G)) AND (IDGRPriceList=#L))";
const std::string kFavourites =
    "GRPriceListRel.ID IN (select P5.ID from SQPriceList5 P5 inner join GRArticle on "
    "P5.IDGRArticle=GRArticle.ID where IDGRPriceList=1 AND P5.IDGRArticle in (select IDGRArticle "
    "from SDOrderRow inner join SDOrder on SDOrderRow.IDSDOrder=SDOrder.ID where "
    "SDOrder.IDGRCompany=1))";

struct Question {
    const char* what;
    std::string criterion;
    std::size_t lines;
};

std::string Filled(std::string text, const std::string& mark, const std::string& value) {
    return text.replace(text.find(mark), mark.size(), value);
}

std::string Search(const std::string& name, const std::string& code, int list) {
    return Filled(Filled(Filled(kSearch, "#N", name), "#C", code), "#L", std::to_string(list));
}

std::string Category(int category, int list) {
    return Filled(Filled(kCategory, "#G", std::to_string(category)), "#L", std::to_string(list));
}

TEST_F(CriteriaTest, FindTheirLinesWithoutReadingWholeTables) {
    const std::string priced = "GRPriceListRel.Price<>0 AND ";
    const Question questions[] = {
        // Every 97th article of 3,000 has no price yet.
        {"plain search for everything", Search("%", "%", 1), 3000},
        {"all priced lines", priced + Search("%", "%", 1), 2970},
        {"the same by way of the source list", priced + Search("%", "%", 3), 2970},
        {"words of a name", Search("%polt%M8×%", "polt%M8×%", 1), 9},
        {"start of a code", Search("%krv-m8%", "krv-m8%", 1), 10},
        {"nothing", Search("%no such%", "no such%", 1), 0},
        // 100 of each category, and 50 of category 20 stand in 21 too; one of each has no price.
        {"a category", Category(8, 1), 99},
        {"a category with more from another", Category(21, 3), 148},
        {"bought before", kFavourites, 60},
    };
    for (const Question& question : questions) {
        EXPECT_EQ(sql().Rows(List(question.criterion)).size(), question.lines) << question.what;
        for (const Sql::Row& step : sql().Rows("explain query plan " + List(question.criterion))) {
            EXPECT_EQ(step[3].find("SCAN"), std::string::npos) << question.what << ": " << step[3];
        }
    }
}

TEST_F(CriteriaTest, AListFromAnotherShowsThatListsLines) {
    EXPECT_EQ(sql().Number("select count(*) from SQPriceList5 a join SQPriceList5 b on a.ID = b.ID "
                           "where a.IDGRPriceList = 1 and b.IDGRPriceList = 3 and "
                           "a.IDSrcPriceList = 1 and b.IDSrcPriceList = 1 and a.Price is b.Price"),
              3000);
    EXPECT_EQ(sql().Number("select count(*) from SQPriceList5 where IDGRPriceList = 3"), 3000);
    EXPECT_EQ(sql().Number("select count(*) from SQPriceList5 where IDGRPriceList = 2 and "
                           "IDSrcPriceList <> 2"),
              0);
}

struct Price {
    const char* customer;
    int company;
    int list;
    const char* expected;  // article, percentage and price: the list's with the percentage
};

TEST_F(CriteriaTest, GiveTheCustomersPrices) {
    // List prices: 2.65, 1.09, 6.47 and 21.63; in the export list 2.84, 1.12, 5.95 and 23.36.
    const Price prices[] = {
        {"gold", 1, 1, "1 -22.5 2.05|2 -22.5 0.84|26 -12.0 5.69|61 -22.5 16.76|"},
        {"gold, from the source", 14, 3, "1 -22.5 2.05|2 -22.5 0.84|26 -12.0 5.69|61 -22.5 16.76|"},
        {"retail pays more", 4, 1, "1 15.0 3.05|2 15.0 1.25|26 0 6.47|61 15.0 24.87|"},
        {"regular, export", 2, 2, "1 -8.5 2.6|2 -8.5 1.02|26 -3.75 5.73|61 -8.5 21.37|"},
    };
    for (const Price& price : prices) {
        std::string found;
        const auto rows =
            sql().Rows(PriceQuery(price.company, price.list, "1,2,26,61") + " order by 1");
        for (const Sql::Row& row : rows) {
            found += row[0] + " " + row[2] + " " + row[3] + "|";
        }
        EXPECT_EQ(found, price.expected) << price.customer;
    }
}

}  // namespace
}  // namespace zebtell::demo
