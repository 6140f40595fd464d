#include "host/live/SeenRequests.h"

#include <algorithm>
#include <array>
#include <mutex>
#include <utility>
#include <variant>

#include "documents/JsonReader.h"
#include "host/live/AnswerTexts.h"
#include "platform/base/Json.h"

namespace ktr::host {

using platform::Dictionary;
using platform::HttpAnswer;
using platform::HttpRequest;
using platform::Value;

namespace {

/// The ends of the commands' paths (docs/service-protocol.md).
constexpr const char* kQuestion = "/getlocations";
constexpr const char* kSharingCommand = "/showHideLocation";

/// The members that say where somebody is, and the one in them that says when that was.
constexpr std::array<const char*, 2> kPositions = {"myLocation", "requestedLocation"};
constexpr const char* kOwnPosition = "myLocation";
constexpr const char* kTime = "timestamp";

HttpAnswer cancelled() {
    return {platform::HttpFailure::Cancelled, 0, std::nullopt, std::nullopt};
}

Dictionary withoutTimes(Dictionary body) {
    for (const char* name : kPositions) {
        const Value* position = body.find(name);
        if (position != nullptr && position->dictionary() != nullptr) {
            Dictionary place = *position->dictionary();
            place.remove(kTime);
            body.set(name, std::move(place));
        }
    }
    return body;
}

/// Of the friends that a question is about.
std::vector<std::string> handlesIn(const HttpRequest& request) {
    const auto read = documents::JsonReader::read(request.body);
    const auto* body = std::get_if<Value>(&read);
    const Dictionary* members = body != nullptr ? body->dictionary() : nullptr;
    const Value* listed = members != nullptr ? members->find("handles") : nullptr;
    std::vector<std::string> handles;
    if (listed != nullptr && listed->array() != nullptr) {
        for (const Value& handle : *listed->array()) {
            handles.push_back(handle.string() != nullptr ? *handle.string() : "");
        }
    }
    return handles;
}

}  // namespace

struct SeenRequests::Asking {
    std::mutex mutex;
    bool isOver = false;
    std::vector<Completion> completions;

    /// False once the answer is there.
    bool join(std::vector<Completion>& others) {
        const std::lock_guard<std::mutex> lock(mutex);
        if (isOver) {
            return false;
        }
        std::move(others.begin(), others.end(), std::back_inserter(completions));
        return true;
    }
    void answer(HttpAnswer answer) {
        std::vector<Completion> all;
        {
            const std::lock_guard<std::mutex> lock(mutex);
            isOver = true;
            all.swap(completions);
        }
        for (std::size_t i = 0; i + 1 < all.size(); ++i) {
            all[i](answer);
        }
        if (!all.empty()) {
            all.back()(std::move(answer));
        }
    }
};

SeenRequests::SeenRequests(std::shared_ptr<platform::HttpTransport> next, std::shared_ptr<platform::MainLoop> mainLoop)
    : next_(std::move(next)), mainLoop_(std::move(mainLoop)) {}

SeenRequests::~SeenRequests() {
    for (const Held& held : held_) {
        for (const Completion& completion : held.completions) {
            completion(cancelled());
        }
    }
}

SeenRequests::Keys SeenRequests::keysOf(const HttpRequest& request) {
    std::string common = request.scheme + '\n' + request.host + '\n' + request.fallbackHost + '\n' + request.path;
    for (const auto& [name, value] : request.headers) {
        common.append(1, '\n').append(name).append(1, ':').append(value);
    }
    common += '\n';
    const auto read = documents::JsonReader::read(request.body);
    const auto* body = std::get_if<Value>(&read);
    const Dictionary* members = body != nullptr ? body->dictionary() : nullptr;
    if (members == nullptr) {
        return {common + request.body, common + request.body};
    }
    Dictionary card = withoutTimes(*members);
    const std::string question = platform::writeJson(card);
    card.remove(kOwnPosition);
    return {common + platform::writeJson(card), common + question};
}

void SeenRequests::refuse(std::vector<Completion> completions) {
    mainLoop_->post([completions = std::move(completions)] {
        for (const Completion& completion : completions) {
            completion(cancelled());
        }
    });
}

void SeenRequests::ask(const HttpRequest& request, const std::string& question, std::vector<Completion> completions) {
    std::erase_if(underWay_, [](const auto& entry) { return entry.second.expired(); });
    if (const auto earlier = underWay_[question].lock(); earlier && earlier->join(completions)) {
        return;
    }
    const auto asking = std::make_shared<Asking>();
    asking->completions = std::move(completions);
    underWay_[question] = asking;
    next_->send(request, [asking](HttpAnswer answer) {
        if (answer.json) {
            answer.json = withShortTexts(std::move(*answer.json));
        }
        asking->answer(std::move(answer));
    });
}

void SeenRequests::send(const HttpRequest& request, Completion completion) {
    if (request.path.ends_with(kSharingCommand) && !isSeen_) {
        refuse({std::move(completion)});
        return;
    }
    if (!request.path.ends_with(kQuestion)) {
        next_->send(request, std::move(completion));
        return;
    }
    Keys keys = keysOf(request);
    if (!mustWait(request)) {
        ask(request, keys.question, {std::move(completion)});
        return;
    }
    auto held = std::find_if(held_.begin(), held_.end(), [&](const Held& one) { return one.card == keys.card; });
    if (held == held_.end()) {
        held = held_.insert(held_.end(), Held{std::move(keys.card), {}, {}});
    }
    held->request = request;
    held->completions.push_back(std::move(completion));
}

bool SeenRequests::mustWait(const HttpRequest& request) const {
    return !isSeen_ || (cover_ && !cover_(handlesIn(request)));
}

void SeenRequests::setSeen(bool seen) {
    isSeen_ = seen;
    sendHeld();
}

void SeenRequests::setCover(IsThePages cover) {
    cover_ = std::move(cover);
    sendHeld();
}

void SeenRequests::sendHeld() {
    for (Held& held : std::exchange(held_, {})) {
        if (mustWait(held.request)) {
            held_.push_back(std::move(held));
        } else {
            ask(held.request, keysOf(held.request).question, std::move(held.completions));
        }
    }
}

void SeenRequests::cancelHeld() {
    for (Held& held : std::exchange(held_, {})) {
        refuse(std::move(held.completions));
    }
}

}  // namespace ktr::host
