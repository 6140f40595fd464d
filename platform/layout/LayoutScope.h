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

    /// Adds those that are not held already.
    void add(std::span<const ConstraintRule> rules);
    /// Removes the rule that equals this one, if there is one.
    void remove(const ConstraintRule& rule);
    bool holds(const ConstraintRule& rule) const;
    /// In order of adding.
    std::vector<ConstraintRule> rules() const;
    /// Constraints that said what is held here, as long as somebody has them: the same rule is the same object.
    void remember(LayoutConstraint& constraint);
    void forget(const LayoutConstraint& constraint);
    LayoutConstraint* remembered(const ConstraintRule& rule) const;

    /// Places the views that constraints mention, for the owner's present size.
    void layout();
    /// The owner's size for a target wished at these priorities (1 ... 1000).
    Size fittingSize(Size target, double horizontalPriority, double verticalPriority);
    /// Some input may have changed.
    void invalidate();
    /// The constraints and what became of them at the owner's present size; see docs/layout.md.
    std::string dump();

    /// How often this scope was solved: for tests and benches.
    int solves() const { return solves_; }
    /// What it shares with scopes of its kind; none before the first layout: for tests and benches.
    const std::shared_ptr<LayoutStructure>& structure() const { return structure_; }

    /// The layout input of `view` changed (its content, a priority, a constraint): it and all above it are laid out
    /// again, and what they remember of sizes is forgotten.
    static void inputChanged(View& view);
    /// Grows whenever the constraints that a view holds change; 0 for a view that never held one.
    static unsigned revisionOf(const View& view);
    static std::vector<ConstraintRule> rulesOf(const View& view);
    /// Whether a view holds constraints about views below it.
    static bool arrangesSubviews(const View& view);

  private:
    struct Fitting {
        Size target;
        double horizontalPriority = 0.0;
        double verticalPriority = 0.0;
        Size size;
    };
    bool isAboutOthers(const ConstraintRule& rule) const;
    void setRules(std::vector<ConstraintRule> rules);
    void prepare();
    const std::vector<double>& solved(Size target, double horizontalLevel, double verticalLevel);
    void apply(const std::vector<double>& values) const;

    View& owner_;
    /// Empty while the equations hold them: rows of one class share what their rules say.
    std::vector<ConstraintRule> rules_;
    /// None where none said what is held, as in the rows of lists.
    std::unique_ptr<std::vector<LayoutConstraint*>> remembered_;
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
