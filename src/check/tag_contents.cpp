#include "check/tag_contents.h"

#include <vector>

#include "base/text.h"
#include "check/statement_check.h"

namespace zebtell::check {
namespace {

constexpr std::string_view kBasketRowWords[] = {"#"};
constexpr std::string_view kPriceLineWords[] = {"Price", "Price18", "FinalPrice*", "PriceCut*"};
constexpr std::string_view kPriceWords[] = {
    "FinalPrice", "FinalPrice18", "FinalPriceWTax", "PriceCut"};
constexpr std::string_view kArticlePriceWords[] = {
    "ID", "FinalPrice", "FinalPriceWTax", "PriceCut"};
constexpr std::string_view kAddedWords[] = {"Price", "Price18", "PriceWTax"};
constexpr std::string_view kComposedWords[] = {"Kustuta"};
// Written as plain text for a text box.
constexpr std::string_view kHeaderWords[] = {"Explanation"};

// clang-format off
constexpr TagContents kContents[] = {
    // on every page
    {"", "zeb:company",          "GRCompany"},
    {"", "zeb:parent",           "GRCompany"},
    {"", "zeb:contact",          "GRCompContPerson"},
    {"", "zeb:grcompcontperson", "GRCompContPerson"},
    {"", "zeb:employee",         "EREmployee"},
    {"", "zeb:eremployee",       "EREmployee"},
    {"", "zeb:tellimus",         "SDOrder"},
    {"", "zeb:tellimus.rida",    "SDOrderRow", kBasketRowWords},
    {"", "zeb:orders.enable",    "", {}, CheckOrdersField},
    {"", "zeb:query",            "", {}, CheckQuery},
    {"", "zeb:query.*",          "", {}, CheckQueryName},
    {"", "zeb:createcombo",      "", {}, CheckCombo},
    {"", "zeb:pricequery",       "", {}, CheckPriceQuery},
    {"", "zeb:tellsumma"},
    {"", "zeb:tellkogus"},
    {"", "zeb:tellridu"},
    {"", "zeb:weblanguage"},
    {"", "zeb:fileversion"},
    {"", "zeb:setstoreid"},
    {"", "zeb:savevalue"},
    {"", "zeb:roundquantity"},

    {"Kaubainfo", "zeb:grpricelistrow", "GRPriceListRel", kPriceLineWords},
    {"Kaubainfo", "zeb:grpricelistrel", "GRPriceListRel", kPriceLineWords},
    {"Kaubainfo", "zeb:qpricelist",     "*", kPriceWords},
    {"Kaubainfo", "zeb:grcompany",      "GRCompany"},
    {"Kaubainfo", "zeb:filter",         "", {}, CheckFilter},
    {"Kaubainfo", "zeb:order",          "", {}, CheckOrder},
    {"Kaubainfo", "zeb:favorites",      "", {}, CheckFavorites},
    {"Kaubainfo", "zeb:otsi.*",         "", {}, CheckArticleColumn},
    {"Kaubainfo", "zeb:editfield.*",    "", {}, CheckRowField},
    {"Kaubainfo", "zeb:pagelen"},
    {"Kaubainfo", "zeb:grupp.*"},
    {"Kaubainfo", "zeb:infolink"},
    {"KInfo",       "zeb:grarticle",  "GRArticle"},
    {"KInfo",       "zeb:qpricelist", "*", kArticlePriceWords},
    {"Raamistik",   "zeb:sdorder",    "SDOrder"},
    {"Koostamine",  "zeb:orderrow",   "SDOrderRow", kComposedWords},
    {"Koostamine",  "zeb:sdorderrow", "SDOrderRow", kComposedWords},
    {"Koostamine",  "zeb:order",      "SDOrder",    kHeaderWords},
    {"Koostamine",  "zeb:sdorder",    "SDOrder",    kHeaderWords},
    {"Lisamine",    "zeb:lisarida",   "GRPriceListRel", kAddedWords},
    {"Kinnitus",    "zeb:sdorder",    "SDOrder", kHeaderWords},
    {"Kinnitus",    "zeb:recipient",  "SDOrder"},
    {"Kinnitus",    "zeb:sdorderrow", "SDOrderRow"},
    {"Kinnitatud",  "zeb:sdorder",    "SDOrder"},
    {"Kinnitatud",  "zeb:sdorderrow", "SDOrderRow"},
    {"Kinnitatud",  "zeb:gdtax",      "GDTax"},
    {"Tellimus",    "zeb:sdorder",    "SDOrder"},
    {"Tellimus",    "zeb:sdorderrow", "SDOrderRow"},
    {"Tellimus",    "zeb:gdtax",      "GDTax"},
};
// clang-format on

bool IsFor(const TagContents& row, std::string_view page, std::string_view lower_name) {
    if (!row.page.empty() && row.page != page) return false;
    return row.tag.ends_with('*') ? lower_name.starts_with(row.tag.substr(0, row.tag.size() - 1))
                                  : lower_name == row.tag;
}

}  // namespace

const TagContents* FindTagContents(std::string_view page, std::string_view lower_name) {
    for (const TagContents& row : kContents) {
        if (IsFor(row, page, lower_name)) return &row;
    }
    return nullptr;
}

}  // namespace zebtell::check
