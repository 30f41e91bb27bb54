#include "tags/form_values.h"

#include <algorithm>

#include "base/rounding.h"
#include "base/text.h"
#include "tags/custom_func.h"

namespace zebtell::tags {

namespace {

constexpr int kMostDecimals = 15;

// What a session keeps of forms. They have a few such fields; a stranger who logs on as the guest
// could send them without end.
constexpr std::size_t kMostSavedValues = 200;
constexpr std::size_t kLongestSavedText = 4000;  // bytes of a name or a value

std::string QueryKey(std::string_view name, std::string_view page) {
    std::string key;
    key.reserve(page.size() + 2 + name.size());
    return key.append(page).append("::").append(name);
}

}  // namespace

bool QueryExists(const host::SessionState& state, std::string_view name, std::string_view page) {
    return !state.templates.Queries.empty() &&
           state.templates.Queries.contains(QueryKey(name, page));
}

data::clsQuery& GetQuery(host::SessionState& state, std::string_view name, std::string_view page) {
    const auto [entry, is_new] = state.templates.Queries.try_emplace(QueryKey(name, page));
    data::clsQuery& query = entry->second;
    if (is_new) query.Query = name;
    query.ZEBApp = state.logon.Application.get();  // also for a page written before the log-on
    return query;
}

bool SaveFormValues(host::SessionState& state, const web::Request& request) {
    for (const web::Field& field : request.Form) {
        std::string name = CleanFormValue(field.name);
        if (!base::StartsWithNoCase(name, "save_")) continue;
        auto& saved = state.templates.SavedValues;
        if (!saved) saved.emplace();
        const bool has_room = saved->size() < kMostSavedValues || saved->contains(name);
        if (!has_room || std::max(name.size(), field.value.size()) > kLongestSavedText) continue;
        saved->insert_or_assign(std::move(name), CleanFormValue(field.value));
    }
    return true;
}

bool ParseQuantity(const host::SessionState& state, std::string_view text, double& result) {
    std::string digits = CleanFormValue(text);
    std::erase(digits, ' ');
    const auto number = base::ParseNumber(digits);
    if (!number) return false;
    const int decimals = std::clamp<int>(state.basket_form.QuantityDecimals, 0, kMostDecimals);
    result = base::Rounded(*number, decimals);
    return true;
}

bool IsUniqueField(const web::Request& request, std::string_view name) {
    return !CleanFormValue(request.Form[std::string(name) + "_unique"]).empty();
}

std::string ReadRowField(const web::Request& request, std::string_view name, std::int16_t row) {
    return CleanFormValue(request.Form[std::string(name) + "_f" + std::to_string(row)]);
}

}  // namespace zebtell::tags
