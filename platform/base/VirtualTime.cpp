#include "platform/base/VirtualTime.h"

#include <algorithm>

namespace ktr::platform {

namespace {
constexpr double kShortestRepeat = 0.001;
}

class VirtualTime::VirtualTimer : public Timer {
  public:
    explicit VirtualTimer(double interval) : interval_(interval) {}
    void invalidate() override { valid_ = false; }
    bool isValid() const override { return valid_; }
    double interval() const override { return interval_; }

  private:
    double interval_;
    bool valid_ = true;
};

VirtualTime::VirtualTime(Date start) : thread_(std::this_thread::get_id()), now_(start.secondsSinceReferenceDate) {}
VirtualTime::~VirtualTime() = default;

void VirtualTime::post(Work work) {
    const std::lock_guard lock(mutex_);
    posted_.push_back(std::move(work));
}

void VirtualTime::runInBackground(Work work) {
    post(std::move(work));
}

bool VirtualTime::isMainThread() const {
    return std::this_thread::get_id() == thread_;
}

Date VirtualTime::now() const {
    return {now_};
}

std::shared_ptr<Timer> VirtualTime::schedule(double seconds, bool repeats, Work work) {
    const double interval = repeats ? std::max(seconds, kShortestRepeat) : std::max(seconds, 0.0);
    auto timer = std::make_shared<VirtualTimer>(interval);
    timers_.emplace(Key{now_ + interval, sequence_++}, Entry{timer, std::move(work), repeats});
    return timer;
}

void VirtualTime::runPosted(std::size_t turns) {
    for (std::size_t turn = 0; turn < turns; ++turn) {
        Work work;
        {
            const std::lock_guard lock(mutex_);
            if (posted_.empty()) {
                return;
            }
            work = std::move(posted_.front());
            posted_.pop_front();
        }
        work();
    }
}

void VirtualTime::dropInvalid() {
    std::erase_if(timers_, [](const auto& entry) { return !entry.second.timer->isValid(); });
}

std::optional<double> VirtualTime::nextDue(bool oneShotOnly) const {
    for (const auto& [key, entry] : timers_) {
        if (entry.timer->isValid() && !(oneShotOnly && entry.repeats)) {
            return key.first;
        }
    }
    return std::nullopt;
}

void VirtualTime::fireFirst() {
    auto node = timers_.extract(timers_.begin());
    Entry entry = std::move(node.mapped());
    if (!entry.timer->isValid()) {
        return;
    }
    now_ = std::max(now_, node.key().first);
    Work work = entry.work;
    if (entry.repeats) {
        timers_.emplace(Key{now_ + entry.timer->interval(), sequence_++}, std::move(entry));
    } else {
        entry.timer->invalidate();
    }
    work();
    runPosted();
}

void VirtualTime::advance(double seconds) {
    const double end = now_ + seconds;
    runPosted();
    dropInvalid();
    while (!timers_.empty() && timers_.begin()->first.first <= end) {
        fireFirst();
    }
    now_ = std::max(now_, end);
}

double VirtualTime::runUntilIdle(double horizon) {
    const double start = now_;
    runPosted();
    for (auto due = nextDue(true); due && *due <= start + horizon; due = nextDue(true)) {
        advance(std::max(0.0, *due - now_));
    }
    dropInvalid();
    return now_ - start;
}

std::size_t VirtualTime::pendingTimers() const {
    return static_cast<std::size_t>(
        std::count_if(timers_.begin(), timers_.end(), [](const auto& e) { return e.second.timer->isValid(); }));
}

}  // namespace ktr::platform
