#pragma once

#include <memory>

#include "platform/base/Api.h"
#include "platform/layout/LayoutTypes.h"

namespace ktr::platform {

class LayoutConstraint;
class View;

/// An edge, extent, centre or baseline of a view, to make constraints from. A value; holds its view weakly. Main
/// thread.
class KTR_API LayoutAnchor {
  public:
    LayoutAnchor() = default;
    LayoutAnchor(std::weak_ptr<View> view, LayoutAttribute attribute) : view_(std::move(view)), attribute_(attribute) {}

    std::shared_ptr<View> view() const { return view_.lock(); }
    /// Whether there is no view, or no longer.
    bool hasLostView() const { return view_.expired(); }
    LayoutAttribute attribute() const { return attribute_; }
    /// Whether both are about one view (or none).
    bool isSameView(const LayoutAnchor& other) const {
        return !view_.owner_before(other.view_) && !other.view_.owner_before(view_);
    }

    /// Constraints of priority 1000, not yet active. Constants in points.
    std::shared_ptr<LayoutConstraint> constraintEqualTo(const LayoutAnchor& other, double constant = 0.0) const;
    std::shared_ptr<LayoutConstraint> constraintLessThanOrEqualTo(const LayoutAnchor& other,
                                                                  double constant = 0.0) const;
    std::shared_ptr<LayoutConstraint> constraintGreaterThanOrEqualTo(const LayoutAnchor& other,
                                                                     double constant = 0.0) const;
    std::shared_ptr<LayoutConstraint> constraintEqualToConstant(double constant) const;

  private:
    std::weak_ptr<View> view_;
    LayoutAttribute attribute_ = LayoutAttribute::None;
};

}  // namespace ktr::platform
