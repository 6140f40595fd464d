#include "server/rules/Visibility.h"

#include <algorithm>
#include <iterator>
#include <limits>

#include "server/rules/Cell.h"

namespace ktr::server {

namespace {

/// What is shown at the beginning of slot `present`: what the person was in (`keyOf` a fix) at the ends of two slots in
/// a row, the latest such two; `initial` stands before the first fix. Fixes come by ascending time.
template <class KeyOf, class Key>
Key shownAt(const std::vector<Fix>& fixes, std::int64_t present, std::int64_t length, const KeyOf& keyOf, Key initial) {
    constexpr auto slotOf = &Visibility::slotOf;
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

}  // namespace

std::int64_t Visibility::slotOf(std::int64_t time, std::int64_t length) {
    return time >= 0 ? time / length : -((-time + length - 1) / length);
}

FixRange Visibility::usable(const Sharing& sharing, std::int64_t now) {
    const bool exact = sharing.grant->precision == Precision::Exact;
    const std::int64_t length = slotLength(sharing.grant->precision);
    // Below exact precision nothing is used that came in this slot: it would tell when it came; nor what becomes too
    // old in this slot, for the same reason.
    const std::int64_t end = exact ? now + 1 : slotOf(now, length) * length;
    const std::int64_t oldest = (exact ? now : end + length) - sharing.retention;
    const std::int64_t shared = std::max(sharing.grant->from, sharing.shownSince);
    // A phone's clock may be ahead: what was heard before the grant is from before it.
    return {std::max(shared, oldest), exact ? std::numeric_limits<std::int64_t>::max() : end, shared, end};
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
    const FixRange range = usable(sharing, now);
    std::vector<Fix> fixes;
    std::copy_if(sharing.fixes.begin(), sharing.fixes.end(), std::back_inserter(fixes),
                 [&](const Fix& fix) { return range.holds(fix); });
    if (fixes.empty()) {
        return std::nullopt;
    }
    const Fix& last = fixes.back();
    const auto placeOf = [&](const Fix& fix) { return NamedPlace::saidAt(sharing.places, fix); };
    if (exact) {
        Seen seen{last.latitude, last.longitude, last.accuracy, last.time};
        if (const NamedPlace* place = placeOf(last)) {
            seen.place = place->name;
            seen.label = place->label;
        }
        seen.isExact = true;
        return seen;
    }
    const std::int64_t time = slotOf(last.time, length) * length;
    if (precision == Precision::Places) {
        const NamedPlace* place =
            shownAt<decltype(placeOf), const NamedPlace*>(fixes, present, length, placeOf, nullptr);
        return place == nullptr ? std::nullopt
                                : std::optional(Seen{place->latitude, place->longitude, place->radius, time,
                                                     place->name, place->label});
    }
    const double side = cellSide(precision);
    const auto cellOf = [side](const Fix& fix) { return Cell::of(fix.latitude, fix.longitude, side); };
    const Cell::Place place = shownAt(fixes, present, length, cellOf, cellOf(fixes.front())).place(side);
    return Seen{place.latitude, place.longitude, place.radius, time};
}

}  // namespace ktr::server
