#include "ask/Meaning.h"

#include <array>

namespace ktr::ask {

namespace {

constexpr std::array<const char*, 14> kWishes{"WhereIs",   "WhereAll", "HowFar",      "IsAt",       "NearMe",
                                              "NearPlace", "Closest",  "TellArrives", "TellLeaves", "TellNow",
                                              "Hide",      "Share",    "WhoSees",     "AskToShare"};
constexpr std::array<const char*, 4> kPrecisions{"exact", "1km", "town", "places"};

template <class Enumeration, std::size_t kCount>
std::optional<Enumeration> named(const std::array<const char*, kCount>& names, const std::string& name) {
    for (std::size_t i = 0; i < kCount; ++i) {
        if (name == names.at(i)) {
            return static_cast<Enumeration>(i);
        }
    }
    return std::nullopt;
}

}  // namespace

const char* nameOf(Wish wish) {
    return kWishes.at(static_cast<std::size_t>(wish));
}

std::optional<Wish> wishNamed(const std::string& name) {
    return named<Wish>(kWishes, name);
}

const char* nameOf(Precision precision) {
    return kPrecisions.at(static_cast<std::size_t>(precision));
}

std::optional<Precision> precisionNamed(const std::string& name) {
    return named<Precision>(kPrecisions, name);
}

bool isPersonal(Wish wish) {
    switch (wish) {
        case Wish::TellArrives:
        case Wish::TellLeaves:
        case Wish::TellNow:
        case Wish::Hide:
        case Wish::Share:
        case Wish::WhoSees:
        case Wish::AskToShare:
            return true;
        default:
            return false;
    }
}

}  // namespace ktr::ask
