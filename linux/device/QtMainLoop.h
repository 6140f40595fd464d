#pragma once

#include <memory>
#include <thread>

#include <QThreadPool>

#include "platform/base/MainLoop.h"

namespace ktr::linux_ {

/// The main loop on Qt's event loop. Made, and destroyed, on the main thread, which runs the event loop; a
/// QCoreApplication exists as long as work is expected to run. Work that has not run when the loop is destroyed is
/// dropped, destroyed on the main thread if it was posted; background work under way is waited for, since it may use
/// what its owner unloads next. Posting to a loop under destruction drops the work.
class QtMainLoop : public platform::MainLoop {
  public:
    QtMainLoop();
    ~QtMainLoop() override;
    QtMainLoop(const QtMainLoop&) = delete;
    QtMainLoop& operator=(const QtMainLoop&) = delete;

    void post(Work work) override;
    /// Exact to a millisecond, never early.
    std::shared_ptr<platform::Timer> schedule(double seconds, bool repeats, Work work) override;
    void runInBackground(Work work) override;
    bool isMainThread() const override;

  private:
    class Context;
    class Schedule;

    std::thread::id thread_;
    std::unique_ptr<Context> context_;
    std::shared_ptr<Schedule> schedule_;
    QThreadPool workers_;
};

}  // namespace ktr::linux_
