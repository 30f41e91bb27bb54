#include "web/request.h"

#include "base/text.h"

namespace zebtell::web {

std::string Request::ServerVariables(std::string_view name) const {
    if (base::EqualNoCase(name, "QUERY_STRING")) return query_string;
    if (base::EqualNoCase(name, "REMOTE_ADDR") || base::EqualNoCase(name, "REMOTE_HOST"))
        return remote_address;
    return {};
}

std::string Request::Value(std::string_view name) const {
    return Form.Has(name) ? Form[name] : QueryString[name];
}

}  // namespace zebtell::web
