#pragma once

#include <filesystem>

#include "base/date_time.h"
#include "erp/connection.h"

namespace zebtell::demo {

// How large the demo company is. Out of range throws RuntimeError kInvalidCall.
struct DemoOptions {
    int articles = 3000;     // 100 to 1,000,000
    int companies = 40;      // 10 to 10,000
    int years = 2;           // of orders, deliveries and invoices; 1 to 10
    int order_rows = 15000;  // with articles, in all orders together; 100 to 10,000,000
    base::DateTime today = base::DateTime::Today();  // the last day that has documents
};

// Makes an SQLite database of a demo company: the same data for the same options everywhere, but
// for the salts of the password hashes. The file is written beside `database_file` (its name and
// ".new") and gets its name when it is complete; an existing file is refused, and so is a
// ".new" file that another run may be writing. RuntimeError for these and for a full disk.
void MakeDemoCompany(const std::filesystem::path& database_file, const DemoOptions& options);

// Makes the same company in an empty database on a server, all of it or nothing: tables, rows,
// indexes and views. RuntimeError for a database that is not empty, and for what the database says.
void MakeDemoCompany(erp::Backend& backend, const DemoOptions& options);

}  // namespace zebtell::demo
