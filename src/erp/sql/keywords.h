#pragma once

#include <cstdint>
#include <string_view>

namespace zebtell::erp::sql {

// The words that the grammar knows. Those up to kLastReserved are no names unless quoted; the
// others are names wherever a name may stand.
enum class Keyword : std::uint8_t {
    kNone,
    kSelect,
    kDistinct,
    kFrom,
    kAs,
    kInner,
    kLeft,
    kCross,
    kJoin,
    kOn,
    kWhere,
    kGroup,
    kBy,
    kHaving,
    kOrder,
    kAsc,
    kDesc,
    kAnd,
    kOr,
    kNot,
    kLike,
    kIn,
    kBetween,
    kIs,
    kNull,
    kExists,
    kCase,
    kWhen,
    kThen,
    kElse,
    kEnd,
    kTop,
    kWith,
    kOuter,
    kOther,  // words of other statements and clauses, which nothing here understands
    kLastReserved = kOther,
    kCast,
    kConvert,
    kTrue,
    kFalse,
};

// kNone for words that are names only. Ignores case.
Keyword KeywordOf(std::string_view word);

inline bool IsReserved(Keyword keyword) {
    return keyword != Keyword::kNone && keyword <= Keyword::kLastReserved;
}

}  // namespace zebtell::erp::sql
