#pragma once

#include <optional>
#include <string>
#include <vector>

namespace ktr::ask {

/// What a question wants. Names are those of the templates (resources/questions).
enum class Wish {
    WhereIs,
    WhereAll,
    HowFar,
    IsAt,
    NearMe,
    NearPlace,
    Closest,
    TellArrives,
    TellLeaves,
    TellNow,
    Hide,
    Share,
    WhoSees,
    AskToShare,
};

/// How exactly somebody may be seen.
enum class Precision { Exact, Kilometre, Town, Places };

/// What a question says, in words: whom and which place it means is for `People` and `Places` to find. All of the
/// question is in here: what no template has a place for makes it not understood.
struct Meaning {
    Wish wish = Wish::WhereIs;
    std::string people;  ///< who it is about, as it was written: a name, or several; empty: nobody is named
    std::string place;   ///< empty: none is named
    std::string
        spot;  ///< a place that has a word of its own: "me", "home", "work", "school", "gym"; then `place` is empty
    std::string until;  ///< until when, as it was written; empty: without an end
    std::optional<Precision> precision;
    bool everyTime = false;   ///< of a wish to be told: not only once
    bool thisMoment = false;  ///< where somebody is "right now": what was known before may not be enough
    /// Letters that a template named, and not only a slot took: a question that is nothing but a name has none.
    int certainty = 0;

    bool operator==(const Meaning&) const = default;
};

/// "WhereIs", "TellArrives": as templates, tables and --json write it.
const char* nameOf(Wish wish);
std::optional<Wish> wishNamed(const std::string& name);
/// As the service's protocol writes it: "exact", "1km", "town", "places".
const char* nameOf(Precision precision);
std::optional<Precision> precisionNamed(const std::string& name);
/// Whether to grant it changes something, at the service or for the user's friends, or tells who sees the user: what a
/// device that everybody can talk to does not do.
bool isPersonal(Wish wish);

}  // namespace ktr::ask
