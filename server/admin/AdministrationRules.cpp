// The commands about who sees what.
#include <algorithm>
#include <charconv>
#include <cmath>

#include "documents/Words.h"
#include "server/admin/Administration.h"
#include "server/rules/WallClock.h"

namespace ktr::server {

namespace {

std::optional<double> degrees(std::string_view text, double most) {
    double number = 0.0;
    const auto [stop, error] = std::from_chars(text.data(), text.data() + text.size(), number);
    const bool whole = error == std::errc() && stop == text.data() + text.size();
    return whole && std::abs(number) <= most ? std::optional(number) : std::nullopt;
}

/// Changes a place by what the words say; empty when they were understood.
std::string readPlace(const Administration::PlaceWords& words, NamedPlace& place) {
    if (!words.at.empty() || place.id == 0) {
        const std::string_view at = words.at;
        const std::size_t comma = std::min(at.find(','), at.size());
        const auto latitude = degrees(at.substr(0, comma), 90.0);
        const auto longitude = degrees(at.substr(std::min(comma + 1, at.size())), 180.0);
        if (!latitude || !longitude) {
            return "--at: expected a latitude and a longitude in degrees, such as 50.21,-3.12";
        }
        place.latitude = *latitude;
        place.longitude = *longitude;
    }
    place.label = words.label.value_or(place.label);
    place.label = place.label == "none" ? "" : place.label;
    if (!place.label.empty() && !NamedPlace::isLabel(place.label)) {
        return "--label: expected home, work, school, gym, other or none, found " + documents::inQuotes(place.label);
    }
    place.radius = words.radius.value_or(place.radius);
    if (!(place.radius >= NamedPlace::kLeastRadius && place.radius <= NamedPlace::kMostRadius)) {
        return "--radius: expected 100 to 5000 metres: below that a phone cannot tell in from out";
    }
    place.said = words.said.value_or(place.said);
    place.name = words.rename.empty() ? words.name : words.rename;
    return NamedPlace::isName(place.name)
               ? std::string()
               : std::string(words.rename.empty() ? "--name" : "--rename") +
                     ": expected 1 to 40 letters on one line, found " + documents::inQuotes(place.name);
}

}  // namespace

std::string Administration::setPlace(const std::string& name, const PlaceWords& words) {
    std::string complaint = open();
    const auto who = complaint.empty() ? person(name, complaint) : std::nullopt;
    if (!who) {
        return complaint;
    }
    if (words.remove) {
        const auto place = placeNamed(*who, words.name, complaint);
        if (place && !store_->removePlace(who->id, place->id, now_)) {
            return "it could not be written";
        }
        if (place) {
            out_ << name << " has no place " << documents::inQuotes(words.name) << " any more\n";
        }
        return complaint;
    }
    std::string isNew;
    NamedPlace place = placeNamed(*who, words.name, isNew).value_or(NamedPlace());
    if (place.id == 0 && !words.rename.empty()) {
        return isNew;
    }
    complaint = readPlace(words, place);
    if (!complaint.empty()) {
        return complaint;
    }
    if (!(place.id == 0 ? store_->setPlace(who->id, place) : store_->changePlace(who->id, place))) {
        return words.rename.empty() ? "the place could not be written"
                                    : "--rename: there is a place of that name already, or it could not be written";
    }
    out_ << name << " has a place " << documents::inQuotes(place.name)
         << (place.said ? ", which may be said\n" : ", which is not said\n");
    return "";
}

std::optional<NamedPlace> Administration::placeNamed(const Person& owner, const std::string& name,
                                                     std::string& complaint) {
    for (NamedPlace& place : store_->placesOf(owner.id)) {
        if (place.name == name) {
            return std::move(place);
        }
    }
    complaint = owner.name + " has no place " + documents::inQuotes(name) + "; ktr-service place names one";
    return std::nullopt;
}

std::string Administration::places(const std::string& name) {
    std::string complaint = open();
    const auto who = complaint.empty() ? person(name, complaint) : std::nullopt;
    if (who) {
        for (const NamedPlace& place : store_->placesOf(who->id)) {
            out_ << place.name << (place.label.empty() ? std::string() : " (" + place.label + ")") << ", "
                 << std::llround(place.radius) << " m, " << (place.said ? "may be said" : "not said") << "\n";
        }
    }
    return complaint;
}

std::string Administration::setZone(const std::string& name, const std::string& zone) {
    std::string complaint = open();
    const auto who = complaint.empty() ? person(name, complaint) : std::nullopt;
    if (!who) {
        return complaint;
    }
    if (!WallClock::isZone(zone)) {
        return "expected a time zone such as Europe/Berlin, found " + documents::inQuotes(zone);
    }
    if (!store_->setZone(who->id, zone)) {
        return "it could not be written";
    }
    out_ << "it is " << WallClock(zone).face(now_) << " for " << name << "\n";
    return "";
}

std::string Administration::looks(const std::string& name) {
    std::string complaint = open();
    const auto who = complaint.empty() ? person(name, complaint) : std::nullopt;
    if (who) {
        const WallClock clock(who->zone);
        for (const Look& look : store_->looksAt(who->id)) {
            out_ << clock.face(look.hour) << "  " << look.viewer << (look.asked ? ", asked\n" : ", carried along\n");
        }
    }
    return complaint;
}

std::string Administration::fences(const std::string& name) {
    std::string complaint = open();
    const auto who = complaint.empty() ? person(name, complaint) : std::nullopt;
    if (!who) {
        return complaint;
    }
    const auto all = store_->fencesAbout(who->id);
    if (!all) {
        return "the store cannot be read";
    }
    const WallClock clock(who->zone);
    int number = 0;
    for (const FenceFacts& one : *all) {
        const Fence& fence = one.fence;
        out_ << ++number << "  " << one.other << " is told when " << name << (fence.arrives ? " arrives" : " leaves")
             << (fence.name.empty() ? std::string() : (fence.arrives ? " at " : " ") + documents::inQuotes(fence.name))
             << ", " << std::llround(fence.circle.radius) << " m, " << (fence.once ? "once" : "always") << ", since "
             << clock.face(fence.made) << "\n";
    }
    return "";
}

std::string Administration::endFence(const std::string& name, int number) {
    std::string complaint = open();
    const auto who = complaint.empty() ? person(name, complaint) : std::nullopt;
    if (!who) {
        return complaint;
    }
    const auto all = store_->fencesAbout(who->id);
    if (!all) {
        return "the store cannot be read";
    }
    if (static_cast<std::size_t>(number) > all->size()) {
        return "--end: there is no such number; ktr-service fences lists them";
    }
    const FenceFacts& one = (*all)[static_cast<std::size_t>(number - 1)];
    if (store_->endFence(who->id, one.fence.id) == FenceOutcome::Failed) {
        return "it could not be written";
    }
    out_ << one.other << " is told of that no more\n";
    return "";
}

std::string Administration::keepGrant(const std::string& owner, const std::string& viewer) {
    std::string complaint = open();
    const auto from = complaint.empty() ? person(owner, complaint) : std::nullopt;
    const auto to = from ? person(viewer, complaint) : std::nullopt;
    if (!to) {
        return complaint;
    }
    switch (store_->confirmGrant(from->id, to->id, now_)) {
        case Confirmation::Kept:
            out_ << viewer << " goes on seeing " << owner << "; the question comes again in 90 days\n";
            return "";
        case Confirmation::HasAnEnd:
            return "that grant says itself when it ends";
        case Confirmation::IsNotThere:
            return viewer + " does not see " + owner + "; ktr-service share begins anew";
        case Confirmation::Failed:
            break;
    }
    return "it could not be written";
}

std::string Administration::devices(const std::string& name) {
    std::string complaint = open();
    const auto who = complaint.empty() ? person(name, complaint) : std::nullopt;
    if (who) {
        const WallClock clock(who->zone);
        int number = 0;
        for (const DeviceFacts& device : store_->devicesOf(who->id)) {
            out_ << ++number << "  " << (device.kind == DeviceKind::Phone ? "phone" : "reader")
                 << (device.shared ? ", shared" : "") << ", since " << clock.face(device.made)
                 << (device.heard ? ", last heard " + clock.face(*device.heard) : std::string(", never heard"))
                 << (device.revoked ? ", ended " + clock.face(*device.revoked) : std::string()) << "\n";
        }
    }
    return complaint;
}

std::string Administration::revokeDevice(const std::string& owner, int number) {
    std::string complaint = open();
    const auto who = complaint.empty() ? person(owner, complaint) : std::nullopt;
    if (!who) {
        return complaint;
    }
    const auto devices = store_->devicesOf(who->id);
    if (number < 1 || static_cast<std::size_t>(number) > devices.size()) {
        return "--device: " + owner + " has no such device; ktr-service devices lists them";
    }
    const DeviceFacts& device = devices[static_cast<std::size_t>(number - 1)];
    if (device.revoked) {
        return "--device: its secret has ended already";
    }
    if (!store_->revokeDevice(who->id, device.id, now_)) {
        return "it could not be written";
    }
    out_ << "the secret of device " << number << " of " << owner << " ended\n";
    return "";
}

}  // namespace ktr::server
