#pragma once

#include <cstddef>
#include <cstdint>
#include <memory>
#include <mutex>
#include <optional>
#include <string>
#include <string_view>
#include <unordered_map>
#include <vector>

#include "base/text.h"

namespace zebtell::erp {

// The names of a result's columns, shared by all rows that have them. Names ignore case; of equal
// names the first counts. A page asks for hundreds of fields, mostly written as they are here.
class FieldSet {
  public:
    explicit FieldSet(std::vector<std::string> names);

    std::optional<std::size_t> Find(std::string_view name) const;
    const std::vector<std::string>& names() const { return names_; }
    std::size_t size() const { return names_.size(); }

  private:
    std::size_t PlaceOf(std::string_view name) const;

    std::vector<std::string> names_;
    // Open addressing: the name's number plus 1, 0 for free places.
    std::vector<std::uint32_t> places_;
};

// The fields that each table's records were asked for so far, so that the next page reads them
// together with the rows. Begins with the key "ID" and the table's own columns. Thread-safe.
class LearnedFields {
  public:
    // `own_columns` makes the start of a table that is new here.
    template <class OwnColumns>
    std::shared_ptr<const FieldSet> Of(const std::string& table, OwnColumns&& own_columns) {
        if (auto known = Known(table)) {
            return known;
        }
        return Start(table, own_columns());
    }

    // Keeps a set that has proved to be readable, unless another thread has learned more.
    void Learn(const std::string& table, std::shared_ptr<const FieldSet> fields);

  private:
    std::shared_ptr<const FieldSet> Known(const std::string& table) const;
    std::shared_ptr<const FieldSet> Start(const std::string& table, std::vector<std::string> own);

    mutable std::mutex mutex_;
    std::unordered_map<std::string, std::shared_ptr<const FieldSet>> tables_;
};

}  // namespace zebtell::erp
