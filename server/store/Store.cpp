#include "server/store/Store.h"

#include <algorithm>
#include <future>
#include <iterator>

#include "documents/AtomicFile.h"
#include "server/store/Migrations.h"
#include "server/store/PostgresHearing.h"
#include "server/store/Secret.h"

namespace ktr::server {

namespace {

constexpr std::size_t kLargestBatch = 512;
/// While there is more to write, other processes hear that often where people are.
constexpr std::chrono::milliseconds kMovesAtLeast{20};

}  // namespace

std::unique_ptr<Store> Store::open(const StoreAddress& address, bool make, std::string& complaint) {
    if (make && address.isFolder()) {
        if (auto failure = documents::AtomicFile::makeFolder(address.text); !failure.empty()) {
            complaint = failure;
            return nullptr;
        }
    }
    auto writing = address.connect(complaint);
    if (!writing) {
        return nullptr;
    }
    if (const std::string problem = Migrations::run(*writing, make); !problem.empty()) {
        complaint = address.name() + ": " + problem;
        return nullptr;
    }
    auto reading = address.connect(complaint);
    if (!reading) {
        return nullptr;
    }
    return std::unique_ptr<Store>(new Store(address, std::move(reading), std::move(writing)));
}

Store::Store(const StoreAddress& address, std::unique_ptr<Database> reading, std::unique_ptr<Database> writing)
    : reading_(std::move(reading)),
      writing_(std::move(writing)),
      address_(address),
      self_(std::to_string(Secret::number())) {
    if (auto row = reading_->statement("SELECT latest FROM clock"); row.next()) {
        latest_ = row.integer(0);
    }
    writing_->othersWrote();  // before now concerns nobody
    thread_ = std::thread([this] { writeAll(); });
}

Store::~Store() {
    {
        const std::lock_guard<std::mutex> lock(mutex_);
        ending_ = true;
    }
    wake_.notify_all();
    thread_.join();
}

void Store::write(std::function<void(Database&)> work, Done done) {
    {
        const std::lock_guard<std::mutex> lock(mutex_);
        waiting_.push_back({std::move(work), std::move(done)});
    }
    wake_.notify_all();
}

void Store::finish() {
    writeNow([](Database&) {});
}

bool Store::writeNow(const std::function<void(Database&)>& work) {
    std::promise<bool> written;
    write(work, [&](bool good) { written.set_value(good); });
    return written.get_future().get();
}

std::shared_ptr<void> Store::listen(Changes::Listener listener) {
    auto listening = changes_.listen(std::move(listener));
    if (StoreAddress::isServer(address_.text)) {
        const std::lock_guard<std::mutex> lock(hearingMutex_);
        if (!hearing_) {
            hearing_ =
                std::make_unique<PostgresHearing>(address_.text, self_, [this](const Change& change) { hear(change); });
        }
    } else {
        // From now on the writing thread wakes up by itself.
        const std::lock_guard<std::mutex> lock(mutex_);
        wake_.notify_all();
    }
    return listening;
}

void Store::lookAfterOthers() {
    if (writing_->othersWrote()) {
        hear({true, {}});
    }
    writing_->clear();
}

void Store::hear(const Change& change) {
    if (change.everything) {
        forgetRests();
    }
    changes_.tell(change);
}

void Store::announceMoves() {
    const auto now = std::chrono::steady_clock::now();
    {
        const std::lock_guard<std::mutex> lock(mutex_);
        // Those who wait for their commit come first.
        if (toAnnounce_.isNothing() || (!waiting_.empty() && now - lastAnnounced_ < kMovesAtLeast)) {
            return;
        }
    }
    lastAnnounced_ = now;
    writing_->announce(toAnnounce_, self_);
    if (!writing_->failed()) {
        toAnnounce_ = {};
    }
    writing_->clear();
}

bool Store::waitForWork(std::deque<Work>& batch) {
    std::unique_lock<std::mutex> lock(mutex_);
    while (!ending_ && waiting_.empty()) {
        if (!address_.isFolder() || !changes_.isListenedTo()) {
            wake_.wait(lock);
        } else if (wake_.wait_for(lock, kLookAfter) == std::cv_status::timeout) {
            break;
        }
    }
    const auto end = waiting_.begin() + static_cast<std::ptrdiff_t>(std::min(kLargestBatch, waiting_.size()));
    std::move(waiting_.begin(), end, std::back_inserter(batch));
    waiting_.erase(waiting_.begin(), end);
    return !ending_ || !batch.empty();
}

void Store::writeAll() {
    for (std::deque<Work> batch; waitForWork(batch); batch.clear()) {
        lookAfterOthers();
        if (batch.empty()) {
            continue;
        }
        Outcome outcome = commit(batch.begin(), batch.end());
        // What one of them cannot do does not refuse the others.
        const bool oneByOne = outcome == Outcome::Refused && batch.size() > 1;
        for (auto work = batch.begin(); work != batch.end(); ++work) {
            if (oneByOne && outcome != Outcome::Broken) {
                outcome = commit(work, std::next(work));
            }
            if (work->done) {
                work->done(outcome == Outcome::Kept);
            }
        }
        announceMoves();
    }
}

Store::Outcome Store::commit(std::deque<Work>::const_iterator begin, std::deque<Work>::const_iterator end) {
    changed_ = moved_ = {};
    if (!writing_->begin()) {
        writing_->rollback();
        return Outcome::Broken;
    }
    for (auto work = begin; work != end && !writing_->failed(); ++work) {
        work->write(*writing_);
    }
    std::int64_t latest = 0;
    {
        const std::lock_guard<std::mutex> lock(mutex_);
        latest = latest_;
    }
    // At most once a second: other processes wait for whoever changes this one row.
    writing_->statement("UPDATE clock SET latest = $1 WHERE latest < $1").bind(latest).run();
    writing_->announce(changed_, self_);
    const bool isDone = writing_->settle();
    if (isDone && writing_->commit()) {
        toAnnounce_.add(moved_);
        changed_.add(moved_);
        if (!changed_.isNothing()) {
            hear(changed_);
        }
        return Outcome::Kept;
    }
    writing_->rollback();
    return isDone ? Outcome::Broken : Outcome::Refused;
}

std::int64_t Store::present(std::int64_t now) {
    const std::lock_guard<std::mutex> lock(mutex_);
    latest_ = std::max(latest_, now);
    return latest_;
}

}  // namespace ktr::server
