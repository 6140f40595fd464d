#include "server/store/Store.h"

#include <algorithm>
#include <future>
#include <iterator>

#include "documents/AtomicFile.h"
#include "server/store/Migrations.h"

namespace ktr::server {

namespace {

constexpr std::size_t kLargestBatch = 512;

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
    return std::unique_ptr<Store>(new Store(std::move(reading), std::move(writing)));
}

Store::Store(std::unique_ptr<Database> reading, std::unique_ptr<Database> writing)
    : reading_(std::move(reading)), writing_(std::move(writing)) {
    if (auto row = reading_->statement("SELECT latest FROM clock"); row.next()) {
        latest_ = row.integer(0);
    }
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

void Store::writeAll() {
    for (;;) {
        std::deque<Work> batch;
        {
            std::unique_lock<std::mutex> lock(mutex_);
            wake_.wait(lock, [this] { return ending_ || !waiting_.empty(); });
            if (waiting_.empty()) {
                return;
            }
            const auto end = waiting_.begin() + static_cast<std::ptrdiff_t>(std::min(kLargestBatch, waiting_.size()));
            std::move(waiting_.begin(), end, std::back_inserter(batch));
            waiting_.erase(waiting_.begin(), end);
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
    }
}

Store::Outcome Store::commit(std::deque<Work>::const_iterator begin, std::deque<Work>::const_iterator end) {
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
    const bool isDone = writing_->settle();
    if (isDone && writing_->commit()) {
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
