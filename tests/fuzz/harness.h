#pragma once

#include <cstdint>
#include <string>
#include <string_view>

namespace zebtell::fuzz {

// What a target does with one input. Each target defines it; an exception that it lets out is a
// fault.
void Try(std::string_view input);

// Ends the program, so that the input is kept, unless the claim holds.
void Claim(bool holds, std::string_view claim, std::string_view about = {});

// Takes the first line of an input, without its end. Inputs are text, so that a corpus can be read.
std::string_view TakeLine(std::string_view& input);

}  // namespace zebtell::fuzz
