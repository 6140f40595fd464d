#pragma once

#include <QThread>
#include <functional>

namespace ktr::linux_ {

/// The thread on which this program speaks HTTPS: commands, questions and tiles share one. Whoever uses it is gone
/// before it ends. The QCoreApplication ends after it and before the process's statics do: a look-up of a name, once
/// handed on, is past calling back, and the application's end waits for those that are left. One that begins later
/// finds the library's statics gone, and ends the process with a signal.
class NetworkThread {
  public:
    NetworkThread();
    /// What was posted runs first.
    ~NetworkThread();
    NetworkThread(const NetworkThread&) = delete;
    NetworkThread& operator=(const NetworkThread&) = delete;

    /// Runs the work on the thread, behind what was posted before. Any thread.
    void post(std::function<void()> work);
    /// The same, and returns when it has run; on the thread itself it runs at once.
    void run(const std::function<void()>& work);
    /// Has an object that was made here live on the thread.
    void take(QObject& object) { object.moveToThread(&thread_); }

  private:
    QThread thread_;
    /// Lives on the thread and is deleted there.
    QObject* context_;
};

}  // namespace ktr::linux_
