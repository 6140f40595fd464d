#pragma once

#include <limits>
#include <memory>
#include <string>
#include <vector>

#include "platform/layout/LayoutConstraint.h"
#include "platform/layout/Solver.h"
#include "platform/ui/View.h"

namespace ktr::platform {

class LayoutStructure;

/// A scope's constraints and content sizes as equations of a solver. What only depends on the kind of view (terms,
/// relations, levels, the constants that constraints were written with) is the *structure*, equal for all rows of one
/// class; the other constants are *inputs* that are read from the views each time.
///
/// A constraint that a view holds on its own width and height counts in the scope above it too; where a view arranges
/// subviews of its own, what these need is its content.
///
/// Variables: width and height of the owner (0 and 1), then width, height, x and y of each view that a constraint
/// mentions, in its superview's coordinates: of a size and a place that nothing determines, the size is the smaller.
class LayoutEquations {
  public:
    static constexpr VariableId kOwnerWidth = 0;
    static constexpr VariableId kOwnerHeight = 1;
    /// A content's priority 1000 gives way to what is explicitly required, silently; below both, no extent is negative.
    static constexpr double kContentLevel = 1000.0 - 1.0 / 512.0;
    static constexpr double kNotNegativeLevel = 1000.0 - 1.0 / 1024.0;

    struct Equation {
        std::vector<Term> terms;
        LayoutRelation relation = LayoutRelation::Equal;
        double constant = 0.0;  // as the constraint was written; an input adds to it
        double level = 0.0;
        bool isInput = false;
    };

    /// A view that takes part.
    struct Participant {
        std::weak_ptr<View> view;
        VariableId height() const { return width + 1; }
        VariableId x() const { return width + 2; }
        VariableId y() const { return width + 3; }

        const View* identity = nullptr;
        const View* superview = nullptr;
        int parent = -1;              // its superview's participant, -1 for the owner
        VariableId width = 0;         // height, x and y follow
        bool isFixed = false;         // its frame is taken as it stands
        unsigned ownConstraints = 0;  // the revision of those that it holds itself
        ContentPriorities priorities;
        bool hasWidth = false;
        bool hasHeight = false;
        Size content;
        BaselineOffsets baselines;
        Rect frame;  // when fixed
        bool wraps = false;
        double lastWidth = std::numeric_limits<double>::infinity();  // of wrapped content
    };

    /// An equation's constants that come from a view.
    struct Source {
        std::size_t equation;  // the first of them
        int participant;       // -1: the owner
    };
    struct Baseline {
        std::size_t equation;
        int participant;
        bool isFirst;
        double factor;  // of the offset in the equation's constant
    };

    /// The structure: the same for all scopes of one kind, which share it.
    struct Plan {
        VariableId variables = 0;
        std::vector<Equation> equations;
        std::vector<Source> contents;
        std::vector<Source> frames;
        std::vector<Baseline> baselines;
    };

    /// Reads everything anew and gives the structure that it shares with its likes. `owner` holds the constraints.
    std::shared_ptr<LayoutStructure> build(View& owner,
                                           const std::vector<std::shared_ptr<LayoutConstraint>>& constraints,
                                           bool rightToLeft);
    bool isRightToLeft() const { return rightToLeft_; }
    /// Whether the views are still those that the equations were built for; false asks for a new build.
    bool isCurrent(View& owner, bool rightToLeft) const;
    /// Reads the inputs from the views; true when some changed. The height of wrapped content is read for its last
    /// known width.
    bool readInputs();
    /// Tells the widths that were solved; true when a wrapped content's height follows with a change of inputs.
    bool readHeightsFor(const std::vector<double>& values);

    const std::vector<Participant>& participants() const { return participants_; }
    /// By equation: the constant on the right, inputs included.
    const std::vector<double>& constants() const { return constants_; }
    /// "owner.width", "view1.x" ...: views in the order in which constraints mention them.
    static std::string nameOf(VariableId variable);

  private:
    /// A constraint and the participants at its ends.
    struct Mention {
        const LayoutConstraint* constraint;
        int first;
        int second;
    };
    static constexpr int kOwner = -1;
    static constexpr int kNobody = -2;
    /// All of them, in the order in which constraints mention views.
    using Mentions = std::vector<Mention>;

    struct End {
        std::vector<Term> terms;
        bool hasBaseline = false;
        int participant = -1;
        bool isFirst = false;
    };

    Mentions collect(const std::vector<std::shared_ptr<LayoutConstraint>>& constraints);
    void mention(const LayoutConstraint& constraint, Mentions& mentions);
    void mentionOwnSizes(int participant, Mentions& mentions);
    bool isBelowOwner(const std::shared_ptr<View>& view) const;
    int participantOf(const std::shared_ptr<View>& view);
    std::vector<double> signature(const Mentions& mentions) const;
    std::shared_ptr<const Plan> makePlan(const Mentions& mentions) const;
    void addConstraint(const Mention& mention, Plan& plan) const;
    End end(const LayoutAnchor& anchor, int participant, bool isMirrored) const;
    std::vector<Term> position(int participant, bool isHorizontal) const;
    void addContent(int participant, Plan& plan) const;
    void addFrame(int participant, Plan& plan) const;
    void readContent(Participant& participant, View& view) const;
    IntrinsicSize contentOf(View& view) const;
    bool writeInputs();
    double baselineOffset(int participant, bool isFirst) const;
    const Participant& content(int participant) const { return participant < 0 ? owner_ : participants_[participant]; }

    std::shared_ptr<const Plan> plan_;
    Participant owner_;
    std::vector<Participant> participants_;
    std::vector<double> constants_;
    bool rightToLeft_ = false;
    bool hasStrangers_ = false;  // some constraint mentions a view that is not below the owner
};

}  // namespace ktr::platform
