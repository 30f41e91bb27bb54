#include "data/basket.h"

#include "base/ignore_errors.h"

namespace zebtell::data {

bool CreateBasket(BasketValues& basket, DataApplication& application, const BasketOwner& owner) {
    if (basket.Basket) return true;
    // Made aside, so that a failure leaves no half-made basket.
    base::IgnoreErrors([&] {
        BasketValues made;
        made.Basket = application.OpenTable("SDOrder")->Open(0);
        if (owner.IDPartner != 0) made.Basket->SetField("IDGRCompany", owner.IDPartner);
        if (owner.IDGRCompContPerson != 0) {
            made.Basket->SetField("IDGRCompContPerson", owner.IDGRCompContPerson);
        }
        made.BasketRows = made.Basket->Rows();
        basket = std::move(made);
    });
    return true;
}

void DiscardBasket(BasketValues& basket) {
    if (basket.Basket) basket = {};
}

}  // namespace zebtell::data
