#include "erp/translator.h"

#include <gtest/gtest.h>

#include "base/text.h"
#include "tests/erp/sql_database.h"

namespace zebtell::erp {
namespace {

struct ListRow {
    const char* label;
    const char* filter;
    const char* order;
    const char* printed;  // behind the text that all lists of price lines begin with
    const char* keys;     // of the lines, in their order
};

// The texts that the catalogue makes, and what else filters are made of.
const ListRow kPriceLines[] = {
    {"nothing", "", "", " order by t1.ID <- [20,10]", "1;2;3"},
    {"empty braces", "{}", "", " order by t1.ID <- [20,10]", "1;2;3"},
    {"key", "ID=3", "", " and t1.ID = ? order by t1.ID <- [20,10], 3", "3"},
    {"another customer's line", "ID=7", "", " and t1.ID = ? order by t1.ID <- [20,10], 7", ""},
    {"order by key",
     "",
     "Price desc, ID desc, price",
     " order by t1.Price desc, t1.ID desc <- [20,10]",
     "3;1;2"},
    {"favourites of a list",
     "{GRPriceListRel.ID IN (select P5.ID from SQPriceList5 P5 inner join GRArticle on "
     "P5.IDGRArticle=GRArticle.ID where IDGRPriceList=20) AND GRArticle.ID in (select "
     "SDOrderRow.IDGRArticle from SDOrderRow inner join SDOrder on "
     "SDOrderRow.IDSDOrder=SDOrder.ID where SDOrder.IDGRCompany=1)}",
     "GRArticle.Code",
     " left join GRArticle t4 on t4.ID = t1.IDGRArticle where t1.IDGRPriceList in (select value "
     "from json_each(?)) and t1.ID in (select t2.ID from SQPriceList5 t2 inner join GRArticle t3 "
     "on t2.IDGRArticle = t3.ID where t2.IDGRPriceList in (select value from json_each(?)) and "
     "t2.IDGRPriceList = ?) and t4.ID in (select t5.IDGRArticle from SDOrderRow t5 inner join "
     "SDOrder t6 on t5.IDSDOrder = t6.ID and t6.IDGRCompany = ? where t5.IDSDOrder in (select "
     "t7.ID from SDOrder t7 where t7.IDGRCompany = ?) and t6.IDGRCompany = ?) order by t4.Code, "
     "t1.ID <- [20,10], [20,10], 20, 1, 1, 1",
     "1;3"},
    {"search in a list",
     "{GRPriceListRel.Price<>0 AND GRPriceListRel.ID IN (select P5.ID from SQPriceList5 P5 inner "
     "join GRArticle on P5.IDGRArticle=GRArticle.ID where (GRArticle.name LIKE '*kruvi*M6*' OR "
     "GRArticle.code LIKE 'kruvi*M6*') AND (IDGRPriceList=20))}",
     "GRArticle.Code",
     " left join GRArticle t4 on t4.ID = t1.IDGRArticle where t1.IDGRPriceList in (select value "
     "from json_each(?)) and t1.Price <> ? and t1.ID in (select t2.ID from SQPriceList5 t2 inner "
     "join GRArticle t3 on t2.IDGRArticle = t3.ID where t2.IDGRPriceList in (select value from "
     "json_each(?)) and (erp_like(t3.Name, ?) or erp_like(t3.Code, ?)) and t2.IDGRPriceList = ?) "
     "order by t4.Code, t1.ID <- [20,10], 0, [20,10], %kruvi%M6%, kruvi%M6%, 20",
     "1"},
    {"no search in a list",
     "{GRPriceListRel.ID IN (select P5.ID from SQPriceList5 P5 inner join GRArticle on "
     "P5.IDGRArticle=GRArticle.ID where (GRArticle.name LIKE '*' OR GRArticle.code LIKE '*') AND "
     "(IDGRPriceList=20))}",
     "",
     " and t1.ID in (select t2.ID from SQPriceList5 t2 inner join GRArticle t3 on t2.IDGRArticle "
     "= t3.ID where t2.IDGRPriceList in (select value from json_each(?)) and (t3.Name is not null "
     "or t3.Code is not null) and t2.IDGRPriceList = ?) order by t1.ID <- [20,10], [20,10], 20",
     "1;2;3"},
    {"search without a list",
     "(GRArticle.code like '*' or GRArticle.name like '*v?RV*')",
     "GRArticle.Name desc",
     " left join GRArticle t2 on t2.ID = t1.IDGRArticle where t1.IDGRPriceList in (select value "
     "from json_each(?)) and (t2.Code is not null or erp_like(t2.Name, ?)) order by t2.Name desc, "
     "t1.ID <- [20,10], %v_RV%",
     "3;2;1"},
    {"category of a list",
     "{GRPriceListRel.Price<>0 AND GRPriceListRel.ID IN (select ID from SQCatPriceList5 where "
     "(IDGRArticleCat IN (1)) AND (IDGRPriceList=20)) and (GRArticle.code like 'M6*' or "
     "GRArticle.name like 'M6*')}",
     "",
     " left join GRArticle t3 on t3.ID = t1.IDGRArticle where t1.IDGRPriceList in (select value "
     "from json_each(?)) and t1.Price <> ? and t1.ID in (select t2.ID from SQCatPriceList5 t2 "
     "where t2.IDGRPriceList in (select value from json_each(?)) and t2.IDGRArticleCat in (select "
     "value from json_each(?)) and t2.IDGRPriceList = ?) and (erp_like(t3.Code, ?) or "
     "erp_like(t3.Name, ?)) order by t1.ID <- [20,10], 0, [20,10], [1], 20, M6%, M6%",
     "1"},
    {"category without a list",
     "GRArticle.GRArticleCatRel.IDGRArticleCat IN (3,2)",
     "",
     " left join GRArticle t2 on t2.ID = t1.IDGRArticle where t1.IDGRPriceList in (select value "
     "from json_each(?)) and exists (select 1 from GRArticleCatRel t3 where t3.IDGRArticle = "
     "t2.ID and t3.IDGRArticleCat in (select value from json_each(?))) order by t1.ID <- "
     "[20,10], [3,2]",
     "2;3"},
    {"link behind a child table",
     "not GRArticle.GRArticleCatRel.GRArticleCat.Name like 'n*'",
     "",
     " left join GRArticle t2 on t2.ID = t1.IDGRArticle where t1.IDGRPriceList in (select value "
     "from json_each(?)) and not (exists (select 1 from GRArticleCatRel t3 left join GRArticleCat "
     "t4 on t4.ID = t3.IDGRArticleCat where t3.IDGRArticle = t2.ID and erp_like(t4.Name, ?))) "
     "order by t1.ID <- [20,10], n%",
     "1;3"},
    {"or beside the scope",
     "ID=1 or 1=1",
     "",
     " and (t1.ID = ? or ? = ?) order by t1.ID <- [20,10], 1, 1, 1",
     "1;2;3"},
    {"longer paths share their joins",
     "GRArticle.GRTax.TaxPercent<10 and [GRPriceListRel].GRArticle.\"GRTax\".Name='Half'",
     "GRArticle.GRTax.Name, GRArticle.Code",
     " left join GRArticle t2 on t2.ID = t1.IDGRArticle left join GRTax t3 on t3.ID = t2.IDGRTax "
     "where t1.IDGRPriceList in (select value from json_each(?)) and t3.TaxPercent < ? and "
     "t3.Name = ? order by t3.Name, t2.Code, t1.ID <- [20,10], 10, Half",
     "3"},
};

std::string PriceLines(const char* printed) {
    const std::string_view text = printed;
    const bool joined = text.starts_with(" left join");
    const std::string scope = " where t1.IDGRPriceList in (select value from json_each(?))";
    return "select t1.ID from GRPriceListRel t1" + (joined ? "" : scope) + printed;
}

TEST(TranslatorTest, ListsOfPriceLines) {
    for (const ListRow& row : kPriceLines) {
        SCOPED_TRACE(row.label);
        const BoundSql sql = Database().translator().ListKeys(
            FirstCustomer(), "grpricelistrel", row.filter, row.order, {});
        EXPECT_EQ(Shown(sql), PriceLines(row.printed));
        EXPECT_EQ(Database().Run(sql), row.keys);
    }
}

TEST(TranslatorTest, PatternsOfFiltersFindWhatPeopleTyped) {
    const struct {
        const char* pattern;
        const char* value;
        const char* codes;
    } rows[] = {
        {"*100%*", "%100\\%%", "V100"},
        {"*_*", "%\\_%", ""},
        {"*õLI", "%õLI", "V100"},
        {"it''s [NEW] \\ ?dd", "it's [NEW] \\\\ _dd", "X_1"},
        {"***kruvi***", "%kruvi%", "M6-20;M6-30"},
        {"", "", ""},
    };
    for (const auto& row : rows) {
        const std::vector<std::string> code = {"Code"};
        const std::string filter = "Name like '" + std::string(row.pattern) + "'";
        const BoundSql sql =
            Database().translator().ListKeys(FirstCustomer(), "GRArticle", filter, "", code);
        EXPECT_EQ(sql.values.front().ToPlainText(), row.value) << row.pattern;
        const std::string keys_and_codes = Database().Run(sql);
        std::string codes;
        for (const std::string_view found : base::Split(keys_and_codes, ';')) {
            codes.append(codes.empty() ? "" : ";").append(found.substr(found.find('|') + 1));
        }
        EXPECT_EQ(codes, row.codes) << row.pattern;
    }
}

TEST(TranslatorTest, ConditionsOnDocuments) {
    const struct {
        const char* filter;
        const char* condition;
        const char* keys;
    } rows[] = {
        {"DocDate>=#11/21/2026# and DocDate<=#11/30/2026#",
         "t1.DocDate >= ? and t1.DocDate <= ? order by t1.ID <- 1, 2026-11-21, 2026-11-30",
         "101"},
        {"DocDate between '2026-11-01' and #11/20/2026 14:05#",
         "t1.DocDate between ? and ? order by t1.ID <- 1, 2026-11-01, 2026-11-20 14:05:00",
         "100"},
        {"WantedDate is not null and not Explanation is null",
         "t1.WantedDate is not null and not (t1.Explanation is null) order by t1.ID <- 1",
         "100"},
        {"not NeedsReview and Number not in (2, 7)",
         "not (t1.NeedsReview <> 0) and t1.Number not in (select value from json_each(?)) order by "
         "t1.ID <- 1, [2,7]",
         "100"},
        {"SDOrderRow.IDGRArticle=3 and GRCompany.Parent.Name='Parent'", nullptr, "100"},
        {"{SDOrder.ID in (select IDSDOrder from SDOrderRow where Quantity>1) and Amount*2-5>=15}",
         nullptr,
         "100"},
        {"GDTax.Amount > 2", nullptr, "100"},
    };
    for (const auto& row : rows) {
        SCOPED_TRACE(row.filter);
        const BoundSql sql =
            Database().translator().ListKeys(FirstCustomer(), "SDOrder", row.filter, "", {});
        if (row.condition) {
            EXPECT_EQ(Shown(sql),
                      "select t1.ID from SDOrder t1 where t1.IDGRCompany = ? and " +
                          std::string(row.condition));
        }
        EXPECT_EQ(Database().Run(sql), row.keys);
    }
}

TEST(TranslatorTest, RowsByIDFetchesLinkedFieldsAlong) {
    const std::vector<std::int64_t> ids = {3, 1, 6, 99};
    const std::vector<std::string> fields = {"Price", "GRArticle.GRTax.TaxPercent", "idgrarticle"};
    const BoundSql sql =
        Database().translator().RowsByID(FirstCustomer(), "GRPriceListRel", ids, fields);
    EXPECT_EQ(Shown(sql),
              "select t1.ID, t1.Price, t3.TaxPercent, t1.IDGRArticle from GRPriceListRel t1 "
              "left join GRArticle t2 on t2.ID = t1.IDGRArticle left join GRTax t3 on t3.ID = "
              "t2.IDGRTax where t1.IDGRPriceList in (select value from json_each(?)) and t1.ID in "
              "(select value from json_each(?)) <- [20,10], [3,1,6,99]");
    EXPECT_EQ(Database().Run(sql), "1|1.15|22|1;3|12|9|3");
}

// A link to rows that the reader may not see gives nulls, not the rows.
TEST(TranslatorTest, LinksAreScoped) {
    Reader reader = FirstCustomer();
    reader.parent = 0;
    reader.settlement_company = 0;
    const std::vector<std::int64_t> ids = {1};
    const std::vector<std::string> fields = {"Name", "Parent.Name", "GRPriceList.Name"};
    const BoundSql sql = Database().translator().RowsByID(reader, "GRCompany", ids, fields);
    EXPECT_EQ(Database().Run(sql), "1|First||First");
}

TEST(TranslatorTest, OrdersAreColumnsAndPathsOnly) {
    const char* const rows[] = {"Price+1",
                                "1",
                                "(select 1)",
                                "Price asc desc",
                                "Price,",
                                "Nothing",
                                "GRArticle.PasswordHash",
                                "GRArticle.GRArticleCatRel.ID",
                                "Price; drop table SDOrder",
                                "Price --"};
    for (const char* order : rows) {
        EXPECT_THROW(
            Database().translator().ListKeys(FirstCustomer(), "GRPriceListRel", "", order, {}),
            base::RuntimeError)
            << order;
    }
}

constexpr const char* kPriceQuery =
    "select s5.*, rc.idgrcompany, isnull(pricecut, 0) as pricecut,round (price * (100 + "
    "isnull(pricecut, 0)), 0) / 100 as finalprice\r\nfrom\r\nsqpricelist5 s5 with "
    "(nolock)\r\nleft join (\r\nselect\r\nrel.pricecut, rel.idgrpricelist, gc.id as idgrcompany, "
    "ga.id as idgrarticle\r\nfrom\r\ngrpricecatrel rel with (nolock)\r\ninner join grarticle ga "
    "with (nolock) on ga.idgrarticlepricecat=rel.idgrarticlepricecat\r\ninner join grcompany gc "
    "with (nolock) on gc.idgrcompanypricecat=rel.idgrcompanypricecat\r\nwhere gc.id=1\r\n) rc on "
    "s5.idgrarticle=rc.idgrarticle and s5.idsrcpricelist=rc.idgrpricelist\r\nwhere\r\n"
    "s5.idgrpricelist=20\r\nand s5.idgrarticle in (1,2,3)";

TEST(TranslatorTest, PriceQueryOfBothDatabases) {
    const std::string values = " <- 0, 100, 0, 100, 1, 3, 3, 1, 1, [1,2,3], [20,10], 20, [1,2,3]";
    const BoundSql sqlite = Database().translator().Select(FirstCustomer(), kPriceQuery);
    EXPECT_EQ(Shown(sqlite),
              "select t1.ID as ID, t1.IDGRPriceList as IDGRPriceList, t1.IDSrcPriceList as "
              "IDSrcPriceList, t1.IDGRArticle as IDGRArticle, t1.Price as Price, t5.idgrcompany as "
              "idgrcompany, ifnull(t5.PriceCut, ?) as pricecut, erp_div(erp_round(t1.Price * (? + "
              "ifnull(t5.PriceCut, ?)), 0), ?) as finalprice from SQPriceList5 t1 left join "
              "(select t2.PriceCut as PriceCut, t2.IDGRPriceList as IDGRPriceList, t4.ID as "
              "idgrcompany, t3.ID as idgrarticle from GRPriceCatRel t2 inner join GRArticle t3 on "
              "t3.IDGRArticlePriceCat = t2.IDGRArticlePriceCat inner join GRCompany t4 on "
              "t4.IDGRCompanyPriceCat = t2.IDGRCompanyPriceCat and t4.ID in (?, ?, ?) where "
              "t2.IDGRCompanyPriceCat = ? and t4.ID = ? and t3.ID in (select value from "
              "json_each(?))) t5 on t1.IDGRArticle = t5.idgrarticle and t1.IDSrcPriceList = "
              "t5.IDGRPriceList where t1.IDGRPriceList in (select value from json_each(?)) and "
              "t1.IDGRPriceList = ? and t1.IDGRArticle in (select value from json_each(?))" +
                  values);
    EXPECT_EQ(Database().Run(sqlite),
              "1|20|10|1|1.15|1|-7.5|1.06;2|20|10|2|0|1|-7.5|0;3|20|10|3|12||0|12");

    const Translator server(Database().schema(), Dialect::kSqlServer);
    EXPECT_EQ(Shown(server.Select(FirstCustomer(), kPriceQuery)),
              "select t1.ID as ID, t1.IDGRPriceList as IDGRPriceList, t1.IDSrcPriceList as "
              "IDSrcPriceList, t1.IDGRArticle as IDGRArticle, t1.Price as Price, t5.idgrcompany as "
              "idgrcompany, isnull(t5.PriceCut, ?) as pricecut, round(cast(t1.Price * (100 + "
              "isnull(t5.PriceCut, ?)) as decimal(28, 10)), 0) * 1.0 / 100 as finalprice "
              "from SQPriceList5 t1 with (nolock) left join (select t2.PriceCut as PriceCut, "
              "t2.IDGRPriceList as IDGRPriceList, t4.ID as idgrcompany, t3.ID as idgrarticle from "
              "GRPriceCatRel t2 with (nolock) inner join GRArticle t3 with (nolock) on "
              "t3.IDGRArticlePriceCat = t2.IDGRArticlePriceCat inner join GRCompany t4 with "
              "(nolock) on t4.IDGRCompanyPriceCat = t2.IDGRCompanyPriceCat and t4.ID in (?, ?, ?) "
              "where t2.IDGRCompanyPriceCat = ? and t4.ID = ? and t3.ID in (select value from "
              "openjson(cast(? as nvarchar(max))) with (value bigint '$'))) t5 on "
              "t1.IDGRArticle = t5.idgrarticle and "
              "t1.IDSrcPriceList = t5.IDGRPriceList where t1.IDGRPriceList in (select value from "
              "openjson(cast(? as nvarchar(max))) with (value bigint '$')) and t1.IDGRPriceList "
              "= ? and t1.IDGRArticle in "
              "(select value from openjson(cast(? as nvarchar(max))) with (value bigint '$'))"
              " <- 0, 0, 1, 3, 3, 1, 1, [1,2,3], [20,10], 20, [1,2,3]");
}

// A guest without a company, and a customer who asks for another's category, pay the list price.
TEST(TranslatorTest, PriceQueryKnowsNoOtherCompany) {
    std::string text = kPriceQuery;
    text.replace(text.find("s5.idgrpricelist=20"), 19, "s5.idgrpricelist=11");
    EXPECT_EQ(Database().Run(Database().translator().Select(GuestReader(), text)),
              "4|11|11|1|2||0|2");
    text = kPriceQuery;
    text.replace(text.find("gc.id=1"), 7, "gc.id=2");
    EXPECT_EQ(Database().Run(Database().translator().Select(FirstCustomer(), text)),
              "1|20|10|1|1.15||0|1.15;2|20|10|2|0||0|0;3|20|10|3|12||0|12");
}

TEST(TranslatorTest, LongListsAreOneValue) {
    std::string list = "0";
    for (int i = 1; i < 30000; ++i) {
        list += "," + std::to_string(i);
    }
    const BoundSql sql = Database().translator().Select(
        FirstCustomer(), "SELECT * FROM GRTax WHERE ID IN (" + list + ")");
    EXPECT_EQ(
        sql.text,
        "select t1.ID as ID, t1.Name as Name, t1.TaxPercent as TaxPercent from GRTax t1 where "
        "t1.ID in (select value from json_each(?))");
    EXPECT_EQ(sql.values, std::vector<base::Value>{"[" + list + "]"});
    EXPECT_EQ(Database().Run(sql), "1|Full|22;2|Half|9");

    std::string codes = "'V100'";
    for (int i = 1; i < 3000; ++i) {
        codes += ",'" + std::to_string(i) + "'";
    }
    const BoundSql texts = Database().translator().Select(
        FirstCustomer(), "SELECT ID FROM GRArticle WHERE Code IN (" + codes + ")");
    EXPECT_TRUE(texts.values.empty()) << texts.values.size();
    EXPECT_EQ(Database().Run(texts), "3");
}

TEST(TranslatorTest, ReadableColumnsLeaveHiddenOnesOut) {
    EXPECT_EQ(
        Database().translator().ReadableColumns(FirstCustomer(), "syuser"),
        (std::vector<std::string>{
            "ID", "Name", "DisplayName", "IDPartner", "IDGRCompContPerson", "Guest", "Disabled"}));
}

}  // namespace
}  // namespace zebtell::erp
