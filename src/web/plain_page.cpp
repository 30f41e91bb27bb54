#include "web/plain_page.h"

#include "web/response.h"

namespace zebtell::web {
namespace {

struct StatusText {
    int status;
    std::string_view title;
    std::string_view text;
    std::string_view retry_after;  // seconds
};

constexpr StatusText kTexts[] = {
    {400, "Bad request", "The request could not be understood.", ""},
    {403,
     "Forbidden",
     "This address cannot be opened from another site. Open the portal itself.",
     ""},
    {404, "Not found", "There is no such page.", ""},
    {405, "Method not allowed", "The request could not be understood.", ""},
    {413, "Too large", "The form has too many fields.", ""},
    {415, "Unsupported form", "The form could not be understood.", ""},
    {500, "Server error", "Something went wrong. Please contact the system administrator.", ""},
    {503, "Busy", "The server is busy. Please try again in a moment.", "1"},
};

const StatusText& TextOf(int status) {
    for (const StatusText& text : kTexts)
        if (text.status == status) return text;
    return kTexts[0];
}

}  // namespace

std::string PlainPageHtml(int status) {
    const StatusText& text = TextOf(status);
    std::string html = "<!DOCTYPE html>\n<html lang=\"en\"><head><meta charset=\"utf-8\"><title>";
    html.append(text.title).append("</title></head>\n<body><h1>").append(text.title);
    return html.append("</h1>\n<p>").append(text.text).append("</p></body></html>\n");
}

http::Response PlainPage(int status) {
    Response page;
    page.SetStatus(status);
    page.SetCacheControl("no-store");
    page.Write(PlainPageHtml(status));
    if (status == 405) page.AddHeader("Allow", "GET, HEAD, POST");
    const std::string_view retry_after = TextOf(status).retry_after;
    if (!retry_after.empty()) page.AddHeader("Retry-After", std::string(retry_after));
    return page.Take();
}

}  // namespace zebtell::web
