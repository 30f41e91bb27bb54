#pragma once

#include <cstdint>
#include <vector>

#include "demo/catalogue.h"
#include "demo/company_store.h"
#include "demo/company_table.h"

namespace zebtell::demo {

// What documents need to know of a company.
struct Buyer {
    std::int64_t id = 0;
    std::int64_t contact = 0;     // GRCompContPerson.ID, 0: none
    std::int64_t price_list = 0;  // the one that counts: own, else of who pays, else the default
    CompanyGroup group = CompanyGroup::kUsual;
    int payment_days = 0;
    bool may_order = true;
};

// Stores the companies with their people, price categories and percentages.
std::vector<Buyer> WriteCompanies(CompanyStore& store, int companies);

// Stores the users: those that people are told of, and one for each other company.
void WriteUsers(CompanyStore& store, const std::vector<Buyer>& buyers);

}  // namespace zebtell::demo
