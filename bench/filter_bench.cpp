#include <benchmark/benchmark.h>

#include <string>
#include <vector>

#include "erp/translator.h"

namespace zebtell::erp {
namespace {

Column Link(const char* name, const char* table) {
    return {name, ColumnType::kInteger, table};
}
Column Text(const char* name) {
    return {name, ColumnType::kText, ""};
}
Column Money(const char* name) {
    return {name, ColumnType::kCurrency, ""};
}

// The tables that the catalogue reads.
const Schema& CatalogueSchema() {
    const Column id = Link("ID", "");
    static const Schema schema({
        {"GRTax", false, {id, Text("Name"), Money("TaxPercent")}},
        {"GRArticle",
         false,
         {id,
          Text("Code"),
          Text("Name"),
          Text("Unit"),
          Text("Barcode"),
          Link("IDGRTax", "GRTax"),
          Link("IDGRArticlePriceCat", "")}},
        {"GRArticleCatRel",
         false,
         {id, Link("IDGRArticle", "GRArticle"), Link("IDGRArticleCat", "")}},
        {"GRCompany", false, {id, Text("Name"), Link("IDGRCompanyPriceCat", "")}},
        {"GRPriceCatRel",
         false,
         {id,
          Link("IDGRCompanyPriceCat", ""),
          Link("IDGRArticlePriceCat", ""),
          Link("IDGRPriceList", ""),
          Money("PriceCut")}},
        {"GRPriceListRel",
         false,
         {id, Link("IDGRPriceList", ""), Link("IDGRArticle", "GRArticle"), Money("Price")}},
        {"SQPriceList5",
         true,
         {id,
          Link("IDGRPriceList", ""),
          Link("IDSrcPriceList", ""),
          Link("IDGRArticle", "GRArticle"),
          Money("Price")}},
        {"SQCatPriceList5",
         true,
         {id,
          Link("IDGRPriceList", ""),
          Link("IDSrcPriceList", ""),
          Link("IDGRArticle", "GRArticle"),
          Money("Price"),
          Link("IDGRArticleCat", "")}},
    });
    return schema;
}

Reader Customer() {
    Reader reader;
    reader.role = Role::kUser;
    reader.partner = 1;
    reader.price_lists = {20, 10};
    return reader;
}

void ListKeys(benchmark::State& state, const char* filter) {
    const Translator translator(CatalogueSchema(), Dialect::kSqlite);
    const Reader reader = Customer();
    const std::vector<std::string> columns = {"IDGRArticle"};
    for (auto _ : state) {
        benchmark::DoNotOptimize(
            translator.ListKeys(reader, "GRPriceListRel", filter, "GRArticle.Code", columns));
    }
}

BENCHMARK_CAPTURE(ListKeys, key, "ID=17");
BENCHMARK_CAPTURE(ListKeys,
                  search,
                  "{GRPriceListRel.Price<>0 AND GRPriceListRel.ID IN (select P5.ID from "
                  "SQPriceList5 P5 inner join GRArticle on P5.IDGRArticle=GRArticle.ID where "
                  "(GRArticle.name LIKE '*kruvi*M6*' OR GRArticle.code LIKE 'kruvi*M6*') AND "
                  "(IDGRPriceList=20))}");
BENCHMARK_CAPTURE(ListKeys, category, "GRArticle.GRArticleCatRel.IDGRArticleCat IN (3)");

void RowsByID(benchmark::State& state) {
    const Translator translator(CatalogueSchema(), Dialect::kSqlite);
    const Reader reader = Customer();
    std::vector<std::int64_t> ids(20);
    const std::vector<std::string> fields = {"Price",
                                             "GRArticle.Code",
                                             "GRArticle.Name",
                                             "GRArticle.Unit",
                                             "GRArticle.GRTax.TaxPercent"};
    for (auto _ : state) {
        benchmark::DoNotOptimize(translator.RowsByID(reader, "GRPriceListRel", ids, fields));
    }
}
BENCHMARK(RowsByID);

std::string PriceQuery(std::int64_t articles) {
    std::string list = "1000";
    for (std::int64_t i = 1; i < articles; ++i) {
        list += "," + std::to_string(1000 + i);
    }
    return "select s5.*, rc.idgrcompany, isnull(pricecut, 0) as pricecut,round (price * (100 + "
           "isnull(pricecut, 0)), 0) / 100 as finalprice\r\nfrom\r\nsqpricelist5 s5 with "
           "(nolock)\r\nleft join (\r\nselect\r\nrel.pricecut, rel.idgrpricelist, gc.id as "
           "idgrcompany, ga.id as idgrarticle\r\nfrom\r\ngrpricecatrel rel with (nolock)\r\ninner "
           "join grarticle ga with (nolock) on ga.idgrarticlepricecat=rel.idgrarticlepricecat\r\n"
           "inner join grcompany gc with (nolock) on gc.idgrcompanypricecat="
           "rel.idgrcompanypricecat\r\nwhere gc.id=1\r\n) rc on s5.idgrarticle=rc.idgrarticle and "
           "s5.idsrcpricelist=rc.idgrpricelist\r\nwhere\r\ns5.idgrpricelist=20\r\nand "
           "s5.idgrarticle in (" +
           list + ")";
}

void PriceQueryOfArticles(benchmark::State& state) {
    const Translator translator(CatalogueSchema(), Dialect::kSqlite);
    const Reader reader = Customer();
    const std::string text = PriceQuery(state.range(0));
    for (auto _ : state) {
        benchmark::DoNotOptimize(translator.Select(reader, text));
    }
}
BENCHMARK(PriceQueryOfArticles)->Arg(20)->Arg(30000);

}  // namespace
}  // namespace zebtell::erp
