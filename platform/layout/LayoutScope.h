#pragma once

#include <memory>
#include <span>
#include <string>
#include <vector>

#include "platform/base/Geometry.h"
#include "platform/layout/LayoutEquations.h"

namespace ktr::platform {

class LayoutStructure;

/// The layout of one view that holds constraints: solved alone, and again only when an input of it changed. Owned by
/// its view. Main thread.
class KTR_API LayoutScope {
  public:
    explicit LayoutScope(View& owner) : owner_(owner) {}

    /// False when an equal constraint is held already.
    bool add(const std::shared_ptr<LayoutConstraint>& constraint);
    /// Removes the constraint, or one that equals it; false when there is none.
    bool remove(const LayoutConstraint& constraint);
    const std::vector<std::shared_ptr<LayoutConstraint>>& constraints() const { return constraints_; }

    /// Places the views that constraints mention, for the owner's present size.
    void layout();
    /// The owner's size for a target wished at these priorities (1 ... 1000).
    Size fittingSize(Size target, double horizontalPriority, double verticalPriority);
    /// Some input may have changed.
    void invalidate();
    /// The constraints and what became of them at the owner's present size; see docs/layout.md.
    std::string dump();

    /// How often a scope of this platform was solved: for tests and benches.
    int solves() const { return solves_; }

    /// The layout input of `view` changed (its content, a priority, a constraint): it and all above it are laid out
    /// again, and what they remember of sizes is forgotten.
    static void inputChanged(View& view);
    /// Grows whenever the constraints that a view holds change; 0 for a view that never held one.
    static unsigned revisionOf(const View& view);
    static std::span<const std::shared_ptr<LayoutConstraint>> constraintsOf(const View& view);
    /// Whether a view holds constraints about views below it.
    static bool arrangesSubviews(const View& view);

  private:
    struct Fitting {
        Size target;
        double horizontalPriority = 0.0;
        double verticalPriority = 0.0;
        Size size;
    };
    void constraintsChanged();
    bool isAboutOthers(const LayoutConstraint& constraint) const;
    void prepare();
    const std::vector<double>& solved(Size target, double horizontalLevel, double verticalLevel);
    void apply(const std::vector<double>& values) const;

    View& owner_;
    std::vector<std::shared_ptr<LayoutConstraint>> constraints_;
    LayoutEquations equations_;
    std::shared_ptr<LayoutStructure> structure_;  // none: to be built
    std::vector<Fitting> fittings_;               // what was asked since an input changed
    unsigned revision_ = 0;
    bool arrangesSubviews_ = false;
    Size laidOut_{-1.0, -1.0};
    bool isDirty_ = true;   // the views are not placed for the present inputs
    bool isFresh_ = false;  // no input was reported to have changed since the inputs were read
    int solves_ = 0;
};

}  // namespace ktr::platform
