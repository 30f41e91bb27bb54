#pragma once

#include <string>
#include <string_view>

namespace zebtell::markup {

// & < > " ' become entities, so that a browser shows exactly this text, in contents and in quoted
// attribute values, and the template engine finds no tag in it.
std::string Escaped(std::string_view text);
void AppendEscaped(std::string& out, std::string_view text);

}  // namespace zebtell::markup
