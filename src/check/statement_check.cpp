#include "check/statement_check.h"

#include <algorithm>

#include "base/text.h"
#include "tags/custom_func.h"
#include "tags/price_query.h"

namespace zebtell::check {
namespace {

constexpr std::size_t kLeastFields = 4;
constexpr std::string_view kPriceLines = "GRPriceListRel";

void Report(PageReading& reading, const TagText& tag, const std::string& text) {
    reading.Report(tag.name, std::string(tag.name) + ": " + text);
}

void ReportFault(PageReading& reading,
                 const TagText& tag,
                 const std::optional<std::string>& fault) {
    if (fault) Report(reading, tag, *fault);
}

void CheckField(PageReading& reading,
                const TagText& tag,
                std::string_view table,
                std::string_view field) {
    if (!reading.tables.HasField(table, field)) {
        Report(reading, tag, std::string(table) + " has no field " + std::string(field));
    }
}

// The fields of a definition, cleaned; empty, and reported, when there are too few.
std::vector<std::string> Definition(PageReading& reading, const TagText& tag) {
    std::vector<std::string> fields;
    for (std::string_view field : base::Split(tag.contents, ';')) {
        fields.push_back(tags::CleanFormValue(field));
    }
    if (fields.size() >= kLeastFields) return fields;
    Report(reading, tag, "at least four fields with \";\" between them are needed");
    return {};
}

// For a text of a template that knows the customer's key only at run time.
std::string WithSomeKey(std::string_view text, std::string_view mark) {
    return base::Replaced(text, mark, "1");
}

}  // namespace

bool DefinesQuery(const PageReading& reading, std::string_view name) {
    return std::any_of(reading.queries.begin(), reading.queries.end(), [&](const auto& query) {
        return base::EqualNoCase(query, name);
    });
}

void CheckQuery(PageReading& reading, const TagText& tag) {
    const auto fields = Definition(reading, tag);
    if (fields.empty()) return;
    std::string sql = "SELECT * FROM " + fields[0];
    if (!fields[1].empty()) {
        const bool is_list = base::EqualNoCase(fields[3], "list");
        sql += " WHERE " + fields[1] + (is_list ? " IN (1)" : "=1");
    }
    const std::string order = fields.size() > kLeastFields ? fields[4] : "";
    if (!order.empty() && !order.starts_with('#')) sql += " ORDER BY " + order;
    ReportFault(reading, tag, reading.tables.SelectFault(sql));
}

void CheckQueryName(PageReading& reading, const TagText& tag) {
    const std::string name = tags::CleanFormValue(tag.contents);
    if (!DefinesQuery(reading, name)) Report(reading, tag, "the page defines no query " + name);
}

void CheckCombo(PageReading& reading, const TagText& tag) {
    const auto fields = Definition(reading, tag);
    if (fields.empty()) return;
    const std::string filter = fields.size() > 6 ? WithSomeKey(fields[6], "#F") : "";
    if (const auto fault = reading.tables.ListFault(fields[0], filter, fields[3])) {
        return Report(reading, tag, *fault);
    }
    CheckField(reading, tag, fields[0], fields[1]);
    CheckField(reading, tag, fields[0], fields[2]);
}

void CheckPriceQuery(PageReading& reading, const TagText& tag) {
    const std::string text = tags::CleanPriceQueryText(tag.contents);
    ReportFault(
        reading, tag, reading.tables.SelectFault(tags::BuildPriceQuery(text, 1, 1, 1, "1")));
}

void CheckOrdersField(PageReading& reading, const TagText& tag) {
    const std::string reference = tags::CleanFormValue(tag.contents);
    const auto parts = base::Split(reference, '.');
    if (parts.size() < 2) {
        CheckField(reading, tag, "GRCompany", reference);
    } else if (DefinesQuery(reading, parts[0])) {
        CheckField(reading, tag, parts[0], parts[1]);
    } else {
        Report(reading, tag, "the page defines no query " + std::string(parts[0]));
    }
}

void CheckFilter(PageReading& reading, const TagText& tag) {
    const std::string filter = tags::CleanFormValue(tag.contents);
    ReportFault(reading, tag, reading.tables.ListFault(kPriceLines, filter, ""));
}

void CheckOrder(PageReading& reading, const TagText& tag) {
    const std::string order = tags::CleanFormValue(tag.contents);
    ReportFault(reading, tag, reading.tables.ListFault(kPriceLines, "", order));
}

void CheckFavorites(PageReading& reading, const TagText& tag) {
    const std::string condition = WithSomeKey(tags::CleanFormValue(tag.contents), "#");
    ReportFault(reading, tag, reading.tables.ListFault(kPriceLines, "{" + condition + "}", ""));
}

void CheckArticleColumn(PageReading& reading, const TagText& tag) {
    CheckField(reading, tag, "GRArticle", tags::CleanFormValue(tag.contents));
}

void CheckRowField(PageReading& reading, const TagText& tag) {
    CheckField(reading, tag, "SDOrderRow", tag.name.substr(tag.name.find('.') + 1));
}

}  // namespace zebtell::check
