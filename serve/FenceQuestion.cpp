#include "serve/FenceQuestion.h"

namespace ktr::serve {

namespace {

bool leaves(const QString& word) {
    return QuestionWords::isAny(word, {"leave", "leaves", "leaving", "left", "depart", "departs", "departing",
                                       "departure", "exit", "exits", "exiting"});
}

bool arrives(const QString& word) {
    return QuestionWords::isAny(
        word, {"arrive", "arrives", "arriving", "arrival", "arrived", "reach",   "reaches", "reaching", "enter",
               "enters", "get",     "gets",     "getting", "come",    "comes",   "coming",  "return",   "returns",
               "go",     "goes",    "going",    "head",    "heads",   "heading", "set",     "sets"});
}

bool isAway(const QString& word) {
    return QuestionWords::isAny(word, {"out", "off", "away"});
}

/// What follows the verb, as far as it names a place.
QString placeAfter(const QStringList& words, qsizetype verb) {
    const auto leads = [](const QString& word) {
        return QuestionWords::isAny(word, {"at", "to", "in", "into", "from", "of", "the", "her", "his", "their", "my",
                                           "back", "up", "out", "off", "away", "a"});
    };
    const auto ends = [](const QString& word) {
        return QuestionWords::isAny(word, {"from", "for", "on", "before", "after", "please", "today", "tonight",
                                           "tomorrow", "now", "and", "tell", "let", "notify", "alert", "inform"});
    };
    qsizetype at = verb + 1;
    while (at < words.size() && leads(words[at])) {
        ++at;
    }
    QStringList place;
    while (at < words.size() && !ends(words[at])) {
        place.append(words[at++]);
    }
    return place.join(QLatin1Char(' '));
}

}  // namespace

std::optional<FenceQuestion> FenceQuestion::read(const QuestionWords& question) {
    const bool notifies = question.hasAny({"notify", "alert", "ping", "inform"}) || question.holds("let me know");
    if (!notifies && !question.hasAny({"tell", "remind"})) {
        return std::nullopt;
    }
    const QStringList& words = question.words();
    const bool asksWhere = question.hasAny({"where", "wheres"});
    bool awaits = false;
    for (qsizetype i = 0; i < words.size(); ++i) {
        awaits = awaits || QuestionWords::isAny(words[i], {"when", "whenever", "once", "if", "soon"});
        if (asksWhere && !awaits) {
            continue;
        }
        FenceQuestion read;
        if (leaves(words[i])) {
            read.trigger = Trigger::Departure;
        } else if (arrives(words[i])) {
            const bool away = i + 1 < words.size() && isAway(words[i + 1]);
            read.trigger = away ? Trigger::Departure : Trigger::Arrival;
        } else if (awaits && QuestionWords::isAny(words[i], {"is", "are"})) {
            read.needsPlace = true;
        } else {
            continue;
        }
        read.place = placeAfter(words, i);
        return read;
    }
    const bool atOnce = question.hasAny({"now", "immediately", "instantly"}) || question.holds("at once") ||
                        question.holds("right away") || question.holds("straight away");
    // "Tell me where Ann is now" wants to see her.
    if (!atOnce || (!notifies && question.hasAny({"where", "wheres"}))) {
        return std::nullopt;
    }
    FenceQuestion read;
    read.trigger = Trigger::Immediate;
    return read;
}

}  // namespace ktr::serve
