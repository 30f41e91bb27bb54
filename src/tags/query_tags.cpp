#include "tags/query_tags.h"

#include <limits>

#include "base/runtime_error.h"
#include "base/text.h"
#include "tags/custom_func.h"
#include "tags/field_text.h"
#include "tags/form_values.h"
#include "tags/page_tags.h"

namespace zebtell::tags {

namespace {

constexpr bool kHandled = true;
constexpr std::string_view kPrefix = "ZEB:";
constexpr std::string_view kRowEnd = ".Row";
constexpr std::size_t kLeastFields = 4;

// The query that the contents name, if the page has defined it.
data::clsQuery* NamedQuery(TagCall& call) {
    const std::string name = Reference(call);
    if (!QueryExists(call.state, name, call.page)) return nullptr;
    return &GetQuery(call.state, name, call.page);
}

template <class Change>
bool ChangeQuery(TagCall& call, Change&& change) {
    call.tag.Hide();
    if (data::clsQuery* query = NamedQuery(call)) change(*query);
    return kHandled;
}

std::string OrderOf(const TagCall& call, std::string order) {
    if (!order.starts_with('#')) return order;
    return CleanFormValue(call.call.request.QueryString[order.substr(1)]);
}

std::shared_ptr<data::RecordList> RecordsFor(TagCall& call, data::clsQuery& query) {
    const std::int32_t key = call.row_key != 0 ? call.row_key : call.state.company.CustomerKey;
    return query.Records(base::Value(key));
}

}  // namespace

bool DefineQuery(TagCall& call) {
    const auto fields = base::Split(call.tag.TemplateContents(), ';');
    call.tag.Hide();
    if (fields.size() < kLeastFields) return kHandled;
    const auto field = [&](std::size_t index) {
        return index < fields.size() ? CleanFormValue(fields[index]) : std::string();
    };
    const std::string order = OrderOf(call, field(4));
    data::clsQuery& query = GetQuery(call.state, base::Trimmed(fields[0]), call.page);
    if (!query.notCreated() && base::EqualNoCase(query.Order(), order)) return kHandled;
    query.Criteria = field(1);
    query.Master = field(2);
    query.Context = call.page;
    query.Mode = field(3);
    query.SetOrder(order);
    query.MasterQ = field(5);
    return kHandled;
}

bool ResetQuery(TagCall& call) {
    return ChangeQuery(call, [](data::clsQuery& query) { query.RecNo = 1; });
}

bool RequeryQuery(TagCall& call) {
    return ChangeQuery(call, [](data::clsQuery& query) { query.Requery(); });
}

bool AdvanceQuery(TagCall& call) {
    return ChangeQuery(call, [](data::clsQuery& query) {
        if (query.RecNo == std::numeric_limits<int>::max()) {
            throw base::RuntimeError(base::errors::kOverflow);
        }
        ++query.RecNo;
    });
}

bool QueryRow(TagCall& call) {
    const std::string_view row_tag = call.tag.TagName();
    call.tag.ShortenName(kRowEnd.size());
    const std::string_view name = call.NameFrom(kPrefix.size());
    if (!QueryExists(call.state, name, call.page)) return !kHandled;
    data::clsQuery& query = GetQuery(call.state, name, call.page);
    if (query.RecNo > RecordsFor(call, query)->Count()) {
        call.tag.Hide();
    } else {
        call.tag.Repeat(row_tag, "\r\n");
    }
    return kHandled;
}

bool QueryFieldTag(TagCall& call) {
    const std::string_view name = call.NameFrom(kPrefix.size());
    if (!QueryExists(call.state, name, call.page)) return !kHandled;
    data::clsQuery& query = GetQuery(call.state, name, call.page);
    const auto records = RecordsFor(call, query);
    if (query.RecNo > records->Count()) {
        call.tag.Hide();
    } else {
        WriteReference(call, records->Item(query.RecNo).get(), Reference(call));
    }
    return kHandled;
}

}  // namespace zebtell::tags
