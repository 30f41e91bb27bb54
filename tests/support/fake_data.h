#pragma once

#include <functional>
#include <initializer_list>
#include <memory>
#include <optional>
#include <string>
#include <string_view>
#include <unordered_map>
#include <utility>
#include <vector>

#include "base/runtime_error.h"
#include "base/text.h"
#include "data/data_application.h"

// A company database in memory, scripted by the test: no SQL is understood, every text that asks
// for data is recorded.
namespace zebtell::fake {

template <class T>
using NoCaseMap = std::unordered_map<std::string, T, base::NoCaseHash, base::NoCaseEqual>;

class List;

class Record : public data::Record {
  public:
    Record(std::initializer_list<std::pair<const std::string, base::Value>> fields = {},
           int status = 0)
        : fields(fields), status(status) {}

    NoCaseMap<base::Value> fields;  // a dotted path is a name like any other
    NoCaseMap<std::shared_ptr<List>> children;
    int status = 0;
    int updates = 0;
    bool deleted = false;
    std::function<void(Record&)> on_update;  // what the database would recalculate

    base::Value GetField(std::string_view name) override {
        const auto found = fields.find(name);
        if (found == fields.end()) throw base::RuntimeError(base::errors::kStatementFailed);
        return found->second;
    }
    void SetField(std::string_view name, const base::Value& value) override {
        fields.insert_or_assign(std::string(name), value);
    }
    std::shared_ptr<data::RecordList> Children(std::string_view table) override;
    void Update(int) override {
        ++updates;
        if (on_update) on_update(*this);
    }
    void Delete() override { deleted = true; }
    bool Status(int mask) override { return (status & mask) == mask; }
};

using Rows = std::vector<std::shared_ptr<Record>>;

class List : public data::RecordList {
  public:
    List() = default;
    explicit List(Rows rows) : rows(std::move(rows)) {}

    Rows rows;
    bool editable = false;  // a document's rows

    std::int64_t Count() override { return static_cast<std::int64_t>(rows.size()); }
    std::shared_ptr<data::Record> Item(std::int64_t index) override {
        if (index < 1 || index > Count()) throw base::RuntimeError(base::errors::kSubscript);
        return rows[static_cast<std::size_t>(index - 1)];
    }
    std::shared_ptr<data::Record> AddRow() override {
        if (!editable) throw base::RuntimeError(base::errors::kInvalidCall);
        return rows.emplace_back(std::make_shared<Record>());
    }
    std::shared_ptr<data::Record> Find(std::string_view criterion) override {
        const std::size_t mark = criterion.find('=');
        for (const auto& row : rows) {
            const auto field = row->fields.find(criterion.substr(0, mark));
            if (field != row->fields.end() &&
                field->second.ToPlainText() == criterion.substr(mark + 1)) {
                return row;
            }
        }
        return nullptr;
    }
};

inline std::shared_ptr<data::RecordList> Record::Children(std::string_view table) {
    const auto found = children.find(table);
    return found == children.end() ? std::make_shared<List>() : found->second;
}

class Document : public data::Document {
  public:
    Document() { rows->editable = true; }

    std::shared_ptr<Record> header = std::make_shared<Record>();
    std::shared_ptr<List> rows = std::make_shared<List>();
    int saves = 0;
    std::optional<base::RuntimeError> save_error;

    base::Value GetField(std::string_view name) override { return header->GetField(name); }
    void SetField(std::string_view name, const base::Value& value) override {
        header->SetField(name, value);
    }
    std::shared_ptr<data::Record> Header() override { return header; }
    std::shared_ptr<data::RecordList> Rows() override { return rows; }
    std::string Key() const override { return "key"; }
    data::Saved Save() override {
        if (save_error) throw *save_error;
        ++saves;
        return data::Saved::kNow;
    }
};

class Table : public data::Table {
  public:
    using Documents = std::vector<std::shared_ptr<Document>>;
    explicit Table(Documents documents) : documents_(std::move(documents)) {}

