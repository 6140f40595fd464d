#pragma once

#include <optional>
#include <string>
#include <vector>

#include "ask/Person.h"
#include "ask/Ports.h"
#include "ask/Question.h"
#include "ask/Sentences.h"
#include "platform/base/Value.h"

namespace ktr::ask {

/// Where one friend is, as the service tells it.
struct Sight {
    const Person* person = nullptr;  ///< of the contacts
    std::string handle;              ///< by which the service answered
    double latitude = 0.0;
    double longitude = 0.0;
    std::optional<double> accuracy;  ///< metres
    platform::Date time;
    bool hasTime = false;
    std::vector<std::string> labels;  ///< the first one is shown
    bool isPhrase = false;            ///< that one says where by itself: "near Exeter, 40 km"
    std::string street;
    std::string city;
    std::string state;
    std::optional<double> metres;  ///< from the asker

    /// Metres from a place.
    double from(const World& world, double otherLatitude, double otherLongitude) const;
    /// Whether one of its names is this one, folded: a label, its street, its town.
    bool isCalled(const std::u32string& name) const;
    /// The sort of place by its labels: "home", "work"; empty: of none that the language has a word for.
    std::string sort(const Language& language) const;
    /// "at home", "at Fish Market", "in Brinmouth"; empty: it has no words.
    std::string where(const Sentences& sentences) const;
    /// The sentence "Ann is at Fish Market, 310 m away.", with the time where it may not hold any more.
    std::string sentence(const Sentences& sentences, const Question& question, const World& world) const;
    /// Whether it is so fresh that nothing newer is wanted.
    bool isOfNow(const Question& question) const;
    /// Whether a sentence may say that it is so: else it says when it was.
    bool isPresent(const Question& question) const;
    std::string distance(const World& world, const std::string& language) const;
};

/// The friends whom an answer to a get-locations command shows. Entries that are not whole are passed over, and what
/// answers to no handle that was asked for as well.
std::vector<Sight> sightsIn(const platform::Dictionary& answer, const std::vector<const Person*>& asked);

/// A snippet of these, in the form of a scenario; `proximity`: it lists several. The answer's context goes with it.
platform::Value snippetOf(const std::vector<Sight>& sights, const platform::Dictionary& answer, const char* proximity);
/// A friend of a snippet.
platform::Value friendOf(const Person& person, const std::string& handle);
/// The context of a snippet: what the service's answer says of it, and more members.
std::string contextOf(const platform::Dictionary& answer, const platform::Dictionary& more = {});

}  // namespace ktr::ask
