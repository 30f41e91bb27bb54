#pragma once

#include <span>
#include <string_view>

namespace zebtell::demo {

// The price categories of articles; GRArticlePriceCat.ID is the position from 1.
enum class PriceGroup { kFasteners = 1, kTools, kConsumables, kElectric, kNet };

// The taxes; GRTax.ID is the position from 1.
enum class TaxRate { kStandard = 1, kReduced, kZero };

// A category of articles: every name goes with every size, length and finish, in this way:
// "Kuuskantpolt % DIN 933" with "M8", "40" and "8.8 Zn" is "Kuuskantpolt M8×40 DIN 933 8.8 Zn".
// A name without "%" has its size behind it. The lists are parted by "|".
struct ArticleKind {
    std::string_view code;      // first part of the articles' codes
    std::string_view category;  // GRArticleCat.Name
    std::string_view group;     // GRArticleCat.Category
    std::string_view unit;
    int pack;     // units in a pack
    int lowest;   // price in cents
    int highest;  // price in cents
    PriceGroup price_group;
    TaxRate tax;
    std::string_view names;
    std::string_view sizes;
    std::string_view lengths;
    std::string_view finishes;
};

// The 30 categories; GRArticleCat.ID is the position from 1.
std::span<const ArticleKind> ArticleKinds();

}  // namespace zebtell::demo
