#pragma once

#include <string>
#include <string_view>

namespace zebtell::http {

// A name or value of a form or query string: "+" is a blank, "%41" a byte. Sequences that are not
// a byte ("%", "%4", "%zz") stay as they are.
std::string DecodeComponent(std::string_view text);

// A path: as above, but "+" is itself.
std::string DecodePath(std::string_view text);

// Everything but letters, digits and "-._~" becomes "%XX", so the result fits any part of an
// address. Both decoders above give the text back.
std::string EncodeComponent(std::string_view text);

}  // namespace zebtell::http
