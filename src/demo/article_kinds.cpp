#include "demo/article_kinds.h"

namespace zebtell::demo {
namespace {

using enum PriceGroup;
using enum TaxRate;

// clang-format off
constexpr ArticleKind kKinds[] = {
    {"KRV", "Kruvid", "Kinnitus", "pk", 200, 180, 2900, kFasteners, kStandard,
     "Puidukruvi|Isepuuriv kruvi % DIN 7504|Kipsikruvi|Terrassikruvi|Betoonikruvi|"
     "Skrūve kokam %|Masinakruvi % DIN 7985",
     "3,5|4,0|4,5|5,0|6,0|8,0|M4|M5|M6|M8",
     "16|20|25|30|40|50|60|80|100|120", "Zn|A2|A4|kollane Zn TX"},
    {"POL", "Poldid", "Kinnitus", "tk", 50, 12, 980, kFasteners, kStandard,
     "Kuuskantpolt % DIN 933|Kuuskantpolt % DIN 931|Sisekuuskantpolt % DIN 912|"
     "Lukupolt % DIN 603|Peitpeapolt % DIN 7991|Sešstūra skrūve % DIN 933",
     "M4|M5|M6|M8|M10|M12|M16|M20|M24",
     "10|16|20|25|30|40|50|60|80|100|120|160", "8.8 Zn|10.9|A2|A4"},
    {"MUT", "Mutrid", "Kinnitus", "tk", 100, 3, 420, kFasteners, kStandard,
     "Kuuskantmutter % DIN 934|Isekinnituv mutter % DIN 985|Tiibmutter % DIN 315|"
     "Kübarmutter % DIN 1587|Äärikmutter % DIN 6923|Uzgrieznis % DIN 934",
     "M3|M4|M5|M6|M8|M10|M12|M14|M16|M20|M24|M30", "", "8 Zn|10 must|A2|A4|kuumtsingitud"},
    {"SEI", "Seibid", "Kinnitus", "tk", 100, 2, 190, kFasteners, kStandard,
     "Lameseib % DIN 125|Vedruseib % DIN 127|Keresseib % DIN 9021|Hammasseib % DIN 6797|"
     "Neliseib % DIN 436|Paplāksne % DIN 125",
     "M3|M4|M5|M6|M8|M10|M12|M14|M16|M20|M24|M30", "", "Zn|must|A2|A4|kuumtsingitud"},
    {"NEE", "Needid", "Kinnitus", "pk", 500, 390, 4200, kFasteners, kStandard,
     "Pimeneet % Al/Fe|Pimeneet % A2/A2|Neetmutter % Fe|Lehtneet % Al|Mitmikneet % Al/Fe",
     "2,4|3,0|3,2|4,0|4,8|6,0|6,4", "6|8|10|12|14|16|18|20|25", "|lai äär|peitpea"},
    {"ANK", "Ankrud ja tüüblid", "Kinnitus", "pk", 50, 240, 6900, kFasteners, kStandard,
     "Kiilankur|Nailontüübel|Kipsitüübel|Raamitüübel|Löökankur|Soojustustüübel",
     "5|6|8|10|12|14|16", "30|40|50|60|80|100|120|160|200", "|Zn|A4"},
    {"PUU", "Puurid", "Tööriist", "tk", 1, 95, 8900, kTools, kStandard,
     "Metallipuur % HSS-G|Metallipuur % HSS-Co5|Kivipuur % SDS-plus|Puidupuur %|"
     "Kõvasulampuur % VHM|Urbis metālam %",
     "1,0|1,5|2,0|2,5|3,0|3,3|4,0|4,2|5,0|5,5|6,0|6,8|8,0|8,5|10,0|12,0|14,0|16,0",
     "60|93|117|160|210|260", "|pikk|vasak"},
    {"LOI", "Lõikekettad", "Tööriist", "tk", 25, 85, 1450, kConsumables, kStandard,
     "Lõikeketas metallile|Lõikeketas roostevabale|Lihvketas|Lamellketas|Kiudketas|"
     "Teemantketas",
     "115|125|150|180|230|300|350", "1,0|1,6|2,0|2,5|3,2|6,0", "A24|A46|A60|INOX|Z40"},
    {"LIH", "Lihvmaterjalid", "Tööriist", "tk", 10, 45, 3400, kConsumables, kStandard,
     "Lihvpaber|Lihvlint|Lihvkäsn|Lihvvõrk|Velcro-lihvketas|Poleervilt",
     "75|100|115|125|150|200", "280|533|610|1000|2000", "P40|P60|P80|P120|P180|P240|P400"},
    {"ELK", "Elektroodid", "Keevitus", "kg", 5, 690, 9800, kConsumables, kStandard,
     "Elektrood E7018|Elektrood E6013 rutiil|Elektrood roostevaba 316L|"
     "Elektrood malmile Ni|Elektrood pealesulatuseks|Elektrods E6013",
     "2,0|2,5|3,2|4,0|5,0", "300|350|450", "vaakumpakk|karbis|AC/DC|< 60 HRC|torus"},
    {"KEE", "Keevitustarvikud", "Keevitus", "tk", 1, 120, 24900, kConsumables, kStandard,
     "Keevitustraat G3Si1|Keevitustraat 308LSi|Kontaktsuudmik % M6|Gaasidüüs|"
     "TIG-varras ER70S-6|Volframelektrood WL20|Massiklamber|Keevitaja O'Shield mask",
     "0,6|0,8|1,0|1,2|1,6|2,0|2,4|3,2", "|1000|1,5 kg|5 kg|15 kg", "|Cu|CuCrZr"},
    {"LII", "Liimid ja hermeetikud", "Keemia", "tk", 12, 240, 5900, kConsumables, kStandard,
     "Silikoonhermeetik|Polüuretaanliim|Kiirliim <20 s|Keermeliim & tihendaja|Epoksüliim|"
     "Montaažiliim|Kontaktliim|Līme universālā",
     "5 g|20 g|50 ml|100 ml|250 ml|290 ml|310 ml|600 ml|1 l",
     "", "|läbipaistev|must|valge|hall|pruun|punane"},
    {"MAA", "Määrded ja õlid", "Keemia", "l", 1, 290, 28900, kConsumables, kStandard,
     "Universaalmääre EP2|Hüdroõli HLP 46|Ketiõli|Lõikeõli|Silikoonmääre|Vaskmääre|"
     "Kompressoriõli VDL 100|Reduktoriõli CLP 220",
     "0,4|1|4|5|10|20|60|208", "", "|bio|toidukõlblik H1|talvine|sünteetiline"},
    {"VAR", "Värvid", "Keemia", "l", 1, 590, 11900, kConsumables, kStandard,
     "Roostevastane kruntvärv|Metallivärv|Aerosoolvärv|Põrandavärv|Märgistusvärv|"
     "Kuumuskindel värv 600 °C",
     "0,4|0,9|1|2,7|3|9|10|20",
     "", "RAL 9005|RAL 9010|RAL 7016|RAL 7035|RAL 3020|RAL 5010|RAL 6005|RAL 1021"},
    {"PUH", "Puhastusvahendid", "Keemia", "tk", 6, 190, 8900, kConsumables, kStandard,
     "Piduripuhasti|Rasvaeemaldi|Roosteeemaldi|Kätepuhastuspasta|Tööstuslapp|"
     "Klaasipuhasti|Kontaktispray|Õliabsorbent",
     "200 ml|400 ml|500 ml|1 l|5 l|10 l|25 kg", "", "|sidrun|lõhnatu|ekstra|tsitrus & aaloe"},
    {"KAI", "Kaitsevahendid", "Ohutus", "tk", 10, 95, 9900, kTools, kStandard,
     "Töökindad nitriil|Töökindad nahk|Kaitseprillid|Kuulmisklapid|Kaitsekiiver|"
     "Respiraator FFP2|Respiraator FFP3|Põlvekaitse|Aizsargbrilles",
     "6|7|8|9|10|11|12", "", "|must|hall|kollane|sinine|talvine|lõikekindel C"},
    {"RII", "Tööriided ja jalatsid", "Ohutus", "tk", 1, 990, 15900, kTools, kStandard,
     "Tööpüksid|Töökombinesoon|Helkurvest|Talvejope|Turvajalats S3|Turvasaabas S5|"
     "Vihmakeep|Fliisjakk",
     "S|M|L|XL|XXL|3XL", "", "must|sinine|oranž|kollane|hall|roheline"},
    {"TOO", "Tööriistad", "Tööriist", "tk", 1, 290, 18900, kTools, kStandard,
     "Lehtsilmusvõti|Silmusvõti|Padrun 1/2\"|Kruvikeeraja|Näpitstangid|Haamer|"
     "Mutrivõti reguleeritav|Meißel, lame|Knaibles",
     "6|8|10|13|17|19|22|24|27|30|32|36", "", "|CrV|VDE 1000 V|komplektis|pikk|lühike"},
    {"ELT", "Elektritööriistad", "Tööriist", "tk", 1, 3900, 89900, kNet, kStandard,
     "Akutrell|Nurklihvija|Puurvasar|Tikksaag|Ketassaag|Kuumaõhupuhur|Löökkruvikeeraja|"
     "Taldlihvija",
     "12 V|18 V|36 V|230 V 600 W|230 V 850 W|230 V 1200 W|230 V 2000 W",
     "", "|kohvris|ilma akuta|2×4,0 Ah|2×5,0 Ah"},
    {"LAA", "Laagrid", "Ülekanne", "tk", 1, 190, 14900, kTools, kStandard,
     "Kuullaager|Koonusrull-laager|Nõellaager|Laagripukk UCP|Gultnis",
     "6000|6001|6002|6003|6004|6005|6006|6200|6201|6202|6203|6204|6205|6206|6300|6301|"
     "6302|6303|6304|6305",
     "", "2RS|2RS C3|ZZ|ZZ C3|lahtine"},
    {"TIH", "Tihendid", "Ülekanne", "tk", 10, 8, 1900, kTools, kStandard,
     "O'Ring tihend|Võllitihend|V-rõngas|Lametihend|X-rõngas|Blīve",
     "5|8|10|12|16|20|25|30|40|50|60|80|100",
     "1,5|2|2,5|3|4|5,3", "NBR 70|FPM 75|EPDM|silikoon"},
    {"KET", "Ketid ja trossid", "Ülekanne", "m", 1, 90, 5900, kTools, kStandard,
     "Rullkett|Tõstekett|Terastross|Trossiklamber|Seekel|Tropp",
     "2|3|4|5|6|8|10|12|16", "", "|Zn|A4|G80|PVC-kattega"},
    {"TOR", "Torud", "Toru", "m", 6, 110, 8900, kConsumables, kStandard,
     "Terastoru|Vasktoru|PE-toru PN16|PVC-toru|Roostevaba toru 304|Presstoru",
     "12|15|16|18|20|22|25|28|32|40|50|63", "1|1,5|2|2,3|3", "|3 m|6 m"},
    {"LTM", "Liitmikud", "Toru", "tk", 10, 65, 6900, kConsumables, kStandard,
     "Põlv 90°|Kolmik|Nippel|Muhv|Kiirliitmik|Kuulkraan|Üleminek|Veidgabals",
     "1/4\"|3/8\"|1/2\"|3/4\"|1\"|1 1/4\"|1 1/2\"|2\"",
     "", "SK|VK|SK/VK|pressitav|messing|roostevaba"},
    {"VOO", "Voolikud", "Toru", "m", 1, 95, 7900, kConsumables, kStandard,
     "Suruõhuvoolik|Hüdrovoolik 2SN|Kütusevoolik|Aiavoolik|Imivoolik|Voolikuklamber",
     "6|8|10|13|16|19|25|32|38|50", "", "|PVC|kumm|PU spiraal|toiduaine & piim"},
    {"KAB", "Kaablid", "Elekter", "m", 1, 42, 4900, kElectric, kStandard,
     "Kaabel XPJ-HF|Kaabel H07RN-F|Kaabel PPJ|Juhe MKEM|Maakaabel AXPK|Kabelis NYM",
     "1G|2X|3G|4G|5G|7G", "0,75|1,5|2,5|4|6|10|16|25", "|must|valge|hall"},
    {"VAL", "Valgustid", "Elekter", "tk", 1, 490, 24900, kElectric, kStandard,
     "LED-prožektor|LED-paneel|Avariivalgusti|Tööstusvalgusti IP65|Käsilamp|Otsmikulamp|"
     "Gaismeklis LED",
     "5 W|10 W|20 W|30 W|50 W|100 W|150 W|200 W", "", "3000 K|4000 K|5000 K|6500 K|anduriga"},
    {"LUL", "Lülitid ja kaitsmed", "Elekter", "tk", 1, 190, 9900, kElectric, kStandard,
     "Kaitselüliti|Rikkevoolukaitse|Pistikupesa & lüliti|Kontaktor|Jõupistik CEE|"
     "Harukarp IP54|Hermeetiline lüliti",
     "2 A|6 A|10 A|16 A|20 A|25 A|32 A|63 A", "", "B 1P|C 1P|C 3P|30 mA|24 V DC|230 V AC"},
    {"RMT", "Käsiraamatud", "Muu", "tk", 1, 890, 6900, kNet, kReduced,
     "Keevitaja käsiraamat|Kinnitusvahendite tabelid|Laagrite teatmik|Tööohutuse juhend|"
     "Elektriku taskuraamat|Metināšanas rokasgrāmata",
     "1. osa|2. osa|3. osa|4. osa", "", "eesti k|läti k|vene k|inglise k|soome k"},
    {"TAA", "Pakend ja taara", "Muu", "tk", 1, 45, 2900, kNet, kZero,
     "Euroalus (tagatis)|Gaasiballoon (tagatis)|Vaat (tagatis)|Plastkast (tagatis)|"
     "Metallkonteiner (tagatis)",
     "2 l|5 l|10 l|20 l|60 l|200 l|600×400|800×600|1200×800", "", "|uus|kasutatud"},
};
// clang-format on

}  // namespace

std::span<const ArticleKind> ArticleKinds() {
    return kKinds;
}

}  // namespace zebtell::demo
