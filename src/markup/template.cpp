#include "markup/template.h"

#include <utility>

#include "markup/node.h"

namespace zebtell::markup {

Template::Template(std::string name, std::string text)
    : name_(std::move(name)),
      text_(std::move(text)),
      tree_(std::make_unique<const NodeTree>(ParseNodes(text_))) {}

Template::~Template() = default;

std::shared_ptr<const Template> Template::Parse(std::string name, std::string text) {
    struct Parsed : Template {
        Parsed(std::string name, std::string text) : Template(std::move(name), std::move(text)) {}
    };
    return std::make_shared<const Parsed>(std::move(name), std::move(text));
}

const Node& Template::root() const {
    return tree_->nodes.front();
}

}  // namespace zebtell::markup
