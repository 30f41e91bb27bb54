#include "catalogue/kaubainfo_tags.h"

#include "base/rounding.h"
#include "base/text.h"
#include "catalogue/basket_marks.h"
#include "catalogue/option_lists.h"
#include "catalogue/price_list.h"
#include "catalogue/row_prices.h"
#include "markup/escape.h"
#include "tags/basket_boxes.h"
#include "tags/custom_func.h"
#include "tags/field_text.h"

namespace zebtell::catalogue {
namespace {

using host::CatalogueState;
using tags::TagCall;

CatalogueState& Catalogue(TagCall& c) {
    return c.state.catalogue;
}

// A tag that only declares a value of the page.
template <std::string CatalogueState::*Text>
bool Declare(TagCall& c) {
    Catalogue(c).*Text = tags::Reference(c);
    c.tag.Hide();
    return true;
}

template <bool (*Test)(const CatalogueState&)>
bool ShowWhen(TagCall& c) {
    Test(Catalogue(c)) ? c.tag.Show() : c.tag.Hide();
    return true;
}

template <std::int16_t CatalogueState::*Number>
bool WriteNumber(TagCall& c) {
    c.tag.Write(std::to_string(Catalogue(c).*Number));
    return true;
}

// A form field's or event's name: the prefix and the current row's ID.
std::string RowName(const TagCall& c, std::string_view prefix) {
    data::Record* row = c.state.catalogue.CurrentRow.get();
    return std::string(prefix) + (row == nullptr ? "" : row->GetField("ID").ToPlainText());
}

template <const std::string_view& Prefix>
bool WriteRowName(TagCall& c) {
    c.tag.Write(RowName(c, Prefix));
    return true;
}
constexpr std::string_view kQuantityBox = "ID_";
constexpr std::string_view kPriceBox = "Price_";
constexpr std::string_view kUnitPriceBox = "UPrice_";

bool Grupid(TagCall& c) {
    c.tag.Write(CategoryOptions(c.state, {}));
    return true;
}

bool GrupidOfGroup(TagCall& c) {
    c.tag.Write(CategoryOptions(c.state, c.NameFrom(std::string_view("ZEB:Grupid.").size())));
    return true;
}

bool GruppQuery(TagCall& c) {
    Catalogue(c).GroupQueryText =
        base::Replaced(tags::Reference(c), "#F", std::to_string(c.state.company.CustomerKey));
    c.tag.Hide();
    return true;
}

bool DataOrder(TagCall& c) {
    c.tag.WriteEscaped(base::Trimmed(Catalogue(c).OrderText));
    return true;
}

// In the name of the tag the order's blanks are written "_".
bool DataOrderChoice(TagCall& c) {
    const std::string chosen = base::Replaced(Catalogue(c).OrderText, " ", "_");
    const bool same =
        base::EqualNoCase(c.NameFrom(std::string_view("ZEB:DataOrder.").size()), chosen);
    same ? c.tag.Show() : c.tag.Hide();
    return true;
}

bool NoOutput(TagCall& c) {
    c.tag.Hide();
    return true;
}

bool HKRida(TagCall& c) {
    CatalogueState& catalogue = Catalogue(c);
    if (!catalogue.ListQuery || catalogue.RowCount == 0) return NoOutput(c);
    ReadRow(c.state);
    const bool page_ends = catalogue.PageLength > 0 &&
                           catalogue.RowCursor >= catalogue.PageNumber * catalogue.PageLength;
    if (!page_ends && catalogue.RowCursor < catalogue.RowCount) {
        c.tag.Repeat("ZEB:HKRida");
    } else {
        c.tag.Show();
    }
    catalogue.RowCursor = base::ToInteger16(catalogue.RowCursor + 1.0);
    return true;
}

bool HKRida12(TagCall& c) {
    const std::string contents = c.tag.TagContents();
    const auto mark = contents.find(';');
    if (mark == std::string::npos) return NoOutput(c);
    // The cursor has already passed the row being drawn.
    const bool odd = Catalogue(c).RowCursor % 2 != 0;
    c.tag.Write(odd ? contents.substr(0, mark) : contents.substr(mark + 1));
    return true;
}

bool RowFieldTag(TagCall& c) {
    c.tag.Write(RowField(c.state, tags::Reference(c)));
    return true;
}

bool PriceFieldTag(TagCall& c) {
    c.tag.Write(PriceField(c.state, tags::Reference(c)));
    return true;
}

bool Company(TagCall& c) {
    if (!c.state.company.PartnerRecord) return NoOutput(c);
    c.tag.Write(tags::FormatFieldValue(
        *c.state.company.PartnerRecord, "Partner." + tags::Reference(c), "", c.state.region()));
    return true;
}

bool DiscountPercent(TagCall& c) {
    const double percent = base::Rounded((1 - c.state.company.PriceFactor) * 100, 1);
    c.tag.Write(base::Value(percent).ToText(c.state.region()));
    return true;
}

bool LisaLink(TagCall& c) {
    c.tag.Write(c.call.URLFor("Lisamine", RowName(c, "ID_")));
    return true;
}

bool InfoLink(TagCall& c) {
    data::Record* row = Catalogue(c).CurrentRow.get();
    const std::string article = row == nullptr ? "" : row->GetField("IDGRArticle").ToPlainText();
    c.tag.Write(c.call.URLFor("KInfo", tags::Reference(c)) + "&ID=" + article);
    return true;
}

bool EditField(TagCall& c) {
    const std::string name(c.NameFrom(std::string_view("ZEB:EditField.").size()));
    c.state.basket_form.EditableRowFields.insert(name);
    c.tag.Write("EF_" + name + "_" + std::to_string(c.state.basket_form.RowIndex));
    return true;
}

bool Korvis(TagCall& c) {
    tags::ShowIf(c, QuantityInBasket(c.state) > 0);
    return true;
}

bool KorvisKogus(TagCall& c) {
    tags::WriteByPicture(c, QuantityInBasket(c.state));
    return true;
}

bool LisaKogusRefused(TagCall& c) {
    tags::ShowIfRefused(c, RowName(c, kQuantityBox));
    return true;
}

bool QuickEntryRefused(TagCall& c) {
    tags::ShowIfRefused(c, "QuickEntry");
    return true;
}

bool Added(TagCall& c) {
    tags::ShowIf(c, c.state.basket_form.LastForm.AddedRows > 0);
    return true;
}

bool AddedCount(TagCall& c) {
    tags::WriteByPicture(c, c.state.basket_form.LastForm.AddedRows);
    return true;
}

bool LastFind(TagCall& c) {
    c.tag.WriteEscaped(Catalogue(c).LastFind);
    return true;
}

bool Pagelen(TagCall& c) {
    const auto number = base::ParseNumber(tags::Reference(c));
    Catalogue(c).PageLength = number ? base::ToInteger16(*number) : std::int16_t{0};
    c.tag.Hide();
    return true;
}

bool OnFirstPage(const CatalogueState& s) {
    return s.PageNumber == 1;
}
bool OnLastPage(const CatalogueState& s) {
    return s.PageNumber == s.PageCount;
}
bool NotOnFirstPage(const CatalogueState& s) {
    return s.PageNumber >= 2;
}
bool NotOnLastPage(const CatalogueState& s) {
    return s.PageNumber < s.PageCount;
}
bool OnePage(const CatalogueState& s) {
    return s.PageCount <= 1;
}
bool SeveralPages(const CatalogueState& s) {
    return s.PageCount >= 2;
}
bool HasRows(const CatalogueState& s) {
    return s.ListQuery != nullptr && s.RowCount > 0;
}
bool HasNoRows(const CatalogueState& s) {
    return s.ListQuery != nullptr && s.RowCount == 0;
}

}  // namespace

const tags::TagTable& KaubainfoTagTable() {
    static const tags::TagTable kTable{
        {"ZEB:Grupid", Grupid, "options: the article categories, the chosen one preselected"},
        {"ZEB:Grupid.*", GrupidOfGroup, "options: the categories of one group"},
        {"ZEB:Grupp.Empty",
         Declare<&CatalogueState::EmptyGroupText>,
         "declares the text of the option for all categories"},
        {"ZEB:Grupp.Favourites",
         Declare<&CatalogueState::FavouritesGroupText>,
         "declares the text of the option for the favourites"},
        {"ZEB:Grupp.Query",
         GruppQuery,
         "declares which categories are offered: a filter; #F is the customer's key"},
        {"ZEB:Filter",
         Declare<&CatalogueState::FilterText>,
         "declares a condition that every list is restricted by"},
        {"ZEB:Order", Declare<&CatalogueState::OrderText>, "declares the sort order"},
        {"ZEB:DataOrder", DataOrder, "the sort order"},
        {"ZEB:DataOrder.*",
         DataOrderChoice,
         "contents when the list is sorted so; blanks of the order are written _"},
        {"ZEB:Favorites",
         Declare<&CatalogueState::FavoritesText>,
         "declares the favourites' condition; # is the customer's ID"},
        {"ZEB:Otsi.Code",
         Declare<&CatalogueState::SearchCodeColumn>,
         "declares the article column searched as the code"},
        {"ZEB:Otsi.Name",
         Declare<&CatalogueState::SearchNameColumn>,
         "declares the article column searched as the name"},
        {"ZEB:GRArticleCat", NoOutput, "nothing"},
        {"ZEB:HKRida", HKRida, "contents once for each row of the page"},
        {"ZEB:HKRida12", HKRida12, "\"odd;even\": one of two texts, turn and turn about"},
        {"ZEB:GRPriceListRow", RowFieldTag, "a field or price of the row"},
        {"ZEB:GRPriceListRel", RowFieldTag, "a field or price of the row"},
        {"ZEB:QPriceList", PriceFieldTag, "a field of the customer's prices for the row"},
        {"ZEB:GRCompany", Company, "a field of the customer's company"},
        {"ZEB:DiscountPercent", DiscountPercent, "the customer's general discount in per cent"},
        {"ZEB:LisaLink", LisaLink, "address: the page that adds the row's article"},
        {"ZEB:InfoLink", InfoLink, "address: the page about the row's article"},
        {"ZEB:LisaKogus", WriteRowName<kQuantityBox>, "name of the row's quantity box"},
        {"ZEB:LisaKogus.Refused",
         LisaKogusRefused,
         "contents, with what was typed in place of \"Typed\", when the row's box was refused"},
        {"ZEB:Korvis", Korvis, "contents when the basket holds the row's article"},
        {"ZEB:KorvisKogus", KorvisKogus, "how much of it, by a format picture"},
        {"ZEB:QuickEntry.Refused",
         QuickEntryRefused,
         "contents, with the lines in place of \"Typed\", when lines of the quick entry were "
         "refused"},
        {"ZEB:Added", Added, "contents when the last form has added rows to the basket"},
        {"ZEB:Added.Count", AddedCount, "how many, by a format picture"},
        {"ZEB:SavePriceTag", WriteRowName<kPriceBox>, "name of the row's price field"},
        {"ZEB:SaveUPriceTag", WriteRowName<kUnitPriceBox>, "name of the row's unit price field"},
        {"ZEB:MuudaKomment", tags::CommentBox, "name of the basket row's comment box"},
        {"ZEB:EditField.*", EditField, "name of a box for a further field of the basket row"},
        {"ZEB:LastFind", LastFind, "the last search text"},
        {"ZEB:Pagelen", Pagelen, "declares the rows per page; 0: no paging"},
        {"ZEB:Pagenum", WriteNumber<&CatalogueState::PageNumber>, "number of this page"},
        {"ZEB:Pagecount", WriteNumber<&CatalogueState::PageCount>, "number of pages"},
        {"ZEB:Pages.First", ShowWhen<OnFirstPage>, "contents on the first page"},
        {"ZEB:Pages.Last", ShowWhen<OnLastPage>, "contents on the last page"},
        {"ZEB:Pages.NotFirst", ShowWhen<NotOnFirstPage>, "contents behind the first page"},
        {"ZEB:Pages.NotLast", ShowWhen<NotOnLastPage>, "contents before the last page"},
        {"ZEB:Pages.Single", ShowWhen<OnePage>, "contents when there is one page or none"},
        {"ZEB:Pages.Multiple", ShowWhen<SeveralPages>, "contents when there are several pages"},
        {"ZEB:List.Exists", ShowWhen<HasRows>, "contents when the list has rows"},
        {"ZEB:List.Empty", ShowWhen<HasNoRows>, "contents when a list was asked for and is empty"},
        {"ZEB:Rowcount", WriteNumber<&CatalogueState::RowCount>, "number of rows of the list"},
    };
    return kTable;
}

}  // namespace zebtell::catalogue
