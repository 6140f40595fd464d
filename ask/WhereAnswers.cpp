#include "ask/WhereAnswers.h"

#include <algorithm>
#include <utility>

#include "ask/FoldedText.h"

namespace ktr::ask {

namespace {

/// So many friends are told in a sentence each; of more the names alone are listed.
constexpr std::size_t kTold = 3;
constexpr std::size_t kListed = 8;
constexpr double kMillisecondsASecond = 1000.0;
/// So many of those who are not seen can be asked to share.
constexpr std::size_t kOffered = 5;

std::string joined(const std::vector<std::string>& sentences) {
    std::string all;
    for (const std::string& one : sentences) {
        // Full-width full stops bring their own room.
        const bool needsBlank = !all.empty() && !one.empty() &&
                                all.compare(all.size() - std::min<std::size_t>(3, all.size()), 3, "。") != 0;
        all += (needsBlank ? " " : "") + one;
    }
    return all;
}

}  // namespace

WhereAnswers::WhereAnswers(const Asking& asking, std::vector<Sight> sights, const platform::Dictionary& answer)
    : asking_(asking), sentences_(asking.sentences()), sights_(std::move(sights)), answer_(answer) {}

std::vector<const Person*> WhereAnswers::asked(const Understood& understood, const People& people) {
    const Wish wish = understood.meaning.wish;
    std::vector<const Person*> asked = understood.people;
    if (wish == Wish::WhereAll || wish == Wish::NearMe || wish == Wish::NearPlace || wish == Wish::Closest) {
        for (const Person& person : people.all()) {
            if (!person.handle().empty()) {
                asked.push_back(&person);
            }
        }
    }
    return asked;
}

Answer WhereAnswers::answer(const std::vector<Place>& ownPlaces) const {
    switch (asking_.understood.meaning.wish) {
        case Wish::WhereAll:
            return whereAll();
        case Wish::HowFar:
            return howFar();
        case Wish::IsAt:
            return isAt(ownPlaces);
        case Wish::NearMe:
        case Wish::NearPlace:
        case Wish::Closest:
            return near(ownPlaces);
        default:
            return whereIs();
    }
}

std::vector<const Person*> WhereAnswers::unseen() const {
    std::vector<const Person*> unseen;
    for (const Person* person : asking_.understood.people) {
        const bool isSeen =
            std::any_of(sights_.begin(), sights_.end(), [&](const Sight& sight) { return sight.person == person; });
        if (!isSeen) {
            unseen.push_back(person);
        }
    }
    return unseen;
}

std::string WhereAnswers::unseenSentences() const {
    std::vector<std::string> sentences;
    for (const Person* person : unseen()) {
        sentences.push_back(sentences_.text("notSeen", {{"name", person->shownName()}}));
    }
    return joined(sentences);
}

void WhereAnswers::offerUnseen(Answer& answer) const {
    for (const Person* person : unseen()) {
        if (answer.unseen.size() < kOffered) {
            const std::string handle = person->handle();
            // By handle where two have the name: the question has to mean this one.
            const bool isPlain = asking_.people->find(person->shownName(), *asking_.language).index() == 0;
            answer.unseen.push_back(
                {person->shownName(), handle,
                 handle.empty() || !asking_.question.mayChange
                     ? ""
                     : sentences_.text("askToShare", {{"name", isPlain ? person->shownName() : handle}})});
        }
    }
    if (!answer.unseen.empty() && !answer.unseen.front().question.empty()) {
        answer.action = {Action::Kind::AskToShare, answer.unseen.front().question};
    }
}

std::string WhereAnswers::askedSentence() const {
    const platform::Value* given = answer_.find("asked");
    const platform::Dictionary* asked = given == nullptr ? nullptr : given->dictionary();
    std::optional<platform::Date> since;
    for (const Sight& sight : sights_) {
        const platform::Value* one = asked == nullptr ? nullptr : asked->find(sight.handle);
        const auto time = one == nullptr ? std::nullopt : one->number();
        if (!time || sight.isOfNow(asking_.question)) {
            continue;
        }
        const platform::Date moment{*time / kMillisecondsASecond - platform::kSecondsFrom1970ToReferenceDate};
        if (!since || moment.secondsSinceReferenceDate < since->secondsSinceReferenceDate) {
            since = moment;
        }
    }
    return since ? sentences_.text("askedNewer", {{"time", sentences_.time(*since, asking_.question.now)}})
                 : std::string();
}

Answer WhereAnswers::nobodySeen() const {
    const auto& people = asking_.understood.people;
    Answer answer =
        asking_.answer(Outcome::NotSeen, people.empty() ? sentences_.text("nobodySeen") : unseenSentences());
    offerUnseen(answer);
    return answer;
}

Answer WhereAnswers::found(std::string sentence, const std::vector<Sight>& sights, bool isList) const {
    Answer answer = asking_.answer(Outcome::Found, std::move(sentence));
    answer.snippet = snippetOf(sights, answer_,
                               !isList                                           ? nullptr
                               : asking_.understood.meaning.wish == Wish::NearMe ? "nearby"
                                                                                 : "friends");
    for (const Sight& sight : sights) {
        if (sight.hasTime) {
            const double age = asking_.question.now.secondsSinceReferenceDate - sight.time.secondsSinceReferenceDate;
            answer.ageSeconds = std::max(answer.ageSeconds.value_or(0.0), std::max(age, 0.0));
        }
    }
    offerUnseen(answer);
    return answer;
}

Answer WhereAnswers::whereIs() const {
    if (sights_.empty()) {
        return nobodySeen();
    }
    std::vector<std::string> told;
    for (const Sight& sight : sights_) {
        told.push_back(sight.sentence(sentences_, asking_.question, asking_.world));
    }
    told.push_back(askedSentence());
    told.push_back(unseenSentences());
    return found(joined(told), sights_, asking_.understood.people.size() > 1);
}

Answer WhereAnswers::whereAll() const {
    if (sights_.empty()) {
        return nobodySeen();
    }
    std::vector<std::string> told;
    if (sights_.size() <= kTold) {
        for (const Sight& sight : sights_) {
            told.push_back(sight.sentence(sentences_, asking_.question, asking_.world));
        }
        return found(joined(told), sights_, true);
    }
    for (std::size_t i = 0; i < std::min(sights_.size(), kListed); ++i) {
        told.push_back(nameOf(sights_[i]));
    }
    const std::size_t more = sights_.size() - told.size();
    const std::string key = more == 0 ? "seen" : "seenMore";
    return found(sentences_.text(key, {{"names", sentences_.list(told)}, {"count", std::to_string(more)}}), sights_,
                 true);
}

Answer WhereAnswers::howFar() const {
    if (sights_.empty()) {
        return nobodySeen();
    }
    std::vector<std::string> told;
    for (const Sight& sight : sights_) {
        const std::string far = sight.distance(asking_.world, asking_.language->tag());
        const platform::Date moment = sight.hasTime ? sight.time : asking_.question.now;
        told.push_back(far.empty()
                           ? sentences_.text("howFarUnknown", {{"name", nameOf(sight)}})
                           : sentences_.text("howFar", {{"name", nameOf(sight)},
                                                        {"distance", far},
                                                        {"when", sight.isPresent(asking_.question) ? "now" : "then"},
                                                        {"time", sentences_.time(moment, asking_.question.now)}}));
    }
    told.push_back(askedSentence());
    told.push_back(unseenSentences());
    return found(joined(told), sights_, asking_.understood.people.size() > 1);
}

std::optional<WhereAnswers::Place> WhereAnswers::place(const std::vector<Place>& ownPlaces) const {
    const Understood& understood = asking_.understood;
    const auto& position = asking_.question.position;
    if (understood.placeWord == "me" || (understood.meaning.place.empty() && understood.placeWord.empty())) {
        return position ? std::optional(Place{"", position->latitude, position->longitude}) : std::nullopt;
    }
    for (const Sight& sight : sights_) {
        if (sight.person == understood.placePerson) {
            return Place{nameOf(sight), sight.latitude, sight.longitude};
        }
    }
    if (understood.placePerson != nullptr) {
        return std::nullopt;
    }
    const std::u32string name = FoldedText::of(understood.meaning.place);
    for (const Place& own : ownPlaces) {
        const bool isKind = !understood.placeWord.empty() && own.name == "_$!<" + understood.placeWord + ">!$_";
        if (isKind || FoldedText::of(own.name) == name) {
            return Place{understood.meaning.place, own.latitude, own.longitude};
        }
    }
    // Everybody has a home: only the asker's own is meant by the word alone.
    for (const Sight& sight : sights_) {
        if (understood.placeWord.empty() && sight.isCalled(name)) {
            return Place{understood.meaning.place, sight.latitude, sight.longitude};
        }
    }
    return std::nullopt;
}

Answer WhereAnswers::isAt(const std::vector<Place>& ownPlaces) const {
    if (sights_.empty()) {
        return nobodySeen();
    }
    const Understood& understood = asking_.understood;
    const std::u32string name = FoldedText::of(understood.meaning.place);
    const auto known = place(ownPlaces);
    std::vector<std::string> told;
    for (const Sight& sight : sights_) {
        const std::string sort = sight.sort(*asking_.language);
        const bool isSort = !understood.placeWord.empty() && understood.placeWord != "me";
        const bool isCalled =
            isSort ? sort == understood.placeWord : understood.placeWord.empty() && sight.isCalled(name);
        // Whoever is at a place of another sort is not there; of one without a sort nobody can tell.
        const bool canTell = isSort ? !sort.empty() : known.has_value();
        const bool isThere =
            isCalled || (!isSort && known && sight.from(asking_.world, known->latitude, known->longitude) <= kAt);
        const char* key = isThere ? "yes" : canTell ? "no" : "cannotTell";
        told.push_back(sentences_.text(key, {{"name", nameOf(sight)}, {"place", understood.meaning.place}}));
        told.push_back(sight.sentence(sentences_, asking_.question, asking_.world));
    }
    told.push_back(askedSentence());
    told.push_back(unseenSentences());
    return found(joined(told), sights_, understood.people.size() > 1);
}

Answer WhereAnswers::near(const std::vector<Place>& ownPlaces) const {
    const Understood& understood = asking_.understood;
    const bool isMine =
        understood.placeWord == "me" || (understood.meaning.place.empty() && understood.placeWord.empty());
    const auto known = place(ownPlaces);
    if (!known) {
        if (understood.placePerson != nullptr) {
            return asking_.answer(Outcome::NotSeen,
                                  sentences_.text("notSeen", {{"name", understood.placePerson->shownName()}}));
        }
        return isMine ? asking_.answer(Outcome::NotSeen, sentences_.text("noPosition"))
                      : asking_.answer(Outcome::NotSeen,
                                       sentences_.text("unknownPlace", {{"place", understood.meaning.place}}));
    }
    std::vector<std::pair<double, Sight>> byDistance;
    for (const Sight& sight : sights_) {
        if (sight.person != understood.placePerson) {
            byDistance.emplace_back(sight.from(asking_.world, known->latitude, known->longitude), sight);
            // What the rows say: how far from the asker; what the sentence says: how far from the place.
            byDistance.back().second.metres = byDistance.back().first;
        }
    }
    std::stable_sort(byDistance.begin(), byDistance.end(),
                     [](const auto& one, const auto& other) { return one.first < other.first; });
    const std::string place = known->name;
    const auto text = [&](const char* key, Sentences::Arguments arguments) {
        arguments.insert({{"place", place}, {"where", isMine ? "me" : "place"}});
        return sentences_.text(key, arguments);
    };
    if (understood.meaning.wish == Wish::Closest && byDistance.size() > 1) {
        byDistance.resize(1);
    } else if (understood.meaning.wish != Wish::Closest) {
        const auto far =
            std::find_if(byDistance.begin(), byDistance.end(), [](const auto& one) { return one.first > kNear; });
        byDistance.erase(far, byDistance.end());
    }
    if (byDistance.empty()) {
        return asking_.answer(Outcome::NotSeen, text("nobodyNear", {}));
    }
    std::vector<std::string> names;
    std::vector<Sight> sights;
    for (const auto& [metres, sight] : byDistance) {
        const std::string far = sight.distance(asking_.world, asking_.language->tag());
        names.push_back(far.empty() ? nameOf(sight) : nameOf(sight) + " (" + far + ")");
        sights.push_back(sight);
    }
    names.resize(std::min(names.size(), kListed));
    // One sentence for all is as old as the oldest of them.
    platform::Date oldest = asking_.question.now;
    bool isPresent = true;
    for (const Sight& sight : sights) {
        isPresent = isPresent && sight.isPresent(asking_.question);
        oldest = sight.hasTime && sight.time.secondsSinceReferenceDate < oldest.secondsSinceReferenceDate ? sight.time
                                                                                                          : oldest;
    }
    const char* key = understood.meaning.wish == Wish::Closest ? "closest" : "near";
    return found(text(key, {{"names", sentences_.list(names)},
                            {"when", isPresent ? "now" : "then"},
                            {"time", sentences_.time(oldest, asking_.question.now)}}),
                 sights, true);
}

}  // namespace ktr::ask
