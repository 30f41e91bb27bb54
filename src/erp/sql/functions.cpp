#include "erp/sql/functions.h"

#include <unordered_map>

#include "base/text.h"

namespace zebtell::erp::sql {
namespace {

using enum ValueType;

constexpr std::size_t kMany = 100;

// clang-format off
constexpr Function kFunctions[] = {
    // name           arguments  result   aggregate  SQLite                                  SQL Server
    {"isnull",            2, 2, kUnknown, false, "ifnull($1, $2)",                          "isnull($1, $2)"},
    {"ifnull",            2, 2, kUnknown, false, "ifnull($1, $2)",                          "isnull($1, $2)"},
    {"coalesce",      2, kMany, kUnknown, false, "coalesce($*)",                            "coalesce($*)"},
    {"nullif",            2, 2, kUnknown, false, "nullif($1, $2)",                          "nullif($1, $2)"},
    // The cast ends binary fractions that miss a half by their last bit.
    {"round",             2, 2, kNumber,  false, "erp_round($1, @2)",                       "round(cast($1 as decimal(28, 10)), @2)"},
    {"abs",               1, 1, kNumber,  false, "abs($1)",                                 "abs($1)"},
    {"upper",             1, 1, kText,    false, "upper($1)",                               "upper($1)"},
    {"lower",             1, 1, kText,    false, "lower($1)",                               "lower($1)"},
    {"len",               1, 1, kNumber,  false, "length(rtrim($1))",                       "len($1)"},
    {"substring",         3, 3, kText,    false, "substr($1, $2, $3)",                      "substring($1, $2, $3)"},
    {"left",              2, 2, kText,    false, "substr($1, 1, $2)",                       "left($1, $2)"},
    {"right",             2, 2, kText,    false, "substr($1, -@2, @2)",                     "right($1, @2)"},
    {"ltrim",             1, 1, kText,    false, "ltrim($1)",                               "ltrim($1)"},
    {"rtrim",             1, 1, kText,    false, "rtrim($1)",                               "rtrim($1)"},
    {"replace",           3, 3, kText,    false, "replace($1, $2, $3)",                     "replace($1, $2, $3)"},
    {"count",             1, 1, kNumber,  true,  "count($1)",                               "count_big($1)"},
    {"sum",               1, 1, kNumber,  true,  "sum($1)",                                 "sum($1)"},
    {"min",               1, 1, kUnknown, true,  "min($1)",                                 "min($1)"},
    {"max",               1, 1, kUnknown, true,  "max($1)",                                 "max($1)"},
    {"avg",               1, 1, kNumber,  true,  "avg($1)",                                 "avg($1 * 1.0)"},
    {"getdate",           0, 0, kDate,    false, "datetime('now', 'localtime')",            "getdate()"},
    {"year",              1, 1, kNumber,  false, "cast(strftime('%Y', $1) as integer)",     "year($1)"},
    {"month",             1, 1, kNumber,  false, "cast(strftime('%m', $1) as integer)",     "month($1)"},
    {"day",               1, 1, kNumber,  false, "cast(strftime('%d', $1) as integer)",     "day($1)"},
    // Dates are stored without their time when it is midnight.
    {"dateadd day",       2, 2, kDate,    false, "replace(datetime($2, ($1) || ' days'), ' 00:00:00', '')",   "dateadd(day, $1, $2)"},
    {"dateadd month",     2, 2, kDate,    false, "replace(datetime($2, ($1) || ' months'), ' 00:00:00', '')", "dateadd(month, $1, $2)"},
    {"dateadd year",      2, 2, kDate,    false, "replace(datetime($2, ($1) || ' years'), ' 00:00:00', '')",  "dateadd(year, $1, $2)"},
    {"datediff day",      2, 2, kNumber,  false, "cast(julianday(date($2)) - julianday(date($1)) as integer)", "datediff(day, $1, $2)"},
    // From one first of a month to another, so that the mean month divides them well enough.
    {"datediff month",    2, 2, kNumber,  false, "cast(round((julianday(date($2, 'start of month')) - julianday(date($1, 'start of month'))) / 30.436875) as integer)", "datediff(month, $1, $2)"},
    {"datediff year",     2, 2, kNumber,  false, "(strftime('%Y', $2) - strftime('%Y', $1))",               "datediff(year, $1, $2)"},
};

constexpr CastType kCastTypes[] = {
    {"int",      0, kNumber, "cast($1 as integer)",              "cast($1 as int)"},
    {"integer",  0, kNumber, "cast($1 as integer)",              "cast($1 as int)"},
    {"bigint",   0, kNumber, "cast($1 as integer)",              "cast($1 as bigint)"},
    {"float",    0, kNumber, "cast($1 as real)",                 "cast($1 as float)"},
    {"real",     0, kNumber, "cast($1 as real)",                 "cast($1 as float)"},
    {"money",    0, kNumber, "erp_round($1, 4)",                 "cast($1 as money)"},
    {"decimal",  2, kNumber, "erp_round($1, @2)",                "cast($1 as decimal(@1, @2))"},
    {"numeric",  2, kNumber, "erp_round($1, @2)",                "cast($1 as decimal(@1, @2))"},
    {"varchar",  1, kText,   "substr(cast($1 as text), 1, @1)",  "cast($1 as nvarchar(@1))"},
    {"nvarchar", 1, kText,   "substr(cast($1 as text), 1, @1)",  "cast($1 as nvarchar(@1))"},
    {"date",     0, kDate,   "date($1)",                         "cast($1 as date)"},
    {"datetime", 0, kDate,   "replace(datetime($1), ' 00:00:00', '')", "cast($1 as datetime)"},
};
// clang-format on

using FunctionsByName =
    std::unordered_map<std::string_view, const Function*, base::NoCaseHash, base::NoCaseEqual>;

FunctionsByName MakeFunctionsByName() {
    FunctionsByName functions;
    for (const Function& function : kFunctions) {
        functions.emplace(function.name, &function);
    }
    return functions;
}

}  // namespace

const Function* FindFunction(std::string_view name) {
    static const FunctionsByName functions = MakeFunctionsByName();
    const auto found = functions.find(name);
    return found == functions.end() ? nullptr : found->second;
}

const CastType* FindCastType(std::string_view name, std::size_t numbers) {
    for (const CastType& type : kCastTypes) {
        if (type.numbers == numbers && base::EqualNoCase(type.name, name)) {
            return &type;
        }
    }
    return nullptr;
}

}  // namespace zebtell::erp::sql
