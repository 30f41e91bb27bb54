#include "erp/read_only_record.h"

#include "base/runtime_error.h"
#include "erp/sql/errors.h"

namespace zebtell::erp {
namespace {

[[noreturn]] void NotEdited() {
    throw base::RuntimeError(base::errors::kInvalidCall, "The record is not being edited");
}

}  // namespace

void ReadOnlyRecord::SetField(std::string_view, const base::Value&) {
    NotEdited();
}

void ReadOnlyRecord::Update(int) {
    NotEdited();
}

void ReadOnlyRecord::Delete() {
    NotEdited();
}

bool ReadOnlyRecord::Status(int mask) {
    try {
        const base::Value status = GetField("Status");
        return status.IsNumeric() && (status.ToInteger64() & mask) != 0;
    } catch (const base::RuntimeError& error) {
        if (error.number() != base::errors::kStatementFailed) {
            throw;
        }
        return false;  // records of this kind have no status
    }
}

std::shared_ptr<data::Record> ReadOnlyList::AddRow() {
    throw base::RuntimeError(base::errors::kInvalidCall, "The list takes no new rows");
}

std::size_t Checked(std::int64_t index, std::int64_t count) {
    if (index < 1 || index > count) {
        throw base::RuntimeError(base::errors::kSubscript);
    }
    return static_cast<std::size_t>(index - 1);
}

void NoSuchField(std::string_view name) {
    sql::Fail("No such field", name);
}

}  // namespace zebtell::erp
