#include "tests/portal/watched_disk.h"

#include <sqlite3.h>

#include <mutex>
#include <set>
#include <stdexcept>

namespace zebtell {
namespace {

sqlite3_vfs* usual;
sqlite3_io_methods usual_methods;
sqlite3_io_methods watched_methods;
std::mutex mutex;
std::set<sqlite3_file*> in_doubt;

void NoteUse(sqlite3_file* file) {
    const std::lock_guard lock(mutex);
    if (in_doubt.contains(file)) ++WatchedDisk::Get().uses_in_doubt;
}

int Write(sqlite3_file* file, const void* bytes, int count, sqlite3_int64 offset) {
    NoteUse(file);
    if (WatchedDisk::Get().full) return SQLITE_FULL;
    ++WatchedDisk::Get().unsynced_writes;
    return usual_methods.xWrite(file, bytes, count, offset);
}

int Sync(sqlite3_file* file, int flags) {
    NoteUse(file);
    WatchedDisk& disk = WatchedDisk::Get();
    ++disk.syncs;
    if (disk.failing_syncs > 0) {
        --disk.failing_syncs;
        const std::lock_guard lock(mutex);
        in_doubt.insert(file);
        return SQLITE_IOERR_FSYNC;
    }
    disk.unsynced_writes = 0;
    return usual_methods.xSync(file, flags);
}

int Close(sqlite3_file* file) {
    {
        const std::lock_guard lock(mutex);
        in_doubt.erase(file);
    }
    return usual_methods.xClose(file);
}

// The usual functions find their own file behind their own or any other table of methods.
int Open(sqlite3_vfs*, const char* name, sqlite3_file* file, int flags, int* out_flags) {
    const int code = usual->xOpen(usual, name, file, flags, out_flags);
    if (code != SQLITE_OK || (flags & SQLITE_OPEN_WAL) == 0) return code;
    static std::once_flag first;
    std::call_once(first, [file] {
        usual_methods = *file->pMethods;
        watched_methods = usual_methods;
        watched_methods.xWrite = Write;
        watched_methods.xSync = Sync;
        watched_methods.xClose = Close;
    });
    file->pMethods = &watched_methods;
    return code;
}

}  // namespace

WatchedDisk& WatchedDisk::Get() {
    static WatchedDisk disk;
    static sqlite3_vfs vfs;
    static const int registered = [] {
        usual = sqlite3_vfs_find(nullptr);
        vfs = *usual;
        vfs.zName = "watched";
        vfs.xOpen = Open;
        return sqlite3_vfs_register(&vfs, 1);
    }();
    if (registered != SQLITE_OK) throw std::runtime_error("SQLite takes no other disk");
    return disk;
}

}  // namespace zebtell
