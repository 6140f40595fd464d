#pragma once

#include <memory>

#include "platform/base/Api.h"
#include "platform/layout/LayoutTypes.h"
#include "platform/ui/ViewReference.h"

namespace ktr::platform {

class LayoutConstraint;
class View;

/// An edge, extent, centre or baseline of a view, to make constraints from. A value; does not own its view. Main
/// thread.
class KTR_API LayoutAnchor {
  public:
    LayoutAnchor() = default;
    LayoutAnchor(ViewReference view, LayoutAttribute attribute) : view_(std::move(view)), attribute_(attribute) {}

    /// None when there is no view, or no longer.
    std::shared_ptr<View> view() const;
    const ViewReference& reference() const { return view_; }
    LayoutAttribute attribute() const { return attribute_; }

    /// Constraints of priority 1000, not yet active. Constants in points.
    std::shared_ptr<LayoutConstraint> constraintEqualTo(const LayoutAnchor& other, double constant = 0.0) const;
    std::shared_ptr<LayoutConstraint> constraintLessThanOrEqualTo(const LayoutAnchor& other,
                                                                  double constant = 0.0) const;
    std::shared_ptr<LayoutConstraint> constraintGreaterThanOrEqualTo(const LayoutAnchor& other,
                                                                     double constant = 0.0) const;
    std::shared_ptr<LayoutConstraint> constraintEqualToConstant(double constant) const;

  private:
    ViewReference view_;
    LayoutAttribute attribute_ = LayoutAttribute::None;
};

}  // namespace ktr::platform
