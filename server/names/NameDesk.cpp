#include "server/names/NameDesk.h"

#include <utility>

namespace ktr::server {

NameDesk::NameDesk(PlaceNames::Setup setup) : names_(std::move(setup)), thread_([this] { run(); }) {}

NameDesk::~NameDesk() {
    std::deque<Question> left;  // goes last: whoever asked may do anything when it learns that there is no answer
    {
        const std::lock_guard lock(mutex_);
        isEnding_ = true;
        left.swap(waiting_);
    }
    wake_.notify_one();
    thread_.join();
}

void NameDesk::ask(std::vector<PlaceNames::Place> places, ViewerLocale viewer, Told told) {
    {
        const std::lock_guard lock(mutex_);
        if (placesWaiting_ < kMostWaiting) {
            placesWaiting_ += places.size();
            waiting_.push_back(
                {std::move(places), std::move(viewer), std::move(told), PlaceNames::Clock::now() + kPatience});
            wake_.notify_one();
            return;
        }
    }
    const PlaceWords words(viewer);
    std::vector<PlaceName> names;
    names.reserve(places.size());
    for (const PlaceNames::Place& place : places) {
        names.push_back({"", "", words.coordinates(place.latitude, place.longitude)});
    }
    told(std::move(names));
}

void NameDesk::run() {
    std::unique_lock lock(mutex_);
    for (;;) {
        wake_.wait(lock, [this] { return isEnding_ || !waiting_.empty(); });
        if (isEnding_) {
            return;
        }
        const Question question = std::move(waiting_.front());
        waiting_.pop_front();
        placesWaiting_ -= question.places.size();
        lock.unlock();
        names_.renew();
        std::vector<PlaceName> names;
        for (const PlaceNames::Place& place : question.places) {
            names.push_back(names_.name(place, question.viewer, question.until));
        }
        question.told(std::move(names));
        lock.lock();
    }
}

}  // namespace ktr::server
