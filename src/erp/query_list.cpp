#include "erp/query_list.h"

#include <algorithm>

#include "base/runtime_error.h"
#include "base/text.h"
#include "erp/children.h"
#include "erp/criterion.h"
#include "erp/sql/errors.h"

namespace zebtell::erp {
namespace {

constexpr std::size_t kLinkedAtOnce = 64;

class QueryRecord : public ReadOnlyRecord {
  public:
    QueryRecord(std::shared_ptr<QueryRows> source, std::size_t row)
        : source_(std::move(source)), row_(row) {}

    base::Value GetField(std::string_view name) override {
        if (const auto field = source_->rows().fields().Find(name)) {
            return source_->rows().Get(row_, *field);
        }
        if (name.starts_with('@')) {
            return {};
        }
        const std::size_t dot = name.find('.');
        if (dot == std::string_view::npos) {
            NoSuchField(name);
        }
        return source_->Linked(row_, name.substr(0, dot), name.substr(dot + 1));
    }

    std::shared_ptr<data::RecordList> Children(std::string_view table) override {
        if (!source_->table()) {
            sql::Fail("The query's records have no table of their own and so no", table);
        }
        return OpenChildren(source_->session(),
                            *source_->table(),
                            GetField("ID").ToInteger64(),
                            table,
                            [this](const std::string& column) { return GetField(column); });
    }

  private:
    std::shared_ptr<QueryRows> source_;
    std::size_t row_;
};

// Where a link column of a result leads: as its own table says, else as any table does.
const TableInfo* LinkTarget(const Schema& schema, const TableInfo* table, std::string_view link) {
    if (const Column* own = table ? table->FindLink(link) : nullptr) {
        return schema.Find(own->links_to);
    }
    for (const TableInfo& other : schema.tables()) {
        const Column* column = other.FindLink(link);
        if (column && !column->links_to.empty()) {
            return schema.Find(column->links_to);
        }
    }
    return nullptr;
}

std::int64_t KeyOf(const base::Value& value) {
    return value.IsNumeric() ? value.ToInteger64() : 0;
}

bool IsNameByte(char c) {
    return c == '_' || (c >= '0' && c <= '9') || (c >= 'A' && c <= 'Z') || (c >= 'a' && c <= 'z');
}

bool IsBlank(char c) {
    return c == ' ' || c == '\t' || c == '\r' || c == '\n';
}

// The first table behind "from" of a plain statement ("select * from SDOrder where ...").
const TableInfo* SelectedTable(const Schema& schema, std::string_view sql) {
    constexpr std::string_view kFrom = "from";
    std::size_t at = 0;
    do {
        at = base::FindNoCase(sql, kFrom, at + 1);
        if (at == std::string_view::npos || at + kFrom.size() == sql.size()) {
            return nullptr;
        }
    } while (!IsBlank(sql[at - 1]) || !IsBlank(sql[at + kFrom.size()]));
    const auto name = std::find_if_not(sql.begin() + at + kFrom.size(), sql.end(), IsBlank);
    const auto end = std::find_if_not(name, sql.end(), IsNameByte);
    return schema.Find(std::string_view(name, end));
}

}  // namespace

base::Value QueryRows::Linked(std::size_t row, std::string_view link, std::string_view path) {
    const std::string column = "ID" + std::string(link);
    const auto field = rows_->fields().Find(column);
    const TableInfo* target = field ? LinkTarget(session_->schema(), table_, link) : nullptr;
    if (!target) {
        NoSuchField(link);
    }
    const auto following = [&] {
        std::vector<std::int64_t> keys;
        const std::size_t end = std::min(rows_->count(), row + kLinkedAtOnce);
        for (std::size_t other = row; other < end; ++other) {
            keys.push_back(KeyOf(rows_->Get(other, *field)));
        }
        return keys;
    };
    return linked_.Get(*target, KeyOf(rows_->Get(row, *field)), path, following);
}

std::int64_t QueryList::Count() {
    return static_cast<std::int64_t>(rows_->rows().count());
}

std::shared_ptr<data::Record> QueryList::Item(std::int64_t index) {
    return std::make_shared<QueryRecord>(rows_, Checked(index, Count()));
}

const QueryList::Index& QueryList::IndexOf(std::size_t field) {
    const auto [found, is_new] = indexes_.try_emplace(field);
    for (std::size_t row = 0; is_new && row < rows_->rows().count(); ++row) {
        const base::Value& value = rows_->rows().Get(row, field);
        if (!value.IsBlank() && value.IsNumeric()) {
            found->second.try_emplace(value.ToInteger64(), row);
        }
    }
    return found->second;
}

std::shared_ptr<data::Record> QueryList::Find(std::string_view criterion) {
    const Criterion wanted = ParseCriterion(criterion);
    const auto field = rows_->rows().fields().Find(wanted.field);
    if (!field) {
        NoSuchField(wanted.field);
    }
    const Index& index = IndexOf(*field);
    const auto found = index.find(wanted.number);
    return found == index.end() ? nullptr : std::make_shared<QueryRecord>(rows_, found->second);
}

std::shared_ptr<data::RecordList> OpenQueryList(const std::shared_ptr<Session>& session,
                                                std::string_view sql) {
    auto rows = std::make_shared<QueryRows>(
        session, session->Query(sql), SelectedTable(session->schema(), sql));
    return std::make_shared<QueryList>(std::move(rows));
}

}  // namespace zebtell::erp
