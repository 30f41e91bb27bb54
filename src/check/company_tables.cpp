#include "check/company_tables.h"

#include <span>
#include <string_view>

#include "base/text.h"

namespace zebtell::check {
namespace {

// A table or view and its columns besides ID, separated by blanks. "IDParent>GRCompany" is a link
// and must be a foreign key to that table.
struct NeededTable {
    std::string_view name;
    std::string_view columns;
};

// clang-format off
constexpr NeededTable kNeeded[] = {
    {"GRCompany",
     "Code Name RegCode TaxCode Address City PostCode Country Phone Email PriceCut OrdersAllowed "
     "IDGRPriceList>GRPriceList IDSettlCompany>GRCompany IDParent>GRCompany "
     "IDGRCompanyPriceCat>GRCompanyPriceCat IDEREmployee>EREmployee"},
    {"GRCompContPerson", "IDGRCompany>GRCompany Name Position Phone Email"},
    {"EREmployee",       "Name Phone Email"},
    {"SYUser",
     "Name PasswordHash DisplayName IDPartner>GRCompany IDGRCompContPerson>GRCompContPerson Guest "
     "Disabled"},

    {"GRArticle",
     "Code Name Unit PackQuantity Barcode Explanation Stock IDGRTax>GRTax "
     "IDGRArticlePriceCat>GRArticlePriceCat"},
    {"GRTax",            "Name TaxPercent"},
    {"GRArticleCat",     "Name Category"},
    {"GRArticleCatRel",  "IDGRArticle>GRArticle IDGRArticleCat>GRArticleCat"},

    {"GRCompanyPriceCat", "Name"},
    {"GRArticlePriceCat", "Name"},
    {"GRPriceCatRel",
     "IDGRCompanyPriceCat>GRCompanyPriceCat IDGRArticlePriceCat>GRArticlePriceCat "
     "IDGRPriceList>GRPriceList PriceCut"},
    {"GRPriceList",      "Name Currency IDSrcPriceList>GRPriceList IsDefault"},
    {"GRPriceListRel",   "IDGRPriceList>GRPriceList IDGRArticle>GRArticle Price"},
    {"SQPriceList5",     "IDGRPriceList IDSrcPriceList IDGRArticle Price"},
    {"SQCatPriceList5",  "IDGRPriceList IDSrcPriceList IDGRArticle Price IDGRArticleCat"},

    {"GDocument",        "Kind DocKey"},
    {"GDocRel",          "IDGDocument>GDocument IDSrcGDocument>GDocument"},
    {"GDTax",            "IDGDocument>GDocument TaxPercent Base Amount"},
    {"SDOrder",
     "Number DocDate WantedDate State IDGRCompany>GRCompany IDGRCompContPerson>GRCompContPerson "
     "IDGRPriceList>GRPriceList CompanyName CompanyAddr Explanation Amount TaxAmount AmountWTax "
     "NeedsReview"},
    {"SDOrderRow",
     "IDSDOrder>SDOrder RowNo IDGRArticle>GRArticle Quantity Price UnitPrice PriceCut Amount "
     "TaxPercent Explanation DeliveredQuantity ReviewPrice Status"},
    {"SDConsignmD",
     "Number DocDate State IDGRCompany>GRCompany IDGRCompContPerson>GRCompContPerson "
     "IDGRPriceList>GRPriceList CompanyName CompanyAddr Explanation Amount TaxAmount AmountWTax"},
    {"DDStoreDRow",
     "IDSDConsignmD>SDConsignmD RowNo IDGRArticle>GRArticle Quantity Price UnitPrice PriceCut "
     "Amount TaxPercent Explanation Status"},
    {"SDInvoice",
     "Number DocDate DueDate State IDGRCompany>GRCompany IDGRCompContPerson>GRCompContPerson "
     "IDGRPriceList>GRPriceList CompanyName CompanyAddr Explanation Amount TaxAmount AmountWTax "
     "PaidAmount"},
    {"SDInvoiceRow",
     "IDSDInvoice>SDInvoice RowNo IDGRArticle>GRArticle Quantity Price UnitPrice PriceCut Amount "
     "TaxPercent Explanation Status"},
};
// clang-format on

std::string ColumnFault(const erp::TableInfo& table, std::string_view needed) {
    const std::size_t mark = needed.find('>');
    const std::string name(needed.substr(0, mark));
    const erp::Column* column = table.FindColumn(name);
    if (column == nullptr) return "table " + table.name + " has no column " + name;
    if (mark == std::string_view::npos) return {};
    const std::string target(needed.substr(mark + 1));
    if (base::EqualNoCase(column->links_to, target)) return {};
    return "column " + name + " of table " + table.name + " has no foreign key to " + target;
}

void AddFaults(const NeededTable& needed,
               const erp::Schema& schema,
               std::vector<Finding>& findings) {
    const erp::TableInfo* table = schema.Find(needed.name);
    if (table == nullptr) {
        findings.push_back({"database", 0, "there is no table " + std::string(needed.name)});
        return;
    }
    const auto add = [&](std::string_view column) {
        std::string fault = ColumnFault(*table, column);
        if (!fault.empty()) findings.push_back({"database", 0, std::move(fault)});
    };
    add("ID");
    for (std::string_view column : base::Split(needed.columns, ' ')) add(column);
}

}  // namespace

std::vector<Finding> MissingInDatabase(const erp::Schema& schema) {
    std::vector<Finding> findings;
    for (const NeededTable& needed : kNeeded) AddFaults(needed, schema, findings);
    return findings;
}

}  // namespace zebtell::check
