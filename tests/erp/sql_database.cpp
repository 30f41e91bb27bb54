#include "tests/erp/sql_database.h"

#include <sqlite3.h>
#include <unistd.h>

#include <filesystem>
#include <fstream>
#include <sstream>
#include <stdexcept>

#include "erp/links_by_name.h"
#include "erp/sqlite/backend.h"
#include "tests/support/source_folder.h"

namespace zebtell::erp {
namespace {

constexpr const char* kRows = R"(
INSERT INTO GRCompanyPriceCat VALUES (1, 'Good'), (2, 'foreign category');
INSERT INTO GRPriceList VALUES (10, 'Source', 'EUR', NULL, 0), (11, 'Default', 'EUR', NULL, 1),
    (20, 'First', 'EUR', 10, 0), (30, 'foreign list', 'EUR', NULL, 0);
INSERT INTO EREmployee VALUES (1, 'Mari', NULL, NULL), (2, 'foreign employee', NULL, NULL);
INSERT INTO GRCompany (ID, Code, Name, PriceCut, IDGRPriceList, IDParent, IDSettlCompany,
                       IDGRCompanyPriceCat, IDEREmployee)
    VALUES (3, 'C3', 'Parent', 0, NULL, NULL, NULL, NULL, NULL),
           (1, 'C1', 'First', -10, 20, 3, 3, 1, 1),
           (2, 'C2', 'foreign company', 0, 30, NULL, NULL, 2, 2);
INSERT INTO GRCompContPerson VALUES (1, 1, 'Jaan', NULL, NULL, NULL),
                                    (2, 2, 'foreign person', NULL, NULL, NULL);
INSERT INTO SYUser VALUES (1, 'first', 'secret-1', NULL, 1, 1, 0, 0),
                          (2, 'second', 'foreign secret', NULL, 2, 2, 0, 0);
INSERT INTO GRTax VALUES (1, 'Full', 22), (2, 'Half', 9);
INSERT INTO GRArticlePriceCat VALUES (1, 'Screws'), (2, 'Paint');
INSERT INTO GRArticle (ID, Code, Name, IDGRTax, IDGRArticlePriceCat)
    VALUES (1, 'M6-20', 'Kruvi M6 20 mm', 1, 1), (2, 'M6-30', 'Kruvi M6 30 mm', 1, 1),
           (3, 'V100', 'Värv 100% õli', 2, 2), (4, 'X_1', 'It''s [new] \ odd', 2, NULL);
INSERT INTO GRArticleCat VALUES (1, 'Screws', 'metal'), (2, 'Paint', 'liquid'), (3, 'News', NULL);
INSERT INTO GRArticleCatRel VALUES (1, 1, 1), (2, 2, 1), (3, 3, 2), (4, 2, 3);
INSERT INTO GRPriceListRel VALUES (1, 10, 1, 1.15), (2, 10, 2, 0), (3, 10, 3, 12),
    (4, 11, 1, 2), (5, 11, 4, 3), (6, 30, 1, 99.99), (7, 30, 4, 98.5);
INSERT INTO GRPriceCatRel VALUES (1, 1, 1, 10, -7.5), (2, 2, 1, 10, -50), (3, 2, 1, 30, -51);
INSERT INTO GDocument (ID, Kind, DocKey) VALUES (100, 'SDOrder', 'key-100'),
    (101, 'SDOrder', 'key-101'), (200, 'SDOrder', 'foreign key'), (110, 'SDInvoice', 'key-110'),
    (210, 'SDInvoice', 'foreign key 2'), (120, 'SDConsignmD', 'key-120');
INSERT INTO GDocRel VALUES (1, 110, 100), (2, 210, 200), (3, 210, 101);
INSERT INTO GDTax VALUES (1, 100, 22, 10, 2.2), (2, 200, 22, 777, 77.7);
INSERT INTO SDOrder (ID, Number, DocDate, WantedDate, IDGRCompany, Explanation, Amount)
    VALUES (100, 1, '2026-11-20', '2026-11-25', 1, 'mine', 10),
           (101, 2, '2026-11-21', NULL, 1, NULL, 20),
           (200, 3, '2026-11-20', NULL, 2, 'foreign order', 777);
INSERT INTO SDOrderRow (ID, IDSDOrder, RowNo, IDGRArticle, Quantity, Explanation)
    VALUES (1, 100, 1, 1, 5, 'row'), (2, 100, 2, 3, 2, NULL), (3, 200, 1, 1, 7, 'foreign row');
INSERT INTO SDInvoice (ID, Number, DocDate, DueDate, IDGRCompany, Explanation, Amount)
    VALUES (110, 1, '2026-11-20', '2026-12-04', 1, NULL, 10),
           (210, 2, '2026-11-20', '2026-12-04', 2, 'foreign invoice', 777);
INSERT INTO SDInvoiceRow (ID, IDSDInvoice, RowNo, IDGRArticle, Quantity, Explanation)
    VALUES (1, 110, 1, 1, 5, NULL), (2, 210, 1, 1, 7, 'foreign row');
INSERT INTO SDConsignmD (ID, Number, DocDate, IDGRCompany) VALUES (120, 1, '2026-11-20', 1);
INSERT INTO DDStoreDRow (ID, IDSDConsignmD, RowNo, IDGRArticle) VALUES (1, 120, 1, 1);
)";

std::string FileText(const std::string& path) {
    std::ifstream file(path);
    std::ostringstream text;
    text << file.rdbuf();
    return text.str();
}

void MakeDatabase(const std::string& path, std::string_view changes) {
    const std::string folder = (SourceFolder() / "database/sqlite/").string();
    const std::string script = "BEGIN;" + FileText(folder + "schema.sql") +
                               FileText(folder + "views.sql") + kRows + std::string(changes) +
                               "COMMIT;";
    sqlite3* database = nullptr;
    sqlite3_open(path.c_str(), &database);
    char* message = nullptr;
    const int code = sqlite3_exec(database, script.c_str(), nullptr, nullptr, &message);
    const std::string words = message ? message : "";
    sqlite3_free(message);
    sqlite3_close(database);
    if (code != SQLITE_OK) {
        throw std::runtime_error("The test database can't be made: " + words);
    }
}

}  // namespace

