#include "check/addresses.h"

#include <algorithm>

#include "base/like.h"
#include "base/text.h"
#include "check/html_reader.h"
#include "web/fields.h"
#include "web/form_parser.h"

namespace zebtell::check {
namespace {

bool HasGap(std::string_view text) {
    return text.find(HtmlReader::kGap) != text.npos;
}

// What follows "?" in an address relative to the portal's own.
std::optional<std::string> QueryOf(std::string_view address) {
    const std::size_t mark = address.find('?');
    if (mark == address.npos || (mark != 0 && address.substr(0, mark) != "/")) return std::nullopt;
    const std::string_view query = address.substr(mark + 1);
    return base::Replaced(query.substr(0, query.find('#')), "&amp;", "&");
}

const CheckedPage* FindPage(std::span<const CheckedPage> pages, std::string_view name) {
    const auto found = std::find_if(pages.begin(), pages.end(), [&](const CheckedPage& page) {
        return base::EqualNoCase(page.name, name);
    });
    return found == pages.end() ? nullptr : &*found;
}

bool Takes(const CheckedPage& page, std::string_view event) {
    const auto& patterns = page.event_patterns;
    const auto is_event = [&](std::string_view name) { return base::EqualNoCase(name, event); };
    return std::any_of(page.events.begin(), page.events.end(), is_event) ||
           std::any_of(patterns.begin(), patterns.end(), [&](std::string_view pattern) {
               return base::Like(event, pattern);
           });
}

}  // namespace

std::optional<std::string> AddressFault(std::string_view address,
                                        std::span<const CheckedPage> pages) {
    const auto query = QueryOf(address);
    const auto fields = query ? web::ParseUrlEncoded(*query) : std::nullopt;
    if (!fields) return std::nullopt;
    const web::FieldList parameters(*fields);
    const std::string page_name = parameters["page"];
    const std::string event = parameters["event"];
    if (HasGap(page_name)) return std::nullopt;
    if (page_name.empty()) {
        if (event.empty()) return std::nullopt;
        return "the event " + event + " is of no page";
    }
    const CheckedPage* page = FindPage(pages, page_name);
    if (page == nullptr) return "there is no page " + page_name;
    // An event that begins with what is written at run time can be any.
    if (event.empty() || event.front() == HtmlReader::kGap || Takes(*page, event)) {
        return std::nullopt;
    }
    return "page " + std::string(page->name) + " has no event " +
           event.substr(0, event.find(HtmlReader::kGap));
}

}  // namespace zebtell::check
