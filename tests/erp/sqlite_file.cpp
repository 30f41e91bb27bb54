#include "tests/erp/sqlite_file.h"

#include <sqlite3.h>

#include <fstream>
#include <iterator>
#include <stdexcept>

#include "tests/support/source_folder.h"

namespace zebtell::erp {
namespace {

constexpr const char* kCompany = R"(
insert into GRTax values (1, '20 %', 20), (2, '9 %', 9);
insert into GRArticlePriceCat values (1, 'Kinnitus');
insert into GRCompanyPriceCat values (1, 'Kuld'), (2, 'Hõbe');
insert into GRPriceList values
    (1, 'Jae', 'EUR', null, 1), (2, 'Hulgi', 'EUR', null, 0), (3, 'Hulgi kaudu', 'EUR', 2, 0);
insert into EREmployee values (1, 'Rein', '555', 'rein@example.com');
insert into GRCompany (ID, Code, Name, Address, City, PostCode, PriceCut, IDGRPriceList, IDParent,
                       IDGRCompanyPriceCat, IDEREmployee)
values (2, 'K2', 'Ema AS', null, null, null, 0, 2, null, null, null),
       (1, 'K1', 'Puit OÜ', 'Tamme 5', 'Tallinn', '10115', -10, 3, 2, 1, 1),
       (3, 'K3', 'Võõras AS', null, 'Tartu', null, 0, null, null, 2, null),
       (4, 'K4', 'Jaeklient', null, null, null, 0, null, null, null, null);
insert into GRCompContPerson values
    (1, 1, 'Mari Maasikas', 'ostja', null, null), (2, 3, 'Õie Õun', null, null, null);
insert into SYUser values
    (1, 'mari', null, 'Mari', 1, 1, 0, 0), (2, 'Õie', null, 'Õie', 3, 2, 0, 0),
    (3, 'WebGuest', null, 'Külaline', 4, null, 1, 0), (4, 'endine', null, '', 1, null, 0, 1);
with recursive n(i) as (select 1 union all select i + 1 from n where i < 46)
insert into GRArticle (ID, Code, Name, IDGRTax, IDGRArticlePriceCat)
select i, printf('A%03d', i), 'Kruvi M' || i, 2 - i % 2, iif(i % 2, 1, null) from n;
insert into GRPriceListRel select 100 + ID, 2, ID, ID from GRArticle where ID < 46;
insert into GRPriceListRel select 200 + ID, 1, ID, 2 * ID from GRArticle where ID < 46;
insert into GRPriceCatRel values (1, 1, 1, 2, -12.5), (2, 2, 1, 1, 10);
insert into GDocument values (11, 'SDOrder', 'k11', '2026-01-05 09:30:00'),
    (12, 'SDOrder', 'k12', '2026-01-06'), (13, 'SDOrder', 'k13', '2026-01-07');
insert into SDOrder (ID, Number, DocDate, State, IDGRCompany, IDGRPriceList, Amount)
values (11, 501, '2026-01-05', 0, 1, 3, 30), (12, 502, '2026-01-06', 1, 1, 3, 2),
       (13, 503, '2026-01-07', 0, 3, 1, 6);
insert into SDOrderRow
    (ID, IDSDOrder, RowNo, IDGRArticle, Quantity, Price, UnitPrice, Amount, TaxPercent, Status)
values (1, 11, 2, 4, 2.5, 4, 4, 10, 9, 0), (2, 11, 1, 8, 2, 8, 8, 16, 9, 0),
       (3, 11, 3, 2, 1, 4, 4, 4, 9, 4), (4, 12, 1, 2, 1, 2, 2, 2, 9, 0),
       (5, 13, 1, 3, 1, 6, 6, 6, 20, 0);
insert into GDTax values (1, 11, 9, 30, 2.7), (2, 12, 9, 2, 0.18), (3, 13, 20, 6, 1.2);
)";

void Run(sqlite3* database, const std::string& sql) {
    char* words = nullptr;
    if (sqlite3_exec(database, sql.c_str(), nullptr, nullptr, &words) != SQLITE_OK) {
        throw std::runtime_error(words);
    }
}

std::string ReadFile(const std::filesystem::path& path) {
    std::ifstream in(path);
    return {std::istreambuf_iterator<char>(in), {}};
}

}  // namespace

void MakeSqliteFile(const std::filesystem::path& file,
                    std::initializer_list<const char*> schema_files,
                    const std::string& password_hash) {
    sqlite3* database = nullptr;
    sqlite3_open(file.c_str(), &database);
    Run(database, "pragma journal_mode = wal; begin");
    const std::filesystem::path folder = SourceFolder() / "database/sqlite";
    for (const char* schema_file : schema_files) {
        Run(database, ReadFile(folder / schema_file));
    }
    Run(database, kCompany);
    Run(database, "update SYUser set PasswordHash = '" + password_hash + "'");
    Run(database, "commit");
    sqlite3_close(database);
}

}  // namespace zebtell::erp
