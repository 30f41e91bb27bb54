#include "orders/saving_problem.h"

#include "host/texts.h"

namespace zebtell::orders {
namespace {

constexpr std::string_view kProblem = "Probleem tellimuse salvestamisel!";

// The data layer's refusals, by how their descriptions begin: a refused field's with its name.
struct Reason {
    std::string_view description;
    host::LocalText text;
    std::string_view field = {};
};
constexpr Reason kReasons[] = {
    {"The wanted date is over",
     {"Soovitud tarnepäev on möödas.",
      "The wanted delivery date is over.",
      "Vēlamais piegādes datums ir pagājis."},
     "SDOrder.WantedDate"},
    {"CompanyName ",
     {"Nimi on liiga pikk.", "The name is too long.", "Nosaukums ir pārāk garš."},
     "SDOrder.CompanyName"},
    {"CompanyAddr ",
     {"Aadress on liiga pikk.", "The address is too long.", "Adrese ir pārāk gara."},
     "SDOrder.CompanyAddr"},
    {"Explanation ",
     {"Märkused on liiga pikad.", "The comment is too long.", "Piezīmes ir pārāk garas."},
     "ZEB_Komment"},
    {"The order has no rows",
     {"Tellimusel ei ole ühtegi kogusega rida.",
      "The order has no rows with a quantity.",
      "Pasūtījumā nav nevienas rindas ar daudzumu."}},
    {"The order is being processed",
     {"Tellimust juba täidetakse, seda ei saa enam muuta.",
      "The order is being processed and cannot be changed.",
      "Pasūtījums jau tiek izpildīts, to vairs nevar mainīt."}},
    {"Somebody else has changed the order",
     {"Tellimust on vahepeal muudetud, palun avage see uuesti.",
      "The order has been changed meanwhile, please open it again.",
      "Pasūtījums pa šo laiku ir mainīts, lūdzu, atveriet to vēlreiz."}},
    {"The order is not there any more",
     {"Seda tellimust enam ei ole.",
      "The order does not exist any more.",
      "Šāda pasūtījuma vairs nav."}},
};

}  // namespace

SavingProblem DescribeSavingProblem(const std::exception& error, host::UserLanguage language) {
    const std::string_view description = error.what();
    SavingProblem problem{std::string(kProblem), {}};
    for (const Reason& reason : kReasons) {
        if (!description.starts_with(reason.description)) continue;
        problem.message.append(" ").append(reason.text.In(language));
        problem.field = reason.field;
        break;
    }
    return problem;
}

}  // namespace zebtell::orders
