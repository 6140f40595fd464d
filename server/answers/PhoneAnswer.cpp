#include "server/answers/PhoneAnswer.h"

#include <cmath>
#include <cstdio>
#include <cstdlib>

#include "server/ingest/Base64.h"
#include "server/store/Secret.h"

namespace ktr::server {

using platform::Dictionary;
using platform::Value;

namespace {

/// After which a card comes again: a phone may have lost it. Seconds.
constexpr std::int64_t kWeek = std::int64_t{7} * 86400;

}  // namespace

bool PhoneAnswer::isSound(const Dictionary& message) {
    for (const auto& [name, value] : message) {
        if (value.isNull() || (value.number() && !std::isfinite(*value.number()))) {
            return false;
        }
    }
    const auto text = [&](const char* name) {
        const Value* value = message.find(name);
        return value != nullptr && value->string() != nullptr && !value->string()->empty() ? *value->string() : "";
    };
    if (text("tid").empty()) {
        return false;
    }
    if (text("_type") == "card") {
        return !text("name").empty();
    }
    const auto number = [&](const char* name) {
        const Value* value = message.find(name);
        return value == nullptr ? std::nullopt : value->number();
    };
    const auto isTime = [&](const char* name) {
        const Value* time = message.find(name);
        return time != nullptr && time->integer() && *time->integer() > 0;
    };
    const bool hasPlace = isTime("tst") && number("lat") && std::abs(*number("lat")) <= 90.0 && number("lon") &&
                          std::abs(*number("lon")) <= 180.0;
    if (text("_type") == "transition") {
        return hasPlace && isTime("wtst") && number("acc") && !text("desc").empty() &&
               (text("event") == "enter" || text("event") == "leave");
    }
    return text("_type") == "location" && hasPlace;
}

Value::Array PhoneAnswer::messages(const std::vector<PhoneFriend>& friends) {
    Value::Array messages;
    const auto add = [&](const Dictionary& message) {
        if (isSound(message)) {
            messages.emplace_back(message);
        }
    };
    for (const PhoneFriend& one : friends) {
        if (one.withCard) {
            // Before the place: a phone that knows no card yet would show two letters.
            Dictionary card{{"_type", "card"}, {"tid", one.name}, {"name", one.title.empty() ? one.name : one.title}};
            if (!one.face.empty()) {
                card.set("face", Base64::encode(one.face));
            }
            add(card);
        }
        if (!one.seen) {
            continue;
        }
        Dictionary location{{"_type", "location"},
                            {"tid", one.name},
                            {"lat", one.seen->latitude},
                            {"lon", one.seen->longitude},
                            {"tst", one.seen->time}};
        if (one.seen->accuracy) {
            // The apps read whole metres.
            location.set("acc", static_cast<std::int64_t>(std::ceil(*one.seen->accuracy)));
        }
        add(location);
    }
    return messages;
}

bool PhoneAnswer::showsTransitions(const std::string& userAgent) {
    // The system's own words for the program: "OwnTracks/18.5 CFNetwork/1494.0.7 Darwin/23.4.0".
    return userAgent.rfind("OwnTracks/", 0) == 0 && userAgent.find(" CFNetwork/") != std::string::npos;
}

Dictionary PhoneAnswer::reportNow() {
    return {{"_type", "cmd"}, {"action", "reportLocation"}};
}

bool PhoneAnswer::reportsWhenTold(const std::string& userAgent) {
    // "Owntracks-Android/gms/420506000".
    return userAgent.rfind("Owntracks-Android/", 0) == 0;
}

Value::Array PhoneAnswer::transitions(const std::vector<FenceEvent>& events) {
    Value::Array messages;
    for (const FenceEvent& event : events) {
        char place[64] = "";
        std::snprintf(place, sizeof place, "%.2f, %.2f", event.circle.latitude, event.circle.longitude);
        Dictionary message{{"_type", "transition"},
                           {"tid", event.name},
                           {"event", event.arrives ? "enter" : "leave"},
                           {"desc", event.place.empty() ? std::string(place) : event.place},
                           {"wtst", event.made},
                           {"tst", event.time},
                           {"lat", event.circle.latitude},
                           {"lon", event.circle.longitude},
                           {"acc", static_cast<std::int64_t>(std::ceil(event.circle.radius))},
                           {"t", "c"}};
        if (isSound(message)) {
            messages.emplace_back(std::move(message));
        }
    }
    return messages;
}

std::string PhoneAnswer::cardHash(const std::string& name, const std::string& faceHash) {
    return Secret::hash(name + '\n' + faceHash);
}

bool PhoneAnswer::isCardDue(const SentCard& sent, const std::string& hash, std::int64_t now, std::int64_t post) {
    return sent.hash != hash || std::abs(now - sent.time) >= kWeek || (post != 0 && post == sent.post);
}

}  // namespace ktr::server
