#pragma once

#include "data/record.h"
#include "data/record_list.h"

namespace zebtell::erp {

// A record that is not part of a document being edited.
class ReadOnlyRecord : public data::Record {
  public:
    void SetField(std::string_view name, const base::Value& value) override;
    void Update(int mode) override;
    void Delete() override;
    bool Status(int mask) override;  // of the field Status; false without one
};

// A list that takes no new rows.
class ReadOnlyList : public data::RecordList {
  public:
    std::shared_ptr<data::Record> AddRow() override;
};

// RuntimeError 9 unless 1 <= index <= count. Returns the index from 0.
std::size_t Checked(std::int64_t index, std::int64_t count);

// RuntimeError kStatementFailed: there is no such field.
[[noreturn]] void NoSuchField(std::string_view name);

}  // namespace zebtell::erp
