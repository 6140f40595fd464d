#include "platform/layout/LayoutConstraint.h"

#include <cstdio>

#include "platform/base/Log.h"
#include "platform/ui/View.h"

namespace ktr::platform {

namespace {

bool isSameView(const LayoutAnchor& a, const LayoutAnchor& b) {
    return a.attribute() == b.attribute() && a.isSameView(b);
}

std::shared_ptr<View> commonAncestor(const std::shared_ptr<View>& first, const std::shared_ptr<View>& second) {
    if (!second) {
        return first;
    }
    for (auto view = first; view; view = view->superview()) {
        if (second->isDescendantOf(*view)) {
            return view;
        }
    }
    return nullptr;
}

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

LayoutConstraint::LayoutConstraint(LayoutAnchor first, LayoutRelation relation, LayoutAnchor second, double multiplier,
                                   double constant, double priority)
    : first_(std::move(first)),
      second_(std::move(second)),
      relation_(relation),
      multiplier_(multiplier),
      constant_(constant),
      priority_(priority) {}

void LayoutConstraint::setActive(bool active) {
    const auto self = strong(this);
    if (const auto owner = owner_.lock()) {
        if (!active) {
            owner->removeConstraint(self);
        }
        return;
    }
    if (!active) {
        return;
    }
    const auto holder = commonAncestor(first_.view(), second_.view());
    const bool hasLostView = second_.attribute() != LayoutAttribute::None && !second_.view();
    if (!holder || hasLostView) {
        platformLog().write(LogLevel::Debug, "A constraint whose views have no common ancestor is not activated: %@",
                            FormatArgument(description()).shown());
        return;
    }
    holder->addConstraint(self);
}

bool LayoutConstraint::isEqualTo(const LayoutConstraint& other) const {
    return this == &other ||
           (constant_ == other.constant_ && relation_ == other.relation_ && multiplier_ == other.multiplier_ &&
            priority_ == other.priority_ && isSameView(first_, other.first_) && isSameView(second_, other.second_));
}

bool LayoutConstraint::isOrphaned() const {
    return first_.hasLostView() || (second_.attribute() != LayoutAttribute::None && second_.hasLostView());
}

std::string LayoutConstraint::description() const {
    std::string text = std::string("first.") + nameOf(first_.attribute());
    text += relation_ == LayoutRelation::Equal ? " = " : relation_ == LayoutRelation::LessOrEqual ? " <= " : " >= ";
    if (second_.attribute() != LayoutAttribute::None) {
        text += multiplier_ == 1.0 ? "" : number(multiplier_) + "*";
        text += std::string("second.") + nameOf(second_.attribute());
        text += constant_ < 0.0 ? " - " + number(-constant_) : " + " + number(constant_);
    } else {
        text += number(constant_);
    }
    return text + " @" + number(priority_);
}

}  // namespace ktr::platform
