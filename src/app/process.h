#pragma once

#include <cstddef>

namespace zebtell::app {

// Lets this process open as many files as it may, and returns how many connections that leaves
// room for beside databases, templates and the log: at most `wanted`.
std::size_t MakeRoomForConnections(std::size_t wanted);

bool IsRoot();

}  // namespace zebtell::app
