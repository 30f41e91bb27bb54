#pragma once

#include <cstddef>
#include <memory>
#include <string>
#include <string_view>
#include <vector>

namespace zebtell::web {

struct Field {
    std::string name;
    std::string value;
};

// Posted or query-string fields in posting order. Names ignore case.
class FieldList {
  public:
    FieldList() = default;
    explicit FieldList(std::vector<Field> fields);

    std::size_t Count() const { return fields_.size(); }
    const Field& Item(std::size_t index) const;  // from 1; RuntimeError 9 outside
    bool Has(std::string_view name) const;
    // Several values of one name are joined with ", "; "" when there is none. A look-up, also
    // among thousands of fields.
    std::string operator[](std::string_view name) const;

    auto begin() const { return fields_.begin(); }
    auto end() const { return fields_.end(); }

  private:
    struct Index;
    std::vector<Field> fields_;
    std::shared_ptr<const Index> index_;
};

}  // namespace zebtell::web
