#include <gtest/gtest.h>

#include <cmath>
#include <limits>

#include "base/format.h"
#include "base/runtime_error.h"

namespace zebtell::base {
namespace {

const Region& Estonian() {
    return RegionFor("et");
}
const Region& English() {
    return RegionFor("en");
}

struct Row {
    Value value;
    const char* picture;
    const char* expected;
};

template <std::size_t kSize>
void ExpectEach(const Row (&rows)[kSize], const Region& region) {
    for (const Row& row : rows) {
        EXPECT_EQ(Format(row.value, row.picture, region), row.expected)
            << row.value.ToPlainText() << " by " << row.picture;
    }
}

TEST(FormatNumberTest, Places) {
    const Row rows[] = {
        {12.5, "0.00", "12.50"},
        {12.5, "0", "13"},
        {13.5, "0", "14"},
        {-12.5, "0", "-13"},
        {2.675, "0.00", "2.68"},
        {1.005, "0.00", "1.01"},
        {0.5, "#.##", ".5"},
        {0, "#.##", "."},
        {0, "#", ""},
        {5, "#.##", "5."},
        {5, "0.0#", "5.0"},
        {5.25, "0.0##", "5.25"},
        {7, "000", "007"},
        {1234, "0", "1234"},
        {1234, "00:00", "12:34"},
        {12345, "00-00", "123-45"},
        {5551234567.0, "(000) 000-0000", "(555) 123-4567"},
        {12.5, ".00", "12.50"},
        {0, ".", "."},
        {5, ".", "5."},
        {1e22, "0", "10000000000000000000000"},
        {1e-10, "0.00", "0.00"},
        {1e-10, "0.##########", "0.0000000001"},
        {0.1 + 0.2, "0.00", "0.30"},
        {-0.001, "0.00", "0.00"},
        {-0.001, "0.000", "-0.001"},
        {Currency::FromScaled(9223372036854775807), "0.0000", "922337203685477.5807"},
        {std::numeric_limits<std::int64_t>::min(), "0", "-9223372036854775808"},
        {true, "0", "1"},
        {Value(), "0.00", "0.00"},
        {DateTime(46347.5), "0.0", "46347.5"},
    };
    ExpectEach(rows, English());
}

TEST(FormatNumberTest, GroupsScalesAndPercents) {
    const Row rows[] = {
        {1234567.891, "#,##0.00", "1,234,567.89"},
        {12, "#,##0.00", "12.00"},
        {123, "#,##0", "123"},
        {1234, "#,#", "1,234"},
        {5, "0,000", "0,005"},
        {999999.996, "#,##0.00", "1,000,000.00"},
        {-1234567, "#,##0", "-1,234,567"},
        {1234567, "0,", "1235"},
        {1234567890, "#,##0,,.0", "1,234.6"},
        {499, "0,", "0"},
        {12, ",0", "12"},
        {5, "0 kr, 0", "0 kr, 5"},
        {0.125, "0%", "13%"},
        {0.125, "0.0 %", "12.5 %"},
        {-0.5, "0%", "-50%"},
        {0.001, "0%%", "10%%"},
    };
    ExpectEach(rows, English());
}

TEST(FormatNumberTest, Scientific) {
    const Row rows[] = {
        {12345.678, "0.00E+00", "1.23E+04"},
        {0.00012, "0.00E+00", "1.20E-04"},
        {0.00012, "0.0e-0", "1.2e-4"},
        {12345, "0.0E-00", "1.2E04"},
        {9.999, "0.00E+00", "1.00E+01"},
        {999.96, "##0.0E+0", "100.0E+1"},
        {12345, "##0.00E+00", "123.45E+02"},
        {0, "0.00E+00", "0.00E+00"},
        {-1e300, "0E+0", "-1E+300"},
        {5, "0 E", "5 E"},
        {5, "0E+", "5E+"},
    };
    ExpectEach(rows, English());
}

TEST(FormatNumberTest, SectionsAndLiterals) {
    const Row rows[] = {
        {5, "$#,##0.00;($#,##0.00)", "$5.00"},
        {-1234.5, "$#,##0.00;($#,##0.00)", "($1,234.50)"},
        {-5, "$0", "-$5"},
        {0, "0;-0;\\-", "-"},
        {0.001, "0.00;-0.00;\"none\"", "none"},
        {-0.001, "0.00;(0.00)", "0.00"},
        {0.3, "\"some\";\"owed\";\"none\"", "some"},
        {-5, "0;;\\Z", "-5"},
        {0, "0;;", "0"},
        {5, ";0", ""},
        {5, "0\\;0", "0;5"},
        {5, "0\";\"", "5;"},
        {5, "0 \"tk; \\\"", "5 tk; \\"},
        {5, "\\0\\#0", "0#5"},
        {5, "0 \"unclosed;0", "5 unclosed;0"},
        {5, "0\\", "5"},
        {12.5, "EUR 0.00", "EUR 12.50"},
        {12.5, "Summa 0.00 €", "Summa 12.50 €"},
        {7, "õ0õ", "õ7õ"},
        {Value::Null(), "0;-0;zero;\"missing\"", "missing"},
        {Value::Null(), "0;-0;zero", ""},
        {Value::Null(), "Fixed", ""},
        {Value::Null(), "", ""},
        {12.5, "", "12.5"},
    };
    ExpectEach(rows, English());
}

TEST(FormatNumberTest, TextIsANumberOrStaysAsItIs) {
    const Row rows[] = {
        {"12,5", "0.00", "12,50"},
        {" 12.5 ", "#,##0.0", "12,5"},
        {"kuus", "0.00", "kuus"},
        {"", "0.00", ""},
        {"kuus", "Fixed", "kuus"},
        {"kuus", "Yes/No", "kuus"},
        {"1", "Yes/No", "Jah"},
        {"21.11.2026", "0", "46347"},
        {"1e999", "0", "1e999"},
    };
    ExpectEach(rows, Estonian());
}

TEST(FormatNumberTest, NamedFormats) {
    const Row estonian[] = {
        {1234.5, "general number", "1234,5"},
        {1234.5, "Currency", "1 234,50 €"},
        {-1234.5, "CURRENCY", "-1 234,50 €"},
        {1234.565, "Fixed", "1234,57"},
        {0.125, "fixed", "0,13"},
        {-0.001, "Fixed", "0,00"},
        {-0.5, "Fixed", "-0,50"},
        {1e22, "Fixed", "10000000000000000000000,00"},
        {Currency::FromScaled(12345678950), "Standard", "1 234 567,90"},
        {-999.999, "Standard", "-1 000,00"},
        {0.0725, "Percent", "7,25%"},
        {12345, "Scientific", "1,23E+04"},
        {0, "Yes/No", "Ei"},
        {-1, "True/False", "Tõene"},
        {false, "On/Off", "Väljas"},
        {"0,10", "General Number", "0,1"},
        {0, ".", ","},
    };
    ExpectEach(estonian, Estonian());
    const Row english[] = {
        {1234.5, "Currency", "€1,234.50"},
        {-1234.5, "Currency", "-€1,234.50"},
        {1234567.5, "Standard", "1,234,567.50"},
        {1, "on/off", "On"},
    };
    ExpectEach(english, English());
}

TEST(FormatNumberTest, HostilePicturesEnd) {
    const std::string zeros(10000, '0');
    EXPECT_EQ(Format(1, zeros, English()), std::string(9999, '0') + "1");
    EXPECT_EQ(Format(1, "0." + zeros, English()), "1." + zeros);
    EXPECT_EQ(Format(1, "0" + std::string(10000, ','), English()), "0");
    EXPECT_EQ(Format(1, "0" + std::string(10000, '%'), English()).size(), 30001U);
    EXPECT_EQ(Format(1, "0E+" + zeros, English()), "1E+" + zeros);
    EXPECT_EQ(Format(1, zeros + "E+0", English()), "1" + std::string(9999, '0') + "E-9999");
    EXPECT_EQ(Format(1, std::string(10000, '"') + '0', English()), "1");
    EXPECT_EQ(Format(-1e308, "fixed", English()).size(), 313U);
    for (const char c : std::string("\\\";0#.,%E+dmyhnsaqwct@&<>!/:\xC3")) {
        const std::string picture(10000, c);
        for (const Value& value : {Value(-12.5), Value(DateTime(46347.5)), Value("tekst")}) {
            EXPECT_LT(Format(value, picture, English()).size(), 200000U) << c;
        }
    }
    EXPECT_THROW(Format(std::nan(""), "0.00", English()), RuntimeError);
}

}  // namespace
}  // namespace zebtell::base
