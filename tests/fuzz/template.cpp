#include "markup/template.h"

#include <algorithm>
#include <optional>

#include "base/runtime_error.h"
#include "markup/node.h"
#include "markup/tag_scan.h"
#include "tests/fuzz/harness.h"
#include "tests/markup/counting_page.h"
#include "tests/markup/naive_engine.h"

// A page template.

namespace zebtell::fuzz {
namespace {

using markup::Node;
using markup::Tag;

constexpr std::size_t kLongest = 2000;

// Every byte of the text is in the tree once, in order.
void CheckTree(const markup::Template& page) {
    const std::string& text = page.text();
    const char* at = text.data();
    for (const Node& node : page.tree().nodes) {
        Claim(node.size >= 1, "a node holds itself");
        Claim(&node + node.size <= page.tree().nodes.data() + page.tree().nodes.size(),
              "a tag ends within the text");
        if (node.kind == Node::Kind::kTag && node.name.empty()) continue;
        Claim(
            node.text.empty() || (node.text.data() >= text.data() &&
                                  node.text.data() + node.text.size() <= text.data() + text.size()),
            "a node shows the text");
        if (node.kind == Node::Kind::kText) {
            Claim(node.text.data() >= at, "nodes follow one another");
            at = node.text.data() + node.text.size();
        } else {
            Claim(markup::IsTagName(node.name), "a tag has a name", node.name);
        }
    }
}

// What is unclosed means something else in a block that is copied; there only plain tags compare.
bool IsBalanced(const markup::Template& page) {
    const auto& tree = page.tree();
    return tree.strays.empty() && std::all_of(tree.nodes.begin(), tree.nodes.end(), [](auto& node) {
               return node.is_complete;
           });
}

bool CopiesBlocks(std::string_view lower_name) {
    static constexpr std::string_view kPlain[] = {
        "zeb:hide", "zeb:hidden", "zeb:number", "zeb:typed", "zeb:send"};
    return std::find(std::begin(kPlain), std::end(kPlain), lower_name) == std::end(kPlain);
}

std::optional<std::string> Expanded(const markup::Template& page,
                                    const std::function<void(Tag&)>& process_tag) {
    const markup::ExpandLimits limits{.tags = 2000, .bytes = 100'000, .depth = 20};
    std::string out;
    try {
        markup::Expand(page, process_tag, out, limits);
    } catch (const base::RuntimeError&) {
        return std::nullopt;
    }
    Claim(out.size() <= limits.bytes + page.text().size(), "a page has a limit");
    return out;
}

}  // namespace

void Try(std::string_view input) {
    const auto page = markup::Template::Parse("fuzz", std::string(input));
    CheckTree(*page);
    const auto untouched = Expanded(*page, [](Tag&) {});
    if (!markup::MayHoldTags(input)) Claim(untouched == input, "text without tags stays");

    const bool only_ascii = std::all_of(input.begin(), input.end(), [](char c) { return c > 0; });
    if (input.size() > kLongest || !only_ascii) return;
    const bool balanced = IsBalanced(*page);
    const auto handler = [balanced](markup::CountingPage& state) {
        return [&state, balanced](Tag& tag) {
            if (balanced || !CopiesBlocks(tag.LowerName())) state(tag);
        };
    };
    markup::CountingPage state;
    const auto out = Expanded(*page, handler(state));
    if (!out) return;
    markup::CountingPage naive_state;
    const markup::NaiveEngine naive(handler(naive_state));
    Claim(*out == naive.Expand(std::string(input)), "both engines write the same", *out);
}

}  // namespace zebtell::fuzz
