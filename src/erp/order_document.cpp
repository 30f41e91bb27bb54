#include "erp/order_document.h"

#include <algorithm>

#include "base/runtime_error.h"
#include "erp/children.h"
#include "erp/criterion.h"
#include "erp/order_saving.h"
#include "erp/order_sums.h"
#include "erp/query_list.h"
#include "erp/read_only_record.h"

namespace zebtell::erp {
namespace {

std::shared_ptr<data::RecordList> RowsOf(std::shared_ptr<Order> order);

// The tax lines as the rows stand now, which the stored ones need not be.
std::shared_ptr<data::RecordList> TaxesOf(const Order& order) {
    auto fields = std::make_shared<const FieldSet>(
        std::vector<std::string>{"IDGDocument", "TaxPercent", "Base", "Amount"});
    auto rows = std::make_shared<RowSet>(std::move(fields));
    for (const TaxLine& line : SumsOf(order).taxes) {
        rows->Append({order.id, line.percent, line.base, line.amount});
    }
    return std::make_shared<QueryList>(
        std::make_shared<QueryRows>(order.session(), std::move(rows), nullptr));
}

class HeaderRecord : public data::Record {
  public:
    explicit HeaderRecord(std::shared_ptr<Order> order) : order_(std::move(order)) {}

    base::Value GetField(std::string_view name) override { return order_->GetHeaderField(name); }
    void SetField(std::string_view name, const base::Value& value) override {
        order_->SetHeaderField(name, value);
    }
    std::shared_ptr<data::RecordList> Children(std::string_view table) override {
        if (base::EqualNoCase(table, kOrderRowTable)) {
            return RowsOf(order_);
        }
        if (base::EqualNoCase(table, "GDTax")) {
            return TaxesOf(*order_);
        }
        return OpenChildren(order_->session(),
                            order_->header.table(),
                            order_->id,
                            table,
                            [this](const std::string& column) { return GetField(column); });
    }
    void Update(int) override {}  // the header holds nothing that is not calculated when it is read
    void Delete() override {
        throw base::RuntimeError(base::errors::kInvalidCall, "Orders can't be deleted");
    }
    bool Status(int) override { return false; }

  private:
    std::shared_ptr<Order> order_;
};

class RowRecord : public data::Record {
  public:
    RowRecord(std::shared_ptr<Order> order, std::shared_ptr<OrderRow> row)
        : order_(std::move(order)), row_(std::move(row)) {}

    base::Value GetField(std::string_view name) override {
        return order_->GetRowField(*row_, name);
    }
    void SetField(std::string_view name, const base::Value& value) override {
        order_->SetRowField(*row_, name, value);
    }
    std::shared_ptr<data::RecordList> Children(std::string_view table) override {
        return OpenChildren(order_->session(),
                            row_->fields.table(),
                            row_->id,
                            table,
                            [this](const std::string& column) { return GetField(column); });
    }
    void Update(int) override { order_->UpdateRow(*row_); }
    void Delete() override { order_->DeleteRow(*row_); }
    bool Status(int mask) override { return (row_->fields.Integer("Status") & mask) != 0; }

  private:
    std::shared_ptr<Order> order_;
    std::shared_ptr<OrderRow> row_;
};

class RowList : public data::RecordList {
  public:
    explicit RowList(std::shared_ptr<Order> order) : order_(std::move(order)) {}

    std::int64_t Count() override { return static_cast<std::int64_t>(order_->rows.size()); }
    std::shared_ptr<data::Record> Item(std::int64_t index) override {
        return std::make_shared<RowRecord>(order_, order_->rows[Checked(index, Count())]);
    }
    std::shared_ptr<data::Record> AddRow() override {
        return std::make_shared<RowRecord>(order_, order_->AddRow());
    }
    std::shared_ptr<data::Record> Find(std::string_view criterion) override {
        const Criterion wanted = ParseCriterion(criterion);
        const auto found =
            std::find_if(order_->rows.begin(), order_->rows.end(), [&](const auto& row) {
                const base::Value value = order_->GetRowField(*row, wanted.field);
                return value.IsNumeric() && value.ToDouble() == static_cast<double>(wanted.number);
            });
        return found == order_->rows.end() ? nullptr : std::make_shared<RowRecord>(order_, *found);
    }

  private:
    std::shared_ptr<Order> order_;
};

std::shared_ptr<data::RecordList> RowsOf(std::shared_ptr<Order> order) {
    return std::make_shared<RowList>(std::move(order));
}

}  // namespace

base::Value OrderDocument::GetField(std::string_view name) {
    return order_->GetHeaderField(name);
}

void OrderDocument::SetField(std::string_view name, const base::Value& value) {
    order_->SetHeaderField(name, value);
}

std::shared_ptr<data::Record> OrderDocument::Header() {
    return std::make_shared<HeaderRecord>(order_);
}

std::shared_ptr<data::RecordList> OrderDocument::Rows() {
    return RowsOf(order_);
}

data::Saved OrderDocument::Save() {
    const std::lock_guard lock(saving_);
    return SaveOrder(*order_);
}

}  // namespace zebtell::erp
