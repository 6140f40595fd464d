#include "linux/configuration/FilePreferences.h"

#include <algorithm>
#include <variant>

#include "platform/base/LogArea.h"

namespace ktr::linux_ {

namespace {

bool isFileName(const std::string& domain) {
    const auto plain = [](char c) {
        return (c >= 'a' && c <= 'z') || (c >= 'A' && c <= 'Z') || (c >= '0' && c <= '9') || c == '.' || c == '-' ||
               c == '_';
    };
    return !domain.empty() && domain.size() < 200 && domain.front() != '.' &&
           std::all_of(domain.begin(), domain.end(), plain);
}

void logFailure(const std::string& text) {
    platform::areaLog(platform::LogArea::Preferences)
        .write(platform::LogLevel::Error, "%@", platform::FormatArgument(text).shown());
}

}  // namespace

FilePreferences::FilePreferences(std::filesystem::path folder)
    : folder_(std::move(folder)), worker_([this] { work(); }) {}

FilePreferences::~FilePreferences() {
    {
        const std::lock_guard<std::mutex> lock(mutex_);
        ending_ = true;
    }
    wake_.notify_all();
    worker_.join();
}

std::filesystem::path FilePreferences::fileOf(const std::string& domain) const {
    return folder_ / (domain + ".json");
}

FilePreferences::Domain& FilePreferences::domainNamed(const std::string& name) const {
    const auto [entry, isNew] = domains_.try_emplace(name);
    if (isNew && isFileName(name)) {
        auto read = PreferencesFile::read(fileOf(name));
        if (auto* texts = std::get_if<PreferencesFile::Texts>(&read)) {
            entry->second.texts = std::move(*texts);
        } else {
            logFailure(std::get<PreferencesFile::Error>(read).text);
        }
    }
    return entry->second;
}

void FilePreferences::load(const std::string& domain) {
    const std::lock_guard<std::mutex> lock(mutex_);
    domainNamed(domain);
}

std::optional<std::string> FilePreferences::value(const std::string& key, const std::string& domain) const {
    const std::lock_guard<std::mutex> lock(mutex_);
    const Domain& stored = domainNamed(domain);
    if (const auto change = stored.changes.find(key); change != stored.changes.end()) {
        return change->second;
    }
    const auto text = stored.texts.find(key);
    return text == stored.texts.end() ? std::nullopt : std::optional(text->second);
}

void FilePreferences::setValue(const std::string& key, const std::optional<std::string>& value,
                               const std::string& domain) {
    const std::lock_guard<std::mutex> lock(mutex_);
    domainNamed(domain).changes[key] = value;
}

void FilePreferences::synchronize(const std::string& domain) {
    if (!isFileName(domain)) {
        return;
    }
    {
        const std::lock_guard<std::mutex> lock(mutex_);
        if (std::find(queue_.begin(), queue_.end(), domain) == queue_.end()) {
            queue_.push_back(domain);
        }
    }
    wake_.notify_all();
}

void FilePreferences::waitUntilSynchronized() {
    std::unique_lock<std::mutex> lock(mutex_);
    idle_.wait(lock, [this] { return queue_.empty() && !busy_; });
}

void FilePreferences::work() {
    std::unique_lock<std::mutex> lock(mutex_);
    for (;;) {
        wake_.wait(lock, [this] { return ending_ || !queue_.empty(); });
        if (queue_.empty()) {
            return;
        }
        const std::string domain = queue_.front();
        queue_.pop_front();
        busy_ = true;
        lock.unlock();
        const bool isDone = bringToDisk(domain);
        lock.lock();
        if (!isDone && ending_) {
            // Whoever held the lock that long holds it still: the end waits once.
            std::erase(queue_, domain);
        }
        busy_ = false;
        idle_.notify_all();
    }
}

bool FilePreferences::bringToDisk(const std::string& name) {
    PreferencesFile::Changes changes;
    {
        const std::lock_guard<std::mutex> lock(mutex_);
        changes = domainNamed(name).changes;
    }
    auto merged = PreferencesFile::merge(fileOf(name), changes);
    if (const auto* error = std::get_if<PreferencesFile::Error>(&merged)) {
        logFailure(error->text);
        return false;
    }
    const std::lock_guard<std::mutex> lock(mutex_);
    Domain& domain = domainNamed(name);
    domain.texts = std::move(std::get<PreferencesFile::Texts>(merged));
    // What was set meanwhile stays a change.
    for (const auto& [key, value] : changes) {
        const auto now = domain.changes.find(key);
        if (now != domain.changes.end() && now->second == value) {
            domain.changes.erase(now);
        }
    }
    return true;
}

}  // namespace ktr::linux_
