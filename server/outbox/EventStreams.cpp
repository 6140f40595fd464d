#include "server/outbox/EventStreams.h"

#include "platform/base/Json.h"
#include "server/answers/FenceRequest.h"
#include "server/http/HttpStream.h"

namespace ktr::server {

namespace {

/// At once to one reader: what waits in memory stays small.
constexpr int kMostAtOnce = 32;
constexpr const char* kBeat = ":\n\n";

std::string wordOf(const FenceEvent& event) {
    return "id: " + std::to_string(event.number) +
           "\nevent: crossing\ndata: " + platform::writeJson(FenceAnswers::event(event)) + "\n\n";
}

std::string ending(const char* why) {
    return std::string("event: ended\ndata: {\"why\":\"") + why + "\"}\n\n";
}

}  // namespace

struct EventStreams::Reader {
    std::int64_t device = 0;
    std::int64_t person = 0;
    std::shared_ptr<HttpStream> stream;
    std::mutex mutex;
    std::int64_t told = 0;  ///< the number of the last event that was handed over
    bool waits = false;     ///< at the last beat it had not taken everything
};

EventStreams::EventStreams(Setup setup) : setup_(std::move(setup)), alive_(std::make_shared<Alive>()) {
    alive_->streams = this;
    listening_ = setup_.store.listen([this](const Change& change) { concerns(change); });
    schedule(setup_.pause, [](EventStreams& self) { self.beat(); });
}

EventStreams::~EventStreams() {
    listening_.reset();
    {
        const std::lock_guard<std::mutex> lock(alive_->mutex);
        alive_->streams = nullptr;
    }
    for (const auto& [device, reader] : readers_) {
        reader->stream->end();
    }
}

void EventStreams::schedule(double seconds, std::function<void(EventStreams&)> what) {
    setup_.later(seconds, [alive = alive_, what = std::move(what)] {
        const std::lock_guard<std::mutex> lock(alive->mutex);
        if (alive->streams != nullptr) {
            what(*alive->streams);
        }
    });
}

HttpResponse EventStreams::open(const Device& device, std::int64_t after) {
    const auto reader = std::make_shared<Reader>();
    reader->device = device.id;
    reader->person = device.person;
    reader->told = after;
    // On a thread of the edge, in the middle of sending: what there is more comes a little later.
    reader->stream = std::make_shared<HttpStream>([later = setup_.later, alive = alive_, weak = std::weak_ptr(reader)] {
        later(0.0, [alive, weak] {
            const std::lock_guard<std::mutex> lock(alive->mutex);
            if (const auto one = weak.lock(); one && alive->streams != nullptr) {
                alive->streams->pump(one);
            }
        });
    });
    std::shared_ptr<Reader> before;
    {
        const std::lock_guard<std::mutex> lock(mutex_);
        auto& place = readers_[device.id];
        before = std::exchange(place, reader);
        if (!before) {
            devices_.emplace(device.person, device.id);
        }
    }
    if (before) {
        before->stream->end(ending("another stream began"));
    }
    HttpResponse response;
    response.headers = {
        {"Content-Type", "text/event-stream"}, {"Cache-Control", "no-store"}, {"X-Accel-Buffering", "no"}};
    response.body = "retry: 2000\n\n";
    response.stream = reader->stream;
    schedule(0.0, [reader](EventStreams& self) { self.pump(reader); });
    return response;
}

void EventStreams::concerns(const Change& change) {
    std::vector<std::shared_ptr<Reader>> concerned;
    {
        const std::lock_guard<std::mutex> lock(mutex_);
        const auto add = [&](std::int64_t device) { concerned.push_back(readers_.at(device)); };
        if (change.everything) {
            for (const auto& [device, reader] : readers_) {
                concerned.push_back(reader);
            }
        }
        for (const std::int64_t person : change.people) {
            const auto [begin, end] = devices_.equal_range(person);
            for (auto one = begin; one != end && !change.everything; ++one) {
                add(one->second);
            }
        }
    }
    for (const auto& reader : concerned) {
        schedule(0.0, [reader](EventStreams& self) { self.pump(reader); });
    }
}

void EventStreams::pump(const std::shared_ptr<Reader>& reader) {
    const std::lock_guard<std::mutex> lock(reader->mutex);
    // What is not taken yet calls again when it is.
    if (reader->stream->isOver() || !reader->stream->isDrained()) {
        return;
    }
    const auto events = setup_.store.eventsFor(reader->device, reader->told, setup_.now(), kMostAtOnce);
    std::string text;
    for (const FenceEvent& event : events.value_or(std::vector<FenceEvent>())) {
        text += wordOf(event);
    }
    if (!text.empty() && reader->stream->send(text)) {
        reader->told = events->back().number;
    } else if (text.empty() && !setup_.store.isInUse(reader->device).value_or(true)) {
        reader->stream->end(ending("the secret has ended"));
    }
}

void EventStreams::beat() {
    std::vector<std::shared_ptr<Reader>> all;
    {
        const std::lock_guard<std::mutex> lock(mutex_);
        for (const auto& [device, reader] : readers_) {
            all.push_back(reader);
        }
    }
    for (const auto& reader : all) {
        bool isGone = reader->stream->isOver();
        if (!isGone && !setup_.store.isInUse(reader->device).value_or(true)) {
            reader->stream->end(ending("the secret has ended"));
            isGone = true;
        }
        const std::lock_guard<std::mutex> readerLock(reader->mutex);
        if (!isGone && reader->stream->isDrained()) {
            reader->waits = false;
            reader->stream->send(kBeat);
        } else if (!isGone && std::exchange(reader->waits, true)) {
            // For a whole pause. What it has not taken is in the store, and comes when it asks again.
            ++slow_;
            reader->stream->end(ending("too slow"));
            isGone = true;
        }
        if (isGone) {
            const std::lock_guard<std::mutex> lock(mutex_);
            const auto place = readers_.find(reader->device);
            if (place != readers_.end() && place->second == reader) {
                readers_.erase(place);
                const auto [begin, end] = devices_.equal_range(reader->person);
                for (auto one = begin; one != end; ++one) {
                    if (one->second == reader->device) {
                        devices_.erase(one);
                        break;
                    }
                }
            }
        }
    }
    schedule(setup_.pause, [](EventStreams& self) { self.beat(); });
}

std::size_t EventStreams::size() const {
    const std::lock_guard<std::mutex> lock(mutex_);
    return readers_.size();
}

}  // namespace ktr::server
