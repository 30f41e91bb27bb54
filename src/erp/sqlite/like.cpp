#include "erp/sqlite/like.h"

#include <algorithm>
#include <array>
#include <cstring>

#include "base/text.h"

namespace zebtell::erp::sqlite {
namespace {

constexpr char kAnyRun = static_cast<char>(0xFF);
constexpr char kAnyOne = static_cast<char>(0xFE);

constexpr std::array<char, 256> MakeLowerBytes() {
    std::array<char, 256> bytes{};
    for (int i = 0; i < 256; ++i) {
        bytes[i] = static_cast<char>(i >= 'A' && i <= 'Z' ? i - 'A' + 'a' : i);
    }
    return bytes;
}

constexpr auto kLowerBytes = MakeLowerBytes();

// Folds the letters beyond ASCII; none changes its length.
void FoldLetters(std::string_view text, std::string& buffer) {
    const auto is_ascii = [](char c) { return static_cast<unsigned char>(c) < 0x80; };
    const auto end = text.end();
    for (auto at = text.begin(); at != end;) {
        const auto start = std::find_if_not(at, end, is_ascii);
        at = std::find_if(start, end, is_ascii);
        const std::string lower = base::Lower(std::string_view(start, at));
        lower.copy(buffer.data() + (start - text.begin()), lower.size());
    }
}

// The folded text, in a buffer that lives until the thread's next call. A search folds the names
// of all articles.
std::string_view Folded(std::string_view text) {
    thread_local std::string buffer;
    buffer.resize(text.size());
    char* out = buffer.data();
    unsigned char all = 0;
    for (const char c : text) {
        const auto byte = static_cast<unsigned char>(c);
        all |= byte;
        *out++ = kLowerBytes[byte];
    }
    if (all >= 0x80) {
        FoldLetters(text, buffer);
    }
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
