#include "tags/page_tags.h"

#include "host/errors.h"

namespace zebtell::tags {

void ProcessPageTag(host::SessionState& state,
                    web::Call& call,
                    markup::Tag& tag,
                    std::string_view handler,
                    std::string_view page,
                    const TagTable* own,
                    std::int32_t row_key) {
    host::Guarded(state, handler, [&] {
        TagCall tag_call{state, call, tag, page, row_key};
        if (CommonTags(tag_call) || OrderSummaryTags(tag_call)) return;
        if (own != nullptr && own->Offer(tag_call)) return;
        QueryFieldTag(tag_call);
    });
}

}  // namespace zebtell::tags
