#include "base/region.h"

#include "base/text.h"

namespace zebtell::base {

namespace {

Region MakeEstonian() {
    return {
        .name = "et",
        .decimal_mark = ',',
        .group_mark = ' ',
        .date_mark = '.',
        .currency_picture = "#,##0.00 €",
        .long_date_picture = "d\\. mmmm yyyy",
        .months = {"Jaanuar",
                   "Veebruar",
                   "Märts",
                   "Aprill",
                   "Mai",
                   "Juuni",
                   "Juuli",
                   "August",
                   "September",
                   "Oktoober",
                   "November",
                   "Detsember"},
        .short_months = {"jaan",
                         "veebr",
                         "märts",
                         "apr",
                         "mai",
                         "juuni",
                         "juuli",
                         "aug",
                         "sept",
                         "okt",
                         "nov",
                         "dets"},
        .days =
            {"Pühapäev", "Esmaspäev", "Teisipäev", "Kolmapäev", "Neljapäev", "Reede", "Laupäev"},
        .short_days = {"P", "E", "T", "K", "N", "R", "L"},
        .yes = "Jah",
        .no = "Ei",
        .true_text = "Tõene",
        .false_text = "Väär",
        .on = "Sees",
        .off = "Väljas",
        .am = "EL",
        .pm = "PL",
    };
}

Region MakeLatvian() {
    return {
        .name = "lv",
        .decimal_mark = ',',
        .group_mark = ' ',
        .date_mark = '.',
        .currency_picture = "#,##0.00 €",
        .long_date_picture = "yyyy\\. \"gada\" d\\. mmmm",
        .months = {"Janvāris",
                   "Februāris",
                   "Marts",
                   "Aprīlis",
                   "Maijs",
                   "Jūnijs",
                   "Jūlijs",
                   "Augusts",
                   "Septembris",
                   "Oktobris",
                   "Novembris",
                   "Decembris"},
        .short_months = {"janv",
                         "febr",
                         "marts",
                         "apr",
                         "maijs",
                         "jūn",
                         "jūl",
                         "aug",
                         "sept",
                         "okt",
                         "nov",
                         "dec"},
        .days = {"Svētdiena",
                 "Pirmdiena",
                 "Otrdiena",
                 "Trešdiena",
                 "Ceturtdiena",
                 "Piektdiena",
                 "Sestdiena"},
        .short_days = {"Sv", "P", "O", "T", "C", "Pk", "S"},
        .yes = "Jā",
        .no = "Nē",
        .true_text = "Patiess",
        .false_text = "Aplams",
        .on = "Ieslēgts",
        .off = "Izslēgts",
        .am = "priekšp.",
        .pm = "pēcp.",
    };
}

Region MakeEnglish() {
    return {
        .name = "en",
        .decimal_mark = '.',
        .group_mark = ',',
        .date_mark = '/',
        .currency_picture = "€#,##0.00",
        .long_date_picture = "d mmmm yyyy",
        .months = {"January",
                   "February",
                   "March",
                   "April",
                   "May",
                   "June",
                   "July",
                   "August",
                   "September",
                   "October",
                   "November",
                   "December"},
        .short_months =
            {"Jan", "Feb", "Mar", "Apr", "May", "Jun", "Jul", "Aug", "Sep", "Oct", "Nov", "Dec"},
        .days = {"Sunday", "Monday", "Tuesday", "Wednesday", "Thursday", "Friday", "Saturday"},
        .short_days = {"Sun", "Mon", "Tue", "Wed", "Thu", "Fri", "Sat"},
        .yes = "Yes",
        .no = "No",
        .true_text = "True",
        .false_text = "False",
        .on = "On",
        .off = "Off",
        .am = "AM",
        .pm = "PM",
    };
}

}  // namespace

const Region& RegionFor(std::string_view name) {
    static const Region estonian = MakeEstonian();
    static const Region latvian = MakeLatvian();
    static const Region english = MakeEnglish();
    if (StartsWithNoCase(name, "EN")) return english;
    if (StartsWithNoCase(name, "LV")) return latvian;
    return estonian;
}

}  // namespace zebtell::base
