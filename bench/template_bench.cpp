#include <benchmark/benchmark.h>

#include <array>
#include <string>

#include "markup/escape.h"
#include "markup/template.h"

namespace zebtell::markup {
namespace {

constexpr std::array<std::string_view, 6> kValues = {
    "A-10442", "Hexagon bolt M8 x 40 DIN 933", "pcs", "1 250", "0.4175", "0.4926"};

constexpr std::string_view kRow =
    "<tr><td><ZEB:Field>Code</ZEB:Field></td><td><ZEB:Field>Name</ZEB:Field></td>"
    "<td><ZEB:Field>Unit</ZEB:Field></td><td><ZEB:Field>Stock</ZEB:Field></td>"
    "<td><ZEB:Field>Price</ZEB:Field></td><td><ZEB:Field>Price18</ZEB:Field></td></tr>\n";

void Report(benchmark::State& state, std::size_t bytes) {
    const auto rows = static_cast<std::int64_t>(state.iterations() * state.range(0));
    state.SetItemsProcessed(rows);
    state.counters["us_per_row"] = benchmark::Counter(
        static_cast<double>(rows) / 1e6, benchmark::Counter::kIsRate | benchmark::Counter::kInvert);
    state.counters["bytes"] = static_cast<double>(bytes);
}

// A block of six fields repeated by its tag.
void BM_ExpandRows(benchmark::State& state) {
    const auto page =
        Template::Parse("bench", "<table><ZEB:Row>" + std::string(kRow) + "</ZEB:Row></table>");
    std::size_t bytes = 0;
    for (auto _ : state) {
        std::int64_t row = 0;
        std::size_t field = 0;
        std::string out;
        Expand(
            *page,
            [&](Tag& tag) {
                if (tag.LowerName() == "zeb:field") {
                    tag.WriteEscaped(kValues[field]);
                    field = field == 5 ? 0 : field + 1;
                } else if (++row < state.range(0)) {
                    tag.Repeat("ZEB:Row");
                }
            },
            out);
        bytes = out.size();
        benchmark::DoNotOptimize(out.data());
    }
    Report(state, bytes);
}
BENCHMARK(BM_ExpandRows)->Arg(20)->Arg(1000)->Arg(10000)->Arg(100000);

// The same rows written as text by the handler, which the engine scans again.
void BM_ExpandRowsAsText(benchmark::State& state) {
    const std::string text = "<ZEB:Row>" + std::string(kRow) + "</ZEB:Row>";
    const auto page = Template::Parse("bench", "<table>" + text + "</table>");
    const std::string again = std::string(kRow) + text;
    std::size_t bytes = 0;
    for (auto _ : state) {
        std::int64_t row = 0;
        std::size_t field = 0;
        std::string out;
        Expand(
            *page,
            [&](Tag& tag) {
                if (tag.LowerName() == "zeb:field") {
                    tag.WriteEscaped(kValues[field]);
                    field = field == 5 ? 0 : field + 1;
                } else if (++row < state.range(0)) {
                    tag.Write(again);
                }
            },
            out);
        bytes = out.size();
        benchmark::DoNotOptimize(out.data());
    }
    Report(state, bytes);
}
BENCHMARK(BM_ExpandRowsAsText)->Arg(1000)->Arg(10000);

// The same output by appending strings, escaped likewise.
void BM_AppendRows(benchmark::State& state) {
    std::size_t bytes = 0;
    for (auto _ : state) {
        std::string out = "<table>";
        for (std::int64_t row = 0; row < state.range(0); ++row) {
            out += "<tr><td>";
            AppendEscaped(out, kValues[0]);
            for (std::size_t field = 1; field < kValues.size(); ++field) {
                out += "</td><td>";
                AppendEscaped(out, kValues[field]);
            }
            out += "</td></tr>\n";
        }
        out += "</table>";
        bytes = out.size();
        benchmark::DoNotOptimize(out.data());
    }
    Report(state, bytes);
}
BENCHMARK(BM_AppendRows)->Arg(1000)->Arg(10000);

// A page of 20 KB and 200 tags read from its file.
void BM_Parse(benchmark::State& state) {
    std::string text;
    for (int i = 0; i < 33; ++i) text += std::string(kRow) + std::string(250, 'x');
    for (auto _ : state) benchmark::DoNotOptimize(Template::Parse("bench", text));
    state.SetBytesProcessed(static_cast<std::int64_t>(state.iterations() * text.size()));
}
BENCHMARK(BM_Parse);

}  // namespace
}  // namespace zebtell::markup

BENCHMARK_MAIN();
