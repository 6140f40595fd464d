#include "platform/layout/LayoutEquations.h"

#include <algorithm>
#include <limits>

#include "platform/layout/LayoutScope.h"
#include "platform/layout/LayoutStructure.h"

namespace ktr::platform {

namespace {

constexpr double kUnlimited = std::numeric_limits<double>::infinity();

}  // namespace

std::shared_ptr<LayoutStructure> LayoutEquations::build(View& owner, const std::vector<ConstraintRule>& rules,
                                                        bool rightToLeft) {
    *this = LayoutEquations();
    owner_ = &owner;
    LayoutShape shape;
    shape.rightToLeft = rightToLeft;
    const Content content = contentOf(owner, false, kUnlimited);
    shape.owner = {kOwner, false, content.hasWidth, content.hasHeight, owner.contentPriorities()};
    collect(rules, shape);
    auto structure = LayoutStructures::find(std::move(shape));
    plan_ = structure->plan();
    inputs_.resize(plan_->inputs());
    writeInputs(readContents(owner));
    return structure;
}

void LayoutEquations::collect(const std::vector<ConstraintRule>& rules, LayoutShape& shape) {
    shape.mentions.reserve(rules.size() + 8);
    shape.members.reserve(8);
    participants_.reserve(8);
    for (const ConstraintRule& rule : rules) {
        mention(rule, shape);
    }
    shape.ownRules = shape.mentions.size();
    for (int i = 0; i < static_cast<int>(participants_.size()); ++i) {
        mentionOwnSizes(i, shape);
    }
    participants_.shrink_to_fit();
}

void LayoutEquations::mention(const ConstraintRule& rule, LayoutShape& shape) {
    LayoutShape::Mention mention{kNobody, kNobody, rule.terms};
    View* const first = rule.first.get();
    View* const second = rule.second.get();
    // Neither end takes part unless both can.
    const bool areBelow = isBelowOwner(first) && isBelowOwner(second);
    if (!areBelow) {
        hasStrangers_ = true;
        return;
    }
    hasNameless_ = hasNameless_ || (first && rule.terms.first == LayoutAttribute::None) ||
                   (second && rule.terms.second == LayoutAttribute::None);
    if (rule.terms.first != LayoutAttribute::None) {
        mention.first = participantOf(*first, shape);
    }
    if (rule.terms.second != LayoutAttribute::None) {
        mention.second = participantOf(*second, shape);
    }
    shape.mentions.push_back(mention);
}

/// What a view says of its own width and height, which its superview's scope solves.
void LayoutEquations::mentionOwnSizes(int participant, LayoutShape& shape) {
    const View* const view = participants_[participant].view.get();
    if (!view || participants_[participant].ownConstraints == 0) {
        return;
    }
    for (const ConstraintRule& rule : LayoutScope::rulesOf(*view)) {
        const View* const second = rule.second.get();
        if (rule.first.get() == view && (!second || second == view)) {
            mention(rule, shape);
        }
    }
}

std::vector<ConstraintRule> LayoutEquations::rules(const View& owner) const {
    std::vector<ConstraintRule> rules;
    const auto& shape = plan_->shape();
    rules.reserve(shape.ownRules + 1);
    const auto reference = [&](int participant) {
        return participant == kNobody ? ViewReference()
               : participant < 0      ? ViewReference(owner)
                                      : participants_[participant].view;
    };
    for (std::size_t i = 0; i < shape.ownRules; ++i) {
        const LayoutShape::Mention& mention = shape.mentions[i];
        rules.push_back({reference(mention.first), reference(mention.second), mention.terms});
    }
    return rules;
}

bool LayoutEquations::isCurrent(const View& owner, bool rightToLeft) const {
    if (!plan_ || owner_ != &owner || isRightToLeft() != rightToLeft || hasStrangers_ ||
        !(plan_->shape().owner.priorities == owner.contentPriorities())) {
        return false;
    }
    for (std::size_t i = 0; i < participants_.size(); ++i) {
        const Participant& p = participants_[i];
        const LayoutShape::Member& member = plan_->shape().members[i];
        const View* const view = p.view.get();
        if (!view || view->superview_ != p.superview ||
            view->translatesAutoresizingMaskIntoConstraints() != member.isFixed ||
            LayoutScope::revisionOf(*view) != p.ownConstraints || !(member.priorities == view->contentPriorities())) {
            return false;
        }
    }
    return true;
}

/// The content's size; that of a view which places its subviews by constraints is what these need.
IntrinsicSize LayoutEquations::intrinsicSizeOf(View& view) const {
    const IntrinsicSize size = view.intrinsicContentSize(kUnlimited);
    if (size.width || size.height || &view == owner_ || !LayoutScope::arrangesSubviews(view)) {
        return size;
    }
    const Size fitting = view.systemLayoutSizeFitting({kCompressedFittingExtent, kCompressedFittingExtent}, 1.0, 1.0);
    return {fitting.width, fitting.height};
}

/// Whether the view is the owner or below it; true for none.
bool LayoutEquations::isBelowOwner(const View* view) const {
    if (!view || view == owner_) {
        return true;
    }
    for (const View* above = view->superview_; above; above = above->superview_) {
        if (above == owner_) {
            return true;
        }
    }
    return false;
}

/// The participant of a view below the owner.
int LayoutEquations::participantOf(View& view, LayoutShape& shape) {
    if (&view == owner_) {
        return kOwner;
    }
    for (int i = 0; i < static_cast<int>(participants_.size()); ++i) {
        if (participants_[i].view.get() == &view) {
            return i;
        }
    }
    const int parent = participantOf(*view.superview_, shape);
    const bool isFixed = view.translatesAutoresizingMaskIntoConstraints();
    const Content content = contentOf(view, isFixed, kUnlimited);
    shape.members.push_back({parent, isFixed, content.hasWidth, content.hasHeight, view.contentPriorities()});
    participants_.push_back({ViewReference(view), view.superview_, kUnlimited, LayoutScope::revisionOf(view)});
    return static_cast<int>(participants_.size()) - 1;
}

LayoutEquations::Content LayoutEquations::contentOf(View& view, bool isFixed, double lastWidth) const {
    Content content;
    if (isFixed) {
        content.frame = view.frame();
        return content;
    }
    const IntrinsicSize size = intrinsicSizeOf(view);
    content.hasWidth = size.width.has_value();
    content.hasHeight = size.height.has_value();
    content.size = {size.width.value_or(0.0), size.height.value_or(0.0)};
    content.wraps = content.hasHeight && view.intrinsicHeightDependsOnWidth();
    if (content.wraps && lastWidth < content.size.width) {
        content.size.height = view.intrinsicContentSize(lastWidth).height.value_or(0.0);
    }
    if (content.hasHeight) {
        content.baselines = view.baselineOffsets();
    }
    return content;
}

std::vector<LayoutEquations::Content> LayoutEquations::readContents(View& owner) const {
    std::vector<Content> contents;
    contents.reserve(participants_.size() + 1);
    contents.push_back(contentOf(owner, false, ownerLastWidth_));
    for (std::size_t i = 0; i < participants_.size(); ++i) {
        View* const view = participants_[i].view.get();
        const bool isFixed = plan_->shape().members[i].isFixed;
        contents.push_back(view ? contentOf(*view, isFixed, participants_[i].lastWidth) : Content());
    }
    return contents;
}

std::optional<bool> LayoutEquations::readInputs(View& owner, bool rightToLeft) {
    if (!isCurrent(owner, rightToLeft)) {
        return std::nullopt;
    }
    const std::vector<Content> contents = readContents(owner);
    for (int participant = kOwner; const Content& content : contents) {
        const LayoutShape::Member& member = plan_->member(participant++);
        if (content.hasWidth != member.hasWidth || content.hasHeight != member.hasHeight) {
            return std::nullopt;
        }
    }
    return writeInputs(contents);
}

bool LayoutEquations::readHeightsFor(View& owner, const std::vector<double>& values) {
    if (!hasWrapped_) {
        return false;
    }
    const auto widthOf = [&values](int participant) {
        return std::max(0.0, values[LayoutPlan::variableOf(participant)]);
    };
    ownerLastWidth_ = widthOf(kOwner);
    for (int i = 0; i < static_cast<int>(participants_.size()); ++i) {
        participants_[i].lastWidth = widthOf(i);
    }
    return writeInputs(readContents(owner));
}

bool LayoutEquations::writeInputs(const std::vector<Content>& contents) {
    const auto contentOf = [&contents](int participant) -> const Content& { return contents.begin()[participant + 1]; };
    bool isChanged = false;
    const auto write = [&](std::size_t input, double constant) {
        isChanged = isChanged || inputs_[input] != constant;
        inputs_[input] = constant;
    };
    hasWrapped_ = std::any_of(contents.begin(), contents.end(), [](const Content& content) { return content.wraps; });
    for (const LayoutPlan::Source& source : plan_->contents()) {
        const Size& size = contentOf(source.participant).size;
        const LayoutShape::Member& member = plan_->member(source.participant);
        std::size_t next = source.input;
        if (member.hasWidth) {
            write(next++, size.width);
        }
        if (member.hasHeight) {
            write(next, size.height);
        }
    }
    for (const LayoutPlan::Source& source : plan_->frames()) {
        const Rect& frame = contentOf(source.participant).frame;
        const double values[] = {frame.x, frame.y, frame.width, frame.height};
        for (std::size_t i = 0; i < 4; ++i) {
            write(source.input + i, values[i]);
        }
    }
    const auto& baselines = plan_->baselines();
    for (std::size_t i = 0; i < baselines.size();) {
        const std::size_t input = baselines[i].input;
        double constant = baselines[i].constant;
        for (; i < baselines.size() && baselines[i].input == input; ++i) {
            // What must be added to y + height / 2 to reach the baseline.
            const Content& content = contentOf(baselines[i].participant);
            const double half = content.size.height / 2.0;
            constant += baselines[i].factor * (baselines[i].isFirst ? content.baselines.firstFromTop - half
                                                                    : half - content.baselines.lastFromBottom);
        }
        write(input, constant);
    }
    return isChanged;
}

std::string LayoutEquations::nameOf(VariableId variable) {
    static constexpr const char* kParts[] = {".width", ".height", ".x", ".y"};
    if (variable < 2) {
        return std::string("owner") + kParts[variable];
    }
    return "view" + std::to_string((variable - 2) / 4 + 1) + kParts[(variable - 2) % 4];
}

}  // namespace ktr::platform
