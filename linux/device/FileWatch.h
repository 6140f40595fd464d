#pragma once

#include <QObject>
#include <filesystem>
#include <functional>
#include <memory>
#include <vector>

#include "linux/device/Aside.h"

class QSocketNotifier;

namespace ktr::linux_ {

/// Tells when files change (inotify(7)). A disk may not answer: what has to look at it does so in the background. Main
/// thread, whose event loop runs what is called.
class FileWatch : public QObject {
  public:
    using Files = std::vector<std::filesystem::path>;

    /// `changed` is called after one of the files or something in their folders has become another. Where the system
    /// watches nothing more, that is a line in the log, and nothing is told.
    explicit FileWatch(std::function<void()> changed);
    ~FileWatch() override;

    /// From now on these too, and the folders they are in, as far as they are there. `then` is called when that is so,
    /// with whether a folder is among them that was not watched before: what changed there earlier has not been told.
    /// To be said again after a change, since a file that was replaced is another one.
    void watch(Files files, std::function<void(bool isFolderNew)> then = nullptr);

  private:
    class Events;

    std::function<void()> changed_;
    std::shared_ptr<Events> events_;
    std::unique_ptr<QSocketNotifier> notifier_;
    Aside aside_;
};

}  // namespace ktr::linux_
