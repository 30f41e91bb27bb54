#include "http/message.h"

#include "base/text.h"

namespace zebtell::http {

std::string_view Request::HeaderValue(std::string_view name) const {
    for (const auto& [header, value] : headers) {
        if (header.size() == name.size() && base::EqualNoCase(header, name)) return value;
    }
    return {};
}

std::string_view Request::Path() const {
    return std::string_view(target).substr(0, target.find('?'));
}

std::string_view Request::Query() const {
    const std::size_t mark = target.find('?');
    return mark == std::string::npos ? std::string_view()
                                     : std::string_view(target).substr(mark + 1);
}

}  // namespace zebtell::http
