#include <array>

#include "base/text.h"
#include "erp/translator.h"
#include "tests/erp/sql_database.h"
#include "tests/fuzz/harness.h"

// The first line says what the others are: "filter TABLE", "order TABLE", "field TABLE", a whole
// "statement", or a text that is searched for ("search" with quotes that count, "typed" without).
//
// It is run over two databases that are alike in what the customer may see, and in nothing else.
// Whatever he asks for, both give the same: neither values nor counts, orders or errors tell
// anything of what he may not see.

namespace zebtell::fuzz {
namespace {

using erp::BoundSql;
using erp::TwoCompanies;

constexpr std::size_t kLongest = 3000;

constexpr std::string_view kOtherSecrets = R"(
UPDATE SYUser SET PasswordHash = 'another';
UPDATE GDocument SET DocKey = 'another ' || ID;
UPDATE GRCompanyPriceCat SET Name = 'b' WHERE ID = 2;
UPDATE GRPriceList SET Name = 'b', Currency = 'USD' WHERE ID = 30;
UPDATE GRPriceList SET Name = 'c' WHERE ID = 11;
UPDATE EREmployee SET Name = 'b', Email = 'b' WHERE ID = 2;
UPDATE GRCompany SET Code = 'B', Name = 'b', PriceCut = 5, IDEREmployee = 1 WHERE ID = 2;
UPDATE GRCompContPerson SET Name = 'b' WHERE ID = 2;
UPDATE SYUser SET Name = 'b', Disabled = 1 WHERE ID = 2;
UPDATE GRPriceListRel SET Price = Price / 7 WHERE IDGRPriceList IN (11, 30);
UPDATE GRPriceCatRel SET PriceCut = 3 WHERE IDGRCompanyPriceCat = 2;
UPDATE GDTax SET Base = 1, Amount = 0 WHERE IDGDocument = 200;
UPDATE SDOrder SET Number = 99, DocDate = '2020-01-01', Amount = 0, Explanation = NULL,
    CompanyName = 'b' WHERE ID = 200;
UPDATE SDOrderRow SET Quantity = 0, Price = 1, IDGRArticle = 2, Explanation = 'b' WHERE ID = 3;
UPDATE SDInvoice SET Number = 98, Amount = 3, Explanation = 'b' WHERE ID = 210;
UPDATE SDInvoiceRow SET Quantity = -1, IDGRArticle = 3 WHERE ID = 2;
INSERT INTO GRCompany (ID, Code, Name, PriceCut) VALUES (4, 'C4', 'b', 0);
INSERT INTO SYUser VALUES (3, 'third', 'another', NULL, 4, NULL, 0, 0),
    (4, 'colleague', 'another', NULL, 1, NULL, 0, 0);
INSERT INTO GDocument (ID, Kind, DocKey) VALUES (201, 'SDOrder', 'another key');
INSERT INTO SDOrder (ID, Number, DocDate, IDGRCompany, Amount)
    VALUES (201, 4, '2026-11-22', 4, 1);
INSERT INTO SDOrderRow (ID, IDSDOrder, RowNo, IDGRArticle, Quantity) VALUES (4, 201, 1, 1, 1);
INSERT INTO GRPriceListRel VALUES (8, 30, 2, 1), (9, 30, 3, 1);
INSERT INTO GDocRel VALUES (4, 210, 201);
)";

constexpr std::string_view kSearch =
    "{GRPriceListRel.Price<>0 AND GRPriceListRel.ID IN (select P5.ID from SQPriceList5 P5 inner "
    "join GRArticle on P5.IDGRArticle=GRArticle.ID where (GRArticle.name LIKE '@' OR "
    "GRArticle.code LIKE '@') AND (IDGRPriceList=20))}";

BoundSql Translated(std::string_view kind, std::string_view table, std::string_view text) {
    static const erp::Reader reader = erp::FirstCustomer();
    static const erp::Translator translator = erp::Database().translator();
    if (kind == "filter") return translator.ListKeys(reader, table, text, "", {});
    if (kind == "order") return translator.ListKeys(reader, table, "", text, {});
    if (kind == "field") {
        const std::array ids = {std::int64_t{1}, std::int64_t{2}, std::int64_t{100}};
        const std::array fields = {std::string(text)};
        return translator.RowsByID(reader, table, ids, fields);
    }
    if (kind == "search") {
        const std::string filter = base::Replaced(kSearch, "@", text);
        return translator.ListKeys(reader, "GRPriceListRel", filter, "", {});
    }
    if (kind == "typed") {
        data::Filter filter;
        for (const std::string_view piece : base::Split(kSearch, '@')) {
            filter += (filter.empty() ? "" : data::Filter(data::Typed{text})) + piece;
        }
        return translator.ListKeys(reader, "GRPriceListRel", filter, "", {});
    }
    return translator.Select(reader, text);
}

// Rows, or what the database said of the statement.
std::string Outcome(const TwoCompanies& database, const BoundSql& sql) {
    try {
        return database.Run(sql);
    } catch (const base::RuntimeError& error) {
        return std::string("error: ") + error.what();
    }
}

// The database may refuse a statement for its values or its size, never for how it is written.
void CheckIsSql(const std::string& outcome, const BoundSql& sql) {
    if (!outcome.starts_with("error: ")) return;
    for (const char* words : {"syntax error",
                              "no such",
                              "wrong number",
                              "misuse",
                              "ambiguous",
                              "unrecognized",
                              "incomplete input",
                              "bind or column"}) {
        Claim(outcome.find(words) == std::string::npos,
              "what is accepted runs",
              outcome + "\n" + sql.text);
    }
}

}  // namespace

void Try(std::string_view input) {
    static const TwoCompanies other(kOtherSecrets);
    if (input.size() > kLongest) return;
    const auto kind = base::Split(TakeLine(input), ' ');
    if (kind.empty()) return;
    BoundSql sql;
    try {
        sql = Translated(kind[0], kind.size() > 1 ? kind[1] : "GRPriceListRel", input);
    } catch (const base::RuntimeError& error) {
        Claim(error.description().find('<') == std::string::npos,
              "an error is no markup",
              error.what());
        return;
    }
    const std::string outcome = Outcome(erp::Database(), sql);
    CheckIsSql(outcome, sql);
    const std::string other_outcome = Outcome(other, sql);
    constexpr std::string_view kTooLong = "took too long";
    if (outcome.find(kTooLong) != outcome.npos || other_outcome.find(kTooLong) != outcome.npos)
        return;
    Claim(outcome == other_outcome,
          "secrets make no difference",
          sql.text + "\n" + outcome + "\n" + other_outcome);
}

}  // namespace zebtell::fuzz
