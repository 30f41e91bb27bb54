#include "erp/sqlite/functions.h"

#include <exception>
#include <memory>
#include <string_view>

#include "erp/sqlite/errors.h"
#include "erp/sqlite/like.h"
#include "erp/sqlite/round.h"

namespace zebtell::erp::sqlite {
namespace {

bool HasNull(sqlite3_value** arguments) {
    return sqlite3_value_type(arguments[0]) == SQLITE_NULL ||
           sqlite3_value_type(arguments[1]) == SQLITE_NULL;
}

void Round(sqlite3_context* context, int, sqlite3_value** arguments) {
    if (!HasNull(arguments)) {
        sqlite3_result_double(
            context,
            RoundedHalfAway(sqlite3_value_double(arguments[0]), sqlite3_value_int(arguments[1])));
    }
}

void Divide(sqlite3_context* context, int, sqlite3_value** arguments) {
    const double divisor = sqlite3_value_double(arguments[1]);
    if (!HasNull(arguments) && divisor != 0) {
        sqlite3_result_double(context, sqlite3_value_double(arguments[0]) / divisor);
    }
}

std::string_view TextOf(sqlite3_value* value) {
    const auto* text = reinterpret_cast<const char*>(sqlite3_value_text(value));
    return {text ? text : "", static_cast<std::size_t>(sqlite3_value_bytes(value))};
}

void FreePattern(void* pattern) {
    const std::unique_ptr<LikePattern> freed(static_cast<LikePattern*>(pattern));
}

// SQLite keeps the prepared pattern for as long as the argument is the same constant.
void Like(sqlite3_context* context, int, sqlite3_value** arguments) try {
    if (HasNull(arguments)) {
        return;
    }
    const std::string_view text = TextOf(arguments[0]);
    if (const auto* kept = static_cast<LikePattern*>(sqlite3_get_auxdata(context, 1))) {
        sqlite3_result_int(context, kept->Matches(text) ? 1 : 0);
        return;
    }
    auto pattern = std::make_unique<LikePattern>(TextOf(arguments[1]));
    sqlite3_result_int(context, pattern->Matches(text) ? 1 : 0);
    sqlite3_set_auxdata(context, 1, pattern.release(), FreePattern);
} catch (const std::exception&) {
    sqlite3_result_error_nomem(context);  // nothing else can fail here
}

struct Function {
    const char* name;
    void (*call)(sqlite3_context*, int, sqlite3_value**);
};

constexpr Function kFunctions[] = {{"erp_round", Round}, {"erp_div", Divide}, {"erp_like", Like}};

}  // namespace

void RegisterFunctions(sqlite3* database) {
    constexpr int kFlags = SQLITE_UTF8 | SQLITE_DETERMINISTIC | SQLITE_INNOCUOUS;
    for (const Function& function : kFunctions) {
        Check(database,
              sqlite3_create_function_v2(database,
                                         function.name,
                                         2,
                                         kFlags,
                                         nullptr,
                                         function.call,
                                         nullptr,
                                         nullptr,
                                         nullptr));
    }
}

}  // namespace zebtell::erp::sqlite
