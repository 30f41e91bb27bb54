#include "catalogue/option_lists.h"

#include "base/text.h"
#include "host/texts.h"
#include "markup/escape.h"

namespace zebtell::catalogue {
namespace {

constexpr std::string_view kPlain = "<OPTION VALUE=\"";
constexpr std::string_view kSelected = "<OPTION SELECTED VALUE=\"";
constexpr int kYearsBack = 10;
constexpr host::LocalText kLanguageCodes = {"ET", "EN", "LV"};

void AppendOption(std::string& out, std::int64_t value, std::string_view html, bool selected) {
    out.append(selected ? kSelected : kPlain).append(std::to_string(value)).append("\">");
    out.append(html).append("\r\n");
}

std::string NumberOptions(int from, int to, int selected) {
    std::string out;
    for (int i = from; i <= to; ++i) AppendOption(out, i, std::to_string(i), i == selected);
    return out;
}

const std::string& CategoryEntries(host::SessionState& state, std::string_view group) {
    host::CatalogueState& catalogue = state.catalogue;
    const std::string filter =
        group.empty() ? catalogue.GroupQueryText : "Category like '" + std::string(group) + "'";
    const auto known = catalogue.CategoryOptions.find(filter);
    if (known != catalogue.CategoryOptions.end()) return known->second;
    const auto list = state.application().OpenList("GRArticleCat", filter, "Name");
    const auto settings = state.settings();
    return catalogue.CategoryOptions
        .emplace(filter, RecordOptions(*list, "Name", 0, settings->region()))
        .first->second;
}

// The kept entries with the chosen category preselected.
std::string WithSelected(std::string entries, std::int64_t id) {
    const std::string opening = std::string(kPlain) + std::to_string(id) + "\">";
    const auto found = entries.find(opening);
    if (found != std::string::npos) entries.replace(found, kPlain.size(), kSelected);
    return entries;
}

}  // namespace

std::string CategoryOptions(host::SessionState& state, std::string_view group) {
    const host::CatalogueState& catalogue = state.catalogue;
    std::string out;
    if (!catalogue.EmptyGroupText.empty()) {
        AppendOption(out, 0, catalogue.EmptyGroupText, catalogue.CategoryId == 0);
    }
    if (!catalogue.FavouritesGroupText.empty()) {
        AppendOption(out, -1, catalogue.FavouritesGroupText, catalogue.CategoryId == -1);
    }
    return out + WithSelected(CategoryEntries(state, group), catalogue.CategoryId);
}

std::string RecordOptions(data::RecordList& list,
                          std::string_view field,
                          std::int64_t selected,
                          const base::Region& region) {
    std::string out;
    const std::int64_t count = list.Count();
    for (std::int64_t i = 1; i <= count; ++i) {
        const auto record = list.Item(i);
        const std::int64_t id = record->GetField("ID").ToInteger64();
        const base::Value text = record->GetField(field);
        AppendOption(
            out, id, text.IsNull() ? "" : markup::Escaped(text.ToText(region)), id == selected);
    }
    return out;
}

std::string DayOptions(base::DateTime date) {
    return NumberOptions(1, 31, date.Calendar().day);
}

std::string MonthOptions(base::DateTime date, host::UserLanguage language) {
    const base::Region& names = base::RegionFor(kLanguageCodes.In(language));
    std::string out;
    for (int month = 1; month <= 12; ++month) {
        AppendOption(out,
                     month,
                     names.months[static_cast<std::size_t>(month - 1)],
                     month == date.Calendar().month);
    }
    return out;
}

std::string YearOptions(base::DateTime date, base::DateTime today) {
    const int this_year = today.Calendar().year;
    return NumberOptions(this_year - kYearsBack, this_year, date.Calendar().year);
}

}  // namespace zebtell::catalogue
