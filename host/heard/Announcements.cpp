#include "host/heard/Announcements.h"

#include <algorithm>
#include <unordered_set>

#include "platform/base/Format.h"

namespace ktr::host {

using platform::AccessibilitySubject;
using Whereabouts = AccessibilitySubject::Whereabouts;

Announcements::Announcements(std::shared_ptr<platform::MainLoop> mainLoop, Words words, std::function<State()> look,
                             std::function<void(const std::string&)> say)
    : mainLoop_(std::move(mainLoop)), words_(std::move(words)), look_(std::move(look)), say_(std::move(say)) {}

Announcements::~Announcements() {
    if (timer_) {
        timer_->invalidate();
    }
}

void Announcements::answerCame(const std::string& sentence, std::size_t people) {
    answers_.emplace_back(sentence, people);
    changed();
}

void Announcements::changed() {
    pending_ = true;
    if (!timer_) {
        wait(kCollect);
    }
}

void Announcements::wait(double seconds) {
    // Ended with this object: `this` outlives what it waits for.
    timer_ = mainLoop_->schedule(seconds, false, [this] { waitIsOver(); });
}

void Announcements::waitIsOver() {
    timer_.reset();
    quiet_ = false;
    if (pending_) {
        announce();
    }
    if (quiet_) {
        wait(kQuiet);
    }
}

void Announcements::announce() {
    pending_ = false;
    const State state = look_();
    const Sentences sentences = news(state);
    std::string message;
    // A friend may stand in several answers.
    for (auto sentence = sentences.begin(); sentence != sentences.end(); ++sentence) {
        if (!sentence->empty() && std::find(sentences.begin(), sentence, *sentence) == sentence) {
            add(message, *sentence);
        }
    }
    quiet_ = state.listening && !message.empty();
    if (quiet_) {
        say_(message);
    }
}

Announcements::Sentences Announcements::news(const State& state) {
    Sentences sentences;
    for (const auto& [answer, people] : std::exchange(answers_, {})) {
        sentences.push_back(answer);
        sentences.push_back(peopleText(people));
    }
    auto told = std::exchange(toldOf_, {});
    for (const Card& card : state.cards) {
        const auto known = told.find(card.identity);
        People& people = toldOf_[card.identity];
        if (known != told.end()) {
            people = std::move(known->second);
            compare(card, people, sentences);
        }
        for (const AccessibilitySubject& person : card.people) {
            people[person.handle + '\n' + person.person] = person;
        }
    }
    if (state.reachable != std::exchange(toldReachable_, state.reachable)) {
        sentences.push_back(words_.text(state.reachable ? "ANNOUNCE_REACHABLE" : "ANNOUNCE_UNREACHABLE"));
    }
    return sentences;
}

void Announcements::compare(const Card& card, People& told, Sentences& sentences) const {
    std::unordered_set<std::string> present;
    Sentences newcomers;
    for (const AccessibilitySubject& person : card.people) {
        const std::string key = person.handle + '\n' + person.person;
        present.insert(key);
        if (const auto before = told.find(key); before != told.end()) {
            sentences.push_back(changeOf(before->second, person));
        } else if (person.whereabouts == Whereabouts::Known) {
            newcomers.push_back(person.place.empty() ? "" : sentence("ANNOUNCE_PLACE", person));
        }
    }
    if (newcomers.size() > kMostNamed) {
        newcomers = {peopleText(card.people.size())};
    }
    sentences.insert(sentences.end(), newcomers.begin(), newcomers.end());
    // A list leaves out who cannot be seen.
    for (auto& [key, person] : told) {
        if (!present.contains(key) && person.whereabouts != Whereabouts::Unknown) {
            person.whereabouts = Whereabouts::Unknown;
            sentences.push_back(sentence("ANNOUNCE_UNSEEN", person));
        }
    }
}

void Announcements::add(std::string& message, const std::string& sentence) const {
    message = message.empty() ? sentence : platform::formatted(words_.text("ANNOUNCE_NEXT"), {message, sentence});
}

std::string Announcements::peopleText(std::size_t people) const {
    return people == 0 ? "" : platform::formatted(words_.text("ANNOUNCE_PEOPLE"), {words_.number(people)});
}

std::string Announcements::sentence(const char* key, const AccessibilitySubject& about) const {
    return platform::formatted(words_.text(key), {about.person, about.place});
}

std::string Announcements::changeOf(const AccessibilitySubject& before, const AccessibilitySubject& now) const {
    if (now.whereabouts == Whereabouts::Known) {
        if (before.whereabouts == Whereabouts::Unknown) {
            return sentence(now.place.empty() ? "ANNOUNCE_SEEN_SOMEWHERE" : "ANNOUNCE_SEEN", now);
        }
        return now.place.empty() || now.place == before.place ? "" : sentence("ANNOUNCE_PLACE", now);
    }
    return now.whereabouts == Whereabouts::Unknown && before.whereabouts != Whereabouts::Unknown
               ? sentence("ANNOUNCE_UNSEEN", now)
               : "";
}

}  // namespace ktr::host
