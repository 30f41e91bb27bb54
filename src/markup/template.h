#pragma once

#include <functional>
#include <memory>
#include <string>
#include <string_view>

#include "markup/tag.h"

namespace zebtell::markup {

struct Node;
struct NodeTree;

// A template text, parsed once and shared by all threads that expand it.
//
//   <ZEB:Name>contents</ZEB:Name>   <ZEB:Name/>
//
// Names ignore case, may hold letters, digits, "_", "-" and ".", and stand anywhere, in attribute
// values too. Same-name nesting is balanced; an opening tag without its end is a tag with empty
// contents. Everything else passes through byte for byte.
class Template {
  public:
    // `name` is for messages: the file's name.
    static std::shared_ptr<const Template> Parse(std::string name, std::string text);
    ~Template();

    const std::string& name() const { return name_; }
    const std::string& text() const { return text_; }
    // The whole text as a node without a name; see node.h for how to walk below it.
    const Node& root() const;
    const NodeTree& tree() const { return *tree_; }

  private:
    Template(std::string name, std::string text);

    std::string name_;
    std::string text_;
    std::unique_ptr<const NodeTree> tree_;
};

// Where a page must end rather than go on: a template that repeats itself without end.
struct ExpandLimits {
    std::size_t tags = 1'000'000;
    std::size_t bytes = 64U << 20U;
    std::size_t depth = 100;  // of tags made by tags
};

// Appends the expanded template to `out`, raising `process_tag` for each tag, outermost first.
// RuntimeError 5 with the names of the template and the tag when a limit is passed; what the
// handler throws passes through.
void Expand(const Template& page,
            const std::function<void(Tag&)>& process_tag,
            std::string& out,
            const ExpandLimits& limits = {});

}  // namespace zebtell::markup
