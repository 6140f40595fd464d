#include "ask/WishAnswers.h"

#include <algorithm>

#include "ask/Sight.h"

namespace ktr::ask {

using platform::Dictionary;
using platform::Value;

namespace {

constexpr double kMillisecondsASecond = 1000.0;
/// So that a fence is seen whole: this many times its radius, in degrees of latitude.
constexpr double kZoomByRadius = 2.5 / 111320.0;

const Dictionary* objectIn(const Dictionary& object, const char* name) {
    const Value* value = object.find(name);
    return value == nullptr ? nullptr : value->dictionary();
}

bool isTrue(const Dictionary& object, const char* name) {
    const Value* value = object.find(name);
    return value != nullptr && value->boolean() == true;
}

std::string textIn(const Dictionary& object, const char* name) {
    const Value* value = object.find(name);
    return value == nullptr || value->string() == nullptr ? std::string() : *value->string();
}

}  // namespace

bool WishAnswers::isFence() const {
    const Wish wish = asking_.understood.meaning.wish;
    return wish == Wish::TellArrives || wish == Wish::TellLeaves || wish == Wish::TellNow;
}

std::string WishAnswers::names() const {
    std::vector<std::string> names;
    for (const Person* person : asking_.understood.people) {
        names.push_back(person->shownName());
    }
    return sentences_.list(names);
}

std::optional<Answer> WishAnswers::impossible() const {
    const Understood& understood = asking_.understood;
    const Wish wish = understood.meaning.wish;
    if (isFence() && understood.placeWord == "me" && !asking_.question.position) {
        return asking_.answer(Outcome::Refused, sentences_.text("noPosition"));
    }
    if (isFence() && understood.people.size() != 1) {
        return asking_.answer(Outcome::Refused, sentences_.text("oneAtATime"));
    }
    const bool isForAll = understood.people.empty();
    if (wish == Wish::Hide && understood.until) {
        return asking_.answer(Outcome::Refused, sentences_.text("hideWithoutEnd"));
    }
    if (wish == Wish::Share && isForAll && (understood.until || understood.meaning.precision)) {
        return asking_.answer(Outcome::Refused, sentences_.text("shareWithWhom"));
    }
    const auto hasNoHandle = [](const Person* person) { return person->handle().empty(); };
    if (std::any_of(understood.people.begin(), understood.people.end(), hasNoHandle)) {
        return asking_.answer(Outcome::Refused, sentences_.text("noHandle", {{"name", names()}}));
    }
    return std::nullopt;
}

std::pair<std::string, Dictionary> WishAnswers::request() const {
    const Understood& understood = asking_.understood;
    const Meaning& meaning = understood.meaning;
    Dictionary members;
    if (meaning.wish == Wish::AskToShare) {
        Value::Array handles;
        for (const Person* person : understood.people) {
            handles.emplace_back(person->handle());
        }
        return {"askToShare", Dictionary{{"handles", handles}}};
    }
    if (isFence()) {
        members.set("handle", understood.people.front()->handle());
        members.set("trigger", meaning.wish == Wish::TellArrives ? "OnArrival" : "OnDeparture");
        if (understood.placeWord == "me") {
            if (const auto& position = asking_.question.position) {
                members.set("place", Dictionary{{"latitude", position->latitude}, {"longitude", position->longitude}});
            }
        } else if (!meaning.place.empty() || !understood.placeWord.empty()) {
            // A person's own place goes by its sort.
            members.set("place",
                        Dictionary{{"name", understood.placeWord.empty() ? meaning.place : understood.placeWord}});
        }
        members.set("once", !meaning.everyTime);
        return {"setFence", members};
    }
    members.set("wish", meaning.wish == Wish::Hide ? "hide" : meaning.wish == Wish::Share ? "share" : "read");
    Value::Array with;
    for (const Person* person : understood.people) {
        with.emplace_back(person->handle());
    }
    if (!with.empty()) {
        members.set("with", with);
    }
    if (understood.until) {
        members.set("until", (understood.until->secondsSinceReferenceDate + platform::kSecondsFrom1970ToReferenceDate) *
                                 kMillisecondsASecond);
    }
    if (meaning.precision) {
        members.set("precision", nameOf(*meaning.precision));
    }
    return {"sharing", members};
}

Answer WishAnswers::done(const Dictionary& answer) const {
    if (asking_.understood.meaning.wish == Wish::AskToShare) {
        // Whether anybody was there to be asked is said to nobody.
        return asking_.answer(
            Outcome::Found,
            sentences_.text("askedToShare", {{"name", names()},
                                             {"time", sentences_.time(asking_.question.now, asking_.question.now)}}));
    }
    return isFence() ? fence(answer) : sharing(answer);
}

Answer WishAnswers::refused() const {
    if (isFence()) {
        return asking_.answer(Outcome::Refused, sentences_.text("fenceRefused", {{"name", names()}}));
    }
    return asking_.answer(Outcome::Refused, sentences_.text("notDone"));
}

Answer WishAnswers::sharing(const Dictionary& answer) const {
    const Understood& understood = asking_.understood;
    const bool isHidden = isTrue(answer, "hidden");
    std::vector<std::string> viewers;
    if (const Value* given = answer.find("viewers"); given != nullptr && given->array() != nullptr) {
        for (const Value& viewer : *given->array()) {
            if (viewer.dictionary() != nullptr && !textIn(*viewer.dictionary(), "name").empty()) {
                viewers.push_back(textIn(*viewer.dictionary(), "name"));
            }
        }
    }
    std::string sentence;
    if (!understood.people.empty()) {
        const bool shares = understood.meaning.wish == Wish::Share;
        sentence = sentences_.text(
            shares ? "sharedWith" : "hiddenFrom",
            {{"names", names()},
             {"end", understood.until ? "yes" : "no"},
             {"time", understood.until ? sentences_.time(*understood.until, asking_.question.now) : ""}});
        if (shares && isHidden) {
            sentence += " " + sentences_.text("youAreHidden");
        }
    } else if (isHidden) {
        sentence = sentences_.text("youAreHidden");
    } else if (understood.meaning.wish != Wish::WhoSees) {
        sentence = sentences_.text("youAreShown");
    } else {
        sentence =
            sentences_.text(viewers.empty() ? "nobodySeesYou" : "whoSees", {{"names", sentences_.list(viewers)}});
    }
    const bool tellsHidden = isHidden && understood.meaning.wish == Wish::WhoSees;
    Answer done = asking_.answer(tellsHidden ? Outcome::Hidden : Outcome::Found, sentence);
    Dictionary more;
    if (const Dictionary* mine = objectIn(answer, "myInfo");
        mine != nullptr && !textIn(*mine, "preferredEmail").empty()) {
        more.set("preferredEmail", textIn(*mine, "preferredEmail"));
    }
    // Who shares with one friend has a sentence; the card is about all of them.
    if (understood.people.empty()) {
        done.snippet = Dictionary{
            {"kind", "VAKtrVisibilityView"}, {"searchContext", contextOf(answer, more)}, {"visible", !isHidden}};
    }
    return done;
}

Answer WishAnswers::fence(const Dictionary& answer) const {
    const Understood& understood = asking_.understood;
    const Person& person = *understood.people.front();
    const Dictionary* kept = objectIn(answer, "fence");
    const Dictionary* place = kept == nullptr ? nullptr : objectIn(*kept, "place");
    if (place == nullptr) {
        return asking_.failed(ServiceReply::Failure::Unreachable);
    }
    // What is kept may be wider than what was asked for: that is what is drawn.
    const auto number = [&](const char* name) {
        const Value* value = place->find(name);
        return value == nullptr ? 0.0 : value->number().value_or(0.0);
    };
    Dictionary location{
        {"latitude", number("latitude")}, {"longitude", number("longitude")}, {"accuracy", number("radius")}};
    for (const char* name : {"name", "label"}) {
        if (const std::string text = textIn(*place, name); !text.empty()) {
            location.set("label", text);
        }
    }
    const bool leaves = understood.meaning.wish == Wish::TellLeaves;
    const auto* kind = asking_.language->kindOf(understood.placeWord);
    Answer done = asking_.answer(
        Outcome::Found, sentences_.text(leaves ? "fenceLeaves" : "fenceArrives",
                                        {{"name", person.shownName()},
                                         {"place", kind != nullptr ? kind->said : understood.meaning.place},
                                         {"which", kind == nullptr && understood.meaning.place.empty() ? "no" : "yes"},
                                         {"every", understood.meaning.everyTime ? "yes" : "no"}}));
    const double metres = number("radius");
    done.snippet = Dictionary{
        {"kind", "VAKtrGeoFenceSnippet"},
        {"searchContext", contextOf(answer, {{"geoFenceZoomLevel", Value(metres * kZoomByRadius).description()}})},
        {"cueKtrGeoFence", Dictionary{{"friend", friendOf(person, person.handle())},
                                      {"geoFenceTrigger", leaves ? "OnDeparture" : "OnArrival"},
                                      {"location", location}}}};
    return done;
}

}  // namespace ktr::ask
