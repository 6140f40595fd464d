#include "server/rules/FixWalk.h"

#include <algorithm>
#include <iterator>

#include "server/ingest/FixRules.h"
#include "server/rules/Cell.h"

namespace ktr::server {

namespace {

/// So many at most: what is read in vain stays small.
constexpr std::int64_t kMostAtOnce = 64;

}  // namespace

FixWalk::FixWalk(const Sharing& sharing, std::int64_t now, const LastRest& known, std::int64_t heardLate)
    : sharing_(sharing), length_(sharing.grant ? Visibility::slotLength(sharing.grant->precision) : 1) {
    if (!Visibility::isOpen(sharing, now)) {
        return;
    }
    step_ = Step::Going;
    range_ = Visibility::usable(sharing, now);
    later_ = Visibility::slotOf(now, length_);
    // What came in the slot before the present one may just now be on its way into the store.
    horizon_ = later_ - 2;
    // A phone's clock may be ahead by so much: nearer to the grant's beginning it depends on that what may count.
    sure_ = std::max(range_.from, range_.heardFrom + FixRules::kMostAhead);
    const bool isSomething = known.slot != LastRest().slot;
    const bool isTrue = isSomething && known.slot <= horizon_ && heardLate < (known.slot + 1) * length_;
    const bool isForThisViewer = known.fix && known.begin >= sure_;
    const bool isNowhere = known.fix ? known.begin < sure_ : known.since <= sure_;
    if (Visibility::cellSide(sharing.grant->precision) > 0.0 && isTrue && (isForThisViewer || isNowhere)) {
        known_ = known;
        showsKnown_ = isForThisViewer;
        atOnce_ = std::clamp<std::int64_t>(later_ - known.slot, 1, kMostAtOnce);
    }
}

bool FixWalk::isLate(const Fix& fix, std::int64_t now) {
    // By the shorter slots: their edges are all that there are.
    const std::int64_t length = Visibility::slotLength(Precision::Kilometre);
    return Visibility::slotOf(std::min(fix.time, fix.heard), length) < Visibility::slotOf(now, length);
}

std::vector<FixWalk::Question> FixWalk::questions() const {
    std::vector<Question> all;
    if (step_ == Step::First) {
        // Where nobody stayed for two slots the first fix decides.
        all.push_back({range_, FixEdge::First});
        all.back().range.end = fixes_.back().time;
    } else if (step_ == Step::Going && sharing_.grant->precision == Precision::Exact) {
        all.push_back({range_, FixEdge::Last});
    } else if (step_ == Step::Going) {
        FixRange range = range_;
        range.end = std::min(range.end, later_ * length_);
        // Slot by slot, and whatever was before.
        for (std::int64_t slot = later_ - 1; slot > later_ - atOnce_ && slot * length_ > range_.from; --slot) {
            all.push_back({range, FixEdge::Last});
            all.back().range.from = slot * length_;
            range.end = slot * length_;
        }
        all.push_back({range, FixEdge::Last});
    }
    if (asksForFirstToo()) {
        all.push_back({range_, FixEdge::First});
    }
    return all;
}

bool FixWalk::asksForFirstToo() const {
    return step_ == Step::Going && known_ && !showsKnown_ && sure_ == range_.from;
}

bool FixWalk::isSamePlace(const Fix& one, const Fix& other) const {
    if (sharing_.grant->precision == Precision::Places) {
        return NamedPlace::saidAt(sharing_.places, one) == NamedPlace::saidAt(sharing_.places, other);
    }
    const double side = Visibility::cellSide(sharing_.grant->precision);
    return Cell::of(one.latitude, one.longitude, side) == Cell::of(other.latitude, other.longitude, side);
}

void FixWalk::foundRest(const Fix& first, std::int64_t secondSlot, const Fix& second) {
    step_ = Step::Done;
    if (!kept_.empty()) {
        fixes_ = std::move(kept_);
        fixes_.push_back(second);
    }
    if (!found_ && secondSlot <= horizon_ && first.time >= sure_) {
        found_ = LastRest{horizon_, sure_, second, first.time};
    }
}

void FixWalk::useKnown() {
    // Since then there was none.
    found_ = known_;
    found_->slot = horizon_;
    const std::int64_t last = Visibility::slotOf(sure_, length_) + 2;
    if (showsKnown_) {
        fixes_.push_back(*known_->fix);
        step_ = Step::Done;
    } else if (sure_ == range_.from) {
        step_ = Step::First;
    } else if (last < later_) {
        // This viewer may have seen one as their grant began, and none after it.
        kept_ = std::move(fixes_);
        fixes_.clear();
        later_ = last + 1;
    }
    known_.reset();
}

void FixWalk::takeLast(const Fix& fix) {
    const std::int64_t slot = Visibility::slotOf(fix.time, length_);
    const bool isRest = slot < later_ - 1;
    const bool isSame = !isRest && !fixes_.empty() && isSamePlace(fix, fixes_.back());
    fixes_.push_back(fix);
    if (sharing_.grant->precision == Precision::Exact) {
        step_ = Step::Done;
    } else if (isRest) {
        foundRest(fix, slot + 1, fix);  // two slots of which this was the last
    } else if (isSame) {
        foundRest(fix, later_, fixes_[fixes_.size() - 2]);  // an end like that of the slot after it
    } else {
        later_ = slot;
        if (known_ && slot <= known_->slot) {
            useKnown();
        }
    }
}

void FixWalk::takeFirst(const std::optional<Fix>& answer) {
    if (!found_) {
        found_ = LastRest{horizon_, sure_, std::nullopt, 0};
    }
    const Fix first = answer.value_or(fixes_.back());
    if (!kept_.empty()) {
        fixes_ = std::move(kept_);
    }
    fixes_.push_back(first);
    step_ = Step::Done;
}

void FixWalk::take(const std::vector<std::optional<Fix>>& answers) {
    if (step_ == Step::First) {
        return takeFirst(answers.front());
    }
    const bool hasFirst = asksForFirstToo();
    const auto end = answers.end() - (hasFirst ? 1 : 0);
    const bool hadLeft = !kept_.empty();
    for (auto answer = answers.begin(); answer != end; ++answer) {
        // After a leap what was asked for before it is of no use.
        if (*answer && step_ == Step::Going && hadLeft == !kept_.empty()) {
            takeLast(**answer);
        }
    }
    atOnce_ = std::min(atOnce_ * 2, kMostAtOnce);
    if (step_ == Step::Going && !*std::prev(end) && hadLeft == !kept_.empty()) {
        if (fixes_.empty()) {
            fixes_ = std::move(kept_);
        }
        step_ = fixes_.empty() ? Step::Done : Step::First;
    }
    if (hasFirst && step_ == Step::First) {
        // Of all that may count: if it is the one that was found last, nothing is before that.
        takeFirst(*end);
    }
}

std::optional<LastRest> FixWalk::found() const {
    return Visibility::cellSide(sharing_.grant ? sharing_.grant->precision : Precision::Exact) > 0.0 ? found_
                                                                                                     : std::nullopt;
}

}  // namespace ktr::server
