#include <limits>
#include <unordered_map>

#include "base/runtime_error.h"
#include "base/text.h"
#include "markup/node.h"
#include "markup/tag_scan.h"

namespace zebtell::markup {
namespace {

constexpr std::size_t kNone = std::numeric_limits<std::size_t>::max();

// A tag of the text, the number of its name, and, for a start, which mark ends it.
struct Mark {
    TagMark tag;
    std::size_t name = 0;
    std::size_t end_mark = kNone;
};

class Parser {
  public:
    explicit Parser(std::string_view text) : text_(text) {}

    NodeTree Parse() {
        ReadMarks();
        AddNode({.kind = Node::Kind::kTag, .text = text_});
        open_.push_back({0, kNone});
        for (std::size_t i = 0; i < marks_.size(); ++i) Take(i);
        AddText(text_.size());
        tree_.nodes[0].size = static_cast<std::uint32_t>(tree_.nodes.size());
        return std::move(tree_);
    }

  private:
    struct Open {
        std::size_t node;
        std::size_t end_mark;
    };

    // Starts and ends of one name balance like brackets, whatever other names do between them.
    void ReadMarks() {
        std::vector<std::vector<std::size_t>> open_starts;
        for (auto tag = FindTag(text_, 0); tag; tag = FindTag(text_, tag->end)) {
            const std::size_t name = NameNumber(tag->name);
            open_starts.resize(tree_.names.size());
            auto& starts = open_starts[name];
            if (tag->kind == TagMark::Kind::kStart) {
                starts.push_back(marks_.size());
            } else if (tag->kind == TagMark::Kind::kEnd && !starts.empty()) {
                marks_[starts.back()].end_mark = marks_.size();
                starts.pop_back();
            }
            marks_.push_back({*tag, name});
        }
    }

    std::size_t NameNumber(std::string_view name) {
        const auto known = numbers_.find(name);
        if (known != numbers_.end()) return known->second;
        const std::size_t number = tree_.names.size();
        tree_.names.push_back(base::Lower(name));
        numbers_.emplace(name, number);
        return number;
    }

    void Take(std::size_t index) {
        const Mark& mark = marks_[index];
        if (index == open_.back().end_mark) {
            Close(mark);
        } else if (mark.tag.kind == TagMark::Kind::kEnd) {
            tree_.strays.push_back(text_.substr(mark.tag.begin, mark.tag.end - mark.tag.begin));
        } else {
            Start(mark);
        }
    }

    void Close(const Mark& mark) {
        AddText(mark.tag.begin);
        text_done_ = mark.tag.end;
        Node& node = tree_.nodes[open_.back().node];
        node.size = static_cast<std::uint32_t>(tree_.nodes.size() - open_.back().node);
        open_.pop_back();
    }

    void Start(const Mark& mark) {
        AddText(mark.tag.begin);
        text_done_ = mark.tag.end;
        // An end behind the end of the tag around it is not this tag's: it lies outside.
        const bool has_end = mark.end_mark != kNone && mark.end_mark < open_.back().end_mark;
        const std::size_t contents_end = has_end ? marks_[mark.end_mark].tag.begin : mark.tag.end;
        AddNode({.kind = Node::Kind::kTag,
                 .is_complete = has_end || mark.tag.kind == TagMark::Kind::kEmpty,
                 .text = text_.substr(mark.tag.end, contents_end - mark.tag.end),
                 .name = mark.tag.name,
                 .lower_name = tree_.names[mark.name]});
        if (has_end) open_.push_back({tree_.nodes.size() - 1, mark.end_mark});
    }

    void AddText(std::size_t end) {
        if (end == text_done_) return;
        AddNode({.kind = Node::Kind::kText, .text = text_.substr(text_done_, end - text_done_)});
    }

    void AddNode(const Node& node) { tree_.nodes.push_back(node); }

    std::string_view text_;
    std::size_t text_done_ = 0;  // the text up to here is in nodes
    std::vector<Mark> marks_;
    std::vector<Open> open_;
    std::unordered_map<std::string_view, std::size_t, base::NoCaseHash, base::NoCaseEqual> numbers_;
    NodeTree tree_;
};

}  // namespace

NodeTree ParseNodes(std::string_view text) {
    if (text.size() >= std::numeric_limits<std::uint32_t>::max())
        throw base::RuntimeError(base::errors::kInvalidCall, "Template too large");
    return Parser(text).Parse();
}

}  // namespace zebtell::markup
