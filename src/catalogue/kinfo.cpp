#include "catalogue/kinfo.h"

#include "base/text.h"
#include "host/errors.h"
#include "tags/custom_func.h"
#include "tags/page_tags.h"

namespace zebtell::catalogue {
namespace {

using host::SessionState;

std::shared_ptr<data::Record> ReadArticle(SessionState& state, const std::string& id) {
    if (!base::ParseNumber(id)) return nullptr;
    const auto list = state.application().OpenList("GRArticle", "ID=" + id, "");
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

bool Mode(tags::TagCall& c) {
    const bool here = c.tag.LowerName() == "zeb:mode.kinfo";
    here ? c.tag.Show() : c.tag.Hide();
    return true;
}

}  // namespace

void KInfo_Respond(SessionState& state, web::Call& call) {
    state.Message.clear();
    host::ShowPage(state, call);
}

void KInfo_ProcessTag(SessionState& state, web::Call& call, markup::Tag& tag) {
    tags::ProcessPageTag(state, call, tag, "KInfo_ProcessTag", "KInfo", &KInfoTagTable());
}

void KInfo_UserEvent(SessionState& state, web::Call& call, std::string_view) {
    const auto read = [&] {
        const std::string id = tags::CleanFormValue(call.request.Value("ID"));
        state.documents.Article = ReadArticle(state, id);
    };
    host::Guarded(state, "KInfo_UserEvent", read, [&] { state.documents.Article.reset(); });
    host::ShowPage(state, call);
}

const tags::TagTable& KInfoTagTable() {
    static const tags::TagTable kTable{
        {"ZEB:GRArticle", Article, "a field of the article"},
        {"ZEB:Mode.*", Mode, "contents when the name behind the dot is this page's, KInfo"},
    };
    return kTable;
}

}  // namespace zebtell::catalogue
