#pragma once

#include <condition_variable>
#include <deque>
#include <filesystem>
#include <map>
#include <mutex>
#include <string>
#include <thread>

#include "linux/configuration/PreferencesFile.h"
#include "platform/base/Preferences.h"

namespace ktr::linux_ {

/// Preferences in one file a domain, "DOMAIN.json" in a folder. The disk is the business of a thread of its own; what
/// `synchronize` asked for is tried before the destructor returns. A domain whose name is no file name ("", "..", one
/// with "/") lives in memory alone. A domain that nobody loaded is read on first use, by whoever uses it.
class FilePreferences : public platform::Preferences {
  public:
    explicit FilePreferences(std::filesystem::path folder);
    ~FilePreferences() override;
    FilePreferences(const FilePreferences&) = delete;
    FilePreferences& operator=(const FilePreferences&) = delete;

    /// Reads a domain before the main thread needs it. Any thread; it waits for the disk.
    void load(const std::string& domain);
    /// Waits until everything that was asked for has been tried. Any thread.
    void waitUntilSynchronized();

    std::optional<std::string> value(const std::string& key, const std::string& domain) const override;
    void setValue(const std::string& key, const std::optional<std::string>& value, const std::string& domain) override;
    /// What could not be written is tried again at the next call.
    void synchronize(const std::string& domain) override;

  private:
    struct Domain {
        PreferencesFile::Texts texts;      ///< as last seen on the disk
        PreferencesFile::Changes changes;  ///< made since, not on the disk yet
    };
    /// The domain, loaded; call with the lock held.
    Domain& domainNamed(const std::string& name) const;
    std::filesystem::path fileOf(const std::string& domain) const;
    void work();
    /// False, and a line in the log, when that failed.
    bool bringToDisk(const std::string& domain);

    const std::filesystem::path folder_;
    mutable std::mutex mutex_;
    mutable std::map<std::string, Domain> domains_;
    std::condition_variable wake_, idle_;
    std::deque<std::string> queue_;
    bool busy_ = false;
    bool ending_ = false;
    std::thread worker_;
};

}  // namespace ktr::linux_
