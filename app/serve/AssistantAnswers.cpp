#include "app/serve/AssistantAnswers.h"

#include <QString>
#include <QStringList>
#include <algorithm>
#include <cmath>
#include <initializer_list>

#include "platform/base/Date.h"

namespace ktr::app {

using platform::Dictionary;
using platform::Value;

namespace {

/// The words of a text, without regard to case and punctuation; what stands in an e-mail address or a number stays.
QStringList wordsOf(const std::string& text) {
    QStringList words(QString{});
    for (const char32_t c : QString::fromStdString(text).toCaseFolded().toStdU32String()) {
        if (c == U'\'' || c == U'\u2019') {
            continue;  // "where's" is one word
        }
        if (QChar::isLetterOrNumber(c) || QChar::isMark(c) || c == U'@' || c == U'.' || c == U'+' || c == U'-') {
            words.back() += QString::fromUcs4(&c, 1);
        } else if (!words.back().isEmpty()) {
            words.append(QString());
        }
    }
    for (QString& word : words) {
        while (word.endsWith(QLatin1Char('.'))) {
            word.chop(1);
        }
    }
    words.removeAll(QString());
    return words;
}

bool hasAny(const QStringList& words, std::initializer_list<const char*> wanted) {
    return std::any_of(wanted.begin(), wanted.end(),
                       [&](const char* word) { return words.contains(QLatin1String(word)); });
}

/// Whether all words of `part` follow each other in `words`.
bool holds(const QStringList& words, const QStringList& part) {
    return !part.isEmpty() && std::search(words.begin(), words.end(), part.begin(), part.end()) != words.end();
}

std::string nameOf(const ServedFriend& person) {
    if (!person.fullName.empty()) {
        return person.fullName;
    }
    return person.emails.empty() ? person.phones.front() : person.emails.front();
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
    const std::string& handle = person.emails.empty() ? person.phones.front() : person.emails.front();
    return Dictionary{{"data", handle}, {"object", object}};
}

}  // namespace

std::vector<const ServedFriend*> AssistantAnswers::friendsNamed(const std::string& question) const {
    const QStringList words = wordsOf(question);
    std::vector<const ServedFriend*> whole;
    std::vector<const ServedFriend*> part;
    for (const ServedFriend& person : service_.file().friends) {
        const auto named = [&](const std::string& name) { return holds(words, wordsOf(name)); };
        if (named(person.fullName) || std::any_of(person.emails.begin(), person.emails.end(), named)) {
            whole.push_back(&person);
        } else if (named(person.firstName) || named(person.lastName)) {
            part.push_back(&person);
        }
    }
    // "Ann Marsh" means her alone, "Ann" every Ann.
    return whole.empty() ? part : whole;
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
    const auto milliseconds = [](double seconds) { return Value(std::round(seconds * 1000.0)).description(); };
    const std::string context = "ktrServerContext://serverContext?clientId=ktr-serve&minCallbackIntervalInMS=" +
                                milliseconds(service_.file().intervalSeconds) +
                                "&callbackTimeoutIntervalInMS=" + milliseconds(service_.file().timeoutSeconds) + "&";
    Dictionary snippet{{"kind", "VAKtrLocationSnippet"}, {"searchContext", context}};
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
           "?\", \"Where are my friends?\" or \"Who is near me?\"";
}

Dictionary AssistantAnswers::answer(const std::string& question, const ServiceMoment& moment) const {
    const QStringList words = wordsOf(question);
    std::vector<const ServedFriend*> friends = friendsNamed(question);
    const char* proximity = nullptr;
    const bool asks = hasAny(words, {"where", "wheres", "find", "locate", "show"});
    bool understood = !friends.empty() && (asks || words.size() <= 3);
    if (understood) {
        proximity = friends.size() > 1 ? "friends" : nullptr;
    } else if (friends.empty()) {
        const bool near = hasAny(words, {"near", "nearby", "around", "close"});
        understood = near || (asks && hasAny(words, {"friends", "everybody", "everyone", "all"}));
        proximity = near ? "nearby" : "friends";
        for (const ServedFriend& person : service_.file().friends) {
            if (understood && (!near || person.placeAt(moment.seconds))) {
                friends.push_back(&person);
            }
        }
    }
    Dictionary turn{{"question", question}, {"sentence", understood ? sentence(friends, moment) : help()}};
    if (understood) {
        turn.set("snippet", snippet(friends, proximity, moment));
    }
    return turn;
}

}  // namespace ktr::app
