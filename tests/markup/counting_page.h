#pragma once

#include <string>

#include "markup/tag.h"
#include "markup/template.h"

namespace zebtell::markup {

// A page with state, so that tags raised in another order or another number give another output.
class CountingPage {
  public:
    void operator()(Tag& tag) {
        ++raised_;
        const std::string name(tag.LowerName());
        if (name == "zeb:row" || name == "zeb:rows.row") Row(tag);
        if (name == "zeb:hide" || name == "zeb:hidden") tag.Hide();
        if (name == "zeb:number") tag.Write("#" + std::to_string(raised_));
        if (name == "zeb:typed") tag.WriteEscaped("<ZEB:Number/> & 'more'");
        if (name == "zeb:text")
            tag.Write("(" + tag.TagContents() + "<zeb:NUMBER/><ZEB:Show>t</ZEB:Show>)");
        if (name == "zeb:send") tag.SendTags = true;
        if (name == "zeb:next") tag.Continue("ZEB:Shown");
        if (name == "zeb:part") tag.Repeat("ZEB:Hidden", "|");
        if (name == "zeb:odd") tag.Repeat("no tag", "<ZEB:Number/>");
        if (name == "zeb:sendrow") {
            tag.SendTags = true;
            Row(tag);
        }
    }

  private:
    void Row(Tag& tag) {
        if (++row_ % 4 == 0 || raised_ > kEnough) return;
        if (row_ % 4 == 3) return tag.Continue(tag.TagName());
        const bool textual = row_ % 8 > 4;
        if (!textual) return tag.Repeat(tag.TagName(), "\r\n");
        const std::string again(tag.TagName());
        const std::string contents(tag.TemplateContents());
        tag.Write(contents + "\r\n<" + again + ">" + contents + "</" + again + ">");
    }

    static constexpr int kEnough = 300;

    int raised_ = 0;
    int row_ = 0;
};

}  // namespace zebtell::markup
