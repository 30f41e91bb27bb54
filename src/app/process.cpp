#include "app/process.h"

#include <sys/resource.h>
#include <unistd.h>

#include <algorithm>

namespace zebtell::app {
namespace {

constexpr std::size_t kOtherFiles = 256;

}  // namespace

std::size_t MakeRoomForConnections(std::size_t wanted) {
    rlimit files{};
    if (getrlimit(RLIMIT_NOFILE, &files) != 0) return wanted;
    if (files.rlim_cur < files.rlim_max) {
        files.rlim_cur = files.rlim_max;
        if (setrlimit(RLIMIT_NOFILE, &files) != 0) getrlimit(RLIMIT_NOFILE, &files);
    }
    const std::size_t most = std::max<std::size_t>(files.rlim_cur, 2 * kOtherFiles);
    return std::min(wanted, most - kOtherFiles);
}

bool IsRoot() {
    return geteuid() == 0;
}

}  // namespace zebtell::app
