#include "tags/price_query.h"

#include <array>

namespace zebtell::tags {

namespace {

constexpr char kMark = '#';

struct Placeholder {
    char letter;  // in lower case
    std::string text;
};

const std::string* TextFor(char letter, const std::array<Placeholder, 4>& placeholders) {
    for (const Placeholder& placeholder : placeholders) {
        if ((letter | 0x20) == placeholder.letter) return &placeholder.text;
    }
    return nullptr;
}

}  // namespace

// One pass gives what replacing them one after the other does: no number makes a new placeholder,
// and the articles come last.
std::string BuildPriceQuery(std::string_view query_text,
                            std::int32_t company,
                            std::int32_t customer_key,
                            std::int32_t price_list,
                            std::string_view articles) {
    const std::array<Placeholder, 4> placeholders = {{{'f', std::to_string(customer_key)},
                                                      {'p', std::to_string(company)},
                                                      {'h', std::to_string(price_list)},
                                                      {'a', std::string(articles)}}};
    std::string sql;
    sql.reserve(query_text.size() + articles.size());
    std::size_t at = 0;
    while (at < query_text.size()) {
        const bool marked = query_text[at] == kMark && at + 1 < query_text.size();
        if (const auto* text = marked ? TextFor(query_text[at + 1], placeholders) : nullptr) {
            sql += *text;
            at += 2;
            continue;
        }
        const std::size_t next = std::min(query_text.find(kMark, at + 1), query_text.size());
        sql.append(query_text, at, next - at);
        at = next;
    }
    return sql;
}

std::shared_ptr<data::RecordList> OpenCustomerPrices(const host::SessionState& state,
                                                     std::string_view articles) {
    const std::int32_t customer = state.company.CustomerKey;
    const std::string sql = BuildPriceQuery(
        state.templates.PriceQueryText, customer, customer, state.company.PriceListId, articles);
    return state.application().OpenQuery(sql, 0, 0);
}

}  // namespace zebtell::tags
