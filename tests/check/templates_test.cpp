#include <gmock/gmock.h>

#include "tests/check/check_fixture.h"

namespace zebtell::check {
namespace {

struct TemplateCase {
    const char* label;
    const char* file;
    const char* text;
    const char* faults;  // without the file's name
};

class TemplatesTest : public CheckTest {
  protected:
    template <std::size_t N>
    void Expect(const TemplateCase (&cases)[N]) const {
        for (const TemplateCase& each : cases) {
            folder.Write(each.file, each.text);
            std::string expected;
            for (std::string_view line : base::Split(each.faults, '\n')) {
                expected += std::string(each.file) + ":" + std::string(line) + "\n";
            }
            EXPECT_EQ(Faults(), expected) << each.label;
            folder.Write(each.file, "");
        }
    }
};

TEST_F(TemplatesTest, Tags) {
    Expect({
        {"unknown, in any place of the page",
         "zebtell_kaubad.htm",
         "<ZEB:HKRidda>\n<p class=\"<ZEB:Hkrida13/>\">\n<!-- <zeb:x/> --></ZEB:HKRidda>",
         "1: unknown tag ZEB:HKRidda\n2: unknown tag ZEB:Hkrida13\n3: unknown tag zeb:x"},
        {"known on another page only",
         "zebtell_yld.htm",
         "<ZEB:HKRida></ZEB:HKRida>\n<ZEB:WEBUser></ZEB:WEBUser>",
         "1: unknown tag ZEB:HKRida"},
        {"names with a pattern", "zebtell_info.htm", "<ZEB:Mode.Any></ZEB:Mode.Any>", ""},
        {"start without end, end without start",
         "zebtell_yld.htm",
         "<ZEB:WEBUser>\n</ZEB:WEBGuest>",
         "1: ZEB:WEBUser has no end\n2: </ZEB:WEBGuest> has no start before it"},
        {"crossed",
         "zebtell_yld.htm",
         "<ZEB:WEBUser>\n<ZEB:WEBGuest>\n</ZEB:WEBUser>\n</ZEB:WEBGuest>",
         "2: ZEB:WEBGuest has no end\n4: </ZEB:WEBGuest> has no start before it"},
        {"inside of what a field's condition puts out, but not of a picture",
         "zebtell_yld.htm",
         "<ZEB:Company>?ID>0;<b>\n<ZEB:X/></b></ZEB:Company><ZEB:TellRidu><ZEB:Y/></ZEB:TellRidu>",
         "2: unknown tag ZEB:X"},
        {"a query, its rows and its fields",
         "zebtell_yld.htm",
         "<ZEB:Query>SDOrder;IDGRCompany;;;ID desc</ZEB:Query>"
         "<ZEB:SDOrder.Row><ZEB:SDOrder>Number</ZEB:SDOrder>\n<ZEB:SDOrder>Nmber</ZEB:SDOrder>"
         "<ZEB:Query.Advance>SDOrder</ZEB:Query.Advance></ZEB:SDOrder.Row>",
         "2: ZEB:SDOrder: SDOrder has no field Nmber"},
        {"queries that the page does not define",
         "zebtell_yld.htm",
         "<ZEB:SDOrder.Row></ZEB:SDOrder.Row>\n<ZEB:Query.Reset>SDOrder</ZEB:Query.Reset>",
         "1: ZEB:SDOrder.Row: the page defines no query SDOrder\n"
         "2: ZEB:Query.Reset: the page defines no query SDOrder"},
    });
}

TEST_F(TemplatesTest, Fields) {
    Expect({
        {"through links, kept with the row, and known to the tag",
         "zebtell_kaubad.htm",
         "<ZEB:GRPriceListRow>GRArticle.GRTax.TaxPercent</ZEB:GRPriceListRow>"
         "<ZEB:GRPriceListRow>@unitprice</ZEB:GRPriceListRow>"
         "<ZEB:GRPriceListRow>Price18</ZEB:GRPriceListRow>"
         "<ZEB:QPriceList>FinalPrice;0.00</ZEB:QPriceList>"
         "<ZEB:Tellimus.Rida>#</ZEB:Tellimus.Rida>",
         ""},
        {"unknown, at each place of a path",
         "zebtell_kaubad.htm",
         "<ZEB:GRPriceListRow>Nimi</ZEB:GRPriceListRow>\n"
         "<ZEB:GRPriceListRow>GRArtikel.Name</ZEB:GRPriceListRow>\n"
         "<ZEB:GRPriceListRow>GRArticle.GRTax.Rate;0.0</ZEB:GRPriceListRow>\n"
         "<ZEB:Parent></ZEB:Parent>",
         "1: ZEB:GRPriceListRow: GRPriceListRel has no field Nimi\n"
         "2: ZEB:GRPriceListRow: GRPriceListRel has no field GRArtikel.Name\n"
         "3: ZEB:GRPriceListRow: GRPriceListRel has no field GRArticle.GRTax.Rate\n"
         "4: ZEB:Parent: no field is named"},
        {"each tag by its own table",
         "zebtell_tellimus.htm",
         "<ZEB:GDTax>Base</ZEB:GDTax>\n<ZEB:GDTax>Number</ZEB:GDTax>\n"
         "<ZEB:SDOrder>Base</ZEB:SDOrder>\n<ZEB:SDOrderRow>State</ZEB:SDOrderRow>\n"
         "<ZEB:Contact>Position</ZEB:Contact><ZEB:Employee>Position</ZEB:Employee>",
         "2: ZEB:GDTax: GDTax has no field Number\n3: ZEB:SDOrder: SDOrder has no field Base\n"
         "4: ZEB:SDOrderRow: SDOrderRow has no field State\n"
         "5: ZEB:Employee: EREmployee has no field Position"},
        {"in alternatives and conditions",
         "zebtell_yld.htm",
         "<ZEB:Company>Phone|Emial</ZEB:Company>\n<ZEB:Company>?Cod='A*;A</ZEB:Company>\n"
         "<ZEB:Company>?Code='A*</ZEB:Company>\n<ZEB:Company>?Code;A</ZEB:Company>",
         "1: ZEB:Company: GRCompany has no field Emial\n"
         "2: ZEB:Company: GRCompany has no field Cod\n"
         "3: ZEB:Company: the condition ?Code='A* has no test or no \";\" behind it\n"
         "4: ZEB:Company: the condition ?Code;A has no test or no \";\" behind it"},
        {"a column that nobody may read",
         "zebtell_yld.htm",
         "<ZEB:Query>SYUser;;;</ZEB:Query><ZEB:SYUser>PasswordHash</ZEB:SYUser>",
         "1: ZEB:SYUser: SYUser has no field PasswordHash"},
        {"words of modifiers",
         "zebtell_yld.htm",
         "<ZEB:Company>Name;zeb:nospace,quote,attr,len=20</ZEB:Company>\n"
         "<ZEB:Company>Name;zeb:qoute,len=x</ZEB:Company>",
         "2: ZEB:Company: zeb: has no word len=x\n2: ZEB:Company: zeb: has no word qoute"},
    });
}

TEST_F(TemplatesTest, Declarations) {
    Expect({
        {"right ones",
         "zebtell_kaubad.htm",
         "<ZEB:Order>GRArticle.Code desc</ZEB:Order><ZEB:Otsi.Code>barcode</ZEB:Otsi.Code>"
         "<ZEB:Filter>{GRArticle.Stock>0}</ZEB:Filter>"
         "<ZEB:CreateCombo>GRArticleCat;ID;Name;Name;;;Category='#F'</ZEB:CreateCombo>"
         "<ZEB:EditField.UnitPrice/><ZEB:Orders.Enable>OrdersAllowed</ZEB:Orders.Enable>",
         ""},
        {"columns that are not there",
         "zebtell_kaubad.htm",
         "<ZEB:Otsi.Code>kood</ZEB:Otsi.Code>\n<ZEB:EditField.Hind/>\n"
         "<ZEB:CreateCombo>GRArticleCat;ID;Nimi;Name</ZEB:CreateCombo>\n"
         "<ZEB:Orders.Enable>Allowed</ZEB:Orders.Enable>",
         "1: ZEB:Otsi.Code: GRArticle has no field kood\n"
         "2: ZEB:EditField.Hind: SDOrderRow has no field Hind\n"
         "3: ZEB:CreateCombo: GRArticleCat has no field Nimi\n"
         "4: ZEB:Orders.Enable: GRCompany has no field Allowed"},
        {"too few parts",
         "zebtell_yld.htm",
         "<ZEB:Query>SDOrder;IDGRCompany</ZEB:Query>",
         "1: ZEB:Query: at least four fields with \";\" between them are needed"},
    });
    for (const char* statement : {"<ZEB:Order>GRArticle.Cod</ZEB:Order>",
                                  "<ZEB:Filter>{GRArticle.Stok>0}</ZEB:Filter>",
                                  "<ZEB:Favorites>IDGRArticle in (select</ZEB:Favorites>",
                                  "<ZEB:Query>SDTellimus;ID;;</ZEB:Query>",
                                  "<ZEB:PriceQuery>select * from Prices</ZEB:PriceQuery>"}) {
        folder.Write("zebtell_kaubad.htm", statement);
        EXPECT_THAT(Faults(), testing::MatchesRegex("zebtell_kaubad.htm:1: ZEB:[A-Za-z]+: .+\n"))
            << statement;
    }
}

TEST_F(TemplatesTest, FieldsInMarkup) {
    Expect({
        {"escaped, or not text",
         "zebtell_yld.htm",
         "<a title=\"<ZEB:Company>Name;zeb:quote</ZEB:Company>\" rel='<ZEB:Company>Name;zeb:attr"
         "</ZEB:Company>' class=\"<ZEB:Company>PriceCut;0.00</ZEB:Company><ZEB:Company>?ID>0;x"
         "</ZEB:Company>\"><ZEB:Company>Name</ZEB:Company></a>",
         ""},
        {"not escaped",
         "zebtell_yld.htm",
         "<a title=\"<ZEB:Company>Name</ZEB:Company>\"\n rel='<ZEB:Company>Name;0.00</ZEB:Company>'"
         "\n class=\"<ZEB:Company>Name;zeb:quote|Code;zeb:nospace</ZEB:Company>\">",
         "1: ZEB:Company: a field in an attribute value needs zeb:attr or zeb:quote\n"
         "2: ZEB:Company: a field in an attribute value needs zeb:attr or zeb:quote\n"
         "3: ZEB:Company: a field in an attribute value needs zeb:attr or zeb:quote"},
        {"without quotation marks",
         "zebtell_yld.htm",
         "<a title=<ZEB:Company>Name;zeb:quote</ZEB:Company>\n"
         "id=x<ZEB:Company>Name;zeb:quote</ZEB:Company>>\n<a <ZEB:Company>Name</ZEB:Company>>",
         "1: ZEB:Company: a field inside of a tag's markup needs quotation marks around it\n"
         "2: ZEB:Company: a field inside of a tag's markup needs quotation marks around it\n"
         "3: ZEB:Company: a field inside of a tag's markup needs quotation marks around it"},
        {"behind what only looks like markup",
         "zebtell_yld.htm",
         "<!doctype html><!-- <a title=\" --><script>if (a < b) x = \"</script>1 < 2 <p a=b c>\""
         "<ZEB:Company>Name</ZEB:Company>",
         ""},
        {"in what a tag around it shows",
         "zebtell_yld.htm",
         "<a title=\"<ZEB:WEBUser><ZEB:Company>Name</ZEB:Company></ZEB:WEBUser>\">",
         "1: ZEB:Company: a field in an attribute value needs zeb:attr or zeb:quote"},
    });
}

TEST_F(TemplatesTest, Addresses) {
    Expect({
        {"right ones, and those that lead elsewhere",
         "zebtell_yld.htm",
         "<a href=\"?page=kaubainfo&amp;event=favorites\"><form action='?page=Logon&event=Logon'>"
         "<a href=\"?page=Tellimus&amp;event=ID_17#top\"><a href=\"https://x/?page=Y\"><a "
         "href=\"?\">"
         "<a href=\"?page=Koostamine&amp;event=DEL_<ZEB:Tellimus.Rida>#</ZEB:Tellimus.Rida>\">"
         "<a href=\"?page=Kaubainfo&amp;event=<ZEB:TellRidu/>\"><p class=\"?page=Y\">",
         ""},
        {"unknown pages and events",
         "zebtell_yld.htm",
         "<a href=\"?page=Kaup\">\n<form\n action=\"?page=Logon&amp;event=Sisse\">\n"
         "<button formaction=?page=Kaubainfo&event=Hinnakri>\n<a href=\"?event=Logon\">\n"
         "<a href=\"?page=Tellimus&amp;event=NR_<ZEB:TellRidu/>\">",
         "1: there is no page Kaup\n3: page Logon has no event Sisse\n"
         "4: page Kaubainfo has no event Hinnakri\n5: the event Logon is of no page\n"
         "6: page Tellimus has no event NR_"},
    });
}

TEST_F(TemplatesTest, FilesOfTheirOwnLines) {
    folder.Write("inc_a.htm", "a\n<ZEB:X/>\n<!--#include file=\"inc_b.htm\"-->\n<ZEB:Y/>");
    folder.Write("inc_b.htm", "b\n\n<ZEB:HKRida></ZEB:HKRida>");
    folder.Write("zebtell_kaubad.htm", "\n<!--#include file=\"inc_a.htm\"--><ZEB:Z/>\n<ZEB:Q/>");
    folder.Write("zebtell_yld.htm", "<!--#include file=\"inc_a.htm\"-->");
    EXPECT_EQ(Faults(),
              "inc_a.htm:2: unknown tag ZEB:X\n"
              "inc_a.htm:4: unknown tag ZEB:Y\n"
              "inc_b.htm:3: unknown tag ZEB:HKRida (on page Yld)\n"
              "zebtell_kaubad.htm:2: unknown tag ZEB:Z\n"
              "zebtell_kaubad.htm:3: unknown tag ZEB:Q\n");
}

TEST_F(TemplatesTest, FilesThatCanNotBeIncluded) {
    std::filesystem::remove(folder.path() / "zebtell_logon.htm");
    folder.Write("inc_ring.htm", "\n\n<!--#include file=\"zebtell_yld.htm\"-->");
    folder.Write("zebtell_yld.htm",
                 "<!--#include file=\"inc_ring.htm\"-->\n<!--#include file=\"none.htm\"-->\n"
                 "<!--#include file=\"../secret.htm\"--><!--#include file=\"/etc/passwd\"-->\n"
                 "<ZEB:StillRead/>");
    EXPECT_EQ(Faults(),
              "inc_ring.htm:3: the include zebtell_yld.htm includes itself\n"
              "zebtell_logon.htm: the template can't be read\n"
              "zebtell_yld.htm:2: the include none.htm is not there\n"
              "zebtell_yld.htm:3: the include ../secret.htm lies outside of the template folder\n"
              "zebtell_yld.htm:3: the include /etc/passwd lies outside of the template folder\n"
              "zebtell_yld.htm:4: unknown tag ZEB:StillRead\n");
}

}  // namespace
}  // namespace zebtell::check
