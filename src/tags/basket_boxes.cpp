#include "tags/basket_boxes.h"

#include "base/text.h"
#include "markup/escape.h"

namespace zebtell::tags {

bool CommentBox(TagCall& call) {
    call.state.basket_form.ShowRowExplanations = true;
    call.tag.Write("Expl_" + std::to_string(call.state.basket_form.RowIndex));
    return true;
}

void ShowIfRefused(TagCall& call, const std::string& box) {
    const auto& refused = call.state.basket_form.LastForm.Refused;
    const auto found = refused.find(box);
    if (found == refused.end()) return call.tag.Hide();
    call.tag.Write(
        base::ReplacedNoCase(call.tag.TemplateContents(), "Typed", markup::Escaped(found->second)));
}

}  // namespace zebtell::tags
