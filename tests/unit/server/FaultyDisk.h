#pragma once

#include <sqlite3.h>

#include <cstdint>
#include <filesystem>
#include <map>
#include <mutex>
#include <random>
#include <string>
#include <vector>

namespace ktr::test {

/// A disk under SQLite, for all databases that are opened while it lives. Programs see what they wrote, as ever; the
/// disk has what was brought to it, and of the rest whatever it likes. It can be cut off from its power, be full, and
/// fail to bring anything to itself. One at a time; any thread.
class FaultyDisk {
  public:
    FaultyDisk();
    ~FaultyDisk();
    FaultyDisk(const FaultyDisk&) = delete;
    FaultyDisk& operator=(const FaultyDisk&) = delete;

    /// Writes to `folder` what a disk would have if the power went now: all that was brought to it, and of what was
    /// written since some sectors, by `chance`. The programs go on.
    void cutPower(const std::filesystem::path& folder, std::mt19937& chance);
    /// So many bytes more can be written; below 0: as many as one likes.
    void setRoom(std::int64_t bytes);
    /// Bringing something to the disk fails.
    void setBroken(bool broken);
    int syncs() const { return syncs_; }

  private:
    struct Write {
        std::int64_t at = 0;
        std::string bytes;
        bool cuts = false;  ///< the file ends at `at` instead
    };
    struct File {
        std::string durable;
        std::vector<Write> pending;
        bool isSynced = false;
    };
    struct Handle;
    struct Methods;

    static void apply(std::string& bytes, const Write& write);
    int note(const std::string& name, Write write);
    int sync(const std::string& name);

    std::mutex mutex_;
    std::map<std::string, File> files_;  ///< by path
    std::int64_t room_ = -1;
    bool isBroken_ = false;
    int syncs_ = 0;
    sqlite3_vfs* real_;
    sqlite3_vfs system_{};
};

}  // namespace ktr::test
