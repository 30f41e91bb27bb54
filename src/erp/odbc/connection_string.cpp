#include "erp/odbc/connection_string.h"

#include <algorithm>
#include <array>
#include <vector>

#include "base/text.h"

namespace zebtell::erp::odbc {
namespace {

constexpr std::array<std::string_view, 6> kLoginKeys = {
    "UID", "User", "User ID", "Trusted_Connection", "Integrated Security", "Authentication"};

// The keys of "Key=value;Key={a value;with }} marks}".
std::vector<std::string_view> KeysOf(std::string_view text) {
    std::vector<std::string_view> keys;
    std::size_t at = 0;
    while (at < text.size()) {
        const std::size_t equals = text.find('=', at);
        if (equals == std::string_view::npos) {
            break;
        }
        keys.push_back(base::Trimmed(text.substr(at, equals - at)));
        std::size_t end = equals + 1;
        if (end < text.size() && text[end] == '{') {
            for (++end; end < text.size(); ++end) {
                if (text[end] == '}' && text.substr(end, 2) != "}}") {
                    break;
                }
                end += text[end] == '}' ? 1 : 0;
            }
        }
        const std::size_t mark = text.find(';', std::min(end, text.size()));
        at = mark == std::string_view::npos ? text.size() : mark + 1;
    }
    return keys;
}

std::string Braced(std::string_view value) {
    return "{" + base::Replaced(value, "}", "}}") + "}";
}

}  // namespace

std::string ConnectionString(std::string_view path) {
    const std::string_view trimmed = base::Trimmed(path);
    return std::string(trimmed.find('=') == std::string_view::npos ? "DSN=" : "") +
           std::string(trimmed);
}

bool HasLogin(std::string_view connection_string) {
    const auto keys = KeysOf(connection_string);
    return std::any_of(keys.begin(), keys.end(), [](std::string_view key) {
        return std::any_of(kLoginKeys.begin(), kLoginKeys.end(), [key](std::string_view login) {
            return base::EqualNoCase(key, login);
        });
    });
}

std::string WithLogin(std::string_view connection_string,
                      std::string_view user,
                      std::string_view password) {
    std::string text(connection_string);
    text += text.empty() || text.back() == ';' ? "" : ";";
    return text + "UID=" + Braced(user) + ";PWD=" + Braced(password);
}

}  // namespace zebtell::erp::odbc
