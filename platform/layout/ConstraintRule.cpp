#include "platform/layout/ConstraintRule.h"

#include "platform/ui/View.h"

namespace ktr::platform {

bool ConstraintRule::isOrphaned() const {
    return !first.get() || (terms.second != LayoutAttribute::None && !second.get());
}

View* ConstraintRule::holder() const {
    View* const other = second.get();
    if (!other) {
        return terms.second == LayoutAttribute::None ? first.get() : nullptr;
    }
    for (View* view = first.get(); view; view = view->superview_) {
        if (other->isDescendantOf(*view)) {
            return view;
        }
    }
    return nullptr;
}

}  // namespace ktr::platform
