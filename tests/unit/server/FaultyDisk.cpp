#include "tests/unit/server/FaultyDisk.h"

#include <fstream>
#include <new>

namespace ktr::test {

namespace {

constexpr std::size_t kSector = 512;

}  // namespace

/// An open file: what SQLite sees first, then the name, then the real file in the same memory.
struct FaultyDisk::Handle {
    sqlite3_file base;
    FaultyDisk* disk;
    std::string* name;  ///< none for files that no store is made of

    sqlite3_file* real() { return reinterpret_cast<sqlite3_file*>(this + 1); }
    static Handle& of(sqlite3_file* file) { return *reinterpret_cast<Handle*>(file); }
};

/// What SQLite calls.
struct FaultyDisk::Methods {
    static int close(sqlite3_file* file) {
        Handle& handle = Handle::of(file);
        delete handle.name;
        return handle.real()->pMethods->xClose(handle.real());
    }
    static int read(sqlite3_file* file, void* bytes, int size, sqlite3_int64 at) {
        return Handle::of(file).real()->pMethods->xRead(Handle::of(file).real(), bytes, size, at);
    }
    static int write(sqlite3_file* file, const void* bytes, int size, sqlite3_int64 at) {
        Handle& handle = Handle::of(file);
        if (handle.name != nullptr) {
            const std::string copy(static_cast<const char*>(bytes), static_cast<std::size_t>(size));
            if (const int failure = handle.disk->note(*handle.name, {at, copy}); failure != SQLITE_OK) {
                return failure;
            }
        }
        return handle.real()->pMethods->xWrite(handle.real(), bytes, size, at);
    }
    static int truncate(sqlite3_file* file, sqlite3_int64 size) {
        Handle& handle = Handle::of(file);
        if (handle.name != nullptr) {
            handle.disk->note(*handle.name, {size, {}, true});
        }
        return handle.real()->pMethods->xTruncate(handle.real(), size);
    }
    static int sync(sqlite3_file* file, int) {
        Handle& handle = Handle::of(file);
        return handle.name == nullptr ? SQLITE_OK : handle.disk->sync(*handle.name);
    }
    static int size(sqlite3_file* file, sqlite3_int64* size) {
        return Handle::of(file).real()->pMethods->xFileSize(Handle::of(file).real(), size);
    }
    static int lock(sqlite3_file* file, int kind) {
        return Handle::of(file).real()->pMethods->xLock(Handle::of(file).real(), kind);
    }
    static int unlock(sqlite3_file* file, int kind) {
        return Handle::of(file).real()->pMethods->xUnlock(Handle::of(file).real(), kind);
    }
    static int isReserved(sqlite3_file* file, int* result) {
        return Handle::of(file).real()->pMethods->xCheckReservedLock(Handle::of(file).real(), result);
    }
    static int control(sqlite3_file* file, int what, void* argument) {
        return Handle::of(file).real()->pMethods->xFileControl(Handle::of(file).real(), what, argument);
    }
    static int sectorSize(sqlite3_file*) { return static_cast<int>(kSector); }
    static int traits(sqlite3_file*) { return 0; }
    static int mapShared(sqlite3_file* file, int page, int size, int extend, void volatile** where) {
        return Handle::of(file).real()->pMethods->xShmMap(Handle::of(file).real(), page, size, extend, where);
    }
    static int lockShared(sqlite3_file* file, int offset, int count, int flags) {
        return Handle::of(file).real()->pMethods->xShmLock(Handle::of(file).real(), offset, count, flags);
    }
    static void barrier(sqlite3_file* file) { Handle::of(file).real()->pMethods->xShmBarrier(Handle::of(file).real()); }
    static int unmapShared(sqlite3_file* file, int removes) {
        return Handle::of(file).real()->pMethods->xShmUnmap(Handle::of(file).real(), removes);
    }

