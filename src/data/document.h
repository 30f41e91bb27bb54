#pragma once

#include <cstdint>
#include <memory>
#include <string>
#include <string_view>

#include "base/value.h"
#include "data/record.h"
#include "data/record_list.h"

namespace zebtell::data {

// When a document was stored: by this call of Save, or by one before it whose answer was lost.
enum class Saved { kNow, kBefore };

// A document being edited, such as an order: its header and rows are held in memory until Save.
class Document {
  public:
    virtual ~Document() = default;

    virtual base::Value GetField(std::string_view name) = 0;  // of the header
    virtual void SetField(std::string_view name, const base::Value& value) = 0;

    virtual std::shared_ptr<Record> Header() = 0;
    virtual std::shared_ptr<RecordList> Rows() = 0;

    // Stands for this document from the moment that it is made, and for ever in the database.
    // Nobody can guess it. Forms carry it, so that one that comes late or twice is known for what
    // it is.
    virtual std::string Key() const = 0;

    // Stores header, rows and tax lines in one transaction, all or nothing, and gives the header
    // its ID and Number. Rows without a quantity are not stored. A document that was stored
    // already (its key is in the database) is not stored again: the header takes the stored ID, and
    // what has been changed since is left out.
    // RuntimeError, and nothing stored, when there is no row to store, when staff have begun to
    // process the stored document, or when the database fails.
    virtual Saved Save() = 0;
};

// A table opened for editing its documents.
class Table {
  public:
    virtual ~Table() = default;

    // 0 makes a new, unsaved document; any other number opens that stored one (RuntimeError 9 when
    // the filter and the user's rights leave none of that number).
    virtual std::shared_ptr<Document> Open(std::int64_t id) = 0;

    // The first document of the table's filter; RuntimeError 9 when there is none.
    virtual std::shared_ptr<Document> First() = 0;

    // The ID of the stored document with this key, which the user may read from now on; 0 when his
    // company has none.
    virtual std::int64_t FindKey(std::string_view key) = 0;
};

}  // namespace zebtell::data
