#pragma once

#include <memory>
#include <string>

#include "platform/base/Object.h"
#include "platform/layout/ConstraintRule.h"
#include "platform/layout/LayoutAnchor.h"
#include "platform/layout/LayoutTypes.h"

namespace ktr::platform {

/// first (relation) multiplier x second + constant, at a priority. Without a second anchor the constant stands alone.
/// Immutable but for its activity. A view that holds the constraint keeps what it says, not this object. Main thread.
class KTR_API LayoutConstraint : public Object {
  public:
    LayoutConstraint(const LayoutAnchor& first, LayoutRelation relation, const LayoutAnchor& second, double multiplier,
                     double constant, double priority = kRequiredPriority);
    explicit LayoutConstraint(ConstraintRule rule);
    ~LayoutConstraint() override;

    LayoutAnchor first() const { return {rule_.first, rule_.terms.first}; }
    LayoutAnchor second() const { return {rule_.second, rule_.terms.second}; }
    LayoutRelation relation() const { return rule_.terms.relation; }
    double multiplier() const { return rule_.terms.multiplier; }
    /// Points.
    double constant() const { return rule_.terms.constant; }
    double priority() const { return rule_.terms.priority; }
    const ConstraintRule& rule() const { return rule_; }

    /// Active: held by the nearest view that contains both ends (their nearest common ancestor, one of them included).
    /// Activating without a common ancestor does nothing but write a debug line.
    void setActive(bool active);
    bool isActive() const;

    /// Whether both say the same of the same views. Equal constraints are one: a view holds it once.
    bool isEqualTo(const LayoutConstraint& other) const { return rule_ == other.rule_; }

    std::string description() const override;

  private:
    friend class LayoutScope;
    friend class View;
    ConstraintRule rule_;
    /// The view that holds the constraint while it is active.
    ViewReference owner_;
};

}  // namespace ktr::platform
