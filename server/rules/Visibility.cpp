#include "server/rules/Visibility.h"

#include <algorithm>

#include "server/rules/Cell.h"

namespace ktr::server {

namespace {

std::int64_t slotOf(std::int64_t time, std::int64_t length) {
    return time >= 0 ? time / length : -((-time + length - 1) / length);
}

/// The cell that is shown at the beginning of slot `present`, of fixes by ascending time.
Cell shownCell(const std::vector<Fix>& fixes, std::int64_t present, std::int64_t length, double side) {
    const auto cellOf = [side](const Fix& fix) { return Cell::of(fix.latitude, fix.longitude, side); };
    Cell shown = cellOf(fixes.front());
    Cell before = shown;
    std::size_t next = 0;
    Cell here = shown;
    for (std::int64_t slot = slotOf(fixes.front().time, length); slot < present; ++slot) {
        // Where the person was when the slot ended.
        for (; next < fixes.size() && slotOf(fixes[next].time, length) <= slot; ++next) {
            here = cellOf(fixes[next]);
        }
        if (here == before) {
            shown = here;
        }
        before = here;
    }
    return shown;
}

}  // namespace

double Visibility::cellSide(Precision precision) {
    return precision == Precision::Exact ? 0.0 : precision == Precision::Kilometre ? 1000.0 : 4000.0;
}

std::int64_t Visibility::slotLength(Precision precision) {
    return precision == Precision::Exact ? 1 : precision == Precision::Kilometre ? 300 : 900;
}

std::optional<Seen> Visibility::visible(const Sharing& sharing, std::int64_t now) {
    if (sharing.hidden || !sharing.grant || now < sharing.grant->from ||
        (sharing.grant->until && std::max(now, sharing.latest) >= *sharing.grant->until)) {
        return std::nullopt;
    }
    const Precision precision = sharing.grant->precision;
    const bool exact = precision == Precision::Exact;
    const std::int64_t length = slotLength(precision);
    const std::int64_t present = slotOf(now, length);
    const std::int64_t first = std::max({sharing.grant->from, sharing.shownSince, now - sharing.retention});
    // Below exact precision nothing is used that came in this slot: it would tell when it came.
    const std::int64_t end = exact ? now + 1 : present * length;
    std::vector<Fix> usable;
    for (const Fix& fix : sharing.fixes) {
        if (fix.time >= first && fix.heard < end && (exact || fix.time < end)) {
            usable.push_back(fix);
        }
    }
    if (usable.empty()) {
        return std::nullopt;
    }
    const Fix& last = usable.back();
    if (exact) {
        return Seen{last.latitude, last.longitude, last.accuracy, last.time};
    }
    const double side = cellSide(precision);
    const Cell::Place place = shownCell(usable, present, length, side).place(side);
    return Seen{place.latitude, place.longitude, place.radius, slotOf(last.time, length) * length};
}

}  // namespace ktr::server
