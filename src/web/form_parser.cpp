#include "web/form_parser.h"

#include <algorithm>
#include <utility>

#include "base/text.h"
#include "http/url.h"

namespace zebtell::web {
namespace {

constexpr std::string_view kNul("\0", 1);

std::string Cleaned(std::string text) {
    text = base::Utf8FromEither(std::move(text));
    return text.find('\0') == text.npos ? text : base::Replaced(text, kNul, "\xEF\xBF\xBD");
}

// The text up to `mark`, which goes with it; nothing when it is not there.
std::optional<std::string_view> TakeUpTo(std::string_view& text, std::string_view mark) {
    const std::size_t at = text.find(mark);
    if (at == text.npos) return std::nullopt;
    const auto taken = text.substr(0, at);
    text.remove_prefix(at + mark.size());
    return taken;
}

// A quoted value from behind its opening quote; `\"` is a quote.
std::optional<std::string> TakeQuoted(std::string_view& text) {
    std::string value;
    for (std::size_t i = 0; i < text.size(); ++i) {
        if (text[i] == '"') {
            text.remove_prefix(i + 1);
            return value;
        }
        if (text[i] == '\\' && i + 1 < text.size() && (text[i + 1] == '"' || text[i + 1] == '\\'))
            ++i;
        value += text[i];
    }
    return std::nullopt;
}

std::string TakeToken(std::string_view& text) {
    const std::size_t end = std::min(text.find(';'), text.size());
    std::string value(base::Trimmed(text.substr(0, end)));
    text.remove_prefix(end);
    return value;
}

std::optional<Field> FieldOfPart(std::string_view head, std::string_view value) {
    while (!head.empty()) {
        std::string_view line = head;
        if (const auto first = TakeUpTo(head, "\r\n")) {
            line = *first;
        } else {
            head = {};
        }
        if (!base::StartsWithNoCase(line, "content-disposition:")) continue;
        auto name = HeaderParameter(line, "name");
        if (!name) return std::nullopt;
        auto file = HeaderParameter(line, "filename");
        return Field{Cleaned(std::move(*name)), Cleaned(file ? *file : std::string(value))};
    }
    return std::nullopt;
}

}  // namespace

std::optional<std::vector<Field>> ParseUrlEncoded(std::string_view text) {
    std::vector<Field> fields;
    while (!text.empty()) {
        const std::size_t end = std::min(text.find('&'), text.size());
        const auto pair = text.substr(0, end);
        text.remove_prefix(std::min(end + 1, text.size()));
        if (pair.empty()) continue;
        if (fields.size() == kMaxFields) return std::nullopt;
        const std::size_t mark = std::min(pair.find('='), pair.size());
        const auto value = pair.substr(std::min(mark + 1, pair.size()));
        fields.push_back({Cleaned(http::DecodeComponent(pair.substr(0, mark))),
                          Cleaned(http::DecodeComponent(value))});
    }
    return fields;
}

MultipartForm ParseMultipart(std::string_view body, std::string_view boundary) {
    using Outcome = MultipartForm::Outcome;
    MultipartForm form;
    if (boundary.empty() || boundary.size() > 70) return form;
    const std::string delimiter = "\r\n--" + std::string(boundary);
    // The first delimiter may stand at the very start, without its line break.
    const std::string_view first = std::string_view(delimiter).substr(2);
    if (body.starts_with(first)) {
        body.remove_prefix(first.size());
    } else if (!TakeUpTo(body, delimiter)) {
        return form;
    }
    while (!body.starts_with("--")) {
        auto part = TakeUpTo(body, delimiter);
        if (!part || !TakeUpTo(*part, "\r\n")) return form;
        // A part without headers has nothing before the empty line but the line break just taken.
        const auto head = TakeUpTo(*part, "\r\n\r\n");
        auto field = head ? FieldOfPart(*head, *part) : std::nullopt;
        if (!field) return form;
        if (form.fields.size() == kMaxFields) return {Outcome::kTooManyFields, {}};
        form.fields.push_back(std::move(*field));
    }
    form.outcome = Outcome::kRead;
    return form;
}

std::optional<std::string> HeaderParameter(std::string_view header, std::string_view name) {
    while (TakeUpTo(header, ";")) {
        std::string_view rest = header;
        const auto found = TakeUpTo(rest, "=");
        if (!found) return std::nullopt;
        const bool is_wanted = base::EqualNoCase(base::Trimmed(*found), name);
        std::optional<std::string> value;
        if (rest.starts_with('"')) {
            rest.remove_prefix(1);
            value = TakeQuoted(rest);
        } else {
            value = TakeToken(rest);
        }
        if (is_wanted || !value) return value;
        header = rest;
    }
    return std::nullopt;
}

}  // namespace zebtell::web
