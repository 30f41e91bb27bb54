#pragma once

#include <memory>
#include <mutex>

#include "data/document.h"
#include "erp/order.h"

namespace zebtell::erp {

// The order as pages edit it. Its records and row list share the order and may outlive this.
class OrderDocument : public data::Document {
  public:
    explicit OrderDocument(std::shared_ptr<Order> order) : order_(std::move(order)) {}

    base::Value GetField(std::string_view name) override;
    void SetField(std::string_view name, const base::Value& value) override;
    std::shared_ptr<data::Record> Header() override;
    std::shared_ptr<data::RecordList> Rows() override;
    std::string Key() const override { return order_->key; }
    data::Saved Save() override;

  private:
    std::shared_ptr<Order> order_;
    std::mutex saving_;  // an impatient second submit waits for the first and finds it stored
};

}  // namespace zebtell::erp
