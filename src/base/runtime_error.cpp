#include "base/runtime_error.h"

namespace zebtell::base {

namespace {

struct Description {
    int number;
    const char* text;
};

constexpr Description kDescriptions[] = {
    {errors::kInvalidCall, "Invalid procedure call or argument"},
    {errors::kOverflow, "Overflow"},
    {errors::kSubscript, "Subscript out of range"},
    {errors::kDivisionByZero, "Division by zero"},
    {errors::kTypeMismatch, "Type mismatch"},
    {errors::kObjectNotSet, "Object not set"},
    {errors::kInvalidPattern, "Invalid pattern"},
    {errors::kInvalidNull, "Invalid use of null"},
    {errors::kStatementFailed, "The statement failed"},
    {errors::kNoSuchTable, "No such table"},
    {errors::kLogonFailed, "Logon failed"},
    {errors::kUnspecified, "Unspecified error"},
};

std::string UsualDescription(int number) {
    for (const Description& row : kDescriptions) {
        if (row.number == number) return row.text;
    }
    return "Error " + std::to_string(number);
}

}  // namespace

RuntimeError::RuntimeError(int number) : RuntimeError(number, UsualDescription(number)) {}

RuntimeError::RuntimeError(int number, const std::string& description)
    : std::runtime_error(description), number_(number) {}

RuntimeError AsRuntimeError(const std::exception& error) {
    if (const auto* own = dynamic_cast<const RuntimeError*>(&error)) return *own;
    return {errors::kUnspecified, error.what()};
}

}  // namespace zebtell::base
