#include "server/store/Changes.h"

#include <algorithm>
#include <charconv>

namespace ktr::server {

namespace {

constexpr std::string_view kEverything = "everything";

/// Takes the first word away.
std::string_view takeWord(std::string_view& line) {
    const std::size_t end = std::min(line.find(' '), line.size());
    const std::string_view word = line.substr(0, end);
    line.remove_prefix(std::min(end + 1, line.size()));
    return word;
}

}  // namespace

void Change::add(const Change& other) {
    everything = everything || other.everything;
    people.insert(other.people.begin(), other.people.end());
}

std::list<std::string> Change::lines(std::string_view sender, std::size_t limit) const {
    std::list<std::string> lines;
    if (everything) {
        lines.push_back(std::string(sender) + " " + std::string(kEverything));
        return lines;
    }
    for (const std::int64_t person : people) {
        const std::string word = " " + std::to_string(person);
        if (lines.empty() || lines.back().size() + word.size() > limit) {
            lines.emplace_back(sender);
        }
        lines.back() += word;
    }
    return lines;
}

Change Change::ofLine(std::string_view line, std::string& sender) {
    Change change;
    sender = takeWord(line);
    while (!line.empty() && !change.everything) {
        const std::string_view word = takeWord(line);
        std::int64_t person = 0;
        const auto read = std::from_chars(word.data(), word.data() + word.size(), person);
        change.everything = read.ec != std::errc() || read.ptr != word.data() + word.size();
        change.people.insert(person);
    }
    return change.everything || change.people.empty() ? Change{true, {}} : change;
}

std::shared_ptr<void> Changes::listen(Listener listener) {
    const std::lock_guard<std::mutex> lock(mutex_);
    const auto place = listeners_.insert(listeners_.end(), std::move(listener));
    // What is given stands for nothing but its end.
    return {static_cast<void*>(&*place), [this, place](void*) {
                const std::lock_guard<std::mutex> ending(mutex_);
                listeners_.erase(place);
            }};
}

void Changes::tell(const Change& change) {
    const std::lock_guard<std::mutex> lock(mutex_);
    for (const Listener& listener : listeners_) {
        listener(change);
    }
}

bool Changes::isListenedTo() const {
    const std::lock_guard<std::mutex> lock(mutex_);
    return !listeners_.empty();
}

}  // namespace ktr::server
