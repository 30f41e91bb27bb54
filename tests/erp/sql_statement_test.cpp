#include <gtest/gtest.h>

#include "erp/translator.h"
#include "tests/erp/sql_database.h"

namespace zebtell::erp {
namespace {

struct StatementRow {
    const char* text;
    const char* sqlite;      // null: only what it gives matters
    const char* sql_server;  // null: as SQLite's
    const char* rows;
};

// Statements of the first customer.
const StatementRow kStatements[] = {
    {"select top 2 Code, Name n from GRArticle where Name like 'Kru%' order by n desc, 1",
     "select t1.Code as Code, t1.Name as n from GRArticle t1 where erp_like(t1.Name, ?) order by n "
     "desc, 1 limit 2 <- Kru%",
     "select top (2) t1.Code as Code, t1.Name as n from GRArticle t1 where t1.Name like ? escape "
     "'\\' order by n desc, 1 <- Kru%",
     "M6-30|Kruvi M6 30 mm;M6-20|Kruvi M6 20 mm"},
    {"select 'a' + Code + 1 x, Code || ID, ID+1+2+Code from GRArticle where ID=1",
     "select ? || t1.Code || ? as x, t1.Code || t1.ID as Column2, (t1.ID + ? + ?) || t1.Code as "
     "Column3 from GRArticle t1 where t1.ID = ? <- a, 1, 1, 2, 1",
     "select ? + t1.Code + cast(1 as nvarchar(4000)) as x, t1.Code + cast(t1.ID as "
     "nvarchar(4000)) as Column2, cast((t1.ID + 1 + 2) as nvarchar(4000)) + t1.Code as Column3 "
     "from GRArticle t1 where t1.ID = ? <- a, 1",
     "aM6-201|M6-201|4M6-20"},
    {"select 7/2, 7/2/2, 7.5/2, ID/2, (ID+1)/2*3, 7%4, 1/0, 5/ID/2 from GRArticle where ID=1",
     "select ? / ? as Column1, ? / ? / ? as Column2, erp_div(?, ?) as Column3, erp_div(t1.ID, ?) "
     "as Column4, erp_div((t1.ID + ?), ?) * ? as Column5, ? % ? as Column6, ? / ? as Column7, "
     "erp_div(erp_div(?, t1.ID), ?) as Column8 from GRArticle t1 where t1.ID = ? <- 7, 2, 7, 2, "
     "2, 7.5, 2, 2, 1, 2, 3, 7, 4, 1, 0, 5, 2, 1",
     "select 7 / 2 as Column1, 7 / 2 / 2 as Column2, 7.5 * 1.0 / 2 as Column3, t1.ID * 1.0 / 2 as "
     "Column4, (t1.ID + 1) * 1.0 / 2 * 3 as Column5, 7 % 4 as Column6, 1 / nullif(?, 0) as "
     "Column7, 5 * 1.0 / nullif(t1.ID, 0) * 1.0 / 2 as Column8 from GRArticle t1 where t1.ID = ? "
     "<- 0, 1",
     "3|1|3.75|0.5|3|3||2.5"},
    {"select -ID, - -3, ID - -3, -(-ID), +5 from GRArticle where ID=1",
     "select -(t1.ID) as Column1, ? as Column2, t1.ID - ? as Column3, -(-(t1.ID)) as Column4, ? as "
     "Column5 from GRArticle t1 where t1.ID = ? <- 3, -3, 5, 1",
     "select -(t1.ID) as Column1, ? as Column2, t1.ID - -3 as Column3, -(-(t1.ID)) as Column4, ? "
     "as Column5 from GRArticle t1 where t1.ID = ? <- 3, 5, 1",
     "-1|3|4|1|5"},
    {"select distinct case when ID>2 then 'x''y' else 'z' end k, count(*) from GRArticle group by "
     "case when ID>2 then 'x''y' else 'z' end having count(*)>1 order by k",
     "select distinct case when t1.ID > 2 then 'x''y' else 'z' end as k, count(*) as Column2 from "
     "GRArticle t1 group by case when t1.ID > 2 then 'x''y' else 'z' end having count(*) > 1 order "
     "by k",
     "select distinct case when t1.ID > 2 then N'x''y' else N'z' end as k, count_big(*) as Column2 "
     "from GRArticle t1 group by case when t1.ID > 2 then N'x''y' else N'z' end having "
     "count_big(*) > 1 order by k",
     "x'y|2;z|2"},
    {"select o.Number, sum(r.Quantity) [the sum] from dbo.SDOrder o with (nolock) left outer join "
     "SDOrderRow r on r.IDSDOrder=o.ID and r.Quantity>2 group by o.Number order by o.Number desc",
     "select t1.Number as Number, sum(t2.Quantity) as \"the sum\" from SDOrder t1 left join "
     "SDOrderRow t2 on t2.IDSDOrder = t1.ID and t2.Quantity > ? and t2.IDSDOrder in (select t3.ID "
     "from SDOrder t3 where t3.IDGRCompany = ?) where t1.IDGRCompany = ? group by t1.Number order "
     "by t1.Number desc <- 2, 1, 1",
     "select t1.Number as Number, sum(t2.Quantity) as [the sum] from SDOrder t1 with (nolock) left "
     "join SDOrderRow t2 on t2.IDSDOrder = t1.ID and t2.Quantity > ? and t2.IDSDOrder in (select "
     "t3.ID from SDOrder t3 where t3.IDGRCompany = ?) where t1.IDGRCompany = ? group by t1.Number "
     "order by t1.Number desc <- 2, 1, 1",
     "2|;1|5"},
    {"select left(Code,2), right(Code, 2), substring(Code,2,2), len(Code+'  '), upper(lower(Code)),"
     " replace(Code,'-','/'), ltrim(rtrim(' a ')), nullif(ID,1), coalesce(null,null,7), abs(-2) "
     "from GRArticle where ID=1",
     nullptr,
     nullptr,
     "M6|20|6-|5|M6-20|M6/20|a||7|2"},
    {"select cast(ID as varchar(10)) + 'x', convert(int, '3.7'), cast(2.345 as decimal(10,2)), "
     "round(2.345, 2), round(1234.5, -2), cast('1.005' as money), cast(ID as float) from GRArticle "
     "where ID=1",
     nullptr,
     nullptr,
     "1x|3|2.35|2.35|1200|1.005|1"},
    {"select ID, ID=1 from GRArticle",
     nullptr,
     nullptr,
     "A condition stands where a value is needed"},
    {"select year(DocDate), month(DocDate), day(DocDate), dateadd(day, 2*2, DocDate), "
     "dateadd(month, -1, DocDate), dateadd(year, 1, #02/28/2027#), datediff(day, DocDate, "
     "WantedDate), datediff(year, DocDate, #01/01/2030#), "
     "datediff(month, #12/31/1999#, DocDate), datediff(month, DocDate, #11/01/2026#) from SDOrder "
     "where ID=100 and "
     "getdate()>DocDate-1",
     nullptr,
     nullptr,
     "2026|11|20|2026-11-24|2026-10-20|2028-02-28|5|4|323|0"},
    {"select a.Name, a.GRTax.TaxPercent p from GRArticle a where GRTax.Name='Half' order by p, "
     "a.Name desc",
     "select t1.Name as Name, t2.TaxPercent as p from GRArticle t1 left join GRTax t2 on t2.ID = "
     "t1.IDGRTax where t2.Name = ? order by p, t1.Name desc <- Half",
     nullptr,
     "Värv 100% õli|9;It's [new] \\ odd|9"},
    {"select t.ID, c.* from GRTax t, GRArticleCat c cross join GRTax where c.ID=t.ID and "
     "GRTax.ID=1",
     "select t1.ID as ID, t2.ID as ID, t2.Name as Name, t2.Category as Category from GRTax t1 "
     "inner join GRArticleCat t2 on 1 = 1 inner join GRTax t3 on 1 = 1 where t2.ID = t1.ID and "
     "t3.ID = ? <- 1",
     nullptr,
     "1|1|Screws|metal;2|2|Paint|liquid"},
    {"select ID from GRArticle where Name like '%100\\%%' or Name like '%[new] _ %' or exists "
     "(select * from GRPriceListRel p where p.IDGRArticle=GRArticle.ID and Price>100)",
     "select t1.ID as ID from GRArticle t1 where (erp_like(t1.Name, ?) or erp_like(t1.Name, ?) or "
     "exists (select t2.ID, t2.IDGRPriceList, t2.IDGRArticle, t2.Price from GRPriceListRel t2 "
     "where t2.IDGRPriceList in (select value from json_each(?)) and t2.IDGRArticle = t1.ID and "
     "t2.Price > ?)) <- %100\\\\%%, %[new] _ %, [20,10], 100",
     "select t1.ID as ID from GRArticle t1 where (t1.Name like ? escape '\\' or t1.Name like ? "
     "escape '\\' or exists (select t2.ID, t2.IDGRPriceList, t2.IDGRArticle, t2.Price from "
     "GRPriceListRel t2 where t2.IDGRPriceList in (select value from openjson(cast(? as "
     "nvarchar(max))) with (value "
     "bigint '$')) and t2.IDGRArticle = t1.ID and t2.Price > ?)) <- %100\\\\%%, %\\[new] _ %, "
     "[20,10], 100",
     "4"},
    {"select ID from GRArticle where Code in (10, 20) or Code in ('V100', 'x') or ID in () or "
     "ID in (1+1) order by ID",
     nullptr,
     "select t1.ID as ID from GRArticle t1 where (t1.Code in (select cast(value as nvarchar(20)) "
     "from openjson(cast(? as nvarchar(max))) with (value bigint '$')) or t1.Code in (?, ?) or "
     "t1.ID in (select value from openjson(cast(? as nvarchar(max))) with (value bigint '$')) or "
     "t1.ID in ((1 + 1))) order by t1.ID <- [10,20], V100, x, []",
     "2;3"},
    {"select x.n, (select max(Price) from GRPriceListRel where IDGRArticle=x.k) from (select top 2 "
     "Name n, ID as k from GRArticle order by ID desc) x order by x.k",
     "select t2.n as n, (select max(t3.Price) from GRPriceListRel t3 where t3.IDGRPriceList in "
     "(select value from json_each(?)) and t3.IDGRArticle = t2.k) as Column2 from (select t1.Name "
     "as n, t1.ID as k from GRArticle t1 order by t1.ID desc limit 2) t2 order by t2.k <- [20,10]",
     "select t2.n as n, (select max(t3.Price) from GRPriceListRel t3 where t3.IDGRPriceList in "
     "(select value from openjson(cast(? as nvarchar(max))) with (value bigint '$')) and "
     "t3.IDGRArticle = t2.k) as "
     "Column2 from "
     "(select top (2) t1.Name as n, t1.ID as k from GRArticle t1 order by t1.ID desc) t2 order by "
     "t2.k <- [20,10]",
     "Värv 100% õli|12;It's [new] \\ odd|"},
    {"select count(distinct IDGRTax) from GRArticle", nullptr, nullptr, "2"},
    {"select Number, DocDate + ' ' + Number, avg(ID) from SDOrder where Explanation like 'min_' "
     "and "
     "round(Amount * 0.5, 1)=5 group by Number, DocDate order by Number, number desc",
     "select t1.Number as Number, t1.DocDate || ' ' || t1.Number as Column2, avg(t1.ID) as Column3 "
     "from SDOrder t1 where t1.IDGRCompany = ? and erp_like(t1.Explanation, ?) and "
     "erp_round(t1.Amount * ?, 1) = ? group by t1.Number, t1.DocDate order by t1.Number <- 1, "
     "min_, 0.5, 5",
     "select t1.Number as Number, replace(convert(nvarchar(19), t1.DocDate, 120), N' 00:00:00', "
     "N'') + N' ' + cast(t1.Number as nvarchar(4000)) as Column2, avg(t1.ID * 1.0) as Column3 from "
     "SDOrder t1 where t1.IDGRCompany = ? and rtrim(t1.Explanation) like ? escape '\\' and "
     "round(cast(t1.Amount * 0.5 as decimal(28, 10)), 1) = ? group by t1.Number, t1.DocDate order "
     "by t1.Number <- 1, min_, 5",
     "1|2026-11-20 1|100"},
    {"select ID from GRArticle where Code = 5 or Code in ('x', 7) or 9 < Code and ID = 4",
     "select t1.ID as ID from GRArticle t1 where (t1.Code = ? or t1.Code in (?, ?) or (? < t1.Code "
     "and t1.ID = ?)) <- 5, x, 7, 9, 4",
     "select t1.ID as ID from GRArticle t1 where (t1.Code = ? or t1.Code in (?, ?) or (? < t1.Code "
     "and t1.ID = ?)) <- 5, x, 7, 9, 4",
     "4"},
    {"select 1 [user], x.[percent] from (select ID [percent] from GRTax with (nolock)) x "
     "with (nolock) where x.[percent]=2",
     "select ? as \"user\", t2.\"percent\" as \"percent\" from (select t1.ID as \"percent\" from "
     "GRTax t1) t2 where t2.\"percent\" = ? <- 1, 2",
     "select ? as [user], t2.[percent] as [percent] from (select t1.ID as [percent] from GRTax t1 "
     "with (nolock)) t2 where t2.[percent] = ? <- 1, 2",
     "1|2"},
};

TEST(StatementTest, PrintedForBothDatabases) {
    const Translator sqlite = Database().translator();
    const Translator server(Database().schema(), Dialect::kSqlServer);
    for (const StatementRow& row : kStatements) {
        SCOPED_TRACE(row.text);
        const auto print = [&row](const Translator& translator) {
            return ShownOrError([&] { return translator.Select(FirstCustomer(), row.text); });
        };
        const std::string printed = print(sqlite);
        if (row.sqlite) {
            EXPECT_EQ(printed, row.sqlite);
        }
        if (row.sql_server || row.sqlite) {
            EXPECT_EQ(print(server), row.sql_server ? row.sql_server : row.sqlite);
        }
        const bool runs = printed.starts_with("select");
        EXPECT_EQ(runs ? Database().Run(sqlite.Select(FirstCustomer(), row.text)) : printed,
                  row.rows);
    }
}

// Narrowing a joined subquery never changes what a statement gives.
TEST(StatementTest, OnlyPlainSubqueriesAreNarrowed) {
    const struct {
        const char* text;
        bool narrowed;
        const char* rows;
    } rows[] = {
        {"select a.ID, d.c from GRArticle a left join (select IDGRArticle k, IDGRArticleCat c from "
         "GRArticleCatRel where ID<9 or ID>10) d on d.k=a.ID where a.ID in (2,4) order by 1, 2",
         true,
         "2|1;2|3;4|"},
        {"select a.ID, d.c from GRArticle a left join (select top 1 IDGRArticle k, IDGRArticleCat "
         "c from GRArticleCatRel order by ID) d on d.k=a.ID where a.ID in (2,4) order by 1, 2",
         false,
         "2|;4|"},
        {"select a.ID, d.c from GRArticle a left join (select IDGRArticle k, count(*) c from "
         "GRArticleCatRel group by IDGRArticle) d on d.k=a.ID where a.ID in (2,4) order by 1",
         false,
         "2|2;4|"},
        {"select a.ID, d.c from GRArticle a left join (select IDGRArticle k, IDGRArticleCat c from "
         "GRArticleCatRel) d on d.k=a.ID where a.ID in (4) or d.c=3 order by 1",
         false,
         "2|3;4|"},
        {"select a.ID, d.c from GRArticle a left join (select IDGRArticle k, IDGRArticleCat c from "
         "GRArticleCatRel) d on d.k<a.ID where a.ID in (2) order by 1",
         false,
         "2|1"},
        {"select a.ID, d.c from GRArticle a left join (select IDGRArticle k, IDGRArticleCat c from "
         "GRArticleCatRel) d on d.k=a.ID where a.ID not in (2,3) order by 1",
         false,
         "1|1;4|"},
    };
    for (const auto& row : rows) {
        SCOPED_TRACE(row.text);
        const BoundSql sql = Database().translator().Select(FirstCustomer(), row.text);
        const std::string_view text = sql.text;
        const std::size_t inner =
            text.find(") t2") == std::string_view::npos ? text.find(") t3") : text.find(") t2");
        EXPECT_EQ(text.substr(0, inner).find("json_each") != std::string_view::npos, row.narrowed);
        EXPECT_EQ(Database().Run(sql), row.rows);
    }
}

}  // namespace
}  // namespace zebtell::erp
