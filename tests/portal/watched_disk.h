#pragma once

#include <atomic>

namespace zebtell {

// The disk under SQLite, as this program sees it: the write-ahead logs of all databases opened
// after the first use are watched, and fail when asked to.
struct WatchedDisk {
    std::atomic<int> syncs = 0;
    std::atomic<int> unsynced_writes = 0;  // since the last sync
    // Writes and syncs of a file whose sync has failed: what it holds is not known any more.
    std::atomic<int> uses_in_doubt = 0;
    std::atomic<int> failing_syncs = 0;  // so many syncs from now on fail
    std::atomic<bool> full = false;      // writes find no room

    static WatchedDisk& Get();
};

}  // namespace zebtell
