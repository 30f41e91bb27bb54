#pragma once

#include <optional>
#include <string_view>
#include <vector>

#include "web/fields.h"

namespace zebtell::web {

// Fields from the wire. Bytes that are not UTF-8 are taken as windows-1257; a NUL becomes U+FFFD,
// so that leaving it out never makes a name into another one.

// More fields than a form of this portal can have; nobody gets to make us sort more.
inline constexpr std::size_t kMaxFields = 10'000;

// "a=1&b=2", in a query string or a posted form. Nothing for more than kMaxFields.
std::optional<std::vector<Field>> ParseUrlEncoded(std::string_view text);

struct MultipartForm {
    enum class Outcome { kRead, kMalformed, kTooManyFields };
    Outcome outcome = Outcome::kMalformed;
    std::vector<Field> fields;
};

// A multipart/form-data body. A file's value is its name: the portal takes no files.
MultipartForm ParseMultipart(std::string_view body, std::string_view boundary);

// The value of a parameter such as the boundary in `multipart/form-data; boundary="x"`.
std::optional<std::string> HeaderParameter(std::string_view header, std::string_view name);

}  // namespace zebtell::web
