#include "tags/combo.h"

#include <vector>

#include "base/text.h"
#include "markup/escape.h"
#include "tags/field_text.h"

namespace zebtell::tags {

namespace {

constexpr std::size_t kLeastFields = 4;

using Definition = std::vector<std::string_view>;

std::string Criteria(const Definition& fields, std::int32_t customer_key) {
    if (fields.size() < 7) return {};
    return base::Replaced(fields[6], "#F", std::to_string(customer_key));
}

void AppendOption(std::string& out,
                  const Definition& fields,
                  data::Record& record,
                  const base::Region& region) {
    const std::string value = BareAttribute(RawText(record, base::Trimmed(fields[1]), region));
    out.append("<option value=").append(value);
    if (fields.size() > 4) out.append(" ").append(base::Replaced(fields[4], "#V", value));
    if (fields.size() > 5 && !base::Trimmed(fields[5]).empty()) out.append(";").append(fields[5]);
    out += '>';
    markup::AppendEscaped(out, RawText(record, base::Trimmed(fields[2]), region));
    out += "</option>\r\n";
}

}  // namespace

std::string ComboOptions(data::DataApplication& application,
                         std::string_view definition,
                         std::int32_t customer_key,
                         const base::Region& region) {
    const Definition fields = base::Split(definition, ';');
    if (fields.size() < kLeastFields) return {};
    const auto list = application.OpenList(
        base::Trimmed(fields[0]), Criteria(fields, customer_key), base::Trimmed(fields[3]));
    std::string options;
    const std::int64_t count = list->Count();
    for (std::int64_t index = 1; index <= count; ++index) {
        AppendOption(options, fields, *list->Item(index), region);
    }
    return options;
}

std::string BareAttribute(std::string_view text) {
    constexpr std::string_view kBreaking = " \t\r\n\f\"'`=<>&";
    std::string out;
    for (const char c : text) {
        if (kBreaking.find(c) == std::string_view::npos) {
            out += c;
        } else {
            out.append("&#").append(std::to_string(static_cast<int>(c))).append(";");
        }
    }
    return out;
}

}  // namespace zebtell::tags
