#pragma once

#include <stdexcept>
#include <string>

namespace zebtell::base {

// The numbers that errors carry into the log and onto the error page.
namespace errors {
inline constexpr int kInvalidCall = 5;
inline constexpr int kOverflow = 6;
inline constexpr int kSubscript = 9;
inline constexpr int kDivisionByZero = 11;
inline constexpr int kTypeMismatch = 13;
inline constexpr int kObjectNotSet = 91;
inline constexpr int kInvalidPattern = 93;
inline constexpr int kInvalidNull = 94;
inline constexpr int kStatementFailed = static_cast<int>(0x80040E14U);
inline constexpr int kNoSuchTable = static_cast<int>(0x80040E37U);
inline constexpr int kLogonFailed = static_cast<int>(0x80040E4DU);
inline constexpr int kUnspecified = static_cast<int>(0x80004005U);
}  // namespace errors

// An error that ends a page event. what() is the description that the log and the error page show;
// it never holds passwords, and text from people only where that is HTML-escaped already.
class RuntimeError : public std::runtime_error {
  public:
    // The number's usual description ("Type mismatch").
    explicit RuntimeError(int number);
    RuntimeError(int number, const std::string& description);

    int number() const { return number_; }
    std::string description() const { return what(); }

  private:
    int number_;
};

// The error of any exception: its own number, else kUnspecified.
RuntimeError AsRuntimeError(const std::exception& error);

}  // namespace zebtell::base
