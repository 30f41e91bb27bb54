#pragma once

#include <string>

#include "tags/tag_table.h"

namespace zebtell::tags {

// The name of the shown basket row's comment box; basket forms with such boxes then change the
// comments.
bool CommentBox(TagCall& call);

// The contents when what was typed into the form field `box` was refused, with that text in place
// of the word "Typed"; nothing otherwise.
void ShowIfRefused(TagCall& call, const std::string& box);

}  // namespace zebtell::tags
