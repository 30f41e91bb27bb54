#include <algorithm>
#include <variant>

#include "base/text.h"
#include "http/url.h"
#include "tests/fuzz/harness.h"
#include "web/form_parser.h"
#include "web/request_reader.h"

// The query string in the first line, the content type in the second, the form in the others.

namespace zebtell::fuzz {
namespace {

using web::Field;
using web::FieldList;

bool Same(const FieldList& a, const FieldList& b) {
    return std::equal(a.begin(), a.end(), b.begin(), b.end(), [](const Field& x, const Field& y) {
        return x.name == y.name && x.value == y.value;
    });
}

void CheckFields(const FieldList& fields) {
    Claim(fields.Count() <= web::kMaxFields, "the fields are bounded");
    for (const Field& field : fields) {
        for (const std::string& text : {field.name, field.value}) {
            Claim(base::IsValidUtf8(text), "fields are UTF-8", text);
            Claim(text.find('\0') == text.npos, "fields hold no NUL", text);
        }
        Claim(fields.Has(field.name), "a field is found by its name", field.name);
        Claim(fields[base::Upper(field.name)].find(field.value) != std::string::npos,
              "a name finds its value in any case",
              field.name);
    }
}

std::string UrlEncoded(const FieldList& fields) {
    std::string text;
    for (const Field& field : fields) {
        text += "&" + http::EncodeComponent(field.name) + "=" + http::EncodeComponent(field.value);
    }
    return text;
}

// What a browser makes of the same fields.
std::string Multipart(const FieldList& fields, const std::string& boundary) {
    std::string text;
    for (const Field& field : fields) {
        std::string name = base::Replaced(field.name, "\\", "\\\\");
        name = base::Replaced(name, "\"", "\\\"");
        text += "--" + boundary + "\r\nContent-Disposition: form-data; name=\"" + name +
                "\"\r\n\r\n" + field.value + "\r\n";
    }
    return text + "--" + boundary + "--\r\n";
}

void CheckMultipart(const FieldList& fields) {
    constexpr const char* kBoundary = "another-boundary";
    for (const Field& field : fields) {
        if (field.value.find(kBoundary) != std::string::npos) return;
        if (field.name.find_first_of("\r\n") != std::string::npos) return;
        if (field.name.find(kBoundary) != std::string::npos) return;
    }
    const auto again = web::ParseMultipart(Multipart(fields, kBoundary), kBoundary);
    Claim(again.outcome == web::MultipartForm::Outcome::kRead, "a browser's form is read");
    Claim(Same(fields, FieldList(again.fields)), "a browser's form keeps its fields");
}

}  // namespace

void Try(std::string_view input) {
    http::Request from;
    from.method = "POST";
    from.target = "/?" + std::string(TakeLine(input));
    from.headers.emplace_back("Content-Type", TakeLine(input));
    from.body = input;
    const auto read = web::ParseRequest(from, "/");
    if (const auto* refusal = std::get_if<web::Refusal>(&read)) {
        Claim(refusal->status >= 400 && refusal->status < 500, "a bad form is the client's fault");
        return;
    }
    const auto& request = std::get<web::Request>(read);
    for (const FieldList* fields : {&request.QueryString, &request.Form}) {
        CheckFields(*fields);
        Claim(Same(*fields, FieldList(*web::ParseUrlEncoded(UrlEncoded(*fields)))),
              "fields that are posted again stay the same");
        CheckMultipart(*fields);
    }
    Claim(request.query_string.find_first_of("\r\n") == std::string::npos, "one line for the log");
}

}  // namespace zebtell::fuzz
