#pragma once

#include <cstdint>
#include <memory>

#include "data/record.h"

namespace zebtell::host {

// The customer's company and who belongs to it; loaded at log-on.
struct CompanyState {
    // The user's record: the company's fields are read as "Partner.Name".
    std::shared_ptr<data::Record> PartnerRecord;
    std::shared_ptr<data::Record> CompanyRecord;
    bool CompanyLoaded = false;
    std::shared_ptr<data::Record> SettlementRecord;
    std::shared_ptr<data::Record> ParentRecord;
    bool ParentLoaded = false;
    std::shared_ptr<data::Record> ContactRecord;
    bool ContactLoaded = false;

    std::int32_t CustomerKey = 0;  // the company's ID; 0: the user has none
    std::int32_t PriceListId = 0;  // 0: none
    double PriceFactor = 1;        // 0.9: 10 per cent off
    std::int64_t IDContactPerson = 0;
};

}  // namespace zebtell::host
