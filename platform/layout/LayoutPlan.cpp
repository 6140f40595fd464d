#include "platform/layout/LayoutPlan.h"

#include <algorithm>

namespace ktr::platform {

namespace {

bool isHorizontal(LayoutAttribute attribute) {
    return attribute == LayoutAttribute::Left || attribute == LayoutAttribute::Right ||
           attribute == LayoutAttribute::Leading || attribute == LayoutAttribute::Trailing ||
           attribute == LayoutAttribute::CenterX;
}

bool followsDirection(LayoutAttribute attribute) {
    return attribute == LayoutAttribute::Leading || attribute == LayoutAttribute::Trailing;
}

}  // namespace

LayoutPlan::LayoutPlan(LayoutShape shape) : shape_(std::move(shape)) {
    const int participants = static_cast<int>(shape_.members.size());
    equations_.reserve(shape_.mentions.size() + 8 * shape_.members.size() + 8);
    for (const LayoutShape::Mention& mention : shape_.mentions) {
        addConstraint(mention);
    }
    addContent(kOwner);
    for (int i = 0; i < participants; ++i) {
        if (member(i).isFixed) {
            addFrame(i);
        } else {
            addContent(i);
        }
    }
}

/// x or y in the owner's coordinates.
std::vector<Term> LayoutPlan::position(int participant, bool isHorizontal) const {
    std::vector<Term> terms;
    for (int p = participant; p >= 0; p = member(p).parent) {
        terms.push_back({variableOf(p) + (isHorizontal ? 2 : 3), 1.0});
    }
    return terms;
}

/// One side of a constraint. What follows the direction is measured from the edge where reading begins: in a
/// right-to-left interface that is the owner's width minus the coordinate.
LayoutPlan::End LayoutPlan::end(LayoutAttribute attribute, int p, bool isMirrored) const {
    End end;
    if (p == kNobody) {
        return end;
    }
    const VariableId width = variableOf(p);
    const VariableId height = width + 1;
    if (attribute == LayoutAttribute::Width || attribute == LayoutAttribute::Height) {
        end.terms = {{attribute == LayoutAttribute::Width ? width : height, 1.0}};
        return end;
    }
    const bool horizontal = isHorizontal(attribute);
    end.terms = position(p, horizontal);
    const VariableId extent = horizontal ? width : height;
    switch (attribute) {
        case LayoutAttribute::CenterX:
        case LayoutAttribute::CenterY:
            end.terms.push_back({extent, 0.5});
            break;
        case LayoutAttribute::Right:
        case LayoutAttribute::Bottom:
            end.terms.push_back({extent, 1.0});
            break;
        case LayoutAttribute::Leading:
        case LayoutAttribute::Trailing:
            if ((attribute == LayoutAttribute::Trailing) != isMirrored) {
                end.terms.push_back({extent, 1.0});
            }
            break;
        case LayoutAttribute::FirstBaseline:
        case LayoutAttribute::LastBaseline:
            // Content is centred on its view's height; a view without content has its baselines at its bottom.
            end.hasBaseline = member(p).hasHeight && !member(p).isFixed;
            end.participant = p;
            end.isFirst = attribute == LayoutAttribute::FirstBaseline;
            end.terms.push_back({extent, end.hasBaseline ? 0.5 : 1.0});
            break;
        default:
            break;
    }
    if (isMirrored && horizontal) {
        for (Term& term : end.terms) {
            term.coefficient = -term.coefficient;
        }
        end.terms.push_back({kOwnerWidth, 1.0});
    }
    return end;
}

void LayoutPlan::addConstraint(const LayoutShape::Mention& mention) {
    const ConstraintTerms& said = mention.terms;
    const bool isMirrored = shape_.rightToLeft && (followsDirection(said.first) || followsDirection(said.second));
    End first = end(said.first, mention.first, isMirrored);
    const End second = end(said.second, mention.second, isMirrored);
    Equation equation;
    equation.terms = std::move(first.terms);
    for (const Term& term : second.terms) {
        equation.terms.push_back({term.variable, -said.multiplier * term.coefficient});
    }
    equation.relation = said.relation;
    equation.constant = said.constant;
    equation.level = said.priority;
    // The offsets stand on the left: they count with the opposite sign on the right.
    if (first.hasBaseline) {
        baselines_.push_back({inputs_, said.constant, first.participant, first.isFirst, -1.0});
    }
    if (second.hasBaseline) {
        baselines_.push_back({inputs_, said.constant, second.participant, second.isFirst, said.multiplier});
    }
    equation.isInput = first.hasBaseline || second.hasBaseline;
    if (equation.isInput) {
        loads_.push_back({equations_.size(), inputs_++});
    }
    equations_.push_back(std::move(equation));
}

void LayoutPlan::addExtent(VariableId variable, bool hasSize, double hugging, double resistance) {
    const auto add = [this, variable](LayoutRelation relation, double level, bool isInput) {
        if (isInput) {
            loads_.push_back({equations_.size(), inputs_});
        }
        equations_.push_back({{{variable, 1.0}}, relation, 0.0, std::min(level, kNotNegativeLevel), isInput});
    };
    if (hasSize) {
        add(LayoutRelation::GreaterOrEqual, std::min(resistance, kContentLevel), true);
        add(LayoutRelation::LessOrEqual, std::min(hugging, kContentLevel), true);
        ++inputs_;
    }
    add(LayoutRelation::GreaterOrEqual, kNotNegativeLevel, false);
}

void LayoutPlan::addContent(int participant) {
    const LayoutShape::Member& p = member(participant);
    const VariableId width = variableOf(participant);
    if (p.hasWidth || p.hasHeight) {
        contents_.push_back({participant, inputs_});
    }
    addExtent(width, p.hasWidth, p.priorities.horizontalHugging, p.priorities.horizontalCompressionResistance);
    addExtent(width + 1, p.hasHeight, p.priorities.verticalHugging, p.priorities.verticalCompressionResistance);
}

void LayoutPlan::addFrame(int participant) {
    frames_.push_back({participant, inputs_});
    const VariableId width = variableOf(participant);
    for (const VariableId variable : {width + 2, width + 3, width, width + 1}) {
        loads_.push_back({equations_.size(), inputs_++});
        equations_.push_back({{{variable, 1.0}}, LayoutRelation::Equal, 0.0, Solver::kInput, true});
    }
}

}  // namespace ktr::platform
