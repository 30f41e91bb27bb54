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

void Refusals::Add(std::string_view what, std::string_view typed, std::string_view box) {
    std::string item(base::FirstCharacters(what, kLongestTyped));
    item.append(" \"").append(base::FirstCharacters(typed, kLongestTyped)).append("\"");
    items_.push_back(std::move(item));
    if (box == kQuickEntryBox) {
        boxes_[std::string(box)].append(what).append("\t").append(typed).append("\n");
    } else if (!box.empty()) {
        boxes_[std::string(box)] = typed;
    }
}

void Refusals::Tell(host::SessionState& state) const {
    state.basket_form.LastForm.Refused = boxes_;
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
