#include "ask/Sight.h"

#include <algorithm>
#include <cmath>
#include <cstdlib>
#include <map>
#include <utility>

#include "ask/FoldedText.h"

namespace ktr::ask {

using platform::Dictionary;
using platform::Value;

namespace {

/// Seconds for which a sentence without a time is true enough.
constexpr double kPresent = 120.0;
constexpr double kMillisecondsASecond = 1000.0;
constexpr int kOk = 200;
constexpr const char* kLabelBegins = "_$!<";
constexpr const char* kLabelEnds = ">!$_";

const Dictionary* objectIn(const Dictionary& object, const char* name) {
    const Value* value = object.find(name);
    return value == nullptr ? nullptr : value->dictionary();
}

std::string textIn(const Dictionary& object, const char* name) {
    const Value* value = object.find(name);
    return value == nullptr || value->string() == nullptr ? std::string() : *value->string();
}

std::optional<double> numberIn(const Dictionary& object, const char* name) {
    const Value* value = object.find(name);
    const auto number = value == nullptr ? std::nullopt : value->number();
    return number && std::isfinite(*number) ? number : std::nullopt;
}

std::string lowerAscii(std::string text) {
    for (char& c : text) {
        c = c >= 'A' && c <= 'Z' ? static_cast<char>(c - 'A' + 'a') : c;
    }
    return text;
}

/// "home" of "_$!<home>!$_"; empty for a name.
std::string kindOf(const std::string& label) {
    const std::string begins = kLabelBegins;
    const std::string ends = kLabelEnds;
    if (label.size() <= begins.size() + ends.size() || label.compare(0, begins.size(), begins) != 0 ||
        label.compare(label.size() - ends.size(), ends.size(), ends) != 0) {
        return {};
    }
    return lowerAscii(label.substr(begins.size(), label.size() - begins.size() - ends.size()));
}

std::optional<Sight> sightOf(const Dictionary& entry) {
    const Dictionary* location = objectIn(entry, "location");
    const auto status = numberIn(entry, "status");
    if (location == nullptr || (status && *status != kOk)) {
        return std::nullopt;
    }
    const auto latitude = numberIn(*location, "latitude");
    const auto longitude = numberIn(*location, "longitude");
    // 0/0 is how the protocol says that there is none.
    if (!latitude || !longitude || std::abs(*latitude) > 90.0 || std::abs(*longitude) > 180.0 ||
        (*latitude == 0.0 && *longitude == 0.0)) {
        return std::nullopt;
    }
    Sight sight;
    sight.latitude = *latitude;
    sight.longitude = *longitude;
    sight.accuracy = numberIn(*location, "horizontalAccuracy");
    if (const auto time = numberIn(*location, "timestamp")) {
        sight.time = {*time / kMillisecondsASecond - platform::kSecondsFrom1970ToReferenceDate};
        sight.hasTime = true;
    }
    sight.street = textIn(*location, "streetAddress");
    if (const Dictionary* address = objectIn(*location, "address")) {
        sight.city = textIn(*address, "locality");
        sight.state = textIn(*address, "stateCode");
    }
    if (const Value* labels = location->find("labels"); labels != nullptr && labels->array() != nullptr) {
        for (const Value& label : *labels->array()) {
            if (label.dictionary() != nullptr && !textIn(*label.dictionary(), "label").empty()) {
                const Value* phrase = label.dictionary()->find("phrase");
                sight.isPhrase =
                    sight.isPhrase || (sight.labels.empty() && phrase != nullptr && phrase->boolean() == true);
                sight.labels.push_back(textIn(*label.dictionary(), "label"));
            }
        }
    }
    // Text in the protocol: "310.52".
    if (const Value* distance = entry.find("distanceInMeters"); distance != nullptr && distance->string() != nullptr) {
        char* end = nullptr;
        const double metres = std::strtod(distance->string()->c_str(), &end);
        if (end != distance->string()->c_str() && *end == '\0' && std::isfinite(metres) && metres >= 0.0) {
            sight.metres = metres;
        }
    }
    return sight;
}

void setWhenPresent(Dictionary& object, const char* name, const std::string& text) {
    if (!text.empty()) {
        object.set(name, text);
    }
}

/// As a part of a context, which white space, "&" and "=" would end.
std::string escaped(const std::string& text) {
    constexpr const char* kHex = "0123456789ABCDEF";
    std::string escaped;
    for (const char c : text) {
        const auto byte = static_cast<unsigned char>(c);
        if (std::isalnum(byte) != 0 || c == '-' || c == '.' || c == '_' || c == '~' || c == '@') {
            escaped += c;
        } else {
            escaped += {'%', kHex[byte / 16], kHex[byte % 16]};
        }
    }
    return escaped;
}

}  // namespace

double Sight::from(const World& world, double otherLatitude, double otherLongitude) const {
    return world.metres(latitude, longitude, otherLatitude, otherLongitude);
}

bool Sight::isCalled(const std::u32string& name) const {
    const auto is = [&](const std::string& text) { return !text.empty() && FoldedText::of(text) == name; };
    return std::any_of(labels.begin(), labels.end(), is) || is(street) || is(city);
}

std::string Sight::sort(const Language& language) const {
    for (const std::string& label : labels) {
        const std::string kind = kindOf(label);
        std::string sort = kind.empty() ? language.placeWord(label) : kind;
        if (language.kindOf(sort) != nullptr) {
            return sort;
        }
    }
    return {};
}

std::string Sight::where(const Sentences& sentences) const {
    if (const auto* known = sentences.language().kindOf(sort(sentences.language()))) {
        return known->said;
    }
    // A sort of place without words here: the name beside it, if there is one.
    if (!labels.empty() && kindOf(labels.back()).empty()) {
        const std::string& place = kindOf(labels.front()).empty() ? labels.front() : labels.back();
        // "Quay Road, Brinmouth" is no place of its own.
        const bool isStreet = !street.empty() && place.compare(0, street.size(), street) == 0;
        return sentences.text(isPhrase ? "byItself" : isStreet ? "onStreet" : "atPlace", {{"place", place}});
    }
    if (!street.empty()) {
        return sentences.text("onStreet", {{"place", street}});
    }
    if (!city.empty()) {
        return sentences.text("inTown", {{"place", state.empty() ? city : city + ", " + state}});
    }
    return {};
}

bool Sight::isOfNow(const Question& question) const {
    return hasTime && question.now.secondsSinceReferenceDate - time.secondsSinceReferenceDate <= kPresent;
}

bool Sight::isPresent(const Question& question) const {
    return !question.isLive && isOfNow(question);
}

std::string Sight::distance(const World& world, const std::string& language) const {
    const auto text = metres && world.distance ? world.distance(*metres, language) : std::nullopt;
    return text.value_or("");
}

std::string Sight::sentence(const Sentences& sentences, const Question& question, const World& world) const {
    const std::string words = where(sentences);
    const std::string far = distance(world, sentences.language().tag());
    const bool isPresent = this->isPresent(question);
    // Without a time of its own it is known since now at the latest.
    const platform::Date moment = hasTime ? time : question.now;
    return sentences.text(words.empty() ? "foundNoWords" : "found", {{"name", person->shownName()},
                                                                     {"where", words},
                                                                     {"distance", far},
                                                                     {"far", far.empty() ? "no" : "yes"},
                                                                     {"when", isPresent ? "now" : "then"},
                                                                     {"time", sentences.time(moment, question.now)}});
}

std::vector<Sight> sightsIn(const Dictionary& answer, const std::vector<const Person*>& asked) {
    const Dictionary* locations = objectIn(answer, "locations");
    std::vector<Sight> sights;
    if (locations == nullptr) {
        return sights;
    }
    std::map<std::string, std::pair<std::string, const Dictionary*>> entries;
    for (const auto& [handle, entry] : *locations) {
        if (entry.dictionary() != nullptr) {
            entries.emplace(lowerAscii(handle), std::pair(handle, entry.dictionary()));
        }
    }
    for (const Person* person : asked) {
        std::optional<Sight> best;
        const auto look = [&](const std::string& own) {
            const auto entry = entries.find(lowerAscii(own));
            auto sight = entry == entries.end() ? std::nullopt : sightOf(*entry->second.second);
            if (sight && (!best || sight->time.secondsSinceReferenceDate > best->time.secondsSinceReferenceDate)) {
                best = std::move(sight);
                best->person = person;
                best->handle = entry->second.first;
            }
        };
        std::for_each(person->emails.begin(), person->emails.end(), look);
        std::for_each(person->phones.begin(), person->phones.end(), look);
        if (best) {
            sights.push_back(std::move(*best));
        }
    }
    return sights;
}

Value friendOf(const Person& person, const std::string& handle) {
    Dictionary object;
    setWhenPresent(object, "fullName", person.shownName());
    setWhenPresent(object, "firstName", person.firstName);
    setWhenPresent(object, "lastName", person.lastName);
    setWhenPresent(object, "identifier", person.identifier);
    Value::Array emails;
    for (const std::string& email : person.emails) {
        emails.emplace_back(Dictionary{{"emailAddress", email}});
    }
    Value::Array phones;
    for (const std::string& phone : person.phones) {
        phones.emplace_back(Dictionary{{"number", phone}});
    }
    object.set("emails", emails);
    object.set("phones", phones);
    Dictionary one{{"object", object}};
    setWhenPresent(one, "data", handle);
    return one;
}

std::string contextOf(const Dictionary& answer, const Dictionary& more) {
    std::string context = "ktrServerContext://serverContext?";
    const Dictionary* given = objectIn(answer, "serverContext");
    for (const Dictionary* members : {given, &more}) {
        if (members == nullptr) {
            continue;
        }
        for (const auto& [name, value] : *members) {
            // A secret has no place in an address.
            if (name != "authToken" && (value.string() != nullptr || value.isNumber() || value.boolean())) {
                context += escaped(name) + "=" + escaped(value.description()) + "&";
            }
        }
    }
    return context;
}

Value snippetOf(const std::vector<Sight>& sights, const Dictionary& answer, const char* proximity) {
    Value::Array locations;
    for (const Sight& sight : sights) {
        Dictionary location{{"friend", friendOf(*sight.person, sight.handle)},
                            {"latitude", sight.latitude},
                            {"longitude", sight.longitude}};
        if (sight.accuracy) {
            location.set("accuracy", *sight.accuracy);
        }
        setWhenPresent(location, "label", sight.labels.empty() ? std::string() : sight.labels.front());
        setWhenPresent(location, "street", sight.street);
        setWhenPresent(location, "city", sight.city);
        setWhenPresent(location, "stateCode", sight.state);
        if (sight.hasTime) {
            location.set("locationDate", sight.time.secondsSinceReferenceDate);
        }
        locations.emplace_back(location);
    }
    Dictionary snippet{{"kind", "VAKtrLocationSnippet"}, {"searchContext", contextOf(answer)}};
    if (proximity != nullptr) {
        snippet.set("proximity", proximity);
    }
    snippet.set("locations", locations);
    return snippet;
}

}  // namespace ktr::ask
