#include "data/cls_query.h"

#include <algorithm>

#include "base/runtime_error.h"
#include "base/text.h"

namespace zebtell::data {

namespace {

// An order that, once set, no link and no template can change.
constexpr std::string_view kFixedNoOrder = "(none)";

std::string ListText(const std::vector<base::Value>& values) {
    std::string list;
    for (const base::Value& value : values) {
        if (&value != &values.front()) list += ',';
        list += value.ToPlainText();
    }
    return list;
}

std::string TextOf(const clsQuery::FilterValue& filter) {
    if (const auto* values = std::get_if<std::vector<base::Value>>(&filter)) {
        return ListText(*values);
    }
    return std::get<base::Value>(filter).ToPlainText();
}

}  // namespace

std::string clsQuery::Order() const {
    return base::EqualNoCase(order_, kFixedNoOrder) ? std::string() : order_;
}

void clsQuery::SetOrder(std::string_view order) {
    if (base::EqualNoCase(order_, kFixedNoOrder)) return;
    std::string cleaned(base::Trimmed(order));
    // Without these no comment can begin in the order.
    std::erase_if(cleaned, [](char c) { return c == '-' || c == '/'; });
    if (!base::EqualNoCase(cleaned, order_)) records_.reset();
    order_ = std::move(cleaned);
}

bool clsQuery::Requery() {
    records_.reset();
    RecNo = 1;
    return true;
}

std::shared_ptr<RecordList> clsQuery::Records(const std::optional<FilterValue>& CritValue) {
    if (CritValue && !base::EqualNoCase(TextOf(*CritValue), TextOf(MasterValue))) {
        records_.reset();
        MasterValue = *CritValue;
    }
    if (!records_) {
        if (ZEBApp == nullptr) throw base::RuntimeError(base::errors::kObjectNotSet);
        records_ = ZEBApp->OpenQuery(SqlText(), 0, 0);
    }
    return records_;
}

std::string clsQuery::SqlText() const {
    std::string sql = "SELECT * FROM " + Query;
    const std::string value = TextOf(MasterValue);
    if (!value.empty() && !Criteria.empty()) {
        const bool is_list = base::EqualNoCase(Mode, "list");
        if (!is_list && !std::holds_alternative<base::Value>(MasterValue)) {
            throw base::RuntimeError(base::errors::kTypeMismatch);
        }
        sql += " WHERE " + Criteria + (is_list ? " IN (" + value + ")" : "=" + value);
    }
    if (const std::string order = Order(); !order.empty()) sql += " ORDER BY " + order;
    return sql;
}

}  // namespace zebtell::data
