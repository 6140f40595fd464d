#pragma once

#include <QObject>
#include <deque>
#include <filesystem>
#include <functional>
#include <string>
#include <vector>

#include "linux/configuration/ConfigurationFile.h"
#include "linux/device/Aside.h"

namespace ktr::app {

/// Writes settings into the configuration file, one wish after the other, while nobody waits. What was begun is written
/// also when this goes. Main thread.
class SettingsDesk {
  public:
    using Changes = std::vector<linux_::ConfigurationFile::Change>;
    /// `problem` is empty when it is written, else one line.
    using Done = std::function<void(const std::string& problem)>;

    explicit SettingsDesk(std::filesystem::path file) : file_(std::move(file)), aside_(owner_) {}

    void change(Changes changes, Done done);
    /// Wishes are under way.
    bool isBusy() const { return !waiting_.empty(); }

  private:
    void writeNext();

    struct Wish {
        Changes changes;
        Done done;
    };
    const std::filesystem::path file_;
    std::deque<Wish> waiting_;  ///< the first is under way
    QObject owner_;
    linux_::Aside aside_;
};

}  // namespace ktr::app
