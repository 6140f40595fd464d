#include "server/ingest/PhoneMessages.h"

#include <charconv>
#include <cmath>
#include <variant>

#include "documents/IsoTime.h"
#include "documents/JsonReader.h"
#include "platform/base/Date.h"
#include "server/http/UrlQuery.h"
#include "server/ingest/Base64.h"
#include "server/ingest/SealedText.h"

namespace ktr::server {

using platform::Dictionary;
using platform::Value;

namespace {

constexpr double kFirstMilliseconds = 2147483648.0;

std::optional<double> numberIn(const Dictionary& object, std::string_view name) {
    const Value* value = object.find(name);
    return value == nullptr ? std::nullopt : value->number();
}

const std::string* textIn(const Dictionary& object, std::string_view name) {
    const Value* value = object.find(name);
    return value == nullptr ? nullptr : value->string();
}

/// A number that a text consists of.
std::optional<double> numberOf(std::string_view text) {
    double number = 0.0;
    const auto [stop, error] = std::from_chars(text.data(), text.data() + text.size(), number);
    return error == std::errc() && stop == text.data() + text.size() && std::isfinite(number)
               ? std::optional<double>(number)
               : std::nullopt;
}

std::optional<double> numberIn(const UrlQuery& query, std::initializer_list<const char*> names) {
    for (const char* name : names) {
        if (const auto text = query.find(name)) {
            return numberOf(*text);
        }
    }
    return std::nullopt;
}

Report withPosition(const RawFix& fix) {
    return {Report::Kind::Position, {fix}, {}, false, {}, {}};
}

/// What an app calls a waypoint: a place with a name, unless it is a beacon's or one that follows its phone.
std::optional<RawPlace> placeIn(const Dictionary& message) {
    const std::string* name = textIn(message, "desc");
    const auto latitude = numberIn(message, "lat");
    const auto longitude = numberIn(message, "lon");
    if (name == nullptr || name->starts_with('+') || message.find("uuid") != nullptr || !latitude || !longitude) {
        return std::nullopt;
    }
    return RawPlace{*name, *latitude, *longitude, numberIn(message, "rad")};
}

std::vector<RawPlace> placesIn(const Dictionary& message) {
    std::vector<RawPlace> places;
    const auto add = [&](const Dictionary* one) {
        if (auto place = one == nullptr ? std::nullopt : placeIn(*one)) {
            places.push_back(std::move(*place));
        }
    };
    add(&message);
    const Value* list = message.find("waypoints");
    for (const Value& one : list == nullptr || list->array() == nullptr ? Value::Array() : *list->array()) {
        add(one.dictionary());
    }
    return places;
}

Report readOwnTracks(const Dictionary& message, std::string_view key, bool maySeal) {
    const std::string* type = textIn(message, "_type");
    if (type == nullptr) {
        return {};
    }
    if (*type == "encrypted") {
        const std::string* data = maySeal ? textIn(message, "data") : nullptr;
        const auto plain = data == nullptr ? std::nullopt : SealedText::open(*data, key);
        const auto inner = plain ? documents::JsonReader::read(*plain) : documents::JsonReader::read("");
        const auto* value = std::get_if<Value>(&inner);
        if (value == nullptr || value->dictionary() == nullptr) {
            return {};
        }
        Report report = readOwnTracks(*value->dictionary(), {}, false);
        report.sealed = true;
        return report;
    }
    if (*type == "card") {
        Report report = Report::alive();
        const std::string* face = textIn(message, "face");
        report.face = face == nullptr ? std::nullopt : Base64::decode(*face);
        return report;
    }
    if (*type == "waypoint" || *type == "waypoints") {
        Report report = Report::alive();
        report.places = placesIn(message);
        return report;
    }
    if (*type != "location") {
        return Report::alive();
    }
    const auto latitude = numberIn(message, "lat");
    const auto longitude = numberIn(message, "lon");
    if (!latitude || !longitude) {
        return {};
    }
    if (const std::string* trigger = textIn(message, "t"); trigger != nullptr && *trigger == "p") {
        return Report::alive();
    }
    return withPosition({numberIn(message, "tst"), *latitude, *longitude, numberIn(message, "acc")});
}

}  // namespace

Report PhoneMessages::ownTracks(std::string_view body, std::string_view key) {
    // What the app sends when a friend was deleted in it.
    if (body.empty()) {
        return Report::alive();
    }
    const auto document = documents::JsonReader::read(body);
    const auto* value = std::get_if<Value>(&document);
    return value == nullptr || value->dictionary() == nullptr ? Report()
                                                              : readOwnTracks(*value->dictionary(), key, true);
}

std::optional<double> PhoneMessages::timeOf(std::string_view text) {
    if (const auto number = numberOf(text)) {
        return *number < kFirstMilliseconds ? *number : *number / 1000.0;
    }
    std::string iso(text);
    if (const std::size_t blank = iso.find(' '); blank != std::string::npos) {
        iso[blank] = 'T';
    }
    const auto time = documents::parseIsoTime(iso);
    return time
               ? std::optional<double>(time->date.secondsSinceReferenceDate + platform::kSecondsFrom1970ToReferenceDate)
               : std::nullopt;
}

Report PhoneMessages::parameters(std::string_view form) {
    const UrlQuery query = UrlQuery::read(form);
    Report report;
    report.device = query.find("id").value_or(query.find("deviceid").value_or(""));
    auto latitude = numberIn(query, {"lat"});
    auto longitude = numberIn(query, {"lon"});
    if (const auto both = query.find("location"); both && !latitude) {
        const std::size_t comma = both->find(',');
        latitude = numberOf(std::string_view(*both).substr(0, comma));
        longitude = comma == std::string::npos ? std::nullopt : numberOf(std::string_view(*both).substr(comma + 1));
    }
    if (!latitude || !longitude) {
        return report;
    }
    const auto time = query.find("timestamp") ? query.find("timestamp") : query.find("time");
    report.kind = Report::Kind::Position;
    report.fixes = {{time ? timeOf(*time) : std::nullopt, *latitude, *longitude, numberIn(query, {"accuracy", "acc"})}};
    return report;
}

Report PhoneMessages::traccar(std::string_view body) {
    const auto document = documents::JsonReader::read(body);
    const auto* value = std::get_if<Value>(&document);
    const Dictionary* message = value == nullptr ? nullptr : value->dictionary();
    if (message == nullptr) {
        return {};
    }
    Report report;
    if (const std::string* device = textIn(*message, "device_id")) {
        report.device = *device;
    }
    const Value* locationValue = message->find("location");
    const Dictionary* location = locationValue == nullptr ? nullptr : locationValue->dictionary();
    const Value* coordsValue = location == nullptr ? nullptr : location->find("coords");
    const Dictionary* coords = coordsValue == nullptr ? nullptr : coordsValue->dictionary();
    const auto latitude = coords == nullptr ? std::nullopt : numberIn(*coords, "latitude");
    const auto longitude = coords == nullptr ? std::nullopt : numberIn(*coords, "longitude");
    if (!latitude || !longitude) {
        return report;
    }
    RawFix fix{numberIn(*location, "timestamp"), *latitude, *longitude, numberIn(*coords, "accuracy")};
    if (const std::string* text = textIn(*location, "timestamp")) {
        fix.time = timeOf(*text);
    }
    report.kind = Report::Kind::Position;
    report.fixes = {fix};
    return report;
}

}  // namespace ktr::server
