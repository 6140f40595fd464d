#pragma once

#include <QObject>
#include <functional>
#include <memory>

namespace ktr::linux_ {

/// Work that may wait, for an object of the main thread: each piece runs on a thread of its own, and what it gives runs
/// on the main thread, unless this has gone by then. Nobody waits for those threads: a bus may never answer. Main
/// thread.
class Aside {
  public:
    /// What is done on the main thread afterwards.
    using Then = std::function<void()>;

    /// The owner holds this as a member, and its event loop runs what comes back.
    explicit Aside(QObject& owner);
    ~Aside();
    Aside(const Aside&) = delete;
    Aside& operator=(const Aside&) = delete;

    /// `work` uses nothing of the owner's, and `then` may.
    void run(std::function<Then()> work);

  private:
    struct Return;
    std::shared_ptr<Return> return_;
};

}  // namespace ktr::linux_