TwoCompanies::TwoCompanies(std::string_view changes) {
    static int made = 0;
    path_ = std::filesystem::temp_directory_path() /
            ("zebtell-sql-" + std::to_string(getpid()) + "-" + std::to_string(++made) + ".db");
    std::filesystem::remove(path_);
    MakeDatabase(path_, changes);
    sqlite::SqliteBackend backend(path_, {.reading = std::chrono::milliseconds(500)});
    connection_ = backend.Connect(Access::kRead);
    std::vector<TableInfo> tables = connection_->Describe().tables;
    AddLinksByName(tables);
    schema_ = std::make_unique<Schema>(std::move(tables));
}

TwoCompanies::~TwoCompanies() {
    connection_.reset();
    for (const char* suffix : {"", "-wal", "-shm"}) {
        std::error_code ignored;
        std::filesystem::remove(path_ + suffix, ignored);
    }
}

std::string TwoCompanies::Run(const BoundSql& sql) const {
    std::string rows;
    const auto cursor = connection_->Query(sql);
    while (cursor->Next()) {
        rows += rows.empty() ? "" : ";";
        for (std::size_t i = 0; i < cursor->Columns().size(); ++i) {
            rows += (i ? "|" : "") + cursor->Get(i).ToPlainText();
        }
    }
    return rows;
}

const TwoCompanies& Database() {
    static const TwoCompanies database;
    return database;
}

std::string Shown(const BoundSql& sql) {
    std::string shown = sql.text;
    std::string_view glue = " <- ";
    for (const base::Value& value : sql.values) {
        shown.append(glue).append(value.ToPlainText());
        glue = ", ";
    }
    return shown;
}

Reader FirstCustomer() {
    Reader reader;
    reader.role = Role::kUser;
    reader.user = 1;
    reader.partner = 1;
    reader.settlement_company = 3;
    reader.parent = 3;
    reader.employee = 1;
    reader.contact = 1;
    reader.price_category = 1;
    reader.price_lists = {20, 10};
    return reader;
}

Reader GuestReader() {
    Reader reader;
    reader.role = Role::kGuest;
    reader.price_lists = {11};
    reader.saved_documents = {101};
    return reader;
}

}  // namespace zebtell::erp
