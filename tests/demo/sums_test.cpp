#include <gtest/gtest.h>

#include <array>
#include <map>
#include <tuple>

#include "tests/demo/demo_fixture.h"

// Every amount that the generator stored is computed again here, in whole numbers.

namespace zebtell::demo {
namespace {

// Decimal text as a whole number of 10^-places; what does not fit is a failure.
std::int64_t Scaled(const std::string& text, int places) {
    const std::size_t mark = text.find('.');
    std::string digits = text.substr(0, mark);
    std::string fraction = mark == std::string::npos ? "" : text.substr(mark + 1);
    while (fraction.size() > static_cast<std::size_t>(places) && fraction.back() == '0') {
        fraction.pop_back();
    }
    EXPECT_LE(fraction.size(), static_cast<std::size_t>(places)) << text;
    fraction.resize(static_cast<std::size_t>(places), '0');
    return std::stoll(digits + fraction);
}

std::int64_t Cents(const std::string& amount) {
    return Scaled(amount, 2);
}

// Half to even; `number` is not negative.
std::int64_t Divided(std::int64_t number, std::int64_t by) {
    const std::int64_t whole = number / by;
    const std::int64_t twice_rest = number % by * 2;
    const bool up = twice_rest > by || (twice_rest == by && whole % 2 == 1);
    return up ? whole + 1 : whole;
}

struct Kind {
    const char* header;
    const char* rows;
    const char* link;
};
constexpr Kind kKinds[] = {
    {"SDOrder", "SDOrderRow", "IDSDOrder"},
    {"SDConsignmD", "DDStoreDRow", "IDSDConsignmD"},
    {"SDInvoice", "SDInvoiceRow", "IDSDInvoice"},
};

class SumsTest : public DemoCompanyTest, public testing::WithParamInterface<Kind> {
  protected:
    using Taxes = std::map<std::string, std::int64_t>;  // base in cents by percentage

    static std::map<std::string, Taxes> TaxBases() {
        const std::string link = GetParam().link;
        std::map<std::string, Taxes> bases;
        for (const Sql::Row& row :
             sql().Rows("select " + link + ", TaxPercent, Amount from " + GetParam().rows)) {
            bases[row[0]][row[1]] += Cents(row[2]);
        }
        return bases;
    }
};

TEST_P(SumsTest, ARowIsPriceTimesQuantity) {
    const auto rows = sql().Rows(
        std::string("select ID, Price, Quantity, Amount, UnitPrice from ") + GetParam().rows);
    ASSERT_GT(rows.size(), 10'000U);
    for (const Sql::Row& row : rows) {
        const std::int64_t price = Scaled(row[1], 4);
        ASSERT_EQ(Cents(row[3]), Divided(price * Scaled(row[2], 1), 1000)) << "row " << row[0];
        ASSERT_EQ(Scaled(row[4], 4), price) << "row " << row[0];
    }
}

TEST_P(SumsTest, ADocumentIsTheSumOfItsRowsAndEachPercentageIsTaxedOnce) {
    std::map<std::string, Taxes> bases = TaxBases();
    std::map<std::string, std::int64_t> tax_of;
    const auto lines = sql().Rows(
        std::string("select IDGDocument, TaxPercent, Base, Amount from GDTax where IDGDocument in "
                    "(select ID from ") +
        GetParam().header + ")");
    std::size_t expected_lines = 0;
    for (const auto& [document, percents] : bases) {
        expected_lines += percents.size();
    }
    ASSERT_EQ(lines.size(), expected_lines);
    for (const Sql::Row& line : lines) {
        const std::int64_t base = bases.at(line[0]).at(line[1]);
        const std::int64_t tax = Divided(base * Scaled(line[1], 0), 100);
        ASSERT_EQ(Cents(line[2]), base) << "document " << line[0];
        ASSERT_EQ(Cents(line[3]), tax) << "document " << line[0];
        tax_of[line[0]] += tax;
    }
    const auto headers = sql().Rows(std::string("select ID, Amount, TaxAmount, AmountWTax from ") +
                                    GetParam().header);
    ASSERT_EQ(headers.size(), bases.size());
    for (const Sql::Row& header : headers) {
        std::int64_t amount = 0;
        for (const auto& [percent, base] : bases.at(header[0])) {
            amount += base;
        }
        ASSERT_EQ(Cents(header[1]), amount) << "document " << header[0];
        ASSERT_EQ(Cents(header[2]), tax_of[header[0]]) << "document " << header[0];
        ASSERT_EQ(Cents(header[3]), amount + tax_of[header[0]]) << "document " << header[0];
    }
}

INSTANTIATE_TEST_SUITE_P(Kinds, SumsTest, testing::ValuesIn(kKinds), [](const auto& kind) {
    return std::string(kind.param.header);
});

}  // namespace
}  // namespace zebtell::demo
