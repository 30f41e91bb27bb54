#include "erp/sqlite/like.h"

#include <algorithm>
#include <cstring>

#include "base/text.h"

namespace zebtell::erp::sqlite {
namespace {

constexpr char kAnyRun = static_cast<char>(0xFF);
constexpr char kAnyOne = static_cast<char>(0xFE);

bool IsAscii(std::string_view text) {
    return std::all_of(
        text.begin(), text.end(), [](char c) { return static_cast<unsigned char>(c) < 0x80; });
}

// The folded text, in a buffer that lives until the thread's next call.
std::string_view Folded(std::string_view text) {
    thread_local std::string buffer;
    if (!IsAscii(text)) {
        buffer = base::Lower(text);
        return buffer;
    }
    buffer.resize(text.size());
    std::transform(text.begin(), text.end(), buffer.begin(), [](char c) {
        return c >= 'A' && c <= 'Z' ? static_cast<char>(c + ('a' - 'A')) : c;
    });
    return buffer;
}

const char* AfterCharacter(const char* at, const char* end) {
    ++at;
    while (at < end && (static_cast<unsigned char>(*at) & 0xC0) == 0x80) {
        ++at;
    }
    return at;
}

// Where a match of what follows a run could begin: at the next byte that the pattern wants.
const char* NextStart(const char* at, const char* end, const char* wanted, const char* last) {
    if (wanted == last || *wanted == kAnyOne) {
        return at;
    }
    const void* found = std::memchr(at, *wanted, static_cast<std::size_t>(end - at));
    return found ? static_cast<const char*>(found) : end;
}

}  // namespace

LikePattern::LikePattern(std::string_view pattern) {
    const std::string folded(Folded(pattern));
    for (std::size_t i = 0; i < folded.size(); ++i) {
        if (folded[i] == '\\' && i + 1 < folded.size()) {
            marks_ += folded[++i];
        } else if (folded[i] == '_') {
            marks_ += kAnyOne;
        } else if (folded[i] != '%') {
            marks_ += folded[i];
        } else if (marks_.empty() || marks_.back() != kAnyRun) {
            marks_ += kAnyRun;
        }
    }
}

// Goes forward only and, where it fails, tries the last run one character longer, so it takes time
// in proportion to text times pattern at the worst.
bool LikePattern::Matches(std::string_view text) const {
    const std::string_view folded = Folded(text);
    const char* at = folded.data();
    const char* const end = at + folded.size();
    const char* wanted = marks_.data();
    const char* const last = wanted + marks_.size();
    const char* after_run = nullptr;
    const char* retry = nullptr;
    while (true) {
        if (wanted < last && *wanted == kAnyRun) {
            if (++wanted == last) {
                return true;
            }
            after_run = wanted;
            retry = at = NextStart(at, end, wanted, last);
        } else if (at == end) {
            return wanted == last;
        } else if (wanted < last && (*wanted == kAnyOne || *wanted == *at)) {
            at = *wanted++ == kAnyOne ? AfterCharacter(at, end) : at + 1;
        } else if (after_run && retry < end) {
            wanted = after_run;
            retry = at = NextStart(AfterCharacter(retry, end), end, wanted, last);
        } else {
            return false;
        }
    }
}

}  // namespace zebtell::erp::sqlite
