#include <benchmark/benchmark.h>

#include "base/currency.h"
#include "base/format.h"
#include "base/like.h"
#include "base/text.h"

namespace zebtell::base {
namespace {

// Other values in every round, so that no branch is learnt by heart.
constexpr std::size_t kValues = 256;

std::vector<Value> Prices() {
    std::vector<Value> prices;
    for (std::size_t i = 0; i < kValues; ++i) {
        prices.emplace_back(Currency::FromScaled(static_cast<std::int64_t>(i * i * 7919 + 1234)));
    }
    return prices;
}

std::vector<Value> Quantities() {
    std::vector<Value> quantities;
    for (std::size_t i = 0; i < kValues; ++i) {
        quantities.emplace_back(static_cast<double>(i * 37) / 8);
    }
    return quantities;
}

// Doubles with all their digits, as computing leaves them.
std::vector<Value> Results() {
    std::vector<Value> results;
    for (std::size_t i = 0; i < kValues; ++i) {
        results.emplace_back(static_cast<double>(i * i + 1) / 7);
    }
    return results;
}

std::vector<Value> Dates() {
    std::vector<Value> dates;
    for (std::size_t i = 0; i < kValues; ++i) {
        dates.emplace_back(DateTime(46000.25 + static_cast<double>(i)));
    }
    return dates;
}

void FormatEach(benchmark::State& state, const std::vector<Value>& values, const char* picture) {
    const Region& region = RegionFor("et");
    std::size_t i = 0;
    for (auto _ : state) {
        benchmark::DoNotOptimize(Format(values[i++ % kValues], picture, region));
    }
}

BENCHMARK_CAPTURE(FormatEach, price_fixed, Prices(), "Fixed");
BENCHMARK_CAPTURE(FormatEach, price_standard, Prices(), "Standard");
BENCHMARK_CAPTURE(FormatEach, price_picture, Prices(), "0.00");
BENCHMARK_CAPTURE(FormatEach, price_grouped_picture, Prices(), "#,##0.00");
BENCHMARK_CAPTURE(FormatEach, quantity_picture, Quantities(), "0.###");
BENCHMARK_CAPTURE(FormatEach, quantity_general, Quantities(), "General Number");
BENCHMARK_CAPTURE(FormatEach, result_fixed, Results(), "Fixed");
BENCHMARK_CAPTURE(FormatEach, date_picture, Dates(), "dd.mm.yyyy");
BENCHMARK_CAPTURE(FormatEach, date_time_picture, Dates(), "dd.mm.yyyy hh:nn");
BENCHMARK_CAPTURE(FormatEach, short_date, Dates(), "Short Date");

void TextOf(benchmark::State& state, const std::vector<Value>& values) {
    const Region& region = RegionFor("et");
    std::size_t i = 0;
    for (auto _ : state) benchmark::DoNotOptimize(values[i++ % kValues].ToText(region));
}

BENCHMARK_CAPTURE(TextOf, price, Prices());
BENCHMARK_CAPTURE(TextOf, quantity, Quantities());
BENCHMARK_CAPTURE(TextOf, result, Results());
BENCHMARK_CAPTURE(TextOf, date, Dates());

void MultiplyPrice(benchmark::State& state) {
    std::int64_t price = 12'3450;
    for (auto _ : state) {
        benchmark::DoNotOptimize(Multiplied(Currency::FromScaled(price++), 12.5, 2));
    }
}
BENCHMARK(MultiplyPrice);

void LikeText(benchmark::State& state, const char* text, const char* pattern) {
    for (auto _ : state) benchmark::DoNotOptimize(Like(text, pattern));
}

BENCHMARK_CAPTURE(LikeText, prefix, "ZEB:Tellimus.Exists", "zeb:tellimus*");
BENCHMARK_CAPTURE(LikeText, contains, "Kuuskantpolt M8x40 tsingitud DIN 933", "*tsin?itud*");
BENCHMARK_CAPTURE(LikeText, list, "A-1234", "[a-d]-####");

void EqualText(benchmark::State& state, const char* a, const char* b) {
    for (auto _ : state) benchmark::DoNotOptimize(EqualNoCase(a, b));
}

BENCHMARK_CAPTURE(EqualText, ascii, "ZEB:Kaubainfo.Row", "zeb:kaubainfo.row");
BENCHMARK_CAPTURE(EqualText, estonian, "Tööriistad ja õlid", "TÖÖRIISTAD JA ÕLID");

void HashKey(benchmark::State& state) {
    for (auto _ : state) benchmark::DoNotOptimize(NoCaseHash()("GRArticle.GRTax.TaxPercent"));
}
BENCHMARK(HashKey);

}  // namespace
}  // namespace zebtell::base
