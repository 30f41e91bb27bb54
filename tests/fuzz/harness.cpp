#include "tests/fuzz/harness.h"

#include <algorithm>
#include <cstdlib>
#include <iostream>

namespace zebtell::fuzz {

void Claim(bool holds, std::string_view claim, std::string_view about) {
    if (holds) return;
    std::cerr << "This does not hold: " << claim << "\n" << about << std::endl;
    std::abort();
}

std::string_view TakeLine(std::string_view& input) {
    const std::size_t end = std::min(input.find('\n'), input.size());
    const auto line = input.substr(0, end);
    input.remove_prefix(std::min(end + 1, input.size()));
    return line;
}

}  // namespace zebtell::fuzz

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    zebtell::fuzz::Try({reinterpret_cast<const char*>(data), size});
    return 0;
}
