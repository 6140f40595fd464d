#pragma once

#include <initializer_list>
#include <memory>

#include "platform/layout/LayoutConstraint.h"
#include "platform/ui/View.h"
#include "tests/support/PlatformTest.h"
#include "tests/unit/layout/PrintRect.h"

namespace ktr::test {

/// A view with a content of a size that a test sets; counts how often it was asked for it.
class LayoutContent : public platform::View {
  public:
    platform::IntrinsicSize size;
    platform::BaselineOffsets offsets;
    mutable int asked = 0;

    platform::IntrinsicSize intrinsicContentSize(double) const override {
        ++asked;
        return size;
    }
    platform::BaselineOffsets baselineOffsets() const override { return offsets; }
    void setSize(platform::IntrinsicSize newSize) {
        size = newSize;
        invalidateIntrinsicContentSize();
    }
};

/// A view that holds constraints.
class LayoutScopeTest : public PlatformTest {
  protected:
    template <class T = platform::View>
    std::shared_ptr<T> subview(const std::shared_ptr<platform::View>& of) {
        auto view = platform::create<T>(&platform::View::initWithFrame, platform::Rect{});
        view->setTranslatesAutoresizingMaskIntoConstraints(false);
        of->addSubview(view);
        return view;
    }
    static std::shared_ptr<platform::LayoutConstraint> constraint(const platform::LayoutAnchor& first,
                                                                  platform::LayoutRelation relation,
                                                                  const platform::LayoutAnchor& second,
                                                                  double multiplier, double constant,
                                                                  double priority = 1000.0) {
        return std::make_shared<platform::LayoutConstraint>(first, relation, second, multiplier, constant, priority);
    }
    static void activate(std::initializer_list<std::shared_ptr<platform::LayoutConstraint>> constraints) {
        for (const auto& one : constraints) {
            one->setActive(true);
        }
    }
    /// Pinned at the top left with this size.
    static void place(platform::View& view, double x, double y, double width, double height) {
        platform::View& parent = *view.superview();
        activate({view.leftAnchor().constraintEqualTo(parent.leftAnchor(), x),
                  view.topAnchor().constraintEqualTo(parent.topAnchor(), y),
                  view.widthAnchor().constraintEqualToConstant(width),
                  view.heightAnchor().constraintEqualToConstant(height)});
    }

    std::shared_ptr<platform::View> root =
        platform::create<platform::View>(&platform::View::initWithFrame, platform::Rect{10, 20, 300, 200});
};

}  // namespace ktr::test
