#include "orders/refusals.h"

#include "base/text.h"
#include "host/texts.h"

namespace zebtell::orders {
namespace {

constexpr host::LocalText kRefused = {"Need jäid lisamata või muutmata: ",
                                      "These were not added or changed: ",
                                      "Šie netika pievienoti vai mainīti: "};
constexpr std::size_t kMostNamed = 10;
constexpr std::size_t kLongestTyped = 40;

}  // namespace

void Refusals::Add(std::string_view what, std::string_view typed) {
    std::string item(base::FirstCharacters(what, kLongestTyped));
    item.append(" \"").append(base::FirstCharacters(typed, kLongestTyped)).append("\"");
    items_.push_back(std::move(item));
}

void Refusals::Tell(host::SessionState& state) const {
    if (items_.empty()) return;
    std::string text(kRefused.In(state.settings()->language()));
    for (std::size_t i = 0; i < items_.size() && i < kMostNamed; ++i) {
        if (i != 0) text += ", ";
        text += items_[i];
    }
    if (items_.size() > kMostNamed) text += ", ...";
    state.Message = text;
}

}  // namespace zebtell::orders
