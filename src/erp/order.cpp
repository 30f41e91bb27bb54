#include "erp/order.h"

#include "base/runtime_error.h"
#include "data/record.h"
#include "erp/order_price.h"
#include "erp/order_sums.h"
#include "erp/read_only_record.h"

namespace zebtell::erp {
namespace {

// More than anybody types. Each page shows them all, and each takes memory for as long as the
// session lasts.
constexpr std::size_t kMostRows = 2'000;

[[noreturn]] void Refuse(const char* why) {
    throw base::RuntimeError(base::errors::kInvalidCall, why);
}

void RefuseFixed(const OrderRow& row) {
    if (row.IsFixed()) {
        Refuse("The row can't be changed");
    }
}

// The owner is the reader's company; a page may say so, but nothing else.
bool IsOwnCompany(const Reader& reader, std::string_view name, const base::Value& value) {
    return base::EqualNoCase(name, "IDGRCompany") && value.IsNumeric() &&
           value.ToInteger64() == reader.partner;
}

}  // namespace

bool OrderRow::IsFixed() const {
    return (fields.Integer("Status") & data::kFixedRow) != 0;
}

bool OrderRow::IsToStore() const {
    return fields.Integer("IDGRArticle") != 0 && fields.Number("Quantity") > 0;
}

Order::Order(const std::shared_ptr<Session>& session)
    : header(session->database().Table(kOrderTable)), session_(session), linked_(session) {}

base::Value Order::GetHeaderField(std::string_view name) {
    if (base::EqualNoCase(name, "ID")) {
        return id;
    }
    if (const auto sum = HeaderSum(*this, name)) {
        return *sum;
    }
    const base::Value* value = header.Find(name);
    return value ? *value : BehindLink(header, name);
}

void Order::SetHeaderField(std::string_view name, const base::Value& value) {
    if (name.starts_with('@')) {
        header.Set(name, value);
        return;
    }
    if (IsOwnCompany(session_->reader(), name, value)) {
        return;
    }
    const Column& column = WritableColumn(header.table(), name);
    base::Value accepted = Accepted(*session_, header.table(), column, value);
    if (base::EqualNoCase(name, "WantedDate") && !accepted.IsNull() &&
        *accepted.As<base::DateTime>() < session_->clock()().DateOnly()) {
        Refuse("The wanted date is over");
    }
    header.Set(name, std::move(accepted));
    changed = true;
}

base::Value Order::GetRowField(const OrderRow& row, std::string_view name) {
    if (base::EqualNoCase(name, "ID")) {
        return row.id;
    }
    const base::Value* value = row.fields.Find(name);
    return value ? *value : BehindLink(row.fields, name);
}

void Order::SetRowField(OrderRow& row, std::string_view name, const base::Value& value) {
    if (name.starts_with('@')) {
        row.fields.Set(name, value);
        return;
    }
    RefuseFixed(row);
    const Column& column = WritableColumn(row.fields.table(), name);
    if (base::EqualNoCase(name, "IDGRArticle")) {
        SetArticle(row, value);
    } else if (value.IsBlank() && base::EqualNoCase(name, "Quantity")) {
        throw base::RuntimeError(base::errors::kTypeMismatch, "The quantity is not a number");
    } else {
        row.fields.Set(name, Accepted(*session_, row.fields.table(), column, value));
        row.amount_set |= base::EqualNoCase(name, "Amount");
        row.unit_price_set |= base::EqualNoCase(name, "UnitPrice");
    }
    row.changed = true;
    changed = true;
}

void Order::SetArticle(OrderRow& row, const base::Value& value) {
    const std::int64_t article = value.ToInteger64();
    const Reader& reader = session_->reader();
    const auto rows = session_->Query(OwnPricesSql(reader, {article}));
    const OwnPrices prices = ReadOwnPrices(reader, *rows);
    const auto own = prices.find(article);
    if (own == prices.end()) {
        Refuse("The article is in none of your price lists");
    }
    row.fields.Set("IDGRArticle", article);
    row.fields.Set("Price", own->second.price);
    row.fields.Set("PriceCut", own->second.price_cut);
    row.fields.Set("TaxPercent", own->second.tax_percent);
    if (!row.unit_price_set) {
        row.fields.Set("UnitPrice", own->second.price);
    }
}

void Order::UpdateRow(OrderRow& row) {
    RefuseFixed(row);
    const double quantity = row.fields.Number("Quantity");
    const base::Currency price = row.fields.Money("Price");
    const base::Currency by_price = base::Multiplied(price, quantity, 2);
    const base::Currency asked = row.fields.Money("Amount").Rounded(2);
    if (!row.amount_set || quantity == 0 || asked == by_price) {
        row.fields.Set("Amount", by_price);
    } else {
        row.fields.Set("Amount", asked);
        row.fields.Set("Price", base::Currency::FromDouble(asked.ToDouble() / quantity));
    }
    row.amount_set = false;
    row.changed = false;
}

void Order::DeleteRow(const OrderRow& row) {
    RefuseFixed(row);
    std::erase_if(rows, [&row](const auto& kept) { return kept.get() == &row; });
    changed = true;
}

std::shared_ptr<OrderRow> Order::AddRow() {
    if (rows.size() >= kMostRows) {
        Refuse("The order has too many rows");
    }
    auto row = std::make_shared<OrderRow>(session_->database().Table(kOrderRowTable));
    row->id = NewRowId();
    const std::int64_t last = rows.empty() ? 0 : rows.back()->fields.Integer("RowNo");
    row->fields.Set("RowNo", last + 1);
    for (const char* number : {"Quantity", "PriceCut", "TaxPercent", "DeliveredQuantity"}) {
        row->fields.Set(number, 0.0);
    }
    for (const char* amount : {"Price", "UnitPrice", "Amount"}) {
        row->fields.Set(amount, base::Currency());
    }
    row->fields.Set("Status", 0);
    rows.push_back(row);
    return row;
}

// "GRArticle.GRTax.TaxPercent": the record that the first link leads to is read, with its fields
// and those of its like in the other rows.
base::Value Order::BehindLink(const RecordFields& fields, std::string_view path) {
    const std::size_t dot = path.find('.');
    const std::string_view name = path.substr(0, dot);
    const Column* link = fields.table().FindLink(name);
    if (dot == std::string_view::npos || !link || link->links_to.empty()) {
        NoSuchField(path);
    }
    if (base::EqualNoCase(link->links_to, kOrderTable)) {
        return GetHeaderField(path.substr(dot + 1));
    }
    const TableInfo& target = session_->database().Table(link->links_to);
    const std::int64_t key = fields.Integer(link->name);
    if (key == 0) {
        return base::Value::Null();
    }
    return linked_.Get(target, key, path.substr(dot + 1), [&] {
        return &fields == &header ? std::vector<std::int64_t>() : LinkedKeys(link->name);
    });
}

std::vector<std::int64_t> Order::LinkedKeys(std::string_view column) const {
    std::vector<std::int64_t> keys;
    for (const auto& row : rows) {
        keys.push_back(row->fields.Integer(column));
    }
    return keys;
}

}  // namespace zebtell::erp
