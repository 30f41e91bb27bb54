#include "erp/document_table.h"

#include "base/runtime_error.h"
#include "base/text.h"
#include "erp/order_document.h"
#include "erp/order_loading.h"

namespace zebtell::erp {
namespace {

class OrderTable : public data::Table {
  public:
    OrderTable(std::shared_ptr<Session> session, const TableInfo& table, data::Filter filter)
        : session_(std::move(session)), table_(table), filter_(std::move(filter)) {}

    std::shared_ptr<data::Document> Open(std::int64_t id) override {
        if (id == 0) {
            return std::make_shared<OrderDocument>(NewOrder(session_));
        }
        if (!filter_.empty() && !Keys()->Find(0, id)) {
            throw base::RuntimeError(base::errors::kSubscript);
        }
        return OpenStored(id);
    }

    std::shared_ptr<data::Document> First() override {
        const auto keys = Keys();
        if (keys->count() == 0) {
            throw base::RuntimeError(base::errors::kSubscript);
        }
        return OpenStored(keys->Get(0, 0));
    }

    std::int64_t FindKey(std::string_view key) override { return FindOrder(*session_, key); }

  private:
    std::shared_ptr<const KeyTable> Keys() { return session_->Keys(table_, filter_, ""); }

    std::shared_ptr<data::Document> OpenStored(std::int64_t id) {
        auto order = LoadOrder(session_, id);
        if (!order) {
            throw base::RuntimeError(base::errors::kSubscript);
        }
        return std::make_shared<OrderDocument>(std::move(order));
    }

    std::shared_ptr<Session> session_;
    const TableInfo& table_;
    data::Filter filter_;
};

}  // namespace

std::shared_ptr<data::Table> OpenDocumentTable(const std::shared_ptr<Session>& session,
                                               const TableInfo& table,
                                               const data::Filter& filter) {
    if (!base::EqualNoCase(table.name, kOrderTable)) {
        throw base::RuntimeError(base::errors::kInvalidCall,
                                 "The documents of " + table.name + " can't be edited");
    }
    return std::make_shared<OrderTable>(session, table, filter);
}

}  // namespace zebtell::erp
