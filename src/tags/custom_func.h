#pragma once

#include <string>
#include <string_view>

#include "base/region.h"
#include "data/record.h"

namespace zebtell::tags {

// Every no-break space becomes a blank; then blanks at both ends go.
std::string CleanFormValue(std::string_view text);

// For a template's SQL: no-break spaces and the entities of < > & become characters; trimmed.
std::string CleanPriceQueryText(std::string_view text);

// A field of a record as HTML text. The reference is a field with modifiers, a conditional or
// alternatives:
//
//   A | B                 the first that is neither empty nor "&nbsp;"
//   ?field=compare;output the output, as it stands, if the test holds ("=" "#" "<" ">")
//   field;modifier        "dd.mm.yyyy;zebdate", "zeb:len=20,quote,nospace", "zeb:attr", or a
//                         format picture
//   field                 formatted by `format` unless that is empty
//
// Errors in reading and converting end the call with what is there so far, mostly "".
std::string FormatFieldValue(data::Record& record,
                             std::string_view reference,
                             std::string_view format,
                             const base::Region& region);

}  // namespace zebtell::tags
