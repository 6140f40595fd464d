#include "platform/layout/LayoutConstraint.h"

#include <cstdio>

#include "platform/base/Log.h"
#include "platform/ui/View.h"

namespace ktr::platform {

namespace {

const char* nameOf(LayoutAttribute attribute) {
    switch (attribute) {
        case LayoutAttribute::None:
            return "";
        case LayoutAttribute::Left:
            return "left";
        case LayoutAttribute::Right:
            return "right";
        case LayoutAttribute::Top:
            return "top";
        case LayoutAttribute::Bottom:
            return "bottom";
        case LayoutAttribute::Leading:
            return "leading";
        case LayoutAttribute::Trailing:
            return "trailing";
        case LayoutAttribute::Width:
            return "width";
        case LayoutAttribute::Height:
            return "height";
        case LayoutAttribute::CenterX:
            return "centerX";
        case LayoutAttribute::CenterY:
            return "centerY";
        case LayoutAttribute::FirstBaseline:
            return "firstBaseline";
        case LayoutAttribute::LastBaseline:
            return "lastBaseline";
    }
    return "";
}

std::string number(double value) {
    char text[40];
    std::snprintf(text, sizeof text, "%.10g", value);
    return text;
}

}  // namespace

LayoutConstraint::LayoutConstraint(const LayoutAnchor& first, LayoutRelation relation, const LayoutAnchor& second,
                                   double multiplier, double constant, double priority)
    : LayoutConstraint(
          ConstraintRule{first.reference(),
                         second.reference(),
                         {first.attribute(), second.attribute(), relation, multiplier, constant, priority}}) {}

LayoutConstraint::LayoutConstraint(ConstraintRule rule) : rule_(std::move(rule)) {}

LayoutConstraint::~LayoutConstraint() {
    if (View* const owner = owner_.get()) {
        owner->forget(*this);
    }
}

void LayoutConstraint::setActive(bool active) {
    if (isActive()) {
        if (!active) {
            owner_.get()->removeConstraint(strong(this));
        }
        return;
    }
    if (!active) {
        return;
    }
    View* const holder = rule_.holder();
    if (!holder) {
        platformLog().write(LogLevel::Debug, "A constraint whose views have no common ancestor is not activated: %@",
                            FormatArgument(description()).shown());
        return;
    }
    holder->addConstraint(strong(this));
}

bool LayoutConstraint::isActive() const {
    const View* const owner = owner_.get();
    return owner && owner->holds(rule_);
}

std::string LayoutConstraint::description() const {
    std::string text = std::string("first.") + nameOf(rule_.terms.first);
    text += relation() == LayoutRelation::Equal ? " = " : relation() == LayoutRelation::LessOrEqual ? " <= " : " >= ";
    if (rule_.terms.second != LayoutAttribute::None) {
        text += multiplier() == 1.0 ? "" : number(multiplier()) + "*";
        text += std::string("second.") + nameOf(rule_.terms.second);
        text += constant() < 0.0 ? " - " + number(-constant()) : " + " + number(constant());
    } else {
        text += number(constant());
    }
    return text + " @" + number(priority());
}

}  // namespace ktr::platform
