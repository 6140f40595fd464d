#include "serve/SharingQuestion.h"

namespace ktr::serve {

std::optional<SharingQuestion::Wish> SharingQuestion::wishOf(const QuestionWords& question) {
    const bool sight = question.holds("see me") || question.holds("see where i") || question.holds("find me") ||
                       question.holds("know where i");
    const bool place = question.holds("my location") || question.holds("my position") ||
                       question.holds("my whereabouts") || question.holds("where i am");
    const bool oneself = place || sight || question.hasAny({"i", "im", "me", "myself"});
    if (!oneself) {
        return std::nullopt;
    }
    const bool hides = question.hasAny({"hide", "hides", "hiding", "hidden", "invisible", "conceal", "unshare"});
    const bool shows = question.hasAny({"share", "sharing", "shared", "visible", "unhide", "reveal"}) ||
                       (question.hasAny({"show", "showing"}) && place && !question.holds("show me"));
    if (question.startsWithAny({"am", "is", "are", "do", "does", "who"}) ||
        (question.startsWithAny({"can", "could"}) && !question.holds("can you") && !question.holds("could you"))) {
        const bool own = place || sight || question.hasAny({"i", "im"});
        return own && (hides || shows || sight) ? std::optional(Wish::Know) : std::nullopt;
    }
    const bool no = question.hasAny({"stop", "dont", "not", "never", "nobody", "no", "off", "disable", "quit"});
    if (hides == shows && !sight) {
        return std::nullopt;
    }
    // "Stop hiding me" shows, "don't let my friends see me" hides.
    if (hides) {
        return no && !shows ? Wish::Show : Wish::Hide;
    }
    const bool lets = shows || question.hasAny({"let", "allow", "may", "make"});
    return no ? std::optional(Wish::Hide) : lets ? std::optional(Wish::Show) : std::nullopt;
}

}  // namespace ktr::serve
