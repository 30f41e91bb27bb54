#include "demo/companies.h"

#include <algorithm>
#include <string>

#include "demo/random.h"

namespace zebtell::demo {
namespace {

constexpr std::string_view kGroupNames[] = {
    "Jaekliendid", "Tavakliendid", "Püsikliendid", "Kuldkliendid"};
constexpr std::string_view kSellers[] = {
    "Maarika Saar", "Rein Kuusk", "Jelena Ivanova", "Žanete Kļaviņa", "Heikki Salmi"};
constexpr std::string_view kPositions[] = {
    "ostujuht", "laojuhataja", "tootmisjuht", "raamatupidaja", "töödejuhataja"};
constexpr int kPaymentDays[] = {7, 14, 14, 21, 30};

CompanyRow RowOf(std::int64_t id) {
    const auto rows = Companies();
    const auto position = static_cast<std::size_t>(id - 1);
    CompanyRow row = rows[position % rows.size()];
    if (position >= rows.size()) {
        row.parent = 0;
    }
    return row;
}

std::string Digits(Random& random, int count) {
    std::string digits = std::to_string(random.Between(1, 9));
    while (static_cast<int>(digits.size()) < count) {
        digits += std::to_string(random.Below(10));
    }
    return digits;
}

struct Registration {
    std::string code;
    std::string tax_code;
};

Registration RegistrationIn(std::string_view country, Random& random) {
    if (country == "FI") {
        const std::string digits = Digits(random, 7);
        const std::string check = std::to_string(random.Below(10));
        return {digits + "-" + check, "FI" + digits + check};
    }
    if (country == "LV") {
        const std::string code = "4" + Digits(random, 10);
        return {code, "LV" + code};
    }
    return {"1" + Digits(random, 7), "EE10" + Digits(random, 7)};
}

std::string PhoneIn(std::string_view country, Random& random) {
    std::string phone = country == "LV" ? "+371 " : country == "FI" ? "+358 " : "+372 ";
    phone += Digits(random, 3);
    return phone + " " + Digits(random, 4);
}

std::string CompanyCode(std::int64_t id) {
    const std::string number = std::to_string(id);
    return "K" + std::string(4 - std::min<std::size_t>(4, number.size()), '0') + number;
}

std::string CompanyName(const CompanyRow& row, std::int64_t id) {
    const std::int64_t turn = (id - 1) / static_cast<std::int64_t>(Companies().size());
    return std::string(row.name) + (turn == 0 ? "" : " " + std::to_string(turn + 1));
}

std::string MailAddress(std::string_view box, std::int64_t id) {
    return std::string(box) + "@klient" + std::to_string(id) + ".example";
}

// Own list, else that of who pays, else the default one.
std::int64_t ListThatCounts(const CompanyRow& row) {
    const std::int64_t list =
        row.parent == 0 || row.price_list != 0 ? row.price_list : RowOf(row.parent).price_list;
    return list == 0 ? kBaseList : list;
}
void WriteSellers(CompanyStore& store, Random& random) {
    Insert employees(store, "EREmployee", {"ID", "Name", "Phone", "Email"});
    int id = 0;
    for (std::string_view name : kSellers) {
        ++id;
        const std::string mail = "myyk" + std::to_string(id) + "@tarnija.example";
        employees.Row(id, name, PhoneIn("EE", random), mail);
    }
}

void WritePriceCuts(CompanyStore& store) {
    Insert groups(store, "GRCompanyPriceCat", {"ID", "Name"});
    Insert cuts(store,
                "GRPriceCatRel",
                {"IDGRCompanyPriceCat", "IDGRArticlePriceCat", "IDGRPriceList", "PriceCut"});
    int id = 0;
    for (std::string_view name : kGroupNames) {
        groups.Row(++id, name);
    }
    for (const PriceCutRow& cut : PriceCuts()) {
        cuts.Row(static_cast<int>(cut.company_group),
                 static_cast<int>(cut.price_group),
                 cut.price_list,
                 cut.price_cut);
    }
}

class CompanyWriter {
  public:
    explicit CompanyWriter(CompanyStore& store)
        : companies_(store,
                     "GRCompany",
                     {"ID",
                      "Code",
                      "Name",
                      "RegCode",
                      "TaxCode",
                      "Address",
                      "City",
                      "PostCode",
                      "Country",
                      "Phone",
                      "Email",
                      "PriceCut",
                      "OrdersAllowed",
                      "PaymentDays",
                      "IDGRPriceList",
                      "IDSettlCompany",
                      "IDParent",
                      "IDGRCompanyPriceCat",
                      "IDEREmployee"}),
          people_(
              store, "GRCompContPerson", {"IDGRCompany", "Name", "Position", "Phone", "Email"}) {}

    Buyer Write(std::int64_t id);

  private:
    std::int64_t WritePeople(std::int64_t company, std::string_view country);

    Insert companies_;
    Insert people_;
    Random random_{2};
    std::int64_t last_person_ = 0;
};

Buyer CompanyWriter::Write(std::int64_t id) {
    const CompanyRow row = RowOf(id);
    const Town& town = Towns()[static_cast<std::size_t>(row.town)];
    const Registration registration = RegistrationIn(town.country, random_);
    const std::string address =
        std::string(town.street) + " " + std::to_string(random_.Between(1, 98));
    const std::string phone = PhoneIn(town.country, random_);
    const int seller = random_.Between(1, static_cast<int>(std::size(kSellers)));

    Buyer buyer;
    buyer.id = id;
    buyer.price_list = ListThatCounts(row);
    buyer.group = row.group;
    buyer.payment_days = random_.Pick(kPaymentDays);
    buyer.may_order = id != kBlockedCompany && id % 19 != 0;
    companies_.Row(id,
                   CompanyCode(id),
                   CompanyName(row, id),
                   registration.code,
                   registration.tax_code,
                   address,
                   town.city,
                   town.post_code,
                   town.country,
                   phone,
                   MailAddress("info", id),
                   row.price_cut,
                   buyer.may_order,
                   buyer.payment_days,
                   Link{row.price_list},
                   Link{row.parent},
                   Link{row.parent},
                   static_cast<int>(row.group),
                   seller);
    buyer.contact = id == kRetailCompany ? 0 : WritePeople(id, town.country);
    return buyer;
}

// Returns the first one. Those of the well-known users have names that fit.
std::int64_t CompanyWriter::WritePeople(std::int64_t company, std::string_view country) {
    const PersonNames names = NamesOf(country);
    const std::int64_t first = last_person_ + 1;
    const int count = random_.Between(1, 3);
    for (int i = 0; i < count; ++i) {
        std::string_view first_name = random_.Pick(names.first);
        if (i == 0 && company == kMarisCompany) {
            first_name = "Mari";
        } else if (i == 0 && company == kJanisCompany) {
            first_name = "Jānis";
        }
        const std::string name =
            std::string(first_name) + " " + std::string(random_.Pick(names.last));
        const std::string_view position = random_.Pick(kPositions);
        const std::string mail = MailAddress("isik" + std::to_string(++last_person_), company);
        people_.Row(company, name, position, PhoneIn(country, random_), mail);
    }
    return first;
}

}  // namespace

std::vector<Buyer> WriteCompanies(CompanyStore& store, int companies) {
    Random random(3);
    WriteSellers(store, random);
    WritePriceCuts(store);
    CompanyWriter writer(store);
    std::vector<Buyer> buyers;
    buyers.reserve(static_cast<std::size_t>(companies));
    for (std::int64_t id = 1; id <= companies; ++id) {
        buyers.push_back(writer.Write(id));
    }
    return buyers;
}

}  // namespace zebtell::demo
