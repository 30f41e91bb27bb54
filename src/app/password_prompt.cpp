#include "app/password_prompt.h"

#include <termios.h>
#include <unistd.h>

#include <iostream>
#include <string_view>

#include "base/runtime_error.h"
#include "base/text.h"

namespace zebtell::app {
namespace {

constexpr std::size_t kLeastCharacters = 8;

[[noreturn]] void Refuse(const std::string& why) {
    throw base::RuntimeError(base::errors::kInvalidCall, why);
}

// The terminal shows nothing of what is typed while this is there.
class NoEcho {
  public:
    NoEcho() {
        if (tcgetattr(STDIN_FILENO, &before_) != 0) Refuse("The terminal can't hide a password");
        termios hidden = before_;
        hidden.c_lflag &= ~static_cast<tcflag_t>(ECHO);
        if (tcsetattr(STDIN_FILENO, TCSAFLUSH, &hidden) != 0) {
            Refuse("The terminal can't hide a password");
        }
    }
    ~NoEcho() { tcsetattr(STDIN_FILENO, TCSAFLUSH, &before_); }
    NoEcho(const NoEcho&) = delete;
    NoEcho& operator=(const NoEcho&) = delete;

  private:
    termios before_{};
};

std::string ReadLine() {
    std::string line;
    if (!std::getline(std::cin, line)) Refuse("No password was given");
    if (line.ends_with('\r')) line.pop_back();
    return line;
}

std::string Ask(std::string_view prompt) {
    std::cerr << prompt << ": " << std::flush;
    const NoEcho hidden;
    std::string typed = ReadLine();
    std::cerr << "\n";
    return typed;
}

std::string Typed() {
    std::string password = Ask("New password");
    if (Ask("New password again") != password) Refuse("The two passwords differ");
    return password;
}

}  // namespace

std::string ReadNewPassword(bool may_be_empty) {
    std::string password = isatty(STDIN_FILENO) != 0 ? Typed() : ReadLine();
    if (password.empty() && may_be_empty) return password;
    if (!base::IsValidUtf8(password)) Refuse("The password is not UTF-8 text");
    if (base::CharacterCount(password) < kLeastCharacters) {
        Refuse("A password needs at least " + std::to_string(kLeastCharacters) + " characters");
    }
    return password;
}

}  // namespace zebtell::app
