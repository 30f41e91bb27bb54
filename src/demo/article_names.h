#pragma once

#include <cstdint>
#include <string>

#include "demo/article_kinds.h"

namespace zebtell::demo {

// One article of a kind.
struct ArticleName {
    std::string code;        // "POL-M8-040"; the first variant of a size has no number behind it
    std::string name;        // "Kuuskantpolt M8×40 DIN 933 8.8 Zn"
    int size_per_mille = 0;  // where its size stands among the kind's sizes, 0 to 999
};

// The articles of a kind, without repetition: `number` counts from 0 without end. When every
// combination has been used, they come again by other makers.
ArticleName NameOf(const ArticleKind& kind, int number);

// The 13 digits of a barcode whose first 12 are given.
std::string Ean13(std::int64_t first_digits);

}  // namespace zebtell::demo
