#pragma once

#include <cstdint>
#include <memory>
#include <string_view>

#include "base/value.h"

namespace zebtell::data {

class RecordList;

// One record: a row of a table or view, a row of a query's result, the header or a row of a
// document. Names ignore case. A name may be a dotted path through links
// ("GRArticle.GRTax.TaxPercent", "Partner.PriceCut"); names that begin with "@" are calculated or
// kept with the row in memory. Used by one thread at a time.
class Record {
  public:
    virtual ~Record() = default;

    // RuntimeError kStatementFailed for a field that the record does not have (or that this user
    // may not read). A link that leads nowhere gives Null for the fields behind it.
    virtual base::Value GetField(std::string_view name) = 0;

    // Only in documents being edited, only fields that this user may write; RuntimeError else.
    virtual void SetField(std::string_view name, const base::Value& value) = 0;

    // The records of `table` that link to this one, in the order of their row numbers or IDs; or,
    // when there is no such link, the one record that this record's own link to `table` leads to.
    // Documents being edited give the rows held in memory.
    virtual std::shared_ptr<RecordList> Children(std::string_view table) = 0;

    // Recalculates a changed row and keeps it in its document; `mode` is 0.
    virtual void Update(int mode) = 0;

    // Takes a row out of its document.
    virtual void Delete() = 0;

    // Whether the status bits `mask` are set. Bit 4: a row that the customer's form leaves alone.
    virtual bool Status(int mask) = 0;
};

// Status bit of rows that are made by the ERP, such as transport or packaging.
inline constexpr int kFixedRow = 4;

}  // namespace zebtell::data
