#include "demo/company_table.h"

#include "demo/catalogue.h"

namespace zebtell::demo {
namespace {

using enum CompanyGroup;
using enum PriceGroup;

constexpr Town kTowns[] = {
    {"EE", "Tallinn", "11415", "Peterburi tee"},
    {"EE", "Tartu", "50409", "Ringtee"},
    {"EE", "Pärnu", "80010", "Savi"},
    {"EE", "Narva", "20103", "Kadastiku"},
    {"EE", "Viljandi", "71020", "Reinu tee"},
    {"EE", "Jõhvi", "41534", "Tööstuse"},
    {"EE", "Võru", "65606", "Räpina mnt"},
    {"EE", "Kuressaare", "93815", "Kalevi"},
    {"LV", "Rīga", "LV-1057", "Krustpils iela"},
    {"LV", "Valmiera", "LV-4201", "Cēsu iela"},
    {"LV", "Liepāja", "LV-3401", "Brīvības iela"},
    {"LV", "Jelgava", "LV-3001", "Rūpniecības iela"},
    {"FI", "Helsinki", "00880", "Mekaanikonkatu"},
    {"FI", "Tampere", "33100", "Hämeenkatu"},
    {"FI", "Turku", "20360", "Tehdaskatu"},
};

constexpr CompanyRow kCompanies[] = {
    {"Puit & Teras OÜ", 1, kGold, kBaseList, -5},
    {"SIA Daugavas Instrumenti", 8, kRegular, kExportList, -7.5},
    {"Blokkmaja Ehitus AS", 2, kUsual, kBaseList},
    {"Jaeklient", 0, kRetail, kBaseList},
    {"Uustulnuk OÜ", 4, kUsual, 0},
    {"Põhjatuule Kontsern AS", 0, kGold, kProjectList, -10},
    {"Põhjatuule Metall OÜ", 3, kGold, 0, -10, 6},
    {"Põhjatuule Puit OÜ", 6, kRegular, 0, 0, 6},
    {"SIA Vidzemes Koks", 9, kUsual, kExportList},
    {"Oy Pohjanlahden Konepaja Ab", 13, kRegular, kExportList, -3},
    {"Raudrohu Remonditööd OÜ", 1, kUsual, kBaseList},
    {"Kuusiku Mööbel AS", 4, kRegular, kBaseList, -2.5},
    {"O'Tamm Tehnika OÜ", 2, kUsual, kBaseList},
    {"Sinilille Laevaehitus AS", 7, kGold, kProjectList, -12.5},
    {"Ida-Viru Masinaabi OÜ", 5, kRegular, kBaseList},
    {"Väike & Pojad Keevitus OÜ", 6, kUsual, kBaseList},
    {"Metsatöö Kuus OÜ", 6, kUsual, kBaseList, 2},
    {"Lõunakaare Põllumajandusühistu", 6, kRegular, kBaseList, -4},
    {"Soojatoru Paigaldus OÜ", 0, kRegular, kBaseList},
    {"Hõbekala Sadamateenused AS", 2, kGold, kProjectList, -8},
    {"Kivirünk Betoon OÜ", 3, kUsual, kBaseList},
    {"Elektrimees ja Kaja OÜ", 1, kRegular, kBaseList},
    {"Viljakuivati Hooldus OÜ", 4, kUsual, kBaseList},
    {"Järveotsa Haldus MTÜ", 0, kUsual, kBaseList, 5},
    {"Nurmenuku Kool", 1, kUsual, kBaseList},
    {"Tuulepargi Teenindus OÜ", 2, kRegular, kBaseList, -6.5},
    {"SIA Liepājas Kuģu Remonts", 10, kGold, kExportList, -9},
    {"SIA Zemgales Mašīnas", 11, kUsual, kExportList},
    {"SIA Ģipša Meistari", 8, kUsual, kExportList},
    {"AS Rīgas Tērauds", 8, kRegular, kExportList},
    {"SIA Ūdensvads un Siltums", 9, kUsual, kExportList},
    {"SIA Čiekurkalna Darbnīca", 8, kRegular, kExportList, -1.5},
    {"Järvenrannan Huolto Oy", 12, kUsual, kExportList},
    {"Lännen Pultti Oy", 14, kRegular, kExportList},
    {"Hämeen Sähkö ja Putki Oy", 13, kUsual, kExportList},
    {"Saariston Telakka Oy", 14, kGold, kExportList, -11},
    {"Tehnoülevaatus Ratas OÜ", 0, kUsual, kBaseList},
    {"Saeveski Tamme OÜ", 4, kRegular, kBaseList},
    {"Vanaraud <Uus> OÜ", 5, kUsual, kBaseList},
    {"Linnatransport Nool AS", 0, kGold, kProjectList, -14},
};

constexpr std::string_view kEstonianFirst[] = {
    "Tiit", "Anu", "Margus", "Kadri", "Peeter", "Liis", "Jaan", "Piret", "Urmas", "Kersti"};
constexpr std::string_view kEstonianLast[] = {
    "Tamm", "Kask", "Õunapuu", "Mägi", "Sepp", "Rebane", "Lõhmus", "Pärn", "Ülemaa", "Järv"};
constexpr std::string_view kLatvianFirst[] = {
    "Andris", "Ilze", "Edgars", "Inga", "Juris", "Dace", "Viktors", "Laima"};
constexpr std::string_view kLatvianLast[] = {
    "Bērziņš", "Kalniņa", "Ozoliņš", "Liepiņa", "Krūmiņš", "Žagars", "Ābele", "Šulcs"};
constexpr std::string_view kFinnishFirst[] = {"Matti", "Aino", "Jukka", "Tuula", "Pekka", "Sari"};
constexpr std::string_view kFinnishLast[] = {
    "Mäkinen", "Virtanen", "Hämäläinen", "Järvinen", "Koskinen", "Öhman"};

constexpr PriceCutRow kPriceCuts[] = {
    {kRetail, kFasteners, kBaseList, 15},      {kRetail, kTools, kBaseList, 7.5},
    {kRetail, kConsumables, kBaseList, 10},    {kUsual, kFasteners, kBaseList, -5},
    {kUsual, kTools, kBaseList, -2.5},         {kUsual, kElectric, kBaseList, 3},
    {kRegular, kFasteners, kBaseList, -12.5},  {kRegular, kTools, kBaseList, -7.5},
    {kRegular, kConsumables, kBaseList, -10},  {kRegular, kElectric, kBaseList, -6.25},
    {kGold, kFasteners, kBaseList, -22.5},     {kGold, kTools, kBaseList, -15},
    {kGold, kConsumables, kBaseList, -17.75},  {kGold, kElectric, kBaseList, -12},
    {kUsual, kFasteners, kExportList, -4},     {kUsual, kConsumables, kExportList, 1.5},
    {kRegular, kFasteners, kExportList, -8.5}, {kRegular, kTools, kExportList, -6},
    {kRegular, kElectric, kExportList, -3.75}, {kGold, kFasteners, kExportList, -16},
    {kGold, kTools, kExportList, -11.5},       {kGold, kConsumables, kExportList, -13.25},
};

}  // namespace

std::span<const Town> Towns() {
    return kTowns;
}

std::span<const CompanyRow> Companies() {
    return kCompanies;
}

PersonNames NamesOf(std::string_view country) {
    if (country == "LV") {
        return {kLatvianFirst, kLatvianLast};
    }
    return country == "FI" ? PersonNames{kFinnishFirst, kFinnishLast}
                           : PersonNames{kEstonianFirst, kEstonianLast};
}

std::span<const PriceCutRow> PriceCuts() {
    return kPriceCuts;
}

}  // namespace zebtell::demo
