#include "catalogue/kinfo.h"

#include "base/text.h"
#include "host/errors.h"
#include "tags/custom_func.h"
#include "tags/field_text.h"
#include "tags/fixed_tax.h"
#include "tags/page_tags.h"
#include "tags/price_query.h"

namespace zebtell::catalogue {
namespace {

using host::SessionState;

std::shared_ptr<data::Record> ReadArticle(SessionState& state, const std::string& id) {
    if (!base::ParseNumber(id)) return nullptr;
    const auto list =
        state.application().OpenList("GRArticle", "ID=" + data::Filter(data::Typed{id}), "");
    return list->Count() == 0 ? nullptr : list->Item(1);
}

bool Article(tags::TagCall& c) {
    data::Record* article = c.state.documents.Article.get();
    c.tag.Write(
        article == nullptr
            ? "&nbsp;"
            : tags::FormatFieldValue(
                  *article, tags::CleanFormValue(c.tag.TagContents()), "", c.state.region()));
    return true;
}

void ReadPrices(SessionState& state) {
    auto& documents = state.documents;
    documents.ArticlePrices.reset();
    if (!documents.Article) return;
    const std::string id = documents.Article->GetField("ID").ToPlainText();
    documents.ArticlePrices = tags::OpenCustomerPrices(state, id)->Find("idgrarticle=" + id);
}

bool Prices(tags::TagCall& c) {
    const auto& documents = c.state.documents;
    if (!documents.ArticlePrices || !base::EqualNoCase(tags::Reference(c), "FinalPriceWTax")) {
        tags::WriteReference(c, documents.ArticlePrices.get(), tags::Reference(c));
        return true;
    }
    c.tag.Write(tags::FixedPrice(documents.ArticlePrices->GetField("FinalPrice"),
                                 tags::TaxFactor(*documents.Article, "GRTax.TaxPercent"),
                                 c.state.region()));
    return true;
}

bool Mode(tags::TagCall& c) {
    const bool here = c.tag.LowerName() == "zeb:mode.kinfo";
    here ? c.tag.Show() : c.tag.Hide();
    return true;
}

}  // namespace

void KInfo_Respond(SessionState& state, web::Call& call) {
    state.Message.clear();
    host::Guarded(state, "KInfo_Respond", [&] { ReadPrices(state); });
    host::ShowPage(state, call);
}

void KInfo_ProcessTag(SessionState& state, web::Call& call, markup::Tag& tag) {
    tags::ProcessPageTag(state, call, tag, "KInfo_ProcessTag", "KInfo", &KInfoTagTable());
}

void KInfo_UserEvent(SessionState& state, web::Call& call, std::string_view) {
    const auto read = [&] {
        const std::string id = tags::CleanFormValue(call.request.Value("ID"));
        state.documents.Article = ReadArticle(state, id);
        ReadPrices(state);
    };
    host::Guarded(state, "KInfo_UserEvent", read, [&] {
        state.documents.Article.reset();
        state.documents.ArticlePrices.reset();
    });
    host::ShowPage(state, call);
}

const tags::TagTable& KInfoTagTable() {
    static const tags::TagTable kTable{
        {"ZEB:GRArticle", Article, "a field of the article"},
        {"ZEB:QPriceList", Prices, "a field of the customer's prices for the article"},
        {"ZEB:Mode.*", Mode, "contents when the name behind the dot is this page's, KInfo"},
    };
    return kTable;
}

}  // namespace zebtell::catalogue
