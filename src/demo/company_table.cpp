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
    {"Puit & Teras OÜ", 1, kBaseList, kGold, -5},
    {"SIA Daugavas Instrumenti", 8, kExportList, kRegular, -7.5},
    {"Blokkmaja Ehitus AS", 2, kBaseList, kUsual},
    {"Jaeklient", 0, kBaseList, kRetail},
    {"Uustulnuk OÜ", 4, 0, kUsual},
    {"Põhjatuule Kontsern AS", 0, kProjectList, kGold, -10},
    {"Põhjatuule Metall OÜ", 3, 0, kGold, -10, 6},
    {"Põhjatuule Puit OÜ", 6, 0, kRegular, 0, 6},
    {"SIA Vidzemes Koks", 9, kExportList, kUsual},
    {"Oy Pohjanlahden Konepaja Ab", 13, kExportList, kRegular, -3},
    {"Raudrohu Remonditööd OÜ", 1, kBaseList, kUsual},
    {"Kuusiku Mööbel AS", 4, kBaseList, kRegular, -2.5},
    {"O'Tamm Tehnika OÜ", 2, kBaseList, kUsual},
    {"Sinilille Laevaehitus AS", 7, kProjectList, kGold, -12.5},
    {"Ida-Viru Masinaabi OÜ", 5, kBaseList, kRegular},
    {"Väike & Pojad Keevitus OÜ", 6, kBaseList, kUsual},
    {"Metsatöö Kuus OÜ", 6, kBaseList, kUsual, 2},
    {"Lõunakaare Põllumajandusühistu", 6, kBaseList, kRegular, -4},
    {"Soojatoru Paigaldus OÜ", 0, kBaseList, kRegular},
    {"Hõbekala Sadamateenused AS", 2, kProjectList, kGold, -8},
    {"Kivirünk Betoon OÜ", 3, kBaseList, kUsual},
    {"Elektrimees ja Kaja OÜ", 1, kBaseList, kRegular},
    {"Viljakuivati Hooldus OÜ", 4, kBaseList, kUsual},
    {"Järveotsa Haldus MTÜ", 0, kBaseList, kUsual, 5},
    {"Nurmenuku Kool", 1, kBaseList, kUsual},
    {"Tuulepargi Teenindus OÜ", 2, kBaseList, kRegular, -6.5},
    {"SIA Liepājas Kuģu Remonts", 10, kExportList, kGold, -9},
    {"SIA Zemgales Mašīnas", 11, kExportList, kUsual},
    {"SIA Ģipša Meistari", 8, kExportList, kUsual},
    {"AS Rīgas Tērauds", 8, kExportList, kRegular},
    {"SIA Ūdensvads un Siltums", 9, kExportList, kUsual},
    {"SIA Čiekurkalna Darbnīca", 8, kExportList, kRegular, -1.5},
    {"Järvenrannan Huolto Oy", 12, kExportList, kUsual},
    {"Lännen Pultti Oy", 14, kExportList, kRegular},
    {"Hämeen Sähkö ja Putki Oy", 13, kExportList, kUsual},
    {"Saariston Telakka Oy", 14, kExportList, kGold, -11},
    {"Tehnoülevaatus Ratas OÜ", 0, kBaseList, kUsual},
    {"Saeveski Tamme OÜ", 4, kBaseList, kRegular},
    {"Vanaraud <Uus> OÜ", 5, kBaseList, kUsual},
    {"Linnatransport Nool AS", 0, kProjectList, kGold, -14},
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
