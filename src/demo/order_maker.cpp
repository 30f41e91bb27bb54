#include "demo/order_maker.h"

#include <algorithm>
#include <span>
#include <string_view>

#include "demo/assortment.h"

namespace zebtell::demo {
namespace {

constexpr int kMadeByErp = 4;
constexpr int kMostRows = 9;

constexpr std::string_view kOrderNotes[] = {
    "Palun tarnida enne lõunat.",
    "Kaup viia objektile: O'Brieni maja, 2. korrus",
    "Vajame kiiresti, helistage!\nTel. 5550 1234",
    "Lūdzu piegādāt uz noliktavu \"B\"",
    "Arve saata <raamatupidamisse> & koopia ostujuhile",
    "Ostutellimus PO-4471",
};
constexpr std::string_view kRowNotes[] = {
    "Saagida 2 m tükkideks", "Ainult <sama partii>", "Asendus lubatud", "Seadmele \"Liin 3\""};

struct Guest {
    std::string_view name;
    std::string_view address;
};
constexpr Guest kGuests[] = {
    {"Mihkel Õispuu", "Aia 3, 10111 Tallinn"},
    {"Kärt & Villu Nõmm", "Metsa talu, Rõuge vald"},
    {"D'Angelo Rossi", "Kopli 101-12, 11712 Tallinn"},
    {"Solvita Āboliņa", "Lāčplēša iela 20, Rīga"},
};

int TurnsOf(const Buyer& buyer, Random& random) {
    switch (buyer.id) {
        case kMarisCompany:
            return 12;
        case kJanisCompany:
            return 8;
        case kRetailCompany:
            return 2;
        default:
            return random.Between(1, 6);
    }
}

double QuantityOf(const Article& article, Random& random) {
    constexpr int kUsualQuantities[] = {1, 1, 2, 2, 3, 4, 5, 6, 8, 10, 12, 20, 25, 50, 100};
    return article.is_measured ? random.Between(1, 40) * 0.5 : random.Pick(kUsualQuantities);
}

}  // namespace

OrderMaker::OrderMaker(const Catalogue& catalogue, const std::vector<Buyer>& buyers)
    : catalogue_(catalogue), buyers_(buyers) {
    for (std::size_t position = 0; position < buyers.size(); ++position) {
        assortments_.push_back(AssortmentOf(buyers[position], catalogue, random_));
        turns_.insert(
            turns_.end(), static_cast<std::size_t>(TurnsOf(buyers[position], random_)), position);
    }
}

TradeDocument OrderMaker::Make(base::DateTime date, int most_rows, bool with_blocked) {
    return MakeFor(PickCompany(with_blocked), date, most_rows);
}

TradeDocument OrderMaker::MakeFor(std::size_t company, base::DateTime date, int most_rows) {
    TradeDocument order;
    order.buyer = &buyers_[company];
    order.date = date;
    order.wanted = base::DateTime(date.days() + random_.Between(2, 12));
    order.needs_review = random_.Percent(1);
    if (random_.Percent(15)) {
        order.explanation = random_.Pick(kOrderNotes);
    }
    if (order.buyer->id == kRetailCompany) {
        const Guest& guest = random_.Pick(kGuests);
        order.company_name = guest.name;
        order.company_address = guest.address;
    }
    const std::vector<TradeRow>& assortment = assortments_[company];
    const int most = std::min({most_rows, kMostRows, static_cast<int>(assortment.size())});
    AddRows(order, assortment, random_.Between(1, most));
    AddTransport(order);
    return order;
}

std::size_t OrderMaker::PickCompany(bool with_blocked) {
    while (true) {
        const std::size_t company = random_.Pick(turns_);
        if (with_blocked || buyers_[company].may_order) {
            return company;
        }
    }
}

void OrderMaker::AddRows(TradeDocument& order, const std::vector<TradeRow>& assortment, int count) {
    while (static_cast<int>(order.rows.size()) < count) {
        TradeRow row = random_.Pick(assortment);
        const bool is_there =
            std::any_of(order.rows.begin(), order.rows.end(), [&row](const TradeRow& other) {
                return other.article == row.article;
            });
        if (is_there) {
            continue;
        }
        row.SetQuantity(QuantityOf(*row.article, random_));
        if (random_.Percent(4)) {
            row.explanation = random_.Pick(kRowNotes);
        }
        order.rows.push_back(row);
    }
}

// Small orders pay for their transport.
void OrderMaker::AddTransport(TradeDocument& order) {
    const base::Currency kSmallOrder = base::Currency::FromScaled(60'00'00);
    if (SumsOf(order.rows).amount >= kSmallOrder || random_.Percent(50)) {
        return;
    }
    TradeRow row;
    row.article = &catalogue_.transport;
    row.price = row.list_price = catalogue_.transport.PriceIn(kBaseList);
    row.status = kMadeByErp;
    row.SetQuantity(1);
    order.rows.push_back(row);
}

}  // namespace zebtell::demo
