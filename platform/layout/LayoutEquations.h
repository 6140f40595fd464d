#pragma once

#include <limits>
#include <memory>
#include <optional>
#include <string>
#include <vector>

#include "platform/layout/ConstraintRule.h"
#include "platform/layout/LayoutPlan.h"
#include "platform/ui/View.h"

namespace ktr::platform {

class LayoutStructure;

/// A scope's constraints and content sizes as the inputs of a plan's equations.
///
/// A constraint that a view holds on its own width and height counts in the scope above it too; where a view arranges
/// subviews of its own, what these need is its content.
class LayoutEquations {
  public:
    /// A view that takes part. What its kind has in common is in the shape.
    struct Participant {
        ViewReference view;
        const View* superview = nullptr;
        double lastWidth = std::numeric_limits<double>::infinity();  // of wrapped content
        unsigned ownConstraints = 0;                                 // the revision of those that it holds itself
    };

    /// Reads everything anew and gives the structure that it shares with its likes. `owner` holds the rules.
    std::shared_ptr<LayoutStructure> build(View& owner, const std::vector<ConstraintRule>& rules, bool rightToLeft);
    bool isRightToLeft() const { return plan_ && plan_->shape().rightToLeft; }
    /// Whether the shape says all that the rules said: `rules` gives them back.
    bool holdsRules() const { return plan_ && !hasStrangers_ && !hasNameless_; }
    std::vector<ConstraintRule> rules(const View& owner) const;
    /// Reads the inputs from the views, each once; true when some changed. The height of wrapped content is read for
    /// its last known width. None, and the inputs stay as they are, when the views are no longer those that the
    /// equations were built for: that asks for a new build.
    std::optional<bool> readInputs(View& owner, bool rightToLeft);
    /// Tells the widths that were solved; true when a wrapped content's height follows with a change of inputs.
    bool readHeightsFor(View& owner, const std::vector<double>& values);

    const std::vector<Participant>& participants() const { return participants_; }
    bool isFixed(std::size_t participant) const { return plan_->shape().members[participant].isFixed; }
    /// What the plan's loads take.
    const std::vector<double>& inputs() const { return inputs_; }
    /// "owner.width", "view1.x" ...: views in the order in which constraints mention them.
    static std::string nameOf(VariableId variable);

  private:
    static constexpr int kOwner = LayoutShape::kOwner;
    static constexpr int kNobody = LayoutShape::kNobody;

    /// A view's content or frame as it is read.
    struct Content {
        bool hasWidth = false;
        bool hasHeight = false;
        bool wraps = false;
        Size size;
        BaselineOffsets baselines;
        Rect frame;
    };

    void collect(const std::vector<ConstraintRule>& rules, LayoutShape& shape);
    void mention(const ConstraintRule& rule, LayoutShape& shape);
    void mentionOwnSizes(int participant, LayoutShape& shape);
    /// Whether the views stand as they did when the equations were built, their contents aside.
    bool isCurrent(const View& owner, bool rightToLeft) const;
    bool isBelowOwner(const View* view) const;
    int participantOf(View& view, LayoutShape& shape);
    Content contentOf(View& view, bool isFixed, double lastWidth) const;
    IntrinsicSize intrinsicSizeOf(View& view) const;
    /// Of the owner first, then of the participants.
    std::vector<Content> readContents(View& owner) const;
    bool writeInputs(const std::vector<Content>& contents);

    const View* owner_ = nullptr;
    std::shared_ptr<const LayoutPlan> plan_;
    std::vector<Participant> participants_;
    std::vector<double> inputs_;
    double ownerLastWidth_ = std::numeric_limits<double>::infinity();
    bool hasStrangers_ = false;  // some constraint mentions a view that is not below the owner
    bool hasNameless_ = false;   // some constraint has a view without saying what of it
    bool hasWrapped_ = false;
};

}  // namespace ktr::platform
