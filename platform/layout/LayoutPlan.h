#pragma once

#include <vector>

#include "platform/layout/LayoutShape.h"
#include "platform/layout/Solver.h"

namespace ktr::platform {

/// The equations of a shape: the same for all scopes of one kind, which share them. What only depends on the kind of
/// view (terms, relations, levels, the constants that constraints were written with) stands here; the other constants
/// are *inputs*, which each scope reads from its views.
///
/// Variables: width and height of the owner (0 and 1), then width, height, x and y of each view that a constraint
/// mentions, in its superview's coordinates: of a size and a place that nothing determines, the size is the smaller.
/// Immutable.
class LayoutPlan {
  public:
    static constexpr VariableId kOwnerWidth = 0;
    static constexpr VariableId kOwnerHeight = 1;
    /// A content's priority 1000 gives way to what is explicitly required, silently; below both, no extent is negative.
    static constexpr double kContentLevel = 1000.0 - 1.0 / 512.0;
    static constexpr double kNotNegativeLevel = 1000.0 - 1.0 / 1024.0;

    struct Equation {
        std::vector<Term> terms;
        LayoutRelation relation = LayoutRelation::Equal;
        double constant = 0.0;  // as the constraint was written; an input takes its place
        double level = 0.0;
        bool isInput = false;
    };
    /// An equation whose constant is an input.
    struct Load {
        std::size_t equation;
        std::size_t input;
    };
    /// Inputs that come from a view: of content its width and height, as far as it has them; of a frame x, y, width,
    /// height.
    struct Source {
        int participant;
        std::size_t input;  // the first of them
    };
    /// Part of an input that is a constraint's constant and what baselines add to it.
    struct Baseline {
        std::size_t input;
        double constant;
        int participant;
        bool isFirst;
        double factor;  // of the baseline's offset
    };

    explicit LayoutPlan(LayoutShape shape);

    const LayoutShape& shape() const { return shape_; }
    VariableId variables() const { return variableOf(static_cast<int>(shape_.members.size())); }
    const std::vector<Equation>& equations() const { return equations_; }
    std::size_t inputs() const { return inputs_; }
    const std::vector<Load>& loads() const { return loads_; }
    const std::vector<Source>& contents() const { return contents_; }
    const std::vector<Source>& frames() const { return frames_; }
    /// Those of one input stand together.
    const std::vector<Baseline>& baselines() const { return baselines_; }
    const LayoutShape::Member& member(int participant) const {
        return participant < 0 ? shape_.owner : shape_.members[static_cast<std::size_t>(participant)];
    }

    /// A participant's width, or the owner's; the height follows, then x and y of a participant.
    static VariableId variableOf(int participant) {
        return participant < 0 ? kOwnerWidth : static_cast<VariableId>(2 + 4 * participant);
    }

  private:
    static constexpr int kOwner = LayoutShape::kOwner;
    static constexpr int kNobody = LayoutShape::kNobody;

    struct End {
        std::vector<Term> terms;
        bool hasBaseline = false;
        int participant = kOwner;
        bool isFirst = false;
    };

    void addConstraint(const LayoutShape::Mention& mention);
    End end(LayoutAttribute attribute, int participant, bool isMirrored) const;
    std::vector<Term> position(int participant, bool isHorizontal) const;
    void addContent(int participant);
    void addFrame(int participant);
    void addExtent(VariableId variable, bool hasSize, double hugging, double resistance);

    LayoutShape shape_;
    std::vector<Equation> equations_;
    std::size_t inputs_ = 0;
    std::vector<Load> loads_;
    std::vector<Source> contents_;
    std::vector<Source> frames_;
    std::vector<Baseline> baselines_;
};

}  // namespace ktr::platform
