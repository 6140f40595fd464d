#pragma once

#include <QObject>
#include <QTimer>
#include <chrono>
#include <filesystem>
#include <functional>
#include <memory>
#include <vector>

#include "linux/device/Aside.h"

class QSocketNotifier;

namespace ktr::linux_ {

/// Tells when files change (inotify(7)). A disk may not answer: what has to look at it does so in the background. What
/// the system does not watch, because somebody's other programs have used up what there is, is looked at now and then.
/// Main thread, whose event loop runs what is called.
class FileWatch : public QObject {
  public:
    using Files = std::vector<std::filesystem::path>;

    /// `changed` is called after one of the files or something in their folders has become another. What the system
    /// does not watch is said in the log, and looked at every so often.
    explicit FileWatch(std::function<void()> changed, std::chrono::milliseconds everySoOften = std::chrono::seconds(3));
    ~FileWatch() override;

    /// From now on these too, and the folders they are in, as far as they are there. `then` is called when that is so,
    /// with whether a folder is among them that was not watched before: what changed there earlier has not been told.
    /// To be said again after a change, since a file that was replaced is another one.
    void watch(Files files, std::function<void(bool isFolderNew)> then = nullptr);

  private:
    class Events;

    void look();

    std::function<void()> changed_;
    std::shared_ptr<Events> events_;
    std::unique_ptr<QSocketNotifier> notifier_;
    QTimer looks_;
    Aside aside_;
};

}  // namespace ktr::linux_
