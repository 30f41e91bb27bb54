#pragma once

#include <cstdint>
#include <memory>

#include "base/currency.h"
#include "data/data_application.h"

namespace zebtell::data {

// The order that the customer is putting together: an unsaved SDOrder and the running totals that
// the pages show. The totals are kept by whoever changes the rows.
struct BasketValues {
    std::shared_ptr<Document> Basket;  // none: there is no basket
    std::shared_ptr<RecordList> BasketRows;
    std::int16_t BasketRowCount = 0;
    double BasketQuantity = 0;
    base::Currency BasketTotal;
};

// What a new basket takes from the session.
struct BasketOwner {
    std::int64_t IDPartner = 0;           // 0: none
    std::int64_t IDGRCompContPerson = 0;  // 0: no contact person is logged on
};

// Makes an empty basket unless there is one. Always true; when the database fails there is still
// no basket.
bool CreateBasket(BasketValues& basket, DataApplication& application, const BasketOwner& owner);

// Drops the basket; nothing is written to the database.
void DiscardBasket(BasketValues& basket);

}  // namespace zebtell::data