    static int open(sqlite3_vfs* system, const char* name, sqlite3_file* file, int flags, int* outFlags) {
        static constexpr sqlite3_io_methods kMethods = {
            2,       close,      read,   write,     truncate,   sync,    size,        lock,    unlock, isReserved,
            control, sectorSize, traits, mapShared, lockShared, barrier, unmapShared, nullptr, nullptr};
        auto* disk = static_cast<FaultyDisk*>(system->pAppData);
        auto* handle = new (file) Handle{{nullptr}, disk, nullptr};
        const int result = disk->real_->xOpen(disk->real_, name, handle->real(), flags, outFlags);
        if (result != SQLITE_OK) {
            return result;
        }
        handle->base.pMethods = &kMethods;
        if (name != nullptr && (flags & (SQLITE_OPEN_MAIN_DB | SQLITE_OPEN_WAL | SQLITE_OPEN_MAIN_JOURNAL)) != 0) {
            handle->name = new std::string(name);
        }
        return SQLITE_OK;
    }
    static int remove(sqlite3_vfs* system, const char* name, int syncs) {
        auto* disk = static_cast<FaultyDisk*>(system->pAppData);
        const std::lock_guard<std::mutex> lock(disk->mutex_);
        disk->files_.erase(name);
        return disk->real_->xDelete(disk->real_, name, syncs);
    }
};

FaultyDisk::FaultyDisk() : real_(sqlite3_vfs_find(nullptr)) {
    system_ = *real_;
    system_.iVersion = 1;
    system_.szOsFile = static_cast<int>(sizeof(Handle)) + real_->szOsFile;
    system_.pNext = nullptr;
    system_.zName = "faulty";
    system_.pAppData = this;
    system_.xOpen = Methods::open;
    system_.xDelete = Methods::remove;
    // The others look at the real system's own data.
    system_.xAccess = [](sqlite3_vfs* system, const char* name, int flags, int* result) {
        sqlite3_vfs* real = static_cast<FaultyDisk*>(system->pAppData)->real_;
        return real->xAccess(real, name, flags, result);
    };
    system_.xFullPathname = [](sqlite3_vfs* system, const char* name, int size, char* result) {
        sqlite3_vfs* real = static_cast<FaultyDisk*>(system->pAppData)->real_;
        return real->xFullPathname(real, name, size, result);
    };
    sqlite3_vfs_register(&system_, 1);
}

FaultyDisk::~FaultyDisk() {
    sqlite3_vfs_unregister(&system_);
    sqlite3_vfs_register(real_, 1);
}

void FaultyDisk::apply(std::string& bytes, const Write& write) {
    const auto at = static_cast<std::size_t>(write.at);
    if (write.cuts) {
        bytes.resize(std::min(bytes.size(), at));
        return;
    }
    bytes.resize(std::max(bytes.size(), at + write.bytes.size()));
    bytes.replace(at, write.bytes.size(), write.bytes);
}

int FaultyDisk::note(const std::string& name, Write write) {
    const std::lock_guard<std::mutex> lock(mutex_);
    if (room_ >= 0) {
        const auto size = static_cast<std::int64_t>(write.bytes.size());
        if (size > room_) {
            return SQLITE_FULL;
        }
        room_ -= size;
    }
    files_[name].pending.push_back(std::move(write));
    return SQLITE_OK;
}

int FaultyDisk::sync(const std::string& name) {
    const std::lock_guard<std::mutex> lock(mutex_);
    if (isBroken_) {
        return SQLITE_IOERR_FSYNC;
    }
    ++syncs_;
    File& file = files_[name];
    for (const Write& write : file.pending) {
        apply(file.durable, write);
    }
    file.pending.clear();
    file.isSynced = true;
    return SQLITE_OK;
}

void FaultyDisk::cutPower(const std::filesystem::path& folder, std::mt19937& chance) {
    const std::lock_guard<std::mutex> lock(mutex_);
    std::filesystem::create_directories(folder);
    for (const auto& [name, file] : files_) {
        std::string bytes = file.durable;
        for (const Write& write : file.pending) {
            for (std::size_t from = 0; from < write.bytes.size(); from += kSector) {
                if (chance() % 2 == 0) {
                    apply(bytes, {write.at + static_cast<std::int64_t>(from), write.bytes.substr(from, kSector)});
                }
            }
        }
        if (file.isSynced || !bytes.empty()) {
            std::ofstream(folder / std::filesystem::path(name).filename(), std::ios::binary) << bytes;
        }
    }
}

void FaultyDisk::setRoom(std::int64_t bytes) {
    const std::lock_guard<std::mutex> lock(mutex_);
    room_ = bytes;
}

void FaultyDisk::setBroken(bool broken) {
    const std::lock_guard<std::mutex> lock(mutex_);
    isBroken_ = broken;
}

}  // namespace ktr::test
