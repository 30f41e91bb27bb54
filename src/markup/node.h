#pragma once

#include <cstdint>
#include <deque>
#include <string>
#include <string_view>
#include <vector>

namespace zebtell::markup {

// A run of text, or a tag with the nodes of its contents. A template's nodes lie in one row in the
// order of the text: a tag's first child is the node behind it, and what follows the tag is `size`
// nodes further on. So neither making nor destroying deep nesting takes any stack.
struct Node {
    enum class Kind : std::uint8_t { kText, kTag };

    Kind kind = Kind::kText;
    // kTag: false for a start whose end is missing.
    bool is_complete = true;
    std::uint32_t size = 1;            // this node and all below it
    std::string_view text = {};        // the run, or the tag's contents
    std::string_view name = {};        // "ZEB:Name"
    std::string_view lower_name = {};  // "zeb:name"

    const Node* ChildrenBegin() const { return this + 1; }
    const Node* ChildrenEnd() const { return this + size; }
    const Node* Next() const { return this + size; }
};

// A parsed text. The views point into the text and into `names`.
struct NodeTree {
    std::vector<Node> nodes;               // the first is the root, a tag without a name
    std::deque<std::string> names;         // each name once, in lower case
    std::vector<std::string_view> strays;  // ends without a start, which pass through as text
};

// Linear in the length of the text. RuntimeError 5 beyond 4 GB.
NodeTree ParseNodes(std::string_view text);

}  // namespace zebtell::markup
