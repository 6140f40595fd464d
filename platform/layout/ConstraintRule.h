#pragma once

#include "platform/base/Api.h"
#include "platform/layout/LayoutTypes.h"
#include "platform/ui/ViewReference.h"

namespace ktr::platform {

/// What a constraint says, whichever views it is about.
struct ConstraintTerms {
    LayoutAttribute first = LayoutAttribute::None;
    LayoutAttribute second = LayoutAttribute::None;
    LayoutRelation relation = LayoutRelation::Equal;
    double multiplier = 1.0;
    /// Points.
    double constant = 0.0;
    double priority = kRequiredPriority;
    bool operator==(const ConstraintTerms&) const = default;
};

/// A constraint as a view holds it: first (relation) multiplier x second + constant. Equal rules are one. A value. Main
/// thread.
struct KTR_API ConstraintRule {
    ViewReference first;
    ViewReference second;
    ConstraintTerms terms;

    bool operator==(const ConstraintRule&) const = default;
    /// Whether a view that it is about is gone.
    bool isOrphaned() const;
    /// The nearest common ancestor of both views, one of them included; none without one.
    View* holder() const;
};

}  // namespace ktr::platform
