#include "ask/Understanding.h"

#include "ask/Moment.h"

namespace ktr::ask {

namespace {

bool namesPeopleAsPlace(Wish wish) {
    return wish == Wish::NearPlace || wish == Wish::Closest;
}

}  // namespace

Understanding::Result Understanding::resolved(const Language& language, const Question& question,
                                              const Meaning& meaning) const {
    Understood understood;
    understood.meaning = meaning;
    const auto persons = [&](const std::vector<std::size_t>& numbers) {
        std::vector<const Person*> named;
        for (const std::size_t number : numbers) {
            named.push_back(&people_.all()[number]);
        }
        return named;
    };
    if (!meaning.people.empty()) {
        const auto found = people_.find(meaning.people, language, question.chosen);
        if (const auto* unknown = std::get_if<People::Unknown>(&found)) {
            // A mere word that is no name was no question.
            return meaning.certainty == 0 ? Result(NotUnderstood{})
                                          : UnknownPerson{meaning, unknown->name, persons(unknown->near)};
        }
        if (const auto* several = std::get_if<People::Ambiguous>(&found)) {
            return Ambiguous{meaning, several->name, persons(several->people)};
        }
        understood.people = persons(std::get<People::Found>(found));
    }
    understood.placeWord = meaning.spot;
    if (!meaning.place.empty()) {
        understood.placeWord = language.placeWord(meaning.place);
        if (understood.placeWord.empty() && namesPeopleAsPlace(meaning.wish)) {
            const auto found = people_.find(meaning.place, language, question.chosen);
            if (const auto* several = std::get_if<People::Ambiguous>(&found)) {
                return Ambiguous{meaning, several->name, persons(several->people)};
            }
            if (const auto* numbers = std::get_if<People::Found>(&found); numbers != nullptr && numbers->size() == 1) {
                understood.placePerson = &people_.all()[numbers->front()];
            }
        }
    }
    if (!meaning.until.empty()) {
        understood.until = momentOf(meaning.until, language, question.now, question.secondsFromUtc);
        if (!understood.until) {
            return UnknownMoment{meaning};
        }
    }
    return understood;
}

Understanding::Result Understanding::understandIn(const Language& language, const Question& question) const {
    std::optional<Result> first;
    for (const Meaning& meaning : language.meanings(question.text)) {
        Result result = resolved(language, question, meaning);
        if (std::holds_alternative<Understood>(result)) {
            // A surer reading that names several people is not passed over for one that names one.
            const bool wasSeveral = first && std::holds_alternative<Ambiguous>(*first);
            return wasSeveral ? *first : result;
        }
        if (!first || std::holds_alternative<NotUnderstood>(*first)) {
            first = std::move(result);
        }
    }
    return first.value_or(NotUnderstood{});
}

Understanding::Result Understanding::understand(const Question& question) const {
    if (question.text.size() > Question::kLongest) {
        return NotUnderstood{};
    }
    Result result = understandIn(language_, question);
    if (!std::holds_alternative<NotUnderstood>(result) || &language_ == &english_) {
        return result;
    }
    return understandIn(english_, question);
}

}  // namespace ktr::ask
