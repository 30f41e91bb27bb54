#pragma once

#include <cstdint>
#include <memory>
#include <string_view>

#include "data/record.h"

namespace zebtell::data {

// The records that a filter, a query or a document gave, in their order. Rows are read in windows
// as they are asked for. Used by one thread at a time.
class RecordList {
  public:
    virtual ~RecordList() = default;

    virtual std::int64_t Count() = 0;

    // Index from 1; RuntimeError 9 outside.
    virtual std::shared_ptr<Record> Item(std::int64_t index) = 0;

    // A new row at the end of a document's rows; RuntimeError 5 for other lists.
    virtual std::shared_ptr<Record> AddRow() = 0;

    // The first record for which "field=whole number" holds ("ID=17", "idgrarticle=17"), else none.
    // A hash look-up, however long the list is.
    virtual std::shared_ptr<Record> Find(std::string_view criterion) = 0;
};

}  // namespace zebtell::data