    std::shared_ptr<data::Document> Open(std::int64_t id) override {
        if (id == 0) return std::make_shared<Document>();
        for (const auto& document : documents_) {
            if (document->GetField("ID") == base::Value(id)) return document;
        }
        throw base::RuntimeError(base::errors::kSubscript);
    }
    std::shared_ptr<data::Document> First() override {
        if (documents_.empty()) throw base::RuntimeError(base::errors::kSubscript);
        return documents_.front();
    }
    std::int64_t FindKey(std::string_view) override { return 0; }

  private:
    Documents documents_;
};

class Application : public data::DataApplication {
  public:
    // By table, or table + "|" + filter where the filter matters.
    NoCaseMap<std::shared_ptr<List>> lists;
    NoCaseMap<Table::Documents> documents;
    // By SQL text; a text that is not here gives the list of `any_query`.
    NoCaseMap<std::shared_ptr<List>> queries;
    std::shared_ptr<List> any_query = std::make_shared<List>();
    // "OpenList GRArticle|ID=1|Code", "OpenQuery select ...", "OpenTable SDOrder|ID=1"
    std::vector<std::string> asked;
    std::optional<base::RuntimeError> error;  // what every opening throws
    std::string user_name, user_password;
    std::shared_ptr<Record> user = std::make_shared<Record>();
    std::int64_t default_link = 0;

    void Initialise(std::string_view,
                    std::string_view,
                    std::string_view,
                    std::string_view) override {}
    std::shared_ptr<data::Record> Logon(data::DatabaseType,
                                        std::string_view,
                                        std::string_view name,
                                        std::string_view password) override {
        if (name != user_name || password != user_password) {
            throw base::RuntimeError(base::errors::kLogonFailed);
        }
        return user;
    }
    std::shared_ptr<data::Record> Load(std::string_view table, std::int64_t id) override {
        return ListOf(table, {})->Find("ID=" + std::to_string(id));
    }
    std::shared_ptr<data::RecordList> OpenList(std::string_view table,
                                               const data::Filter& filter,
                                               std::string_view order) override {
        Ask("OpenList", Joined(Joined(table, filter.text()), order));
        return ListOf(table, filter.text());
    }
    std::shared_ptr<data::RecordList> OpenQuery(std::string_view sql, int, int) override {
        Ask("OpenQuery", std::string(sql));
        const auto found = queries.find(sql);
        return found == queries.end() ? any_query : found->second;
    }
    std::shared_ptr<data::Table> OpenTable(std::string_view table,
                                           const data::Filter& filter) override {
        Ask("OpenTable", Joined(table, filter.text()));
        const auto found = documents.find(Joined(table, filter.text()));
        return std::make_shared<Table>(found == documents.end() ? documents[std::string(table)]
                                                                : found->second);
    }
    std::int64_t DefaultLink(std::string_view, std::string_view) override { return default_link; }

  private:
    static std::string Joined(std::string_view a, std::string_view b) {
        return std::string(a) + "|" + std::string(b);
    }
    void Ask(std::string_view call, const std::string& text) {
        asked.push_back(std::string(call) + " " + text);
        if (error) throw *error;
    }
    std::shared_ptr<List> ListOf(std::string_view table, std::string_view filter) {
        auto found = lists.find(Joined(table, filter));
        if (found == lists.end()) found = lists.find(table);
        if (found == lists.end()) throw base::RuntimeError(base::errors::kNoSuchTable);
        return found->second;
    }
};

using Fields = std::initializer_list<std::pair<const std::string, base::Value>>;

inline std::shared_ptr<Record> MakeRecord(Fields fields, int status = 0) {
    return std::make_shared<Record>(fields, status);
}

// A list of records: MakeList({{{"ID", 1}, {"Name", "a"}}, {{"ID", 2}}}).
inline std::shared_ptr<List> MakeList(std::initializer_list<Fields> records) {
    auto list = std::make_shared<List>();
    for (const Fields& fields : records) list->rows.push_back(MakeRecord(fields));
    return list;
}

}  // namespace zebtell::fake
