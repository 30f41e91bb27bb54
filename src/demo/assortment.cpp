#include "demo/assortment.h"

#include <algorithm>
#include <unordered_set>

namespace zebtell::demo {
namespace {

double PriceCutOf(const Buyer& buyer, const Article& article) {
    const auto cuts = PriceCuts();
    const auto found = std::find_if(cuts.begin(), cuts.end(), [&](const PriceCutRow& cut) {
        return cut.company_group == buyer.group && cut.price_group == article.price_group &&
               cut.price_list == SourceList(buyer.price_list);
    });
    return found == cuts.end() ? 0 : found->price_cut;
}

TradeRow RowOf(const Buyer& buyer, const Article& article) {
    TradeRow row;
    row.article = &article;
    row.list_price = article.PriceIn(buyer.price_list);
    row.price_cut = PriceCutOf(buyer, article);
    row.price = base::PercentOf(row.list_price, 100 + row.price_cut, 2);
    return row;
}

}  // namespace

std::vector<TradeRow> AssortmentOf(const Buyer& buyer, const Catalogue& catalogue, Random& random) {
    const int articles = static_cast<int>(catalogue.articles.size());
    const int size = std::min(random.Between(24, 72), articles / 3);
    std::vector<TradeRow> assortment;
    std::unordered_set<std::int64_t> chosen;
    while (static_cast<int>(assortment.size()) < size) {
        const Article& article = random.Pick(catalogue.articles);
        const bool is_priced = article.PriceIn(buyer.price_list) != base::Currency();
        if (is_priced && chosen.insert(article.id).second) {
            assortment.push_back(RowOf(buyer, article));
        }
    }
    return assortment;
}

}  // namespace zebtell::demo
