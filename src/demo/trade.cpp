#include "demo/trade.h"

#include <cmath>

namespace zebtell::demo {
namespace {

constexpr double kDaysOfYear = 365.25;

// The states of orders; the others have but two.
enum OrderState { kNew, kInProcess, kPartlyDelivered, kDelivered };
constexpr int kDeliveryDone = 1;
constexpr int kInvoiceOpen = 1;
constexpr int kInvoicePaid = 2;

bool IsWorkday(int day) {
    constexpr int kSunday = 1;
    constexpr int kSaturday = 7;
    const int weekday = base::DateTime(day).Weekday();
    return weekday != kSunday && weekday != kSaturday;
}

int DayOf(base::DateTime date) {
    return static_cast<int>(date.days());
}

// What goes with the first of two deliveries: every third row waits, every third is halved.
double FirstPart(std::size_t position, double quantity) {
    switch (position % 3) {
        case 1:
            return 0;
        case 2:
            return std::floor(quantity / 2);
        default:
            return quantity;
    }
}

int StateOf(const TradeDocument& order, bool is_in_process) {
    bool any = false;
    bool all = true;
    for (const TradeRow& row : order.rows) {
        any = any || row.delivered > 0;
        all = all && row.delivered == row.quantity;
    }
    return all ? kDelivered : any ? kPartlyDelivered : is_in_process ? kInProcess : kNew;
}

}  // namespace

Trade::Trade(CompanyStore& store,
             const Catalogue& catalogue,
             const std::vector<Buyer>& buyers,
             const DemoOptions& options)
    : first_day_(DayOf(options.today) - static_cast<int>(options.years * kDaysOfYear)),
      today_(DayOf(options.today)),
      last_workday_(today_),
      wanted_rows_(options.order_rows),
      orders_(catalogue, buyers),
      writer_(store) {
    while (!IsWorkday(last_workday_)) {
        --last_workday_;
    }
}

int Trade::WorkdayFrom(int day) const {
    while (!IsWorkday(day)) {
        ++day;
    }
    return day;
}

void Trade::Run() {
    const std::int64_t days = last_workday_ - first_day_;
    for (int day = first_day_; day <= today_; ++day) {
        if (IsWorkday(day)) {
            TakeOrders(day, (day - first_day_) * wanted_rows_ / days);
        }
        Deliver(day);
        Bill(day);
    }
}

void Trade::TakeOrders(int day, std::int64_t rows_until_then) {
    const base::DateTime date(day);
    const bool with_blocked = day < (first_day_ + today_) / 2;
    // On the last day those whom people log on as have something to look at.
    std::size_t next = 0;
    while (rows_ < rows_until_then) {
        const int rows_left = static_cast<int>(wanted_rows_ - rows_);
        const bool is_known = day == last_workday_ && next < kJanisCompany;
        TradeDocument order = is_known ? orders_.MakeFor(next, date, rows_left)
                                       : orders_.Make(date, rows_left, with_blocked);
        ++next;
        for (const TradeRow& row : order.rows) {
            rows_ += row.status == 0 ? 1 : 0;
        }
        StoreOrder(std::move(order));
    }
}

// Decides when the order will be delivered, in one part or in two, and stores it as it stands
// today.
void Trade::StoreOrder(TradeDocument order) {
    const int day = DayOf(order.date);
    const int process_day = day == last_workday_ ? today_ + 1 : day + random_.Below(3);
    const int first = WorkdayFrom(process_day + random_.Below(4));
    const bool in_parts = random_.Percent(15);
    const int wait = random_.Percent(20) ? 60 : random_.Between(3, 16);
    const int second = WorkdayFrom(first + wait);
    std::vector<double> first_quantities;
    std::vector<double> second_quantities;
    for (TradeRow& row : order.rows) {
        const std::size_t position = first_quantities.size();
        const double part = in_parts ? FirstPart(position, row.quantity) : row.quantity;
        first_quantities.push_back(part);
        second_quantities.push_back(row.quantity - part);
        row.delivered = second <= today_ ? row.quantity : first <= today_ ? part : 0;
    }
    order.state = StateOf(order, process_day <= today_);
    writer_.WriteOrder(order);
    PlanDelivery(order, first, first_quantities);
    PlanDelivery(order, second, second_quantities);
}

void Trade::PlanDelivery(const TradeDocument& order,
                         int day,
                         const std::vector<double>& quantities) {
    TradeDocument delivery = order;
    delivery.source = order.id;
    delivery.date = base::DateTime(day);
    delivery.state = kDeliveryDone;
    delivery.rows.clear();
    for (std::size_t i = 0; i < quantities.size(); ++i) {
        if (quantities[i] > 0) {
            TradeRow row = order.rows[i];
            row.source_row = row.id;
            row.SetQuantity(quantities[i]);
            delivery.rows.push_back(row);
        }
    }
    if (!delivery.rows.empty() && day <= today_) {
        deliveries_[day].push_back(std::move(delivery));
    }
}

void Trade::Deliver(int day) {
    for (TradeDocument& delivery : deliveries_[day]) {
        writer_.WriteDelivery(delivery);
        PlanInvoice(delivery);
    }
    deliveries_.erase(day);
}

void Trade::PlanInvoice(const TradeDocument& delivery) {
    TradeDocument invoice = delivery;
    const int day = WorkdayFrom(DayOf(delivery.date) + random_.Below(3));
    invoice.source = delivery.id;
    invoice.date = base::DateTime(day);
    const int due = day + delivery.buyer->payment_days;
    invoice.due = base::DateTime(due);
    for (TradeRow& row : invoice.rows) {
        row.source_row = row.id;
    }
    const bool is_time = due - 10 + random_.Below(25) <= today_;
    const int morals = random_.Below(100);  // below 3 nothing is paid, below 6 a half
    invoice.paid_in_full = is_time && morals >= 6;
    invoice.paid_percent = is_time && morals >= 3 ? 50 : 0;
    invoice.state = invoice.paid_in_full ? kInvoicePaid : kInvoiceOpen;
    if (day <= today_) {
        invoices_[day].push_back(std::move(invoice));
    }
}

void Trade::Bill(int day) {
    for (TradeDocument& invoice : invoices_[day]) {
        writer_.WriteInvoice(invoice);
    }
    invoices_.erase(day);
}

}  // namespace zebtell::demo
