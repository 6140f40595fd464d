#include "linux/device/QtMainLoop.h"

#include <algorithm>
#include <chrono>
#include <cmath>
#include <cstdint>
#include <map>
#include <mutex>
#include <utility>
#include <vector>

#include <QObject>
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

/// What is to be done later, by the time when it is due, then by the order in which it was asked for; one Qt timer
/// waits for the first. Tens of thousands of rows have a step each: as many Qt timers took seconds. Main thread.
class QtMainLoop::Schedule : public std::enable_shared_from_this<Schedule> {
  public:
    /// The schedule owns it: dropping the handle stops nothing, closing the loop does.
    class Entry : public platform::Timer {
      public:
        Entry(double interval, bool repeats, Work work)
            : interval_(interval), repeats_(repeats), work_(std::make_shared<const Work>(std::move(work))) {}

        void invalidate() override {
            if (const auto schedule = schedule_.lock()) {
                schedule->drop(*this);
            }
        }
        bool isValid() const override { return !schedule_.expired(); }
        double interval() const override { return interval_; }

      private:
        friend class Schedule;
        const double interval_;
        const bool repeats_;
        /// Goes when it is done or dropped: the handle, which the work may hold, stays.
        std::shared_ptr<const Work> work_;
        /// Where it waits; none once it does not.
        std::weak_ptr<Schedule> schedule_;
        SteadyClock::time_point due_;
        std::uint64_t number_ = 0;
    };

    Schedule() {
        timer_.setSingleShot(true);
        timer_.setTimerType(Qt::PreciseTimer);
        QObject::connect(&timer_, &QTimer::timeout, &timer_, [this] { turn(); });
    }

    void add(const std::shared_ptr<Entry>& entry) {
        if (!isClosed_) {
            insert(entry, later(SteadyClock::now(), entry->interval_));
            if (waiting_.begin()->second == entry && dropped_.empty()) {
                waitForFirst();
            }
        }
    }

    /// Drops all that waits. What is dropped may ask for more in its destructor: it gets nothing.
    void close() {
        isClosed_ = true;
        timer_.stop();
        auto dropped = std::exchange(dropped_, {});
        for (const auto& [place, entry] : std::exchange(waiting_, {})) {
            entry->schedule_.reset();
            dropped.push_back(std::move(entry->work_));
        }
    }

  private:
    using Place = std::pair<SteadyClock::time_point, std::uint64_t>;

    void insert(const std::shared_ptr<Entry>& entry, SteadyClock::time_point due) {
        entry->schedule_ = weak_from_this();
        entry->due_ = due;
        entry->number_ = ++numbers_;
        waiting_.emplace(Place(due, entry->number_), entry);
    }

    void drop(Entry& entry) {
        entry.schedule_.reset();
        // Whoever says so may live by what the work holds: that goes on a later turn.
        dropped_.push_back(std::move(entry.work_));
        waiting_.erase(Place(entry.due_, entry.number_));
        timer_.start(0);
    }

    void turn() {
        const auto self = shared_from_this();
        std::exchange(dropped_, {}).clear();
        // Work may run an event loop of its own, in which the rest goes on.
        timer_.start(0);
        const auto now = SteadyClock::now();
        while (!waiting_.empty() && waiting_.begin()->first.first <= now) {
            const auto entry = waiting_.extract(waiting_.begin()).mapped();
            const auto work = entry->work_;
            if (entry->repeats_) {
                // From the time that was meant, unless that has passed as well: a stalled loop does not fire in bursts.
                insert(entry, std::max(later(entry->due_, entry->interval_), SteadyClock::now()));
            } else {
                entry->schedule_.reset();
                entry->work_.reset();
            }
            (*work)();
        }
        if (!dropped_.empty()) {
            return;
        }
        timer_.stop();
        if (!waiting_.empty()) {
            waitForFirst();
        }
    }

    void waitForFirst() { timer_.start(wait(secondsUntil(waiting_.begin()->first.first))); }

    std::map<Place, std::shared_ptr<Entry>> waiting_;
    std::vector<std::shared_ptr<const Work>> dropped_;
    std::uint64_t numbers_ = 0;
    bool isClosed_ = false;
    QTimer timer_;
};

QtMainLoop::QtMainLoop()
    : thread_(std::this_thread::get_id()),
      context_(std::make_unique<Context>()),
      schedule_(std::make_shared<Schedule>()) {}

QtMainLoop::~QtMainLoop() {
    workers_.clear();
    workers_.waitForDone();
    schedule_->close();
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
    const auto entry = std::make_shared<Schedule::Entry>(interval, repeats, std::move(work));
    schedule_->add(entry);
    return entry;
}

void QtMainLoop::runInBackground(Work work) {
    workers_.start(QRunnable::create(std::move(work)));
}

bool QtMainLoop::isMainThread() const {
    return std::this_thread::get_id() == thread_;
}

}  // namespace ktr::linux_
