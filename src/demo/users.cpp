#include <string>

#include "base/text.h"
#include "demo/companies.h"
#include "demo/random.h"
#include "erp/password.h"

namespace zebtell::demo {
namespace {

struct UserRow {
    std::string_view name;
    std::string_view password;
    std::string_view display_name;
    std::int64_t company;
    bool guest = false;
    bool disabled = false;
};

constexpr UserRow kKnownUsers[] = {
    {"mari", "mari-demo", "Mari", kMarisCompany},
    {"janis", "janis-demo", "Jānis", kJanisCompany},
    {"blokk", "blokk-demo", "Blokkmaja ostja", kBlockedCompany},
    {"WebGuest", "", "Külaline", kRetailCompany, true},
    {"endine", "endine-demo", "Endine töötaja", kMarisCompany, false, true},
};

// Of all users that have no row above: hashing takes its time on purpose.
constexpr std::string_view kCommonPassword = "klient-demo";

class UserWriter {
  public:
    explicit UserWriter(CompanyStore& store)
        : users_(store,
                 "SYUser",
                 {"Name",
                  "PasswordHash",
                  "DisplayName",
                  "IDPartner",
                  "IDGRCompContPerson",
                  "Guest",
                  "Disabled"}) {}

    void Write(const UserRow& user, const std::string& hash, std::int64_t contact) {
        users_.Row(user.name,
                   hash,
                   user.display_name,
                   user.company,
                   Link{contact},
                   user.guest,
                   user.disabled);
    }

  private:
    Insert users_;
};

}  // namespace

void WriteUsers(CompanyStore& store, const std::vector<Buyer>& buyers) {
    UserWriter writer(store);
    for (const UserRow& user : kKnownUsers) {
        const Buyer& buyer = buyers[static_cast<std::size_t>(user.company - 1)];
        writer.Write(user, erp::HashPassword(user.password), user.disabled ? 0 : buyer.contact);
    }
    const std::string common_hash = erp::HashPassword(kCommonPassword);
    for (const Buyer& buyer : buyers) {
        const std::string number = std::to_string(buyer.id);
        const std::string name = "klient" + number;
        const UserRow user{name, "", name, buyer.id};
        if (buyer.id > kRetailCompany) {
            writer.Write(user, common_hash, buyer.contact);
        }
        if (buyer.id > kRetailCompany && buyer.id % 10 == 0) {
            const std::string second = name + "b";
            writer.Write({second, "", second, buyer.id}, common_hash, 0);
        }
    }
}

}  // namespace zebtell::demo
