#include "linux/device/QtMainLoop.h"

#include <algorithm>
#include <chrono>
#include <cmath>
#include <limits>
#include <mutex>
#include <utility>

#include <QObject>
#include <QPointer>
#include <QRunnable>
#include <QTimer>

namespace ktr::linux_ {

namespace {

using SteadyClock = std::chrono::steady_clock;

/// QTimer counts milliseconds in an int; what is longer is waited for in several goes.
constexpr double kLongestWait = 1e9;
constexpr double kShortestRepeat = 0.001;

/// Whole milliseconds, rounded up so that nothing fires early.
int wait(double seconds) {
    return static_cast<int>(std::ceil(std::clamp(seconds * 1000.0, 0.0, kLongestWait)));
}

double secondsUntil(SteadyClock::time_point due) {
    return std::chrono::duration<double>(due - SteadyClock::now()).count();
}

SteadyClock::time_point later(SteadyClock::time_point from, double seconds) {
    // A century is as good as never, and does not overflow.
    constexpr double kCentury = 3.2e9;
    return from + std::chrono::duration_cast<SteadyClock::duration>(
                      std::chrono::duration<double>(std::clamp(seconds, 0.0, kCentury)));
}

}  // namespace

/// Receives what is posted. Posting threads may meet its end: the receiver is only touched under the lock.
class QtMainLoop::Context {
  public:
    Context() : receiver_(std::make_unique<QObject>()) {}

    void post(Work work) {
        const std::lock_guard lock(mutex_);
        if (receiver_) {
            QMetaObject::invokeMethod(receiver_.get(), std::move(work), Qt::QueuedConnection);
        }
    }

    /// The parent of the timers; null once closed. Main thread.
    QObject* receiver() const { return receiver_.get(); }

    /// Drops what is posted. It is destroyed outside the lock, since a destructor may post again.
    void close() {
        std::unique_ptr<QObject> receiver;
        {
            const std::lock_guard lock(mutex_);
            receiver = std::move(receiver_);
        }
    }

  private:
    std::mutex mutex_;
    std::unique_ptr<QObject> receiver_;
};

/// The receiver owns the Qt timer, and that owns the work: dropping the handle stops nothing, closing the loop does.
class QtMainLoop::QtTimer : public platform::Timer {
  public:
    explicit QtTimer(double interval) : interval_(interval) {}

    static std::shared_ptr<QtTimer> start(QObject* receiver, double interval, bool repeats, Work work) {
        auto handle = std::make_shared<QtTimer>(interval);
        auto* timer = new QTimer(receiver);
        handle->timer_ = timer;
        timer->setSingleShot(true);
        timer->setTimerType(Qt::PreciseTimer);
        auto due = later(SteadyClock::now(), interval);
        QObject::connect(timer, &QTimer::timeout, timer,
                         [timer, handle, repeats, due, work = std::move(work)]() mutable {
                             if (const double left = secondsUntil(due); left > 0.0) {
                                 timer->start(wait(left));
                                 return;
                             }
                             // The work may invalidate the timer, which drops this very closure at the next turn.
                             const Work now = work;
                             if (repeats) {
                                 // From the time that was meant, unless that has passed as well: a stalled loop does
                                 // not fire in bursts.
                                 due = std::max(later(due, handle->interval()), SteadyClock::now());
                                 timer->start(wait(secondsUntil(due)));
                             } else {
                                 handle->invalidate();
                             }
                             now();
                         });
        timer->start(wait(interval));
        return handle;
    }

    void invalidate() override {
        if (timer_) {
            timer_->stop();
            timer_->disconnect();
            timer_->deleteLater();
            timer_ = nullptr;
        }
    }
    bool isValid() const override { return !timer_.isNull(); }
    double interval() const override { return interval_; }

  private:
    double interval_;
    QPointer<QTimer> timer_;
};

QtMainLoop::QtMainLoop() : thread_(std::this_thread::get_id()), context_(std::make_unique<Context>()) {}

QtMainLoop::~QtMainLoop() {
    workers_.clear();
    workers_.waitForDone();
    context_->close();
}

void QtMainLoop::post(Work work) {
    context_->post(std::move(work));
}

std::shared_ptr<platform::Timer> QtMainLoop::schedule(double seconds, bool repeats, Work work) {
    double interval = std::isnan(seconds) ? 0.0 : std::max(seconds, 0.0);
    if (repeats) {
        interval = std::max(interval, kShortestRepeat);
    }
    QObject* receiver = context_->receiver();
    return receiver ? QtTimer::start(receiver, interval, repeats, std::move(work))
                    : std::make_shared<QtTimer>(interval);
}

void QtMainLoop::runInBackground(Work work) {
    workers_.start(QRunnable::create(std::move(work)));
}

bool QtMainLoop::isMainThread() const {
    return std::this_thread::get_id() == thread_;
}

}  // namespace ktr::linux_
