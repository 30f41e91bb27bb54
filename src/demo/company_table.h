#pragma once

#include <cstdint>
#include <span>
#include <string_view>

#include "demo/article_kinds.h"

namespace zebtell::demo {

struct Town {
    std::string_view country;
    std::string_view city;
    std::string_view post_code;
    std::string_view street;
};

// The price categories of companies; GRCompanyPriceCat.ID is the position from 1.
enum class CompanyGroup { kRetail = 1, kUsual, kRegular, kGold };

// A company; GRCompany.ID is its position in the table from 1. Links of 0 are not set.
struct CompanyRow {
    std::string_view name;
    int town;  // position in Towns()
    CompanyGroup group;
    std::int64_t price_list;
    double price_cut = 0;
    std::int64_t parent = 0;  // who also pays its invoices
};

// The companies that people look for by their users.
inline constexpr std::int64_t kMarisCompany = 1;
inline constexpr std::int64_t kJanisCompany = 2;
inline constexpr std::int64_t kBlockedCompany = 3;
inline constexpr std::int64_t kRetailCompany = 4;

std::span<const Town> Towns();
std::span<const CompanyRow> Companies();

struct PersonNames {
    std::span<const std::string_view> first;
    std::span<const std::string_view> last;
};
PersonNames NamesOf(std::string_view country);

// The percentage of a company price category on the prices of an article price category.
struct PriceCutRow {
    CompanyGroup company_group;
    PriceGroup price_group;
    std::int64_t price_list;
    double price_cut;
};
std::span<const PriceCutRow> PriceCuts();

}  // namespace zebtell::demo
