#include "app/search/SearchDesk.h"

#include <algorithm>
#include <utility>
#include <variant>

#include "ask/FoldedText.h"

namespace ktr::app {

namespace {

/// Ids say what they are of: a restarted program, and a desktop that kept them, still find it.
const std::string kPerson = "person/";
const std::string kQuestion = "question/";
/// A single letter of an alphabet begins too many names.
constexpr std::size_t kLeastLetters = 2;
constexpr std::size_t kMostKept = 32;

bool isTooShort(const std::string& text) {
    const std::u32string folded = ask::FoldedText::of(text);
    return folded.empty() || (folded.size() < kLeastLetters && !ask::FoldedText::isWithoutBlanks(folded.front()));
}

/// "12/person/ann@x.example": the answer's number, 0 for none, and the key.
std::string keyIn(const std::string& id) {
    const std::size_t slash = id.find('/');
    return slash == std::string::npos ? "" : id.substr(slash + 1);
}

}  // namespace

SearchDesk::SearchDesk(host::Host& host, std::function<bool()> isOpen)
    : host_(host), isOpen_(std::move(isOpen)), desk_(host) {
    rest_.setSingleShot(true);
    rest_.setInterval(kRest);
    connect(&rest_, &QTimer::timeout, this, [this] { rest(); });
}

bool SearchDesk::mayShow() const {
    return isOpen_() && !host_.isRestricted();
}

const NameIndex& SearchDesk::names() {
    const auto& people = desk_.engine().people();
    if (!names_ || names_->people() != people) {
        names_ = std::make_unique<NameIndex>(people);
    }
    return *names_;
}

const SearchDesk::Kept* SearchDesk::kept(const std::string& key) const {
    const auto found = kept_.find(key);
    const bool isThere = found != kept_.end() && Clock::now() - found->second.since < kKept;
    return isThere ? &found->second : nullptr;
}

ask::Question SearchDesk::read(const std::string& text) const {
    ask::Question question = desk_.questionInWords(text);
    question.mayChange = false;
    return question;
}

SearchDesk::Result SearchDesk::resultOf(const ask::Person& person, bool isWhole) {
    const std::string key = kPerson + person.handle();
    const Kept* answer = kept(key);
    const std::string question = desk_.engine().whereIs(person.shownName(), host_.settings().language);
    return {std::to_string(answer == nullptr ? 0 : answer->number) + "/" + key, person.shownName(),
            answer == nullptr ? question : answer->sentence, isWhole, answer != nullptr};
}

SearchDesk::Result SearchDesk::resultOf(const std::string& question, const std::string& sentence) {
    const std::string key = kQuestion + question;
    const Kept* answer = kept(key);
    return {std::to_string(answer == nullptr ? 0 : answer->number) + "/" + key, question,
            answer == nullptr ? sentence : answer->sentence, true, answer != nullptr || !sentence.empty()};
}

std::vector<SearchDesk::Result> SearchDesk::results(const std::string& text) {
    planned_.clear();
    rest_.stop();
    std::vector<Result> results;
    if (!mayShow() || text.size() > ask::Question::kLongest || isTooShort(text)) {
        return results;
    }
    for (const NameIndex::Match& match : names().find(text, kMost)) {
        results.push_back(resultOf(*match.person, match.isWhole));
    }
    // Of several with one name nobody is guessed.
    const auto whole = std::count_if(results.begin(), results.end(), [](const Result& one) { return one.isWhole; });
    if (whole == 1) {
        plan(keyIn(results.front().id));
    }
    if (!results.empty()) {
        return results;
    }
    const auto said = desk_.engine().readHere(read(text));
    if (const auto* understood = std::get_if<ask::Understood>(&said)) {
        if (understood->meaning.certainty == 0) {
            // A name in another form: "mum", "Annan".
            for (const ask::Person* person : understood->people) {
                results.push_back(resultOf(*person, false));
            }
            return results;
        }
        results.push_back(resultOf(text, ""));
        if (!understood->people.empty()) {
            plan(kQuestion + text);
        }
        return results;
    }
    const auto& answer = std::get<ask::Answer>(said);
    if (answer.outcome != ask::Outcome::NotUnderstood) {
        results.push_back(resultOf(text, answer.sentence));
        for (const ask::Choice& choice : answer.choices) {
            if (const ask::Person* person = names().withHandle(choice.handle)) {
                results.push_back(resultOf(*person, false));
            }
        }
    }
    return results;
}

SearchDesk::Result SearchDesk::result(const std::string& id) {
    Result none;
    none.id = id;
    const std::string key = keyIn(id);
    if (!mayShow()) {
        return none;
    }
    Result found = none;
    if (key.starts_with(kPerson)) {
        const ask::Person* person = names().withHandle(key.substr(kPerson.size()));
        found = person == nullptr ? none : resultOf(*person, true);
    } else if (key.starts_with(kQuestion) && key.size() <= kQuestion.size() + ask::Question::kLongest) {
        const std::string question = key.substr(kQuestion.size());
        const auto said = desk_.engine().readHere(read(question));
        const auto* answer = std::get_if<ask::Answer>(&said);
        const bool isNone = answer != nullptr && answer->outcome == ask::Outcome::NotUnderstood;
        found = isNone ? none : resultOf(question, answer == nullptr ? "" : answer->sentence);
    }
    found.id = id;
    return found;
}

std::string SearchDesk::questionAbout(const ask::Person& person) {
    const std::string language = host_.settings().language;
    const std::string named = desk_.engine().whereIs(person.shownName(), language);
    const auto said = desk_.engine().readHere(read(named));
    const auto* understood = std::get_if<ask::Understood>(&said);
    const bool isMeant = understood != nullptr && understood->people.size() == 1 &&
                         understood->people.front()->handle() == person.handle();
    return isMeant ? named : desk_.engine().whereIs(person.handle(), language);
}

std::vector<std::string> SearchDesk::opening(const std::string& id) {
    const std::string key = keyIn(id);
    if (!mayShow()) {
        return {};
    }
    if (key.starts_with(kPerson)) {
        const ask::Person* person = names().withHandle(key.substr(kPerson.size()));
        return person == nullptr ? std::vector<std::string>() : openingOf(questionAbout(*person));
    }
    return key.starts_with(kQuestion) ? openingOf(key.substr(kQuestion.size())) : std::vector<std::string>();
}

std::vector<std::string> SearchDesk::openingOf(const std::string& text) {
    if (!mayShow() || text.size() > ask::Question::kLongest) {
        return {};
    }
    const auto said = desk_.engine().readHere(read(text));
    const auto* answer = std::get_if<ask::Answer>(&said);
    // A wish is not granted by an Enter in the search; and what was typed for something else is not asked.
    const bool isAsked = answer == nullptr || answer->outcome == ask::Outcome::Ambiguous ||
                         answer->outcome == ask::Outcome::UnknownPerson;
    return isAsked ? std::vector<std::string>{"show", "--ask=" + text} : std::vector<std::string>{"open"};
}

void SearchDesk::setReady() {
    isReady_ = true;
    if (!planned_.empty() && !rest_.isActive()) {
        rest();
    }
}

void SearchDesk::forget() {
    kept_.clear();
    planned_.clear();
    rest_.stop();
}

void SearchDesk::plan(const std::string& key) {
    const Kept* answer = kept(key);
    if (answer == nullptr || Clock::now() - answer->since >= kFresh) {
        planned_ = key;
        rest_.start();
    }
}

void SearchDesk::rest() {
    if (!isReady_ || isAsking_ || planned_.empty()) {
        return;
    }
    const std::string key = std::exchange(planned_, {});
    const bool isPerson = key.starts_with(kPerson);
    const ask::Person* person = isPerson ? names().withHandle(key.substr(kPerson.size())) : nullptr;
    if (!mayShow() || (isPerson && person == nullptr)) {
        return;
    }
    // The sentence stays on the screen while time goes by: it says when it was true.
    ask::Question question = desk_.question(isPerson ? questionAbout(*person) : key.substr(kQuestion.size()), true);
    question.mayChange = false;
    isAsking_ = true;
    desk_.ask(question, [this, key](const ask::Answer& answer) { take(key, answer); });
}

void SearchDesk::take(const std::string& key, const ask::Answer& answer) {
    isAsking_ = false;
    // Who cannot be seen any more was seen here until now.
    if (answer.snippet.isNull() || !mayShow() || kept_.size() >= kMostKept) {
        kept_.clear();
    }
    if (mayShow()) {
        kept_[key] = {answer.sentence, ++answers_, Clock::now()};
    }
    if (!rest_.isActive()) {
        rest();
    }
}

}  // namespace ktr::app
