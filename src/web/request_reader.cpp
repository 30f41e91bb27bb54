#include "web/request_reader.h"

#include <optional>
#include <utility>

#include "base/text.h"
#include "web/form_parser.h"

namespace zebtell::web {
namespace {

using Fields = std::variant<std::vector<Field>, Refusal>;

bool IsMethodKnown(std::string_view method) {
    return method == "GET" || method == "HEAD" || method == "POST";
}

std::string_view WithoutEndSlash(std::string_view path) {
    if (path.ends_with('/')) path.remove_suffix(1);
    return path;
}

Fields ReadUrlEncoded(std::string_view text) {
    auto fields = ParseUrlEncoded(text);
    if (!fields) return Refusal{413};
    return std::move(*fields);
}

Fields ReadMultipart(std::string_view body, std::string_view content_type) {
    const auto boundary = HeaderParameter(content_type, "boundary");
    auto form = ParseMultipart(body, boundary.value_or(""));
    switch (form.outcome) {
        case MultipartForm::Outcome::kRead:
            return std::move(form.fields);
        case MultipartForm::Outcome::kTooManyFields:
            return Refusal{413};
        case MultipartForm::Outcome::kMalformed:
            break;
    }
    return Refusal{400};
}

Fields ReadForm(const http::Request& from) {
    if (from.method != "POST" || from.body.empty()) return std::vector<Field>{};
    const std::string_view type = from.HeaderValue("Content-Type");
    const auto media = base::Trimmed(type.substr(0, type.find(';')));
    if (base::EqualNoCase(media, "application/x-www-form-urlencoded"))
        return ReadUrlEncoded(from.body);
    if (base::EqualNoCase(media, "multipart/form-data")) return ReadMultipart(from.body, type);
    return Refusal{415};
}

}  // namespace

std::variant<Request, Refusal> ParseRequest(const http::Request& from, std::string_view base_path) {
    if (!IsMethodKnown(from.method)) return Refusal{405};
    if (WithoutEndSlash(from.Path()) != WithoutEndSlash(base_path)) return Refusal{404};
    Fields query = ReadUrlEncoded(from.Query());
    if (const auto* refusal = std::get_if<Refusal>(&query)) return *refusal;
    Fields form = ReadForm(from);
    if (const auto* refusal = std::get_if<Refusal>(&form)) return *refusal;

    Request request;
    request.method = from.method;
    request.QueryString = FieldList(std::get<std::vector<Field>>(std::move(query)));
    request.Form = FieldList(std::get<std::vector<Field>>(std::move(form)));
    request.page = request.QueryString["page"];
    request.event = request.QueryString["event"];
    request.query_string = base::WithoutControls(from.Query());
    request.remote_address = from.remote_address;
    return request;
}

}  // namespace zebtell::web
