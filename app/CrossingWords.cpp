#include "app/CrossingWords.h"

#include <charconv>
#include <cmath>

#include "documents/JsonReader.h"
#include "documents/Words.h"
#include "platform/base/Format.h"
#include "platform/base/Json.h"
#include "platform/base/Value.h"

namespace ktr::app {

using platform::Dictionary;
using platform::Value;

namespace {

/// Milliseconds since 1970, on both sides: what is beyond is no moment (ECMA-262, 21.4.1.1).
constexpr double kLastMoment = 8.64e15;

std::string textOf(const Dictionary& dictionary, const char* name) {
    const Value* value = dictionary.find(name);
    // Somebody else chose it: nothing in it moves a line or turns its direction.
    return value == nullptr || value->string() == nullptr ? std::string() : documents::forLine(*value->string());
}

}  // namespace

std::optional<Crossing> Crossing::read(const std::string& json) {
    const auto document = documents::JsonReader::read(json);
    const auto* value = std::get_if<Value>(&document);
    const Dictionary* event = value == nullptr ? nullptr : value->dictionary();
    if (event == nullptr) {
        return std::nullopt;
    }
    Crossing crossing;
    const std::string id = textOf(*event, "id");
    const auto [end, error] = std::from_chars(id.data(), id.data() + id.size(), crossing.number);
    const std::string trigger = textOf(*event, "trigger");
    const Value* time = event->find("timestamp");
    crossing.name = textOf(*event, "name");
    crossing.handle = textOf(*event, "handle");
    crossing.arrives = trigger == "OnArrival";
    if (id.empty() || error != std::errc() || end != id.data() + id.size() || crossing.number <= 0 ||
        crossing.name.empty() || (!crossing.arrives && trigger != "OnDeparture") || time == nullptr ||
        !time->number() || !(std::abs(*time->number()) <= kLastMoment)) {
        return std::nullopt;
    }
    crossing.time = static_cast<std::int64_t>(std::floor(*time->number() / 1000.0));
    if (const Value* place = event->find("place"); place != nullptr && place->dictionary() != nullptr) {
        crossing.place = textOf(*place->dictionary(), "name");
    }
    return crossing;
}

std::string Crossing::json() const {
    Dictionary event{{"id", std::to_string(number)},
                     {"name", name},
                     {"handle", handle},
                     {"trigger", arrives ? "OnArrival" : "OnDeparture"},
                     {"timestamp", time * 1000}};
    if (!place.empty()) {
        event.set("place", Dictionary{{"name", place}});
    }
    return platform::writeJson(event);
}

CrossingWords CrossingWords::of(const Crossing& crossing, bool isLocked,
                                const std::function<std::string(const std::string& key)>& text,
                                const std::function<std::string(std::int64_t time)>& clock) {
    if (isLocked) {
        return {text(crossing.arrives ? "WATCH_SOMEBODY_ARRIVED" : "WATCH_SOMEBODY_LEFT"), ""};
    }
    const std::string where = crossing.place.empty() ? clock(crossing.time) : crossing.place;
    return {crossing.name, platform::formatted(text(crossing.arrives ? "WATCH_ARRIVAL" : "WATCH_DEPARTURE"), {where})};
}

std::string CrossingWords::question(const Crossing& crossing,
                                    const std::function<std::string(const std::string& key)>& text) {
    return platform::formatted(text("FRIEND_WHERE"), {crossing.name});
}

}  // namespace ktr::app
