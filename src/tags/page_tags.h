#pragma once

#include "tags/tag_table.h"

namespace zebtell::tags {

// The tags that all pages share.
bool CommonTags(TagCall& call);
const TagTable& CommonTagTable();

// The order basket, the customer's people, and the price query.
bool OrderSummaryTags(TagCall& call);
const TagTable& OrderSummaryTagTable();

// "ZEB:" and the name of a query defined on the page: a field of that query's current record.
bool QueryFieldTag(TagCall& call);

// A page's ProcessTag: the common tags, the order summary tags, the page's own table, then the
// page's queries. Errors are logged as "<handler> error:" and end the tag's handling. `row_key`
// stands for the customer's key in the page's queries; 0: the customer's key itself.
void ProcessPageTag(host::SessionState& state,
                    web::Call& call,
                    markup::Tag& tag,
                    std::string_view handler,
                    std::string_view page,
                    const TagTable* own,
                    std::int32_t row_key = 0);

}  // namespace zebtell::tags
