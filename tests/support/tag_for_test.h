#pragma once

#include <string>
#include <string_view>
#include <utility>

#include "base/text.h"
#include "markup/tag.h"

namespace zebtell::markup {

// A tag as a template would raise it, for tests of tag handlers without a template.
class TagForTest {
  public:
    explicit TagForTest(std::string name, std::string contents = {})
        : name_(std::move(name)), lower_name_(base::Lower(name_)), contents_(std::move(contents)) {
        tag_.name_ = name_;
        tag_.lower_name_ = lower_name_;
        tag_.contents_ = contents_;
    }
    TagForTest(const TagForTest&) = delete;
    TagForTest& operator=(const TagForTest&) = delete;

    Tag& tag() { return tag_; }
    // What the page would now hold in place of the tag, before it is scanned again.
    std::string TagContents() const { return tag_.TagContents(); }
    bool WroteText() const { return tag_.output_ == Tag::Output::kText; }

  private:
    std::string name_;
    std::string lower_name_;
    std::string contents_;
    Tag tag_;
};

}  // namespace zebtell::markup
