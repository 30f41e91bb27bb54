#pragma once

#include <memory>
#include <optional>
#include <string>
#include <string_view>
#include <variant>
#include <vector>

#include "base/value.h"
#include "data/data_application.h"

namespace zebtell::data {

// A page's named query over one table or view: it runs when its records are first asked for and
// keeps them until a new filter value, a new order or Requery drops them. Values go into the SQL
// text as they are; the DataApplication checks the text and binds what it may show.
class clsQuery {
  public:
    using FilterValue = std::variant<base::Value, std::vector<base::Value>>;

    std::string Query;     // table or view
    std::string Mode;      // "list": the filter is a list of values
    std::string Context;   // the page that defined it
    std::string Criteria;  // the filter's column; empty: no filter
    std::string Master;
    FilterValue MasterValue;
    std::string MasterQ;
    int RecNo = 1;
    DataApplication* ZEBApp = nullptr;  // not owned; null once the user is logged off

    bool notCreated() const { return !records_; }

    std::string Order() const;
    void SetOrder(std::string_view order);

    bool Requery();

    // RuntimeError 91 without an application, else what the database reports.
    std::shared_ptr<RecordList> Records(const std::optional<FilterValue>& CritValue = {});

  private:
    std::string SqlText() const;

    std::string order_;
    std::shared_ptr<RecordList> records_;
};

}  // namespace zebtell::data
