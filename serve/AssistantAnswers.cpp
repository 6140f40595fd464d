#include "serve/AssistantAnswers.h"

#include <QUrl>
#include <algorithm>
#include <array>
#include <cmath>

#include "platform/base/Date.h"

namespace ktr::serve {

using platform::Dictionary;
using platform::Value;

namespace {

/// Metres around the place of a fence.
constexpr double kFenceRadius = 100.0;
/// So that a fence of that radius is seen whole: about 2.5 times as much, in degrees of latitude.
constexpr const char* kFenceZoom = "0.00225";

std::string nameOf(const ServedFriend& person) {
    for (const std::string& name : {person.fullName, person.handle(), person.firstName, person.lastName}) {
        if (!name.empty()) {
            return name;
        }
    }
    return "Somebody";
}

/// As a value in a context, which white space, "&" and "=" would end.
std::string escaped(const std::string& text) {
    return QUrl::toPercentEncoding(QString::fromStdString(text), "@").toStdString();
}

void setWhenPresent(Dictionary& dictionary, const char* name, const std::string& text) {
    if (!text.empty()) {
        dictionary.set(name, text);
    }
}

Value personOf(const ServedFriend& person) {
    Dictionary object;
    setWhenPresent(object, "fullName", person.fullName);
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
    // Somebody whom a scenario describes may have neither.
    Dictionary friendOf{{"object", object}};
    setWhenPresent(friendOf, "data", person.handle());
    return friendOf;
}

}  // namespace

std::vector<const ServedFriend*> AssistantAnswers::friendsNamed(const QuestionWords& question) const {
    std::vector<const ServedFriend*> whole;
    std::vector<const ServedFriend*> part;
    for (const ServedFriend& person : service_.file().friends) {
        const auto named = [&](const std::string& name) { return question.holds(QuestionWords(name)); };
        if (named(person.fullName) || std::any_of(person.emails.begin(), person.emails.end(), named)) {
            whole.push_back(&person);
        } else if (named(person.firstName) || named(person.lastName)) {
            part.push_back(&person);
        }
    }
    // "Ann Marsh" means her alone, "Ann" every Ann.
    return whole.empty() ? part : whole;
}

std::string AssistantAnswers::context() const {
    const auto milliseconds = [](double seconds) { return Value(std::round(seconds * 1000.0)).description(); };
    return "ktrServerContext://serverContext?clientId=ktr-serve&minCallbackIntervalInMS=" +
           milliseconds(service_.file().intervalSeconds) +
           "&callbackTimeoutIntervalInMS=" + milliseconds(service_.file().timeoutSeconds) + "&";
}

Value AssistantAnswers::snippet(const std::vector<const ServedFriend*>& friends, const char* proximity,
                                const ServiceMoment& moment) const {
    Value::Array locations;
    for (const ServedFriend* person : friends) {
        Dictionary location{{"friend", personOf(*person)}};
        if (const auto place = person->placeAt(moment.seconds)) {
            location.set("latitude", place->latitude);
            location.set("longitude", place->longitude);
            location.set("accuracy", place->accuracy);
            setWhenPresent(location, "label", place->label.value_or(""));
            setWhenPresent(location, "street", place->street.value_or(""));
            setWhenPresent(location, "city", place->city.value_or(""));
            setWhenPresent(location, "stateCode", place->stateCode.value_or(""));
            location.set("locationDate",
                         moment.millisecondsSince1970 / 1000.0 - platform::kSecondsFrom1970ToReferenceDate);
        }
        locations.emplace_back(location);
    }
    Dictionary snippet{{"kind", "VAKtrLocationSnippet"}, {"searchContext", context()}};
    if (proximity != nullptr) {
        snippet.set("proximity", proximity);
    }
    snippet.set("locations", locations);
    return snippet;
}

std::string AssistantAnswers::sentence(const std::vector<const ServedFriend*>& friends,
                                       const ServiceMoment& moment) const {
    if (friends.empty()) {
        return "Let me see who is around.";
    }
    if (friends.size() > 1) {
        return "Here is where they are.";
    }
    const ServedFriend& person = *friends.front();
    const auto place = person.placeAt(moment.seconds);
    if (!place) {
        return "Looking for " + nameOf(person) + ".";
    }
    if (place->label) {
        return nameOf(person) + " is here: " + *place->label + ".";
    }
    return nameOf(person) + (place->city ? " is in " + *place->city + "." : " is here.");
}

std::string AssistantAnswers::help() const {
    std::string name = "Ann";
    for (const ServedFriend& person : service_.file().friends) {
        if (!person.firstName.empty()) {
            name = person.firstName;
            break;
        }
    }
    return "I can tell where your friends are. Ask \"Where is " + name +
           "?\", \"Where are my friends?\" or \"Who is near me?\", say \"Tell me when " + name +
           " leaves work\" or \"Hide my location\".";
}

Dictionary AssistantAnswers::sharingAnswer(SharingQuestion::Wish wish, const ServiceMoment& moment) const {
    SharingState& sharing = service_.sharing();
    if (wish != SharingQuestion::Wish::Know) {
        sharing.wish(wish == SharingQuestion::Wish::Hide, moment.wholeSeconds());
    }
    const bool hidden = sharing.now().hidden;
    const std::string state = hidden ? "Friends can\u2019t see where you are." : "Friends can see where you are.";
    std::string searchContext = context();
    if (const auto& emails = service_.file().user.emails; !emails.empty()) {
        searchContext += "preferredEmail=" + escaped(emails.front()) + "&";
    }
    return Dictionary{
        {"sentence", wish == SharingQuestion::Wish::Know ? state : "Done. " + state},
        {"snippet",
         Dictionary{{"kind", "VAKtrVisibilityView"}, {"searchContext", searchContext}, {"visible", !hidden}}}};
}

std::optional<Waypoint> AssistantAnswers::placeNamed(const QString& words, const ServedFriend& person,
                                                     const ServiceMoment& moment) const {
    if (words.isEmpty()) {
        return person.placeAt(moment.seconds);
    }
    if (words == QLatin1String("here")) {
        const auto position = service_.sharing().now().position;
        return position ? std::optional(service_.placeAt(position->latitude, position->longitude)) : std::nullopt;
    }
    // What the friend calls so comes first: everybody has a home.
    std::vector<const ServedFriend*> people = {&person};
    const bool everybodysOwn = QuestionWords::isAny(words, {"home", "work", "school", "gym"});
    for (const ServedFriend& other : service_.file().friends) {
        if (!everybodysOwn && &other != &person) {
            people.push_back(&other);
        }
    }
    const auto isMeant = [&](const std::optional<std::string>& name) {
        return name && QuestionWords(*name).words().join(QLatin1Char(' ')) == words;
    };
    for (const ServedFriend* one : people) {
        for (Waypoint waypoint : one->track) {
            if (isMeant(waypoint.label)) {
                if (everybodysOwn) {
                    waypoint.label = "_$!<" + words.toStdString() + ">!$_";
                }
                return waypoint;
            }
            if (isMeant(waypoint.street)) {
                waypoint.label = std::nullopt;
                return waypoint;
            }
        }
    }
    return std::nullopt;
}

Dictionary AssistantAnswers::fenceAnswer(const FenceQuestion& question, const ServedFriend& person,
                                         const Waypoint& place, const ServiceMoment& moment) const {
    using Trigger = FenceQuestion::Trigger;
    const bool leaves = question.trigger == Trigger::Departure;
    server::FenceCircle circle{place.latitude, place.longitude, kFenceRadius};
    if (question.trigger != Trigger::Immediate) {
        const auto kept = service_.setFence(person, circle, !leaves, moment);
        if (!kept) {
            return Dictionary{{"sentence", "I may not tell you when " + nameOf(person) + " comes and goes."}};
        }
        circle = kept->circle;
    }
    Dictionary location{{"latitude", circle.latitude}, {"longitude", circle.longitude}, {"accuracy", circle.radius}};
    if (!question.place.isEmpty()) {
        setWhenPresent(location, "label", place.label.value_or(""));
        setWhenPresent(location, "street", place.street.value_or(""));
    }
    const char* trigger = question.trigger == Trigger::Immediate ? "Immediate" : leaves ? "OnDeparture" : "OnArrival";
    const std::string sentence = question.trigger == Trigger::Immediate
                                     ? "I will tell you where " + nameOf(person) + " is."
                                     : "I will tell you when " + nameOf(person) + (leaves ? " leaves." : " arrives.");
    const Dictionary fence{{"friend", personOf(person)}, {"geoFenceTrigger", trigger}, {"location", location}};
    return Dictionary{{"sentence", sentence},
                      {"snippet", Dictionary{{"kind", "VAKtrGeoFenceSnippet"},
                                             {"searchContext", context() + "geoFenceZoomLevel=" + kFenceZoom + "&"},
                                             {"cueKtrGeoFence", fence}}}};
}

std::optional<Dictionary> AssistantAnswers::fenceAnswer(const QuestionWords& question,
                                                        const std::vector<const ServedFriend*>& friends,
                                                        const ServiceMoment& moment) const {
    const auto fence = FenceQuestion::read(question);
    if (!fence || friends.empty()) {
        return std::nullopt;
    }
    if (friends.size() > 1) {
        return Dictionary{{"sentence", "I can watch one friend at a time."}};
    }
    const ServedFriend& person = *friends.front();
    if (const auto place = placeNamed(fence->place, person, moment)) {
        return fenceAnswer(*fence, person, *place, moment);
    }
    if (fence->needsPlace) {
        return std::nullopt;
    }
    return Dictionary{{"sentence", fence->place.isEmpty() ? "Looking for " + nameOf(person) + "."
                                                          : "I know no such place of " + nameOf(person) + "."}};
}

Dictionary AssistantAnswers::locationsAnswer(const QuestionWords& question, std::vector<const ServedFriend*> friends,
                                             const ServiceMoment& moment) const {
    const char* proximity = nullptr;
    const bool asks = question.hasAny({"where", "wheres", "find", "locate", "show"});
    bool understood = !friends.empty() && (asks || question.words().size() <= 3);
    if (understood) {
        proximity = friends.size() > 1 ? "friends" : nullptr;
    } else if (friends.empty()) {
        const bool near = question.hasAny({"near", "nearby", "around", "close"});
        understood = near || (asks && question.hasAny({"friends", "everybody", "everyone", "all"}));
        proximity = near ? "nearby" : "friends";
        for (const ServedFriend& person : service_.file().friends) {
            if (understood && (!near || person.placeAt(moment.seconds))) {
                friends.push_back(&person);
            }
        }
    }
    if (!understood) {
        return Dictionary{{"sentence", help()}};
    }
    return Dictionary{{"sentence", sentence(friends, moment)}, {"snippet", snippet(friends, proximity, moment)}};
}

Dictionary AssistantAnswers::answer(const std::string& question, const ServiceMoment& moment) const {
    const QuestionWords words(question);
    const auto friends = friendsNamed(words);
    Dictionary answer;
    if (const auto wish = SharingQuestion::wishOf(words)) {
        answer = sharingAnswer(*wish, moment);
    } else if (auto fence = fenceAnswer(words, friends, moment)) {
        answer = *fence;
    } else {
        answer = locationsAnswer(words, friends, moment);
    }
    Dictionary turn{{"question", question}};
    for (const auto& [name, value] : answer) {
        turn.set(name, value);
    }
    return turn;
}

}  // namespace ktr::serve
