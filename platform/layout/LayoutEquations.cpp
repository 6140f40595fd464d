#include "platform/layout/LayoutEquations.h"

#include <algorithm>
#include <limits>

#include "platform/layout/LayoutScope.h"
#include "platform/layout/LayoutStructure.h"

namespace ktr::platform {

namespace {

constexpr double kUnlimited = std::numeric_limits<double>::infinity();

bool isHorizontal(LayoutAttribute attribute) {
    return attribute == LayoutAttribute::Left || attribute == LayoutAttribute::Right ||
           attribute == LayoutAttribute::Leading || attribute == LayoutAttribute::Trailing ||
           attribute == LayoutAttribute::CenterX;
}

bool followsDirection(LayoutAttribute attribute) {
    return attribute == LayoutAttribute::Leading || attribute == LayoutAttribute::Trailing;
}

}  // namespace

std::shared_ptr<LayoutStructure> LayoutEquations::build(
    View& owner, const std::vector<std::shared_ptr<LayoutConstraint>>& constraints, bool rightToLeft) {
    *this = LayoutEquations();
    rightToLeft_ = rightToLeft;
    owner_.identity = &owner;
    owner_.view = weak(&owner);
    readContent(owner_, owner);
    const Mentions mentions = collect(constraints);
    auto structure = LayoutStructures::find(signature(mentions), [&] { return makePlan(mentions); });
    plan_ = structure->plan();
    constants_.reserve(plan_->equations.size());
    for (const Equation& equation : plan_->equations) {
        constants_.push_back(equation.constant);
    }
    writeInputs();
    return structure;
}

LayoutEquations::Mentions LayoutEquations::collect(const std::vector<std::shared_ptr<LayoutConstraint>>& constraints) {
    Mentions mentions;
    mentions.reserve(constraints.size() + 8);
    participants_.reserve(8);
    for (const auto& constraint : constraints) {
        mention(*constraint, mentions);
    }
    for (int i = 0; i < static_cast<int>(participants_.size()); ++i) {
        mentionOwnSizes(i, mentions);
    }
    participants_.shrink_to_fit();
    return mentions;
}

void LayoutEquations::mention(const LayoutConstraint& constraint, Mentions& mentions) {
    Mention mention{&constraint, kNobody, kNobody};
    const auto first = constraint.first().view();
    const auto second = constraint.second().view();
    // Neither end takes part unless both can.
    const bool areBelow = isBelowOwner(first) && isBelowOwner(second);
    if (!areBelow) {
        hasStrangers_ = true;
        return;
    }
    if (constraint.first().attribute() != LayoutAttribute::None) {
        mention.first = participantOf(first);
    }
    if (constraint.second().attribute() != LayoutAttribute::None) {
        mention.second = participantOf(second);
    }
    mentions.push_back(mention);
}

/// What a view says of its own width and height, which its superview's scope solves.
void LayoutEquations::mentionOwnSizes(int participant, Mentions& mentions) {
    const auto view = participants_[participant].view.lock();
    if (!view || participants_[participant].ownConstraints == 0) {
        return;
    }
    for (const auto& constraint : LayoutScope::constraintsOf(*view)) {
        const auto second = constraint->second().view();
        if (constraint->first().view() == view && (!second || second == view)) {
            mention(*constraint, mentions);
        }
    }
}

/// All that the plan depends on: equal for equal plans only.
std::vector<double> LayoutEquations::signature(const Mentions& mentions) const {
    std::vector<double> signature;
    signature.reserve(2 + mentions.size() * 8 + participants_.size() * 8 + 8);
    signature.push_back(rightToLeft_ ? 1.0 : 0.0);
    signature.push_back(static_cast<double>(mentions.size()));
    for (const auto& [constraint, first, second] : mentions) {
        signature.push_back(first);
        signature.push_back(static_cast<double>(constraint->first().attribute()));
        signature.push_back(second);
        signature.push_back(static_cast<double>(constraint->second().attribute()));
        signature.push_back(static_cast<double>(constraint->relation()));
        signature.push_back(constraint->multiplier());
        signature.push_back(constraint->constant());
        signature.push_back(constraint->priority());
    }
    const auto describe = [&signature](const Participant& p) {
        signature.push_back(p.parent);
        signature.push_back((p.isFixed ? 1.0 : 0.0) + (p.hasWidth ? 2.0 : 0.0) + (p.hasHeight ? 4.0 : 0.0));
        signature.push_back(p.priorities.horizontalHugging);
        signature.push_back(p.priorities.horizontalCompressionResistance);
        signature.push_back(p.priorities.verticalHugging);
        signature.push_back(p.priorities.verticalCompressionResistance);
    };
    describe(owner_);
    for (const Participant& participant : participants_) {
        describe(participant);
    }
    return signature;
}

std::shared_ptr<const LayoutEquations::Plan> LayoutEquations::makePlan(const Mentions& mentions) const {
    auto plan = std::make_shared<Plan>();
    plan->variables = static_cast<VariableId>(2 + 4 * participants_.size());
    plan->equations.reserve(mentions.size() + 8 * participants_.size() + 8);
    for (const Mention& mention : mentions) {
        addConstraint(mention, *plan);
    }
    addContent(kOwner, *plan);
    for (int i = 0; i < static_cast<int>(participants_.size()); ++i) {
        if (participants_[i].isFixed) {
            addFrame(i, *plan);
        } else {
            addContent(i, *plan);
        }
    }
    return plan;
}

bool LayoutEquations::isCurrent(View& owner, bool rightToLeft) const {
    const auto isSame = [this](const Participant& p, View& view) {
        const IntrinsicSize size = p.isFixed ? IntrinsicSize{} : contentOf(view);
        return p.hasWidth == size.width.has_value() && p.hasHeight == size.height.has_value() &&
               p.priorities == view.contentPriorities();
    };
    if (owner_.identity != &owner || rightToLeft_ != rightToLeft || hasStrangers_ || !isSame(owner_, owner)) {
        return false;
    }
    return std::all_of(participants_.begin(), participants_.end(), [&isSame](const Participant& p) {
        const auto view = p.view.lock();
        return view && view->superview().get() == p.superview &&
               view->translatesAutoresizingMaskIntoConstraints() == p.isFixed &&
               LayoutScope::revisionOf(*view) == p.ownConstraints && isSame(p, *view);
    });
}

/// The content's size; that of a view which places its subviews by constraints is what these need.
IntrinsicSize LayoutEquations::contentOf(View& view) const {
    const IntrinsicSize size = view.intrinsicContentSize(kUnlimited);
    if (size.width || size.height || &view == owner_.identity || !LayoutScope::arrangesSubviews(view)) {
        return size;
    }
    const Size fitting = view.systemLayoutSizeFitting({kCompressedFittingExtent, kCompressedFittingExtent}, 1.0, 1.0);
    return {fitting.width, fitting.height};
}

/// Whether the view is the owner or below it; true for none.
bool LayoutEquations::isBelowOwner(const std::shared_ptr<View>& view) const {
    const auto isKnown = [&view](const Participant& p) { return p.identity == view.get(); };
    if (!view || view.get() == owner_.identity || std::any_of(participants_.begin(), participants_.end(), isKnown)) {
        return true;
    }
    for (auto above = view->superview(); above; above = above->superview()) {
        if (above.get() == owner_.identity) {
            return true;
        }
    }
    return false;
}

/// The participant of a view below the owner.
int LayoutEquations::participantOf(const std::shared_ptr<View>& view) {
    if (view.get() == owner_.identity) {
        return kOwner;
    }
    for (int i = 0; i < static_cast<int>(participants_.size()); ++i) {
        if (participants_[i].identity == view.get()) {
            return i;
        }
    }
    const auto superview = view->superview();
    const int parent = participantOf(superview);
    Participant participant;
    participant.view = view;
    participant.identity = view.get();
    participant.superview = superview.get();
    participant.parent = parent;
    participant.width = static_cast<VariableId>(2 + 4 * participants_.size());
    participant.isFixed = view->translatesAutoresizingMaskIntoConstraints();
    participant.ownConstraints = LayoutScope::revisionOf(*view);
    readContent(participant, *view);
    participants_.push_back(std::move(participant));
    return static_cast<int>(participants_.size()) - 1;
}

/// x or y in the owner's coordinates.
std::vector<Term> LayoutEquations::position(int participant, bool isHorizontal) const {
    std::vector<Term> terms;
    for (int p = participant; p >= 0; p = participants_[p].parent) {
        terms.push_back({isHorizontal ? participants_[p].x() : participants_[p].y(), 1.0});
    }
    return terms;
}

/// One side of a constraint. What follows the direction is measured from the edge where reading begins: in a
/// right-to-left interface that is the owner's width minus the coordinate.
LayoutEquations::End LayoutEquations::end(const LayoutAnchor& anchor, int p, bool isMirrored) const {
    End end;
    if (p == kNobody) {
        return end;
    }
    const VariableId width = content(p).width;
    const VariableId height = content(p).height();
    const LayoutAttribute attribute = anchor.attribute();
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
            end.hasBaseline = content(p).hasHeight;
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

void LayoutEquations::addConstraint(const Mention& mention, Plan& plan) const {
    const LayoutConstraint& constraint = *mention.constraint;
    const bool isMirrored = rightToLeft_ && (followsDirection(constraint.first().attribute()) ||
                                             followsDirection(constraint.second().attribute()));
    End first = end(constraint.first(), mention.first, isMirrored);
    const End second = end(constraint.second(), mention.second, isMirrored);
    Equation equation;
    equation.terms = std::move(first.terms);
    for (const Term& term : second.terms) {
        equation.terms.push_back({term.variable, -constraint.multiplier() * term.coefficient});
    }
    equation.relation = constraint.relation();
    equation.constant = constraint.constant();
    equation.level = constraint.priority();
    // The offsets stand on the left: they count with the opposite sign on the right.
    if (first.hasBaseline) {
        plan.baselines.push_back({plan.equations.size(), first.participant, first.isFirst, -1.0});
    }
    if (second.hasBaseline) {
        plan.baselines.push_back({plan.equations.size(), second.participant, second.isFirst, constraint.multiplier()});
    }
    equation.isInput = first.hasBaseline || second.hasBaseline;
    plan.equations.push_back(std::move(equation));
}

void LayoutEquations::addContent(int participant, Plan& plan) const {
    const Participant& p = content(participant);
    const auto addExtent = [&plan](VariableId variable, bool hasSize, double hugging, double resistance) {
        const auto add = [&plan, variable](LayoutRelation relation, double level, bool isInput) {
            plan.equations.push_back({{{variable, 1.0}}, relation, 0.0, std::min(level, kNotNegativeLevel), isInput});
        };
        if (hasSize) {
            add(LayoutRelation::GreaterOrEqual, std::min(resistance, kContentLevel), true);
            add(LayoutRelation::LessOrEqual, std::min(hugging, kContentLevel), true);
        }
        add(LayoutRelation::GreaterOrEqual, kNotNegativeLevel, false);
    };
    plan.contents.push_back({plan.equations.size(), participant});
    addExtent(p.width, p.hasWidth, p.priorities.horizontalHugging, p.priorities.horizontalCompressionResistance);
    addExtent(p.height(), p.hasHeight, p.priorities.verticalHugging, p.priorities.verticalCompressionResistance);
}

void LayoutEquations::addFrame(int participant, Plan& plan) const {
    plan.frames.push_back({plan.equations.size(), participant});
    const Participant& p = participants_[participant];
    for (const VariableId variable : {p.x(), p.y(), p.width, p.height()}) {
        plan.equations.push_back({{{variable, 1.0}}, LayoutRelation::Equal, 0.0, Solver::kInput, true});
    }
}

void LayoutEquations::readContent(Participant& participant, View& view) const {
    participant.priorities = view.contentPriorities();
    if (participant.isFixed) {
        participant.frame = view.frame();
        return;
    }
    const IntrinsicSize size = contentOf(view);
    participant.hasWidth = size.width.has_value();
    participant.hasHeight = size.height.has_value();
    participant.content = {size.width.value_or(0.0), size.height.value_or(0.0)};
    participant.wraps = participant.hasHeight && view.intrinsicHeightDependsOnWidth();
    if (participant.wraps && participant.lastWidth < participant.content.width) {
        participant.content.height = view.intrinsicContentSize(participant.lastWidth).height.value_or(0.0);
    }
    participant.baselines = participant.hasHeight ? view.baselineOffsets() : BaselineOffsets{};
}

bool LayoutEquations::readInputs() {
    if (const auto owner = owner_.view.lock()) {
        readContent(owner_, *owner);
    }
    for (Participant& participant : participants_) {
        if (const auto view = participant.view.lock()) {
            readContent(participant, *view);
        }
    }
    return writeInputs();
}

bool LayoutEquations::readHeightsFor(const std::vector<double>& values) {
    bool isWrapped = false;
    const auto read = [&](Participant& participant) {
        const auto view = participant.wraps ? participant.view.lock() : nullptr;
        if (view) {
            participant.lastWidth = std::max(0.0, values[participant.width]);
            readContent(participant, *view);
            isWrapped = true;
        }
    };
    read(owner_);
    for (Participant& participant : participants_) {
        read(participant);
    }
    return isWrapped && writeInputs();
}

/// What must be added to y + height / 2 to reach the baseline.
double LayoutEquations::baselineOffset(int participant, bool isFirst) const {
    const Participant& p = content(participant);
    const double half = p.content.height / 2.0;
    return isFirst ? p.baselines.firstFromTop - half : half - p.baselines.lastFromBottom;
}

bool LayoutEquations::writeInputs() {
    bool isChanged = false;
    const auto write = [&](std::size_t equation, double constant) {
        isChanged = isChanged || constants_[equation] != constant;
        constants_[equation] = constant;
    };
    for (const Source& source : plan_->contents) {
        const Participant& p = content(source.participant);
        std::size_t next = source.equation;
        if (p.hasWidth) {
            write(next++, p.content.width);
            write(next++, p.content.width);
        }
        ++next;
        if (p.hasHeight) {
            write(next++, p.content.height);
            write(next, p.content.height);
        }
    }
    for (const Source& source : plan_->frames) {
        const Rect& frame = participants_[source.participant].frame;
        const double values[] = {frame.x, frame.y, frame.width, frame.height};
        for (std::size_t i = 0; i < 4; ++i) {
            write(source.equation + i, values[i]);
        }
    }
    const std::vector<Baseline>& baselines = plan_->baselines;
    for (std::size_t i = 0; i < baselines.size();) {
        const std::size_t equation = baselines[i].equation;
        double constant = plan_->equations[equation].constant;
        for (; i < baselines.size() && baselines[i].equation == equation; ++i) {
            constant += baselines[i].factor * baselineOffset(baselines[i].participant, baselines[i].isFirst);
        }
        write(equation, constant);
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
