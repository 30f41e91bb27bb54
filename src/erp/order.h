#pragma once

#include <cstdint>
#include <memory>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include "base/value.h"
#include "erp/linked_rows.h"
#include "erp/record_fields.h"
#include "erp/session.h"

namespace zebtell::erp {

inline constexpr const char* kOrderTable = "SDOrder";
inline constexpr const char* kOrderRowTable = "SDOrderRow";
inline constexpr const char* kOrderRowLink = "IDSDOrder";

struct OrderRow {
    explicit OrderRow(const TableInfo& table) : fields(table) {}

    bool IsFixed() const;
    // Whether it holds an article and a quantity.
    bool IsToStore() const;

    std::int64_t id = 0;  // below 0 until it is stored
    RecordFields fields;
    bool amount_set = false;      // since the last Update: the amount counts, not the price
    bool unit_price_set = false;  // by the page
    bool changed = false;         // since the last Update
};

// A stored order as it was read, to notice what others have done to it meanwhile.
struct OrderImage {
    std::shared_ptr<const RowSet> header;
    std::vector<std::int64_t> row_ids;
    std::shared_ptr<const RowSet> rows;
};

// An order being edited: its header and rows in memory. Used by one thread at a time.
class Order {
  public:
    explicit Order(const std::shared_ptr<Session>& session);

    const std::shared_ptr<Session>& session() const { return session_; }
    bool IsStored() const { return id != 0; }

    base::Value GetHeaderField(std::string_view name);
    void SetHeaderField(std::string_view name, const base::Value& value);

    base::Value GetRowField(const OrderRow& row, std::string_view name);
    void SetRowField(OrderRow& row, std::string_view name, const base::Value& value);
    void UpdateRow(OrderRow& row);
    void DeleteRow(const OrderRow& row);
    std::shared_ptr<OrderRow> AddRow();
    std::int64_t NewRowId() { return --last_row_id_; }

    std::int64_t id = 0;  // 0: not stored
    std::string key;      // what makes an unsaved order known to the database
    RecordFields header;
    std::vector<std::shared_ptr<OrderRow>> rows;
    std::optional<OrderImage> image;  // of a stored order
    bool changed = true;              // since it was stored or read

  private:
    void SetArticle(OrderRow& row, const base::Value& value);
    base::Value BehindLink(const RecordFields& fields, std::string_view path);
    std::vector<std::int64_t> LinkedKeys(std::string_view column) const;

    std::shared_ptr<Session> session_;
    LinkedRows linked_;
    std::int64_t last_row_id_ = 0;
};

}  // namespace zebtell::erp
