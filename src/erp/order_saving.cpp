#include "erp/order_saving.h"

#include <algorithm>

#include "base/runtime_error.h"
#include "erp/made_for.h"
#include "erp/order_image.h"
#include "erp/order_review.h"
#include "erp/order_sums.h"
#include "erp/transaction.h"
#include "erp/write_sql.h"

namespace zebtell::erp {
namespace {

// What saving gave, for the order in memory.
struct Stored {
    data::Saved saved = data::Saved::kNow;
    std::int64_t id = 0;
    base::Value number;
    std::vector<std::int64_t> row_ids;  // by row; 0: not stored
    std::optional<OrderImage> image;
};

// What customers change of a stored order; the rest is the staff's.
constexpr const char* kHeaderColumns[] = {
    "WantedDate", "IDGRCompContPerson", "CompanyName", "CompanyAddr", "Explanation"};
constexpr const char* kRowColumns[] = {"IDGRArticle",
                                       "Quantity",
                                       "Price",
                                       "UnitPrice",
                                       "PriceCut",
                                       "Amount",
                                       "TaxPercent",
                                       "Explanation"};

[[noreturn]] void Refuse(const char* why) {
    throw base::RuntimeError(base::errors::kInvalidCall, why);
}

// One save of one order.
class Saving {
  public:
    Saving(Order& order, Connection& connection)
        : order_(order),
          session_(*order.session()),
          connection_(connection),
          review_prices_(ReviewPrices(order, connection)) {}

    Stored Run() {
        stored_.row_ids.assign(order_.rows.size(), 0);
        if (order_.IsStored()) {
            StoreAgain();
        } else if (!IsStoredAlready()) {
            StoreNew();
        }
        stored_.image = Image(stored_.id);
        return std::move(stored_);
    }

  private:
    BoundSql Kept(const std::string& table,
                  const char* rest,
                  const std::vector<base::Value>& values) const;
    bool IsStoredAlready();
    void StoreNew();
    void StoreAgain();
    void StoreRows();
    void RemoveRows();
    void StoreTaxes();
    std::optional<OrderImage> Image(std::int64_t id);
    ColumnValues Sums();
    ColumnValues ValuesOf(const RecordFields& fields, std::span<const char* const> columns) const;

