#include "catalogue/kaubainfo.h"

#include "base/text.h"
#include "catalogue/criteria.h"
#include "catalogue/kaubainfo_tags.h"
#include "catalogue/price_list.h"
#include "host/errors.h"
#include "tags/custom_func.h"
#include "tags/declarations.h"
#include "tags/form_values.h"
#include "tags/page_tags.h"

namespace zebtell::catalogue {
namespace {

using host::CatalogueState;
using host::SessionState;

constexpr std::int32_t kFavouritesCategory = -1;
// A session keeps no longer texts of what is searched for and sorted by.
constexpr std::size_t kLongestTyped = 1000;
constexpr std::string_view kReadingFailed = "Probleem andmete lugemisel, proovige uuesti!";

// What became of a form is said once.
void Show(SessionState& state, web::Call& call) {
    host::ShowPage(state, call);
    state.basket_form.LastForm = {};
}

// The three events that fill the list: an error leaves the list that was there and its order, with
// a message.
template <class Build>
void BuildAndShow(SessionState& state, web::Call& call, std::string_view handler, Build&& build) {
    CatalogueState& catalogue = state.catalogue;
    std::string order = catalogue.OrderText;
    const auto work = [&] {
        tags::ReadCatalogueDeclarations(state, call);
        order = catalogue.OrderText;
        build();
    };
    host::Guarded(state, handler, work, [&] {
        state.Message = kReadingFailed;
        catalogue.OrderText = order;
        RewindPage(catalogue);
    });
    Show(state, call);
}

std::string Posted(const web::Call& call, std::string_view field) {
    const std::string typed = call.request.Form[field];
    return tags::CleanFormValue(base::FirstCharacters(typed, kLongestTyped));
}

void ReadSearch(CatalogueState& catalogue, const web::Call& call) {
    catalogue.LastFind = Posted(call, "ZEBInText");
    if (catalogue.SearchNameColumn.empty()) catalogue.SearchNameColumn = "name";
    if (catalogue.SearchCodeColumn.empty()) catalogue.SearchCodeColumn = "code";
}

ListRequest RequestFor(const SessionState& state, std::string category) {
    const CatalogueState& catalogue = state.catalogue;
    return {.PriceListId = state.company.PriceListId,
            .category = std::move(category),
            .find = catalogue.LastFind,
            .SearchCodeColumn = catalogue.SearchCodeColumn,
            .SearchNameColumn = catalogue.SearchNameColumn,
            .FilterText = catalogue.FilterText};
}

// The sort choice counts unless the search button was pressed.
void ReadOrder(CatalogueState& catalogue, const web::Call& call) {
    if (!Posted(call, "Find_GRArticle").empty() || !call.request.Form.Has("DataOrder")) return;
    catalogue.OrderText = Posted(call, "DataOrder");
    catalogue.ListFresh = false;
}

std::int32_t CategoryNumber(const std::string& text) {
    const auto number = base::ParseNumber(text);
    const bool fits = number && *number >= INT32_MIN && *number <= INT32_MAX;
    return fits ? static_cast<std::int32_t>(*number) : 0;
}

void OpenFavourites(SessionState& state) {
    state.catalogue.CategoryId = kFavouritesCategory;
    state.catalogue.LastFind.clear();  // the form is shown without it, and sorts without it
    const std::int32_t price_list = state.company.PriceListId;
    std::string favourites = state.catalogue.FavoritesText;
    if (price_list != 0 && !favourites.empty()) {
        const auto partner = state.company.PartnerRecord->GetField("Partner.ID");
        favourites = base::Replaced(favourites, "#", partner.ToPlainText());
    }
    OpenList(state, FavouritesCriterion(price_list, favourites));
}

void OpenCategory(SessionState& state, const web::Call& call) {
    CatalogueState& catalogue = state.catalogue;
    ReadOrder(catalogue, call);
    std::string category = Posted(call, "Combo_GRArticleCat");
    ReadSearch(catalogue, call);
    catalogue.CategoryId = CategoryNumber(category);
    if (catalogue.CategoryId == kFavouritesCategory) {
        // The favourites entry of the category choice; a search goes over everything.
        if (catalogue.LastFind.empty()) return OpenFavourites(state);
        catalogue.CategoryId = 0;
        category.clear();
    }
    if (category == "0") category.clear();
    OpenList(state, CategoryCriterion(RequestFor(state, std::move(category))));
}

void ChooseRow(SessionState& state, web::Call& call, std::string_view id) {
    const auto& list = state.catalogue.ListQuery;
    state.basket_form.RowToAdd = list ? list->Find("ID=" + std::string(id)) : nullptr;
    call.NextItem("Lisamine");
}

// Without a list there is nothing to turn: the page is opened as for the first time.
void Turn(SessionState& state,
          web::Call& call,
          std::string_view handler,
          std::string_view command) {
    if (!state.catalogue.ListQuery) return Kaubainfo_Respond(state, call);
    host::Guarded(state, handler, [&] {
        if (!command.empty()) TurnPage(state.catalogue, command);
        RewindPage(state.catalogue);
    });
    Show(state, call);
}

}  // namespace

void Kaubainfo_Respond(SessionState& state, web::Call& call) {
    CatalogueState& catalogue = state.catalogue;
    if (!catalogue.ListFresh) catalogue.PageNumber = 1;
    catalogue.ListFresh = false;
    RewindPage(catalogue);
    const std::string message = state.Message;
    host::ShowPage(state, call);
    // The catalogue opens with the favourites, once the template has said which they are.
    if (!catalogue.FavoritesText.empty() && !catalogue.ListQuery) {
        call.response.Clear();
        state.Message = message;
        call.RedirectTo("Kaubainfo", "Favorites");
        return;
    }
    state.basket_form.LastForm = {};
}

void Kaubainfo_ProcessTag(SessionState& state, web::Call& call, markup::Tag& tag) {
    tags::ProcessPageTag(
        state, call, tag, "Kaubainfo_ProcessTag", "Kaubainfo", &KaubainfoTagTable());
}

void Kaubainfo_UserEvent(SessionState& state, web::Call& call, std::string_view event) {
    if (base::StartsWithNoCase(event, "ID_")) {
        host::Guarded(
            state, "Kaubainfo_UserEvent", [&] { ChooseRow(state, call, event.substr(3)); });
    } else {
        Turn(state, call, "Kaubainfo_UserEvent", base::EndsWithNoCase(event, "Page") ? event : "");
    }
}

void Kaubainfo_Favorites(SessionState& state, web::Call& call) {
    BuildAndShow(state, call, "Kaubainfo_Favorites", [&] { OpenFavourites(state); });
}

void Kaubainfo_Hinnakiri(SessionState& state, web::Call& call) {
    BuildAndShow(state, call, "Kaubainfo_Hinnakiri", [&] {
        tags::SaveFormValues(state, call.request);
        OpenCategory(state, call);
    });
}

void Kaubainfo_Otsing(SessionState& state, web::Call& call) {
    BuildAndShow(state, call, "Kaubainfo_Otsing", [&] {
        tags::SaveFormValues(state, call.request);
        ReadSearch(state.catalogue, call);
        OpenList(state, SearchCriterion(RequestFor(state, {})));
    });
}

void Kaubainfo_Navigate(SessionState& state, web::Call& call) {
    Turn(state, call, "Kaubainfo_Navigate", tags::CleanFormValue(call.request.Value("Nav")));
}

}  // namespace zebtell::catalogue
