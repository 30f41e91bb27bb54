#include "demo/catalogue.h"

#include <string>

#include "demo/article_names.h"
#include "demo/random.h"

namespace zebtell::demo {
namespace {

using base::Currency;

constexpr std::string_view kPriceGroupNames[] = {
    "Kinnitusvahendid", "Tööriistad", "Kulumaterjal", "Elekter", "Netohinnaga"};

struct Tax {
    std::string_view name;
    double percent;
};
constexpr Tax kTaxes[] = {{"Käibemaks 24 %", 24}, {"Käibemaks 9 %", 9}, {"Maksuvaba 0 %", 0}};

constexpr std::string_view kNotes[] = {
    "Tarneaeg 3–5 tööpäeva",
    "Suuremate koguste hind kokkuleppel: küsi müügist!",
    "Ei sobi temperatuurile < -20 °C",
    "Ettevaatust & kaitseprillid kohustuslikud",
    "Asendab toodet \"vana mudel\"",
    "Ražots Latvijā, piegāde nedēļas laikā",
};

double PercentOfTax(TaxRate rate) {
    return kTaxes[static_cast<int>(rate) - 1].percent;
}

void WriteNames(CompanyStore& store) {
    Insert taxes(store, "GRTax", {"ID", "Name", "TaxPercent"});
    Insert groups(store, "GRArticlePriceCat", {"ID", "Name"});
    Insert categories(store, "GRArticleCat", {"ID", "Name", "Category"});
    Insert lists(store, "GRPriceList", {"ID", "Name", "Currency", "IDSrcPriceList", "IsDefault"});
    int id = 0;
    for (const Tax& tax : kTaxes) {
        taxes.Row(++id, tax.name, tax.percent);
    }
    id = 0;
    for (std::string_view name : kPriceGroupNames) {
        groups.Row(++id, name);
    }
    id = 0;
    for (const ArticleKind& kind : ArticleKinds()) {
        categories.Row(++id, kind.category, kind.group);
    }
    lists.Row(kBaseList, "Põhihinnakiri", "EUR", Link{}, true);
    lists.Row(kExportList, "Ekspordihinnakiri", "EUR", Link{}, false);
    lists.Row(kProjectList, "Projektihinnakiri", "EUR", Link{SourceList(kProjectList)}, false);
}

// Larger ones cost more. What costs less than half a euro is priced to the hundredth of a cent.
Currency ListPrice(const ArticleKind& kind, const ArticleName& name, Random& random) {
    const std::int64_t span = kind.highest - kind.lowest;
    const int share = name.size_per_mille * 6 / 10 + random.Below(400);
    const std::int64_t cents = kind.lowest + span * share * share / 1'000'000;
    return Currency::FromScaled(cents * 100 + (cents < 50 ? random.Below(100) : 0));
}

class CatalogueWriter {
  public:
    explicit CatalogueWriter(CompanyStore& store)
        : articles_(store,
                    "GRArticle",
                    {"ID",
                     "Code",
                     "Name",
                     "Unit",
                     "PackQuantity",
                     "Barcode",
                     "Explanation",
                     "Stock",
                     "IDGRTax",
                     "IDGRArticlePriceCat"}),
          categories_(store, "GRArticleCatRel", {"IDGRArticle", "IDGRArticleCat"}),
          lines_(store, "GRPriceListRel", {"IDGRPriceList", "IDGRArticle", "Price"}) {}

    Article WriteArticle(int id);
    Article WriteTransport(int id);
    void WriteLines(const Catalogue& catalogue);

  private:
    void WriteCategories(int id, int category);
    // Not every article is in every list; some lines are there, but not priced yet.
    void ChoosePrices(Article& article, Currency price);

    Insert articles_;
    Insert categories_;
    Insert lines_;
    Random random_{1};
};

Article CatalogueWriter::WriteArticle(int id) {
    const auto kinds = ArticleKinds();
    const int kind_count = static_cast<int>(kinds.size());
    const int category = (id - 1) % kind_count;
    const ArticleKind& kind = kinds[static_cast<std::size_t>(category)];
    const ArticleName name = NameOf(kind, (id - 1) / kind_count);
    const std::string barcode = id % 15 == 0 ? "" : Ean13(474'012'000'000 + id);
    const std::string_view note = random_.Percent(12) ? random_.Pick(kNotes) : std::string_view();
    const int stock = random_.Percent(10) ? 0 : random_.Below(500);

    Article article;
    article.id = id;
    article.tax_percent = PercentOfTax(kind.tax);
    article.price_group = kind.price_group;
    article.is_measured = kind.unit == "m" || kind.unit == "kg" || kind.unit == "l";
    articles_.Row(id,
                  name.code,
                  name.name,
                  kind.unit,
                  kind.pack,
                  barcode,
                  note,
                  stock,
                  static_cast<int>(kind.tax),
                  static_cast<int>(kind.price_group));
    WriteCategories(id, category + 1);
    ChoosePrices(article, ListPrice(kind, name, random_));
    return article;
}

Article CatalogueWriter::WriteTransport(int id) {
    Article article;
    article.id = id;
    article.tax_percent = PercentOfTax(TaxRate::kStandard);
    article.prices.fill(Currency::FromScaled(7'50'00));
    articles_.Row(id,
                  "TRANSPORT",
                  "Transport",
                  "tk",
                  1,
                  "",
                  "",
                  0,
                  static_cast<int>(TaxRate::kStandard),
                  static_cast<int>(PriceGroup::kNet));
    return article;
}

void CatalogueWriter::WriteCategories(int id, int category) {
    categories_.Row(id, category);
    if (id % 20 == 0) {  // some articles are looked for in two places
        categories_.Row(id, category % static_cast<int>(ArticleKinds().size()) + 1);
    }
}

void CatalogueWriter::ChoosePrices(Article& article, Currency price) {
    const bool is_priced = article.id % 97 != 0;
    const bool is_exported = random_.Percent(85);
    const double export_percent = random_.Between(88, 112);
    if (is_priced) {
        article.prices[kBaseList - 1] = price;
        if (is_exported) {
            article.prices[kExportList - 1] = base::PercentOf(price, export_percent, 2);
        }
    }
}

void CatalogueWriter::WriteLines(const Catalogue& catalogue) {
    for (const Article& article : catalogue.articles) {
        lines_.Row(kBaseList, article.id, article.PriceIn(kBaseList));
    }
    for (const Article& article : catalogue.articles) {
        if (article.PriceIn(kExportList) != Currency()) {
            lines_.Row(kExportList, article.id, article.PriceIn(kExportList));
        }
    }
}

}  // namespace

Catalogue WriteCatalogue(CompanyStore& store, int articles) {
    WriteNames(store);
    CatalogueWriter writer(store);
    Catalogue catalogue;
    catalogue.articles.reserve(static_cast<std::size_t>(articles));
    for (int id = 1; id <= articles; ++id) {
        catalogue.articles.push_back(writer.WriteArticle(id));
    }
    catalogue.transport = writer.WriteTransport(articles + 1);
    writer.WriteLines(catalogue);
    return catalogue;
}

}  // namespace zebtell::demo
