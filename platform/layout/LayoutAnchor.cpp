#include "platform/layout/LayoutAnchor.h"

#include "platform/layout/LayoutConstraint.h"
#include "platform/ui/View.h"

namespace ktr::platform {

std::shared_ptr<View> LayoutAnchor::view() const {
    View* const view = view_.get();
    return view ? std::static_pointer_cast<View>(view->weak_from_this().lock()) : nullptr;
}

std::shared_ptr<LayoutConstraint> LayoutAnchor::constraintEqualTo(const LayoutAnchor& other, double constant) const {
    return std::make_shared<LayoutConstraint>(*this, LayoutRelation::Equal, other, 1.0, constant);
}

std::shared_ptr<LayoutConstraint> LayoutAnchor::constraintLessThanOrEqualTo(const LayoutAnchor& other,
                                                                            double constant) const {
    return std::make_shared<LayoutConstraint>(*this, LayoutRelation::LessOrEqual, other, 1.0, constant);
}

std::shared_ptr<LayoutConstraint> LayoutAnchor::constraintGreaterThanOrEqualTo(const LayoutAnchor& other,
                                                                               double constant) const {
    return std::make_shared<LayoutConstraint>(*this, LayoutRelation::GreaterOrEqual, other, 1.0, constant);
}

std::shared_ptr<LayoutConstraint> LayoutAnchor::constraintEqualToConstant(double constant) const {
    return std::make_shared<LayoutConstraint>(*this, LayoutRelation::Equal, LayoutAnchor(), 0.0, constant);
}

}  // namespace ktr::platform
