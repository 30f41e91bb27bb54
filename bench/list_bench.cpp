// Lists and pages of a company with 30,000 articles, as the catalogue reads them. ZEBTELL_BENCH_DB
// names the database file to use (it is made when it is missing).
#include <benchmark/benchmark.h>

#include <cstdlib>
#include <filesystem>
#include <string>

#include "base/text.h"
#include "data/price_query_text.h"
#include "demo/demo_company.h"
#include "erp/database.h"
#include "erp/sqlite/connection.h"

namespace zebtell::erp {
namespace {

constexpr int kPageLength = 20;
constexpr const char* kFields[] = {"ID",
                                   "Price",
                                   "IDGRArticle",
                                   "GRArticle.Code",
                                   "GRArticle.Name",
                                   "GRArticle.Unit",
                                   "GRArticle.Stock",
                                   "GRArticle.GRTax.TaxPercent"};

std::string DatabaseFile() {
    const char* named = std::getenv("ZEBTELL_BENCH_DB");
    const auto path = named ? std::filesystem::path(named)
                            : std::filesystem::temp_directory_path() / "zebtell-bench-30000.db";
    if (!std::filesystem::exists(path)) {
        demo::DemoOptions options;
        options.articles = 30000;
        options.today = *base::DateTime::FromIso("2026-03-15");
        demo::MakeDemoCompany(path, options);
    }
    return path.string();
}

const std::string& Path() {
    static const std::string path = DatabaseFile();
    return path;
}

std::unique_ptr<data::DataApplication> LogOn() {
    static Databases databases([] { return base::DateTime::Now(); });
    auto portal = databases.NewApplication();
    portal->Initialise("ZEBTell", "WEBUser", "WEBGuest", "Külaline");
    portal->Logon(data::DatabaseType::kSqlite, Path(), "mari", "mari-demo");
    return portal;
}

std::shared_ptr<data::RecordList> OpenCatalogue(data::DataApplication& portal, int least_id) {
    return portal.OpenList("GRPriceListRel", "ID > " + std::to_string(least_id), "GRArticle.Code");
}

// What fetching as many pairs costs without the runtime.
void FetchPairs(benchmark::State& state) {
    sqlite::SqliteConnection connection(Path(), Access::kRead, {});
    for (auto _ : state) {
        const auto cursor =
            connection.Query({"select ID, IDGRArticle from GRPriceListRel limit 30000", {}});
        std::int64_t sum = 0;
        while (cursor->Next()) {
            sum += cursor->GetInteger(0) + cursor->GetInteger(1);
        }
        benchmark::DoNotOptimize(sum);
    }
}
BENCHMARK(FetchPairs)->Unit(benchmark::kMillisecond);

// A filter that nobody has used before: the list is read.
void OpenNewList(benchmark::State& state) {
    const auto portal = LogOn();
    const char* order = state.range(0) == 0 ? "" : "GRArticle.Code";
    int least_id = -1;
    for (auto _ : state) {
        const std::string filter = "ID > " + std::to_string(least_id--);
        benchmark::DoNotOptimize(portal->OpenList("GRPriceListRel", filter, order)->Count());
    }
}
BENCHMARK(OpenNewList)->ArgName("by code")->Arg(0)->Arg(1)->Unit(benchmark::kMillisecond);

// The whole price list as the catalogue asks for it, and searches with few hits; never the same.
void OpenNewSearch(benchmark::State& state) {
    const auto portal = LogOn();
    const bool searches = state.range(0) != 0;
    int number = 0;
    std::int64_t rows = 0;
    for (auto _ : state) {
        const std::string text = searches ? "m" + std::to_string(++number) : "";
        const std::string filter =
            "{GRPriceListRel.Price<>-" + std::to_string(++number) +
            " AND GRPriceListRel.ID IN (select P5.ID from SQPriceList5 P5 inner join GRArticle on "
            "P5.IDGRArticle=GRArticle.ID where (GRArticle.name LIKE '*" +
            text + "*' OR GRArticle.code LIKE '" + text + "*') AND (IDGRPriceList=1))}";
        rows = portal->OpenList("GRPriceListRel", filter, "GRArticle.Code")->Count();
    }
    state.counters["rows"] = static_cast<double>(rows);
}
BENCHMARK(OpenNewSearch)->ArgName("words")->Arg(0)->Arg(1)->Unit(benchmark::kMillisecond);

void OpenKnownList(benchmark::State& state) {
    const auto portal = LogOn();
    OpenCatalogue(*portal, 0);
    for (auto _ : state) {
        benchmark::DoNotOptimize(OpenCatalogue(*portal, 0)->Count());
    }
}
BENCHMARK(OpenKnownList)->Unit(benchmark::kMicrosecond);

std::size_t ReadPage(data::RecordList& list, std::int64_t first) {
    std::size_t bytes = 0;
    for (std::int64_t i = first; i < first + kPageLength; ++i) {
        const auto row = list.Item(i);
        for (const char* field : kFields) {
            bytes += row->GetField(field).ToPlainText().size();
        }
    }
    return bytes;
}

// The first row of the next page, from 0: page after page of so many, or, of 0 pages, one that has
// hardly been read before.
std::int64_t NextFirst(std::int64_t first, std::int64_t pages) {
    return pages == 0 ? (first + 7) % 29'900 : (first + kPageLength) % (pages * kPageLength);
}

void TurnPage(benchmark::State& state) {
    const auto portal = LogOn();
    std::int64_t first = 0;
    auto list = OpenCatalogue(*portal, 0);
    for (auto _ : state) {
        benchmark::DoNotOptimize(ReadPage(*list, first + 1));
        first = NextFirst(first, state.range(0));
    }
}
BENCHMARK(TurnPage)->ArgName("pages")->Arg(0)->Arg(10)->Iterations(4000)->Unit(
    benchmark::kMicrosecond);

void FindByArticle(benchmark::State& state) {
    const auto portal = LogOn();
    const auto list = OpenCatalogue(*portal, 0);
    const std::string criterion =
        "idgrarticle=" + list->Item(20000)->GetField("IDGRArticle").ToPlainText();
    for (auto _ : state) {
        benchmark::DoNotOptimize(list->Find(criterion));
    }
}
BENCHMARK(FindByArticle)->Unit(benchmark::kMicrosecond);

// The customer's prices of a page of articles.
void PagePrices(benchmark::State& state) {
    const auto portal = LogOn();
    std::string text = base::ReplacedNoCase(data::DefaultPriceQueryText(), "#P", "1");
    text = base::ReplacedNoCase(text, "#H", "1");
    std::int64_t first = 0;
    for (auto _ : state) {
        std::string articles = std::to_string(first + 1);
        for (std::int64_t i = 2; i <= kPageLength; ++i) {
            articles += "," + std::to_string(first + i);
        }
        const auto prices = portal->OpenQuery(base::ReplacedNoCase(text, "#A", articles), 0, 0);
        benchmark::DoNotOptimize(prices->Count());
        first = NextFirst(first, state.range(0));
    }
}
BENCHMARK(PagePrices)
    ->ArgName("pages")
    ->Arg(0)
    ->Arg(10)
    ->Iterations(4000)
    ->Unit(benchmark::kMicrosecond);

}  // namespace
}  // namespace zebtell::erp
