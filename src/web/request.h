#pragma once

#include <string>
#include <string_view>

#include "web/fields.h"

namespace zebtell::web {

// A page request. Texts are UTF-8, also where the client sent something else.
struct Request {
    std::string method;
    std::string page;   // "" when the address names none
    std::string event;  // "" for a plain page request
    FieldList Form;
    FieldList QueryString;
    std::string query_string;  // as it came, without control characters
    std::string remote_address;

    // "QUERY_STRING", "REMOTE_ADDR", "REMOTE_HOST" (the address: it is not looked up); "" for
    // others.
    std::string ServerVariables(std::string_view name) const;
    // The form's field, else the query string's.
    std::string Value(std::string_view name) const;
};

}  // namespace zebtell::web
