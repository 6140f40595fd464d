#pragma once

#include <memory>
#include <string>

#include "platform/base/Object.h"
#include "platform/layout/LayoutAnchor.h"
#include "platform/layout/LayoutTypes.h"

namespace ktr::platform {

/// first (relation) multiplier x second + constant, at a priority. Without a second anchor the constant stands alone.
/// Immutable but for its activity. Main thread.
class KTR_API LayoutConstraint : public Object {
  public:
    LayoutConstraint(LayoutAnchor first, LayoutRelation relation, LayoutAnchor second, double multiplier,
                     double constant, double priority = kRequiredPriority);

    const LayoutAnchor& first() const { return first_; }
    const LayoutAnchor& second() const { return second_; }
    LayoutRelation relation() const { return relation_; }
    double multiplier() const { return multiplier_; }
    /// Points.
    double constant() const { return constant_; }
    double priority() const { return priority_; }

    /// Active: held by the nearest view that contains both ends (their nearest common ancestor, one of them included).
    /// Activating without a common ancestor does nothing but write a debug line.
    void setActive(bool active);
    bool isActive() const { return !owner_.expired(); }

    /// Whether both say the same of the same views. Equal constraints are one: a view holds it once.
    bool isEqualTo(const LayoutConstraint& other) const;
    /// Whether a view that it is about has gone.
    bool isOrphaned() const;

    std::string description() const override;

  private:
    friend class View;
    LayoutAnchor first_;
    LayoutAnchor second_;
    LayoutRelation relation_;
    double multiplier_;
    double constant_;
    double priority_;
    /// The view that holds the constraint while it is active.
    std::weak_ptr<View> owner_;
};

}  // namespace ktr::platform
