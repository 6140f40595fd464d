#include "server/rules/Visibility.h"

#include <algorithm>
#include <iterator>
#include <limits>

#include "server/rules/Cell.h"

namespace ktr::server {

namespace {

std::int64_t slotOf(std::int64_t time, std::int64_t length) {
    return time >= 0 ? time / length : -((-time + length - 1) / length);
}

/// What is shown at the beginning of slot `present`: what the person was in (`keyOf` a fix) at the ends of two slots in
/// a row, the latest such two; `initial` stands before the first fix. Fixes come by ascending time.
template <class KeyOf, class Key>
Key shownAt(const std::vector<Fix>& fixes, std::int64_t present, std::int64_t length, const KeyOf& keyOf, Key initial) {
    const std::int64_t begin = slotOf(fixes.front().time, length);
    // The last fix of each slot, going back.
    std::size_t count = fixes.size();
    const auto keyAtEndOf = [&](std::int64_t slot) -> Key {
        while (count > 0 && slotOf(fixes[count - 1].time, length) > slot) {
            --count;
        }
        return count == 0 ? initial : keyOf(fixes[count - 1]);
    };
    Key later = keyAtEndOf(present - 1);
    for (std::int64_t slot = present - 2; slot >= begin - 1; --slot) {
        Key earlier = keyAtEndOf(slot);
        if (earlier == later) {
            return later;
        }
        later = std::move(earlier);
    }
    return initial;
}

/// What may count at all.
FixRange usableRange(const Sharing& sharing, std::int64_t now) {
    const bool exact = sharing.grant->precision == Precision::Exact;
    const std::int64_t length = Visibility::slotLength(sharing.grant->precision);
    // Below exact precision nothing is used that came in this slot: it would tell when it came; nor what becomes too
    // old in this slot, for the same reason.
    const std::int64_t end = exact ? now + 1 : slotOf(now, length) * length;
    const std::int64_t oldest = (exact ? now : end + length) - sharing.retention;
    const std::int64_t shared = std::max(sharing.grant->from, sharing.shownSince);
    // A phone's clock may be ahead: what was heard before the grant is from before it.
    return {std::max(shared, oldest), exact ? std::numeric_limits<std::int64_t>::max() : end, shared, end};
}

}  // namespace

std::vector<Fix> Visibility::needed(const Sharing& sharing, std::int64_t now, const FixSource& source) {
    std::vector<Fix> fixes;
    if (!isOpen(sharing, now)) {
        return fixes;
    }
    const Precision precision = sharing.grant->precision;
    const std::int64_t length = slotLength(precision);
    const double side = cellSide(precision);
    const auto isSamePlace = [&](const Fix& one, const Fix& other) {
        return precision == Precision::Places
                   ? NamedPlace::saidAt(sharing.places, one) == NamedPlace::saidAt(sharing.places, other)
                   : Cell::of(one.latitude, one.longitude, side) == Cell::of(other.latitude, other.longitude, side);
    };
    FixRange range = usableRange(sharing, now);
    bool isDecided = false;
    std::int64_t later = slotOf(now, length);  // of the slots before this one nothing has been read yet
    while (!isDecided) {
        const auto fix = source(range, FixEdge::Last);
        if (!fix) {
            break;
        }
        const std::int64_t slot = slotOf(fix->time, length);
        // Two slots of which this was the last, or an end like that of the slot after it.
        isDecided =
            precision == Precision::Exact || slot < later - 1 || (!fixes.empty() && isSamePlace(*fix, fixes.back()));
        fixes.push_back(*fix);
        later = slot;
        range.end = slot * length;
    }
    if (!fixes.empty() && !isDecided) {
        // Where nobody stayed for two slots the first fix decides.
        range.end = fixes.back().time;
        if (const auto first = source(range, FixEdge::First)) {
            fixes.push_back(*first);
        }
    }
    std::reverse(fixes.begin(), fixes.end());
    return fixes;
}

double Visibility::cellSide(Precision precision) {
    return precision == Precision::Kilometre ? 1000.0 : precision == Precision::Town ? 4000.0 : 0.0;
}

std::int64_t Visibility::slotLength(Precision precision) {
    return precision == Precision::Exact ? 1 : precision == Precision::Town ? 900 : 300;
}

bool Visibility::isOpen(const Sharing& sharing, std::int64_t now) {
    return !sharing.hidden && sharing.grant && now >= sharing.grant->from &&
           std::max(now, sharing.latest) < sharing.grant->end();
}

std::optional<Seen> Visibility::visible(const Sharing& sharing, std::int64_t now) {
    if (!isOpen(sharing, now)) {
        return std::nullopt;
    }
    const Precision precision = sharing.grant->precision;
    const bool exact = precision == Precision::Exact;
    const std::int64_t length = slotLength(precision);
    const std::int64_t present = slotOf(now, length);
    const FixRange range = usableRange(sharing, now);
    std::vector<Fix> usable;
    std::copy_if(sharing.fixes.begin(), sharing.fixes.end(), std::back_inserter(usable),
                 [&](const Fix& fix) { return range.holds(fix); });
    if (usable.empty()) {
        return std::nullopt;
    }
    const Fix& last = usable.back();
    const auto placeOf = [&](const Fix& fix) { return NamedPlace::saidAt(sharing.places, fix); };
    if (exact) {
        Seen seen{last.latitude, last.longitude, last.accuracy, last.time};
        if (const NamedPlace* place = placeOf(last)) {
            seen.place = place->name;
            seen.label = place->label;
        }
        return seen;
    }
    const std::int64_t time = slotOf(last.time, length) * length;
    if (precision == Precision::Places) {
        const NamedPlace* place =
            shownAt<decltype(placeOf), const NamedPlace*>(usable, present, length, placeOf, nullptr);
        return place == nullptr ? std::nullopt
                                : std::optional(Seen{place->latitude, place->longitude, place->radius, time,
                                                     place->name, place->label});
    }
    const double side = cellSide(precision);
    const auto cellOf = [side](const Fix& fix) { return Cell::of(fix.latitude, fix.longitude, side); };
    const Cell::Place place = shownAt(usable, present, length, cellOf, cellOf(usable.front())).place(side);
    return Seen{place.latitude, place.longitude, place.radius, time};
}

}  // namespace ktr::server