    Order& order_;
    Session& session_;
    Connection& connection_;
    const std::vector<std::optional<base::Currency>> review_prices_;  // by row
    Stored stored_;
};

// A select that keeps what it reads of its first table until the transaction ends.
BoundSql Saving::Kept(const std::string& table,
                      const char* rest,
                      const std::vector<base::Value>& values) const {
    return MadeFor(session_.database().dialect(), [&](Dialect dialect) {
        return BoundSql{table + std::string(KeptUntilCommit(dialect)) + rest, values};
    });
}

bool Saving::IsStoredAlready() {
    const auto row =
        connection_.Query(Kept("SELECT d.ID, o.Number FROM GDocument d",
                               " INNER JOIN SDOrder o ON o.ID = d.ID WHERE d.DocKey = ?",
                               {order_.key}));
    if (!row->Next()) {
        return false;
    }
    stored_.saved = data::Saved::kBefore;
    stored_.id = row->GetInteger(0);
    stored_.number = row->GetInteger(1);
    return true;
}

void Saving::StoreNew() {
    if (order_.header.Integer("IDGRCompany") == 0) {
        Refuse("The order has no company");
    }
    stored_.id = connection_.Insert(InsertSql(
        "GDocument",
        {{"Kind", kOrderTable}, {"DocKey", order_.key}, {"Created", session_.clock()()}}));
    {
        const auto last = connection_.Query(Kept("SELECT max(Number) FROM SDOrder", "", {}));
        stored_.number = (last->Next() ? last->GetInteger(0) : 0) + 1;
    }
    ColumnValues values = ValuesOf(order_.header, kHeaderColumns);
    for (const char* column : {"DocDate", "State", "IDGRCompany", "IDGRPriceList"}) {
        values.emplace_back(column, order_.header.Get(column));
    }
    values.emplace_back("ID", stored_.id);
    values.emplace_back("Number", stored_.number);
    const ColumnValues sums = Sums();
    values.insert(values.end(), sums.begin(), sums.end());
    connection_.Execute(InsertSql(kOrderTable, values));
    StoreRows();
    StoreTaxes();
}

void Saving::StoreAgain() {
    connection_.Execute(Kept("SELECT ID FROM SDOrder", " WHERE ID = ?", {order_.id}));
    const auto now = Image(order_.id);
    if (!now) {
        Refuse("The order is not there any more");
    }
    RecordFields header(order_.header.table());
    header.Take(*now->header, 0);
    if (header.Integer("State") != 0) {
        Refuse("The order is being processed and can't be changed");
    }
    if (!order_.image || !IsSame(*now, *order_.image)) {
        Refuse("Somebody else has changed the order");
    }
    stored_.id = order_.id;
    stored_.number = header.Get("Number");
    ColumnValues values = ValuesOf(order_.header, kHeaderColumns);
    const ColumnValues sums = Sums();
    values.insert(values.end(), sums.begin(), sums.end());
    connection_.Execute(UpdateSql(kOrderTable, order_.id, values));
    RemoveRows();
    StoreRows();
    connection_.Execute({"DELETE FROM GDTax WHERE IDGDocument = ?", {order_.id}});
    StoreTaxes();
}

void Saving::RemoveRows() {
    for (const std::int64_t id : order_.image->row_ids) {
        const bool kept =
            std::any_of(order_.rows.begin(), order_.rows.end(), [id](const auto& row) {
                return row->id == id && (row->IsFixed() || row->IsToStore());
            });
        if (!kept) {
            connection_.Execute({"DELETE FROM SDOrderRow WHERE ID = ?", {id}});
        }
    }
}

void Saving::StoreRows() {
    for (std::size_t i = 0; i < order_.rows.size(); ++i) {
        const OrderRow& row = *order_.rows[i];
        if (row.IsFixed()) {
            stored_.row_ids[i] = row.id;
            continue;
        }
        if (!row.IsToStore()) {
            continue;
        }
        ColumnValues values = ValuesOf(row.fields, kRowColumns);
        const auto& review_price = review_prices_[i];
        values.emplace_back("ReviewPrice", review_price ? *review_price : base::Value::Null());
        if (row.id > 0) {
            connection_.Execute(UpdateSql(kOrderRowTable, row.id, values));
            stored_.row_ids[i] = row.id;
            continue;
        }
        values.emplace_back(kOrderRowLink, stored_.id);
        values.emplace_back("RowNo", row.fields.Get("RowNo"));
        stored_.row_ids[i] = connection_.Insert(InsertSql(kOrderRowTable, values));
    }
}

void Saving::StoreTaxes() {
    for (const TaxLine& line : SumsOf(order_).taxes) {
        connection_.Execute(InsertSql("GDTax",
                                      {{"IDGDocument", stored_.id},
                                       {"TaxPercent", line.percent},
                                       {"Base", line.base},
                                       {"Amount", line.amount}}));
    }
}

// Also of an order that the reader sees only from now on.
std::optional<OrderImage> Saving::Image(std::int64_t id) {
    Reader reader = session_.reader();
    if (!order_.IsStored()) {
        reader.saved_documents.push_back(id);
    }
    return ReadOrderImage(session_.database().translator(), reader, connection_, id);
}

ColumnValues Saving::Sums() {
    const OrderSums sums = SumsOf(order_);
    const bool needs_review = std::any_of(review_prices_.begin(),
                                          review_prices_.end(),
                                          [](const auto& price) { return price.has_value(); });
    return {{"Amount", sums.amount},
            {"TaxAmount", sums.tax_amount},
            {"AmountWTax", sums.with_tax()},
            {"NeedsReview", needs_review}};
}

ColumnValues Saving::ValuesOf(const RecordFields& fields,
                              std::span<const char* const> columns) const {
    ColumnValues values;
    for (const char* column : columns) {
        values.emplace_back(column, fields.Get(column));
    }
    return values;
}

void Recalculate(Order& order) {
    for (const auto& row : order.rows) {
        if (row->changed) {
            order.UpdateRow(*row);
        }
    }
    const bool has_rows = std::any_of(
        order.rows.begin(), order.rows.end(), [](const auto& row) { return row->IsToStore(); });
    if (!has_rows) {
        Refuse("The order has no rows");
    }
}

void Take(Order& order, Stored stored) {
    const bool is_new = !order.IsStored();
    order.id = stored.id;
    order.header.Set("Number", stored.number);
    for (std::size_t i = 0; i < order.rows.size(); ++i) {
        const std::int64_t id = stored.row_ids[i];
        order.rows[i]->id = id != 0 ? id : order.NewRowId();
    }
    order.image = std::move(stored.image);
    order.changed = false;
    if (is_new) {
        order.session()->AddSavedDocument(order.id);
    }
}

}  // namespace

data::Saved SaveOrder(Order& order) {
    if (order.IsStored() && !order.changed) {
        return data::Saved::kBefore;
    }
    Recalculate(order);
    Stored stored =
        InTransaction(order.session()->database().pool(),
                      [&order](Connection& connection) { return Saving(order, connection).Run(); });
    const data::Saved saved = stored.saved;
    Take(order, std::move(stored));
    return saved;
}

}  // namespace zebtell::erp
