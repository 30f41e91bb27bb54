#pragma once

// The ODBC headers of unixODBC, with the wide characters of its drivers: UTF-16.
#include <sql.h>
#include <sqlext.h>

#include <cstddef>
#include <string>
#include <string_view>

namespace zebtell::erp::odbc {

static_assert(sizeof(SQLWCHAR) == sizeof(char16_t));

inline SQLWCHAR* Wide(std::u16string& text) {
    return reinterpret_cast<SQLWCHAR*>(text.data());
}

// Attributes that are numbers are handed over as pointers, too.
inline SQLPOINTER AttributeValue(std::size_t number) {
    return reinterpret_cast<SQLPOINTER>(number);  // NOLINT(performance-no-int-to-ptr)
}

// An ODBC handle, freed with the object.
template <SQLSMALLINT kType>
class Handle {
  public:
    explicit Handle(SQLHANDLE parent) { SQLAllocHandle(kType, parent, &handle_); }
    ~Handle() {
        if (handle_) {
            SQLFreeHandle(kType, handle_);
        }
    }
    Handle(const Handle&) = delete;
    Handle& operator=(const Handle&) = delete;

    SQLHANDLE get() const { return handle_; }

  private:
    SQLHANDLE handle_ = SQL_NULL_HANDLE;
};

}  // namespace zebtell::erp::odbc
