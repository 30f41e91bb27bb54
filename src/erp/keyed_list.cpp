#include "erp/keyed_list.h"

#include <algorithm>

#include "erp/children.h"
#include "erp/criterion.h"

namespace zebtell::erp {
namespace {

// Pages mostly show 20 rows; a longer walk reads more at a time.
constexpr std::size_t kFirstWindow = 20;
constexpr std::size_t kLongestWindow = 64;
// Within the making of one page nobody looks whether the database has changed.
constexpr std::chrono::milliseconds kPageTime{500};

class KeyedRecord : public ReadOnlyRecord {
  public:
    KeyedRecord(std::shared_ptr<KeyedRows> source, std::size_t position, KeyedRows::Row row)
        : source_(std::move(source)), position_(position), row_(std::move(row)) {}

    base::Value GetField(std::string_view name) override {
        if (name.starts_with('@')) {
            return {};
        }
        auto field = row_.rows->fields().Find(name);
        if (!field) {
            row_ = source_->Fetch(position_, name);
            field = row_.rows->fields().Find(name);
        }
        return field ? row_.rows->Get(row_.row, *field) : base::Value::Null();
    }

    std::shared_ptr<data::RecordList> Children(std::string_view table) override {
        return OpenChildren(source_->shared_session(),
                            source_->table(),
                            source_->keys().Get(position_, 0),
                            table,
                            [this](const std::string& column) { return GetField(column); });
    }

  private:
    std::shared_ptr<KeyedRows> source_;
    std::size_t position_;
    KeyedRows::Row row_;
};

}  // namespace

KeyedRows::Row KeyedRows::Fetch(std::size_t position, std::string_view field) {
    if (!InWindow(position)) {
        MoveWindow(position);
        ReadWindow(field);
    } else if (!IsFresh() || (!field.empty() && !window_->fields().Find(field))) {
        ReadWindow(field);
    }
    return {window_, position - first_};
}

bool KeyedRows::InWindow(std::size_t position) const {
    return window_ && position >= first_ && position < first_ + length_;
}

bool KeyedRows::IsFresh() {
    const auto now = std::chrono::steady_clock::now();
    if (now - looked_ < kPageTime) {
        return true;
    }
    looked_ = now;
    return session_->database().pool().DataVersion() == version_;
}

void KeyedRows::MoveWindow(std::size_t position) {
    const bool goes_on = window_ && position == first_ + length_;
    const bool goes_back = window_ && position + 1 == first_;
    length_ = goes_on ? std::min(length_ * 2, kLongestWindow) : kFirstWindow;
    first_ = goes_back ? position + 1 - std::min(position + 1, length_) : position;
    length_ = std::min(length_, keys_->count() - first_);
}

void KeyedRows::ReadWindow(std::string_view field) {
    std::vector<std::int64_t> ids;
    for (std::size_t i = 0; i < length_; ++i) {
        ids.push_back(keys_->Get(first_ + i, 0));
    }
    looked_ = std::chrono::steady_clock::now();
    version_ = session_->database().pool().DataVersion();
    window_.reset();
    window_ = session_->Rows(table_, ids, field);
}

std::int64_t KeyedList::Count() {
    return static_cast<std::int64_t>(rows_->keys().count());
}

std::shared_ptr<data::Record> KeyedList::Item(std::int64_t index) {
    const std::size_t position = Checked(index, Count());
    return std::make_shared<KeyedRecord>(rows_, position, rows_->Fetch(position));
}

std::shared_ptr<data::Record> KeyedList::Find(std::string_view criterion) {
    const Criterion wanted = ParseCriterion(criterion);
    const auto position = Position(wanted.field, wanted.number);
    return position ? Item(static_cast<std::int64_t>(*position) + 1) : nullptr;
}

std::optional<std::size_t> KeyedList::Position(std::string_view field, std::int64_t number) {
    if (const auto column = rows_->keys().ColumnOf(field)) {
        return rows_->keys().Find(*column, number);
    }
    if (!find_keys_ || !find_keys_->ColumnOf(field)) {
        find_keys_ = rows_->session().Keys(rows_->table(), filter_, order_, field);
    }
    const auto found = find_keys_->Find(*find_keys_->ColumnOf(field), number);
    // The list itself stays as it was opened.
    return found ? rows_->keys().Find(0, find_keys_->Get(*found, 0)) : std::nullopt;
}

std::shared_ptr<data::RecordList> OpenKeyedList(const std::shared_ptr<Session>& session,
                                                const TableInfo& table,
                                                const data::Filter& filter,
                                                std::string_view order) {
    auto rows = std::make_shared<KeyedRows>(session, table, session->Keys(table, filter, order));
    return std::make_shared<KeyedList>(std::move(rows), filter, std::string(order));
}

std::shared_ptr<data::Record> LoadRecord(const std::shared_ptr<Session>& session,
                                         const TableInfo& table,
                                         std::int64_t id) {
    auto keys = std::make_shared<const KeyTable>(id);
    auto rows = std::make_shared<KeyedRows>(session, table, std::move(keys));
    KeyedRows::Row row = rows->Fetch(0);
    if (!row.rows->Has(row.row)) {
        return nullptr;
    }
    return std::make_shared<KeyedRecord>(std::move(rows), 0, std::move(row));
}

}  // namespace zebtell::erp
