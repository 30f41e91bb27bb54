#include "erp/odbc/errors.h"

#include <algorithm>
#include <cctype>
#include <string>
#include <string_view>
#include <vector>

#include "base/runtime_error.h"
#include "base/text.h"
#include "erp/connection.h"
#include "erp/odbc/utf16.h"
#include "erp/sql/errors.h"

namespace zebtell::erp::odbc {
namespace {

using base::errors::kInvalidCall;
using base::errors::kNoSuchTable;
using base::errors::kStatementFailed;
using base::errors::kUnspecified;

struct Diagnostic {
    std::string state;  // five characters
    SQLINTEGER native = 0;
    std::string words;
};

enum class Effect { kNone, kBroken, kLost, kDeadlock, kLoginRefused };

// What a native error of SQL Server means, or a state (or how it begins) of any driver. The first
// row that fits counts.
struct Meaning {
    SQLINTEGER native;
    std::string_view state;
    int number;
    Effect effect;
    const char* description;
};

constexpr const char* kLost = "The connection to the database was lost";
constexpr const char* kBusy = "The database is busy";
constexpr const char* kRights = "The portal's database user may not do that";
constexpr const char* kConflict = "The record conflicts with another one";
constexpr const char* kFull = "There is no room left for the company database";
constexpr const char* kTooLong = "A text is longer than its column";

constexpr Meaning kMeanings[] = {
    {1205, "", kUnspecified, Effect::kDeadlock, kBusy},
    {1222, "", kUnspecified, Effect::kNone, kBusy},
    {18456, "", kUnspecified, Effect::kLoginRefused, ""},
    {18452, "", kUnspecified, Effect::kLoginRefused, ""},
    {18470, "", kUnspecified, Effect::kLoginRefused, ""},  // disabled
    {18486, "", kUnspecified, Effect::kLoginRefused, ""},  // locked out
    {18487, "", kUnspecified, Effect::kLoginRefused, ""},  // password expired
    {18488, "", kUnspecified, Effect::kLoginRefused, ""},  // password must be changed
    {4060, "", kUnspecified, Effect::kBroken, "The company database is not there"},
    {229, "", kUnspecified, Effect::kNone, kRights},
    {230, "", kUnspecified, Effect::kNone, kRights},
    {1105, "", kUnspecified, Effect::kNone, kFull},
    {9002, "", kUnspecified, Effect::kNone, kFull},
    {3906, "", kStatementFailed, Effect::kNone, "The database may not be written to"},
    {2628, "", kInvalidCall, Effect::kNone, kTooLong},
    {8152, "", kInvalidCall, Effect::kNone, kTooLong},
    {0, "40001", kUnspecified, Effect::kDeadlock, kBusy},
    {0, "40P01", kUnspecified, Effect::kDeadlock, kBusy},
    {0, "28", kUnspecified, Effect::kLoginRefused, ""},
    {0, "HYT", kStatementFailed, Effect::kBroken, "The statement took too long"},
    {0, "57014", kStatementFailed, Effect::kBroken, "The statement took too long"},
    {0, "08", kUnspecified, Effect::kLost, kLost},
    {0, "57P", kUnspecified, Effect::kLost, kLost},  // the server is being shut down
    {0, "22001", kInvalidCall, Effect::kNone, kTooLong},
    {0, "23", kStatementFailed, Effect::kNone, kConflict},
    {0, "42501", kUnspecified, Effect::kNone, kRights},
    {0, "25006", kStatementFailed, Effect::kNone, "The database may not be written to"},
    {0, "55P03", kUnspecified, Effect::kNone, kBusy},
    {0, "42S02", kNoSuchTable, Effect::kNone, ""},
};

std::vector<Diagnostic> Diagnostics(SQLSMALLINT type, SQLHANDLE handle) {
    constexpr SQLSMALLINT kMost = 10;
    std::vector<Diagnostic> diagnostics;
    for (SQLSMALLINT record = 1; record <= kMost; ++record) {
        std::u16string state(6, u'\0');
        std::u16string words(1024, u'\0');
        SQLINTEGER native = 0;
        SQLSMALLINT length = 0;
        const SQLRETURN code = SQLGetDiagRecW(type,
                                              handle,
                                              record,
                                              Wide(state),
                                              &native,
                                              Wide(words),
                                              static_cast<SQLSMALLINT>(words.size()),
                                              &length);
        if (!Succeeded(code)) {
            break;
        }
        words.resize(std::min<std::size_t>(words.size() - 1, static_cast<std::size_t>(length)));
        state.resize(5);
        diagnostics.push_back({FromUtf16(state), native, FromUtf16(words)});
    }
    return diagnostics;
}

const Meaning* MeaningOf(const Diagnostic& diagnostic) {
    for (const Meaning& meaning : kMeanings) {
        if (meaning.native != 0 ? meaning.native == diagnostic.native
                                : diagnostic.state.starts_with(meaning.state)) {
            return &meaning;
        }
    }
    return nullptr;
}

// The words without the "[vendor][driver]" in front.
std::string_view WordsOf(const std::vector<Diagnostic>& diagnostics) {
    std::string_view words = diagnostics.empty() ? "" : std::string_view(diagnostics[0].words);
    while (words.starts_with('[') && words.find(']') != std::string_view::npos) {
        words.remove_prefix(words.find(']') + 1);
    }
    return base::Trimmed(words);
}

// What stands in quotes behind a word: column 'Explanation'.
std::string_view Quoted(std::string_view words, std::string_view behind) {
    const std::size_t at = words.find(std::string(behind) + " '");
    if (at == std::string_view::npos) {
        return {};
    }
    const std::size_t begin = at + behind.size() + 2;
    return words.substr(begin, words.find('\'', begin) - begin);
}

[[noreturn]] void FailWith(const Meaning& meaning, std::string_view words) {
    switch (meaning.effect) {
        case Effect::kLost:
            throw TransientError(TransientError::Kind::kConnectionLost, meaning.description);
        case Effect::kDeadlock:
            throw TransientError(TransientError::Kind::kDeadlock, meaning.description);
        case Effect::kLoginRefused:
            throw LoginRefused();
        default:
            break;
    }
    if (meaning.number == kNoSuchTable) {
        sql::FailNoTable(words);
    }
    const std::string_view column =
        meaning.description == std::string_view(kTooLong) ? Quoted(words, "column") : "";
    throw base::RuntimeError(
        meaning.number,
        column.empty() ? meaning.description : std::string(column) + " is too long");
}

bool IsDead(SQLHDBC handle) {
    SQLUINTEGER dead = SQL_CD_FALSE;
    return Succeeded(SQLGetConnectAttrW(handle, SQL_ATTR_CONNECTION_DEAD, &dead, 0, nullptr)) &&
           dead == SQL_CD_TRUE;
}

}  // namespace

void Fail(Link& link, SQLSMALLINT type, SQLHANDLE handle) {
    const std::vector<Diagnostic> diagnostics = Diagnostics(type, handle);
    const Meaning* found = nullptr;
    for (const Diagnostic& diagnostic : diagnostics) {
        found = found ? found : MeaningOf(diagnostic);
    }
    static constexpr Meaning kDead{0, "08", kUnspecified, Effect::kLost, kLost};
    if ((!found || found->effect == Effect::kNone) && IsDead(link.handle)) {
        found = &kDead;
    }
    link.broken |= found && found->effect != Effect::kNone && found->effect != Effect::kDeadlock;
    if (found) {
        FailWith(*found, WordsOf(diagnostics));
    }
    sql::Fail("The statement failed", WordsOf(diagnostics));
}

void FailToConnect(SQLHDBC handle) {
    for (const Diagnostic& diagnostic : Diagnostics(SQL_HANDLE_DBC, handle)) {
        const Meaning* meaning = MeaningOf(diagnostic);
        if (meaning && (meaning->effect == Effect::kLoginRefused || meaning->native != 0)) {
            FailWith(*meaning, "");
        }
    }
    throw base::RuntimeError(kUnspecified, "The database server does not answer");
}

}  // namespace zebtell::erp::odbc
