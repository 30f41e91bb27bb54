#include "host/errors.h"

#include "base/runtime_error.h"
#include "base/text.h"
#include "host/error_text.h"
#include "markup/escape.h"

namespace zebtell::host {

std::string HexNumber(int number) {
    constexpr std::string_view kDigits = "0123456789ABCDEF";
    auto rest = static_cast<std::uint32_t>(number);
    std::string hex;
    do {
        hex.insert(hex.begin(), kDigits[rest % 16]);
        rest /= 16;
    } while (rest != 0);
    return hex;
}

std::string UserPart(const SessionState& state) {
    return state.logon.LoggedOn ? base::WithoutControls(state.logon.UserName) : "[No user]";
}

ErrorText DescribeError(const std::exception& error) {
    const base::RuntimeError described = base::AsRuntimeError(error);
    const bool own = dynamic_cast<const base::RuntimeError*>(&error) != nullptr;
    // What the portal's own descriptions quote is escaped already; a library's text may hold
    // anything. Neither may begin a tag, or what looks like another entry of the log.
    const std::string text = base::WithoutControls(described.description());
    return {HexNumber(described.number()) + " (" + std::to_string(described.number()) + ")",
            own ? base::Replaced(base::Replaced(text, "<", "&lt;"), ">", "&gt;")
                : markup::Escaped(text)};
}

void WriteErrorPage(SessionState& state, web::Call& call, const std::exception& error) {
    const ErrorText text = DescribeError(error);
    call.response.Clear();
    call.response.Write(
        "<html>\r\n"
        "<head><title>ZEB/Server error</title></head>\r\n"
        "<body>\r\n"
        "<p><b>ZEB/Server error #" +
        text.number +
        "</b></p>\r\n"
        "<p>" +
        text.description +
        "</p>\r\n"
        "<hr noshade size=1>\r\n"
        "<p>Please contact with system administrator</p>\r\n"
        "</body>\r\n");
    WriteLog(
        state, UserPart(state) + " error #" + text.number + "\r\n" + text.description, log_Normal);
}

void ShowPage(SessionState& state, web::Call& call) {
    SetNoCache(call);
    OrErrorPage(state, call, [&] { call.WriteTemplate(); });
}

void LogHandlerError(const SessionState& state,
                     std::string_view handler,
                     const std::exception& error) {
    WriteLog(
        state, std::string(handler) + " error:" + DescribeError(error).description, log_Detail);
}

}  // namespace zebtell::host
