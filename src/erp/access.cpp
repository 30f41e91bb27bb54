#include "erp/access.h"

#include <algorithm>
#include <array>
#include <unordered_map>

#include "base/text.h"

namespace zebtell::erp {
namespace {

constexpr std::string_view kEvery = "";
constexpr std::string_view kNo = AccessRule::kNoRows;

constexpr std::string_view kOwnLists = "IDGRPriceList in (:price_lists)";
constexpr std::string_view kOwnDocuments = "IDGRCompany = :partner";
constexpr std::string_view kSaved = "ID in (:saved_documents)";

constexpr std::string_view kOfOwnOrders =
    "IDSDOrder in (select ID from SDOrder where IDGRCompany = :partner)";
constexpr std::string_view kOfOwnDeliveries =
    "IDSDConsignmD in (select ID from SDConsignmD where IDGRCompany = :partner)";
constexpr std::string_view kOfOwnInvoices =
    "IDSDInvoice in (select ID from SDInvoice where IDGRCompany = :partner)";

constexpr std::string_view kOwnDocumentKeys =
    "ID in (select ID from SDOrder where IDGRCompany = :partner)"
    " or ID in (select ID from SDConsignmD where IDGRCompany = :partner)"
    " or ID in (select ID from SDInvoice where IDGRCompany = :partner)";
constexpr std::string_view kOfOwnDocuments =
    "IDGDocument in (select ID from SDOrder where IDGRCompany = :partner)"
    " or IDGDocument in (select ID from SDConsignmD where IDGRCompany = :partner)"
    " or IDGDocument in (select ID from SDInvoice where IDGRCompany = :partner)";
// Both ends must be the reader's: what follows from his order may have been billed to another.
constexpr std::string_view kBetweenOwnDocuments =
    "(IDGDocument in (select ID from SDOrder where IDGRCompany = :partner)"
    " or IDGDocument in (select ID from SDConsignmD where IDGRCompany = :partner)"
    " or IDGDocument in (select ID from SDInvoice where IDGRCompany = :partner))"
    " and (IDSrcGDocument in (select ID from SDOrder where IDGRCompany = :partner)"
    " or IDSrcGDocument in (select ID from SDConsignmD where IDGRCompany = :partner)"
    " or IDSrcGDocument in (select ID from SDInvoice where IDGRCompany = :partner))";

// clang-format off
const std::array kPolicy = std::to_array<AccessRule>({
    // table               user's rows                 guest's rows
    // The company and its people
    {"GRCompany",          "ID in (:partner, :parent, :settlement_company)",
                           "ID in (:partner, :parent, :settlement_company)"},
    {"GRCompContPerson",   "IDGRCompany = :partner",   "ID = :contact"},
    {"EREmployee",         "ID = :employee",           "ID = :employee"},
    {"SYUser",             "ID = :user",               "ID = :user",
     {"PasswordHash"}},

    // Articles
    {"GRArticle",          kEvery,                     kEvery},
    {"GRTax",              kEvery,                     kEvery},
    {"GRArticleCat",       kEvery,                     kEvery},
    {"GRArticleCatRel",    kEvery,                     kEvery},

    // Prices
    {"GRArticlePriceCat",  kEvery,                     kEvery},
    {"GRCompanyPriceCat",  "ID = :price_category",     "ID = :price_category"},
    {"GRPriceCatRel",      "IDGRCompanyPriceCat = :price_category",
                           "IDGRCompanyPriceCat = :price_category"},
    {"GRPriceList",        "ID in (:price_lists)",     "ID in (:price_lists)"},
    {"GRPriceListRel",     kOwnLists,                  kOwnLists},
    {"SQPriceList5",       kOwnLists,                  kOwnLists},
    {"SQCatPriceList5",    kOwnLists,                  kOwnLists},

    // Documents; a guest's are those that he has stored in his session
    {"SDOrder",            kOwnDocuments,              kSaved,
     {},
     {"WantedDate", "CompanyName", "CompanyAddr", "Explanation", "IDGRCompContPerson"}},
    {"SDOrderRow",         kOfOwnOrders,               "IDSDOrder in (:saved_documents)",
     {},
     {"IDGRArticle", "Quantity", "UnitPrice", "Amount", "Explanation"}},
    {"SDConsignmD",        kOwnDocuments,              kSaved},
    {"DDStoreDRow",        kOfOwnDeliveries,           "IDSDConsignmD in (:saved_documents)"},
    {"SDInvoice",          kOwnDocuments,              kSaved},
    {"SDInvoiceRow",       kOfOwnInvoices,             "IDSDInvoice in (:saved_documents)"},
    {"GDocument",          kOwnDocumentKeys,           kSaved,
     {"DocKey"}},
    {"GDocRel",            kBetweenOwnDocuments,       kNo},
    {"GDTax",              kOfOwnDocuments,            "IDGDocument in (:saved_documents)"},

    // The staff's
    {"SDOrderReview",      kNo,                        kNo},
});
// clang-format on

using RulesByTable =
    std::unordered_map<std::string_view, const AccessRule*, base::NoCaseHash, base::NoCaseEqual>;

RulesByTable MakeRulesByTable() {
    RulesByTable rules;
    for (const AccessRule& rule : kPolicy) {
        rules.emplace(rule.table, &rule);
    }
    return rules;
}

}  // namespace

std::span<const AccessRule> AccessPolicy() {
    return kPolicy;
}

const AccessRule* FindAccessRule(std::string_view table) {
    static const RulesByTable rules = MakeRulesByTable();
    const auto found = rules.find(table);
    return found == rules.end() ? nullptr : found->second;
}

}  // namespace zebtell::erp
