#include "app/HookQueue.h"

#include <utility>

#include "documents/AtomicFile.h"
#include "documents/DocumentReader.h"
#include "documents/FileTrust.h"
#include "platform/base/Json.h"

namespace ktr::app {

using platform::Dictionary;
using platform::Value;

namespace {

constexpr std::size_t kLargest = std::size_t{1} << 20;
constexpr double kMostNumber = 9007199254740991.0;  // whole numbers that a double tells apart

}  // namespace

HookQueue::HookQueue(Setup setup) : setup_(std::move(setup)) {
    std::error_code error;
    if (!std::filesystem::exists(setup_.file, error)) {
        return;
    }
    documents::FileReader::Terms terms;
    terms.most = kLargest;
    terms.refusal = [this](const struct stat& facts) {
        return documents::FileTrust::problemOf(setup_.file.string(), facts);
    };
    const auto problem = documents::DocumentReader::readFile(
        setup_.file, terms,
        [this](documents::FieldReader& fields) {
            last_ = static_cast<std::int64_t>(fields.number("last", 0.0, kMostNumber).value_or(0.0));
            for (const std::string& text : fields.texts("waiting")) {
                if (const auto crossing = Crossing::read(text)) {
                    waiting_.push_back(*crossing);
                }
            }
        },
        nullptr);
    if (problem) {
        setup_.tell(problem->text());
    }
}

void HookQueue::start() {
    postNext();
}

void HookQueue::add(const Crossing& crossing) {
    if (crossing.number <= last_) {
        return;
    }
    last_ = crossing.number;
    waiting_.push_back(crossing);
    if (waiting_.size() > kMost) {
        setup_.tell("too many crossings wait for the hook; the oldest is not posted");
        // The first one may be under way.
        waiting_.erase(waiting_.begin() + (isBusy_ ? 1 : 0));
    }
    write();
    postNext();
}

void HookQueue::write() const {
    Value::Array waiting;
    for (const Crossing& crossing : waiting_) {
        waiting.emplace_back(crossing.json());
    }
    const std::string complaint = documents::AtomicFile::write(
        setup_.file, platform::writeJson(Dictionary{{"last", last_}, {"waiting", std::move(waiting)}}) + "\n", 0600);
    if (!complaint.empty()) {
        setup_.tell(complaint);
    }
}

void HookQueue::postNext() {
    if (isBusy_ || waiting_.empty()) {
        return;
    }
    if (waiting_.front().time + kLasts <= setup_.now()) {
        setup_.tell("a crossing is too old for the hook; it is not posted");
        waiting_.pop_front();
        write();
        return postNext();
    }
    isBusy_ = true;
    setup_.post(waiting_.front(), [this] {
        isBusy_ = false;
        waiting_.pop_front();
        write();
        postNext();
    });
}

}  // namespace ktr::app
