#include "erp/needed_tables.h"

#include "base/text.h"

namespace zebtell::erp {
namespace {

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
     "ID>GDocument Number DocDate WantedDate State IDGRCompany>GRCompany IDGRCompContPerson>GRCompContPerson "
     "IDGRPriceList>GRPriceList CompanyName CompanyAddr Explanation Amount TaxAmount AmountWTax "
     "NeedsReview"},
    {"SDOrderRow",
     "IDSDOrder>SDOrder RowNo IDGRArticle>GRArticle Quantity Price UnitPrice PriceCut Amount "
     "TaxPercent Explanation DeliveredQuantity ReviewPrice Status"},
    {"SDConsignmD",
     "ID>GDocument Number DocDate State IDGRCompany>GRCompany IDGRCompContPerson>GRCompContPerson "
     "IDGRPriceList>GRPriceList CompanyName CompanyAddr Explanation Amount TaxAmount AmountWTax"},
    {"DDStoreDRow",
     "IDSDConsignmD>SDConsignmD RowNo IDGRArticle>GRArticle Quantity Price UnitPrice PriceCut "
     "Amount TaxPercent Explanation Status"},
    {"SDInvoice",
     "ID>GDocument Number DocDate DueDate State IDGRCompany>GRCompany IDGRCompContPerson>GRCompContPerson "
     "IDGRPriceList>GRPriceList CompanyName CompanyAddr Explanation Amount TaxAmount AmountWTax "
     "PaidAmount"},
    {"SDInvoiceRow",
     "IDSDInvoice>SDInvoice RowNo IDGRArticle>GRArticle Quantity Price UnitPrice PriceCut Amount "
     "TaxPercent Explanation Status"},
};
// clang-format on

}  // namespace

std::vector<NeededColumn> NeededTable::Columns() const {
    std::vector<NeededColumn> result;
    if (!columns.starts_with("ID>")) {
        result.push_back({"ID", ""});
    }
    for (const std::string_view column : base::Split(columns, ' ')) {
        const std::size_t mark = column.find('>');
        const bool is_link = mark != std::string_view::npos;
        result.push_back({column.substr(0, mark), is_link ? column.substr(mark + 1) : ""});
    }
    return result;
}

std::span<const NeededTable> NeededTables() {
    return kNeeded;
}

}  // namespace zebtell::erp
