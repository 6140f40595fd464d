// Where what a scope holds comes to stand, and how large it wants to be.
#include "platform/layout/LayoutScope.h"

#include "platform/ui/Label.h"
#include "tests/unit/layout/LayoutScopeFixture.h"

namespace ktr::test {

using namespace platform;

// --- anchors

TEST_F(LayoutScopeTest, EveryAnchor_IsAPlaceOfItsView) {
    const auto fixed = subview(root);
    place(*fixed, 40, 30, 100, 60);
    struct Case {
        LayoutAttribute attribute;
        double leftToRight;
        double rightToLeft;
    };
    // Where a view of 10 x 10 begins that has this anchor in common with the fixed one.
    const Case cases[] = {
        {LayoutAttribute::Left, 40, 40},          {LayoutAttribute::Right, 130, 130},
        {LayoutAttribute::Leading, 40, 130},      {LayoutAttribute::Trailing, 130, 40},
        {LayoutAttribute::CenterX, 85, 85},       {LayoutAttribute::Top, 30, 30},
        {LayoutAttribute::Bottom, 80, 80},        {LayoutAttribute::CenterY, 55, 55},
        {LayoutAttribute::FirstBaseline, 80, 80}, {LayoutAttribute::LastBaseline, 80, 80},
    };
    for (const Case& c : cases) {
        for (const bool rightToLeft : {false, true}) {
            assistant->rightToLeft = rightToLeft;
            const auto view = subview(root);
            activate({view->widthAnchor().constraintEqualToConstant(10),
                      view->heightAnchor().constraintEqualToConstant(10),
                      view->anchor(c.attribute).constraintEqualTo(fixed->anchor(c.attribute))});
            root->layoutIfNeeded();
            const bool isVertical = c.attribute == LayoutAttribute::Top || c.attribute == LayoutAttribute::Bottom ||
                                    c.attribute == LayoutAttribute::CenterY ||
                                    c.attribute == LayoutAttribute::FirstBaseline ||
                                    c.attribute == LayoutAttribute::LastBaseline;
            EXPECT_EQ(isVertical ? view->frame().y : view->frame().x, rightToLeft ? c.rightToLeft : c.leftToRight)
                << static_cast<int>(c.attribute) << rightToLeft;
            view->removeFromSuperview();
        }
    }
}

TEST_F(LayoutScopeTest, Leading_ConstantsAndInequalitiesAreMirrored) {
    const auto a = subview(root);
    const auto b = subview(root);
    activate({a->widthAnchor().constraintEqualToConstant(50), b->widthAnchor().constraintEqualToConstant(20),
              a->leadingAnchor().constraintEqualTo(root->leadingAnchor(), 15),
              b->leadingAnchor().constraintGreaterThanOrEqualTo(a->trailingAnchor(), 8),
              constraint(b->leadingAnchor(), LayoutRelation::Equal, root->leadingAnchor(), 1.0, 0.0, 500.0),
              b->trailingAnchor().constraintLessThanOrEqualTo(root->trailingAnchor(), -5)});
    root->layoutIfNeeded();
    EXPECT_EQ(a->frame().x, 15.0);
    EXPECT_EQ(b->frame().x, 73.0);
    assistant->rightToLeft = true;
    root->setNeedsLayout();
    root->layoutIfNeeded();
    EXPECT_EQ(a->frame().x, 235.0);
    EXPECT_EQ(b->frame().x, 207.0);
}

TEST_F(LayoutScopeTest, Multiplier_ScalesTheSecondAnchor) {
    const auto view = subview(root);
    activate({constraint(view->widthAnchor(), LayoutRelation::Equal, root->widthAnchor(), 0.5, -10.0),
              constraint(view->heightAnchor(), LayoutRelation::Equal, view->widthAnchor(), 0.25, 0.0),
              constraint(view->leadingAnchor(), LayoutRelation::Equal, root->trailingAnchor(), 0.1, 0.0)});
    root->layoutIfNeeded();
    EXPECT_EQ(view->frame(), (Rect{30, 0, 140, 35}));
    assistant->rightToLeft = true;
    root->setNeedsLayout();
    root->layoutIfNeeded();
    EXPECT_EQ(view->frame(), (Rect{130, 0, 140, 35}));
}

TEST_F(LayoutScopeTest, Baselines_CountFromContentThatIsCentred) {
    const auto tall = subview<LayoutContent>(root);
    const auto low = subview<LayoutContent>(root);
    tall->size = {50.0, 40.0};
    tall->offsets = {30.0, 4.0};
    low->size = {50.0, 20.0};
    low->offsets = {12.0, 8.0};
    activate({tall->topAnchor().constraintEqualTo(root->topAnchor(), 10),
              tall->heightAnchor().constraintEqualToConstant(50),
              low->firstBaselineAnchor().constraintEqualTo(tall->firstBaselineAnchor())});
    root->layoutIfNeeded();
    EXPECT_EQ(tall->frame(), (Rect{0, 10, 50, 50}));
    EXPECT_EQ(low->frame(), (Rect{0, 33, 50, 20}));  // 10 + 5 + 30 - 12
}

TEST_F(LayoutScopeTest, BaselineOffset_ThatChanges_IsFollowed) {
    const auto a = subview<LayoutContent>(root);
    const auto b = subview<LayoutContent>(root);
    a->size = b->size = {10.0, 20.0};
    a->offsets = b->offsets = {15.0, 5.0};
    activate({a->topAnchor().constraintEqualTo(root->topAnchor(), 10),
              b->lastBaselineAnchor().constraintEqualTo(a->lastBaselineAnchor())});
    root->layoutIfNeeded();
    EXPECT_EQ(b->frame().y, 10.0);
    b->offsets = {12.0, 8.0};
    b->invalidateIntrinsicContentSize();
    root->layoutIfNeeded();
    EXPECT_EQ(b->frame().y, 13.0);
}

// --- content

TEST_F(LayoutScopeTest, Content_GivesItsSizeWhereNothingElseDoes) {
    const auto view = subview<LayoutContent>(root);
    view->size = {120.0, 30.0};
    activate({view->rightAnchor().constraintEqualTo(root->rightAnchor()),
              view->bottomAnchor().constraintEqualTo(root->bottomAnchor())});
    root->layoutIfNeeded();
    EXPECT_EQ(view->frame(), (Rect{180, 170, 120, 30}));
    view->setSize({60.0, std::nullopt});
    root->layoutIfNeeded();
    EXPECT_EQ(view->frame(), (Rect{240, 200, 60, 0}));  // of a size and a place, the size is the smaller
}

TEST_F(LayoutScopeTest, HigherHugging_KeepsItsContentsSize) {
    const auto a = subview<LayoutContent>(root);
    const auto b = subview<LayoutContent>(root);
    a->size = b->size = {50.0, 10.0};
    activate({a->leftAnchor().constraintEqualTo(root->leftAnchor()),
              b->leftAnchor().constraintEqualTo(a->rightAnchor()),
              b->rightAnchor().constraintEqualTo(root->rightAnchor())});
    root->layoutIfNeeded();
    EXPECT_EQ(a->frame().width, 50.0);  // a tie: the earlier keeps its size
    a->setContentHuggingPriority(249.0, LayoutAxis::Horizontal);
    root->layoutIfNeeded();
    EXPECT_EQ(a->frame().width, 250.0);
    EXPECT_EQ(b->frame().width, 50.0);
}

TEST_F(LayoutScopeTest, LowerResistance_GivesWayFirst) {
    const auto a = subview<LayoutContent>(root);
    const auto b = subview<LayoutContent>(root);
    a->size = b->size = {200.0, 10.0};
    activate({a->leftAnchor().constraintEqualTo(root->leftAnchor()),
              b->leftAnchor().constraintEqualTo(a->rightAnchor()),
              b->rightAnchor().constraintEqualTo(root->rightAnchor())});
    a->setContentCompressionResistancePriority(749.0, LayoutAxis::Horizontal);
    root->layoutIfNeeded();
    EXPECT_EQ(a->frame().width, 100.0);
    EXPECT_EQ(b->frame().width, 200.0);
}

TEST_F(LayoutScopeTest, ContentAtThousand_GivesWaySilently) {
    const auto view = subview<LayoutContent>(root);
    view->size = {500.0, 10.0};
    view->setContentCompressionResistancePriority(1000.0, LayoutAxis::Horizontal);
    view->setContentHuggingPriority(1000.0, LayoutAxis::Horizontal);
    activate({view->leftAnchor().constraintEqualTo(root->leftAnchor(), 10),
              view->rightAnchor().constraintEqualTo(root->rightAnchor(), -10)});
    root->layoutIfNeeded();
    EXPECT_EQ(view->frame().width, 280.0);
    EXPECT_TRUE(log->texts(LogLevel::Debug).empty());
}

TEST_F(LayoutScopeTest, ContentAtThousand_WinsOverWishes) {
    const auto view = subview<LayoutContent>(root);
    view->size = {100.0, 10.0};
    view->setContentCompressionResistancePriority(1000.0, LayoutAxis::Horizontal);
    activate({view->leftAnchor().constraintEqualTo(root->leftAnchor()),
              constraint(view->widthAnchor(), LayoutRelation::Equal, {}, 0.0, 20.0, 999.0)});
    root->layoutIfNeeded();
    EXPECT_EQ(view->frame().width, 100.0);
}

TEST_F(LayoutScopeTest, Priorities_HaveTheirDefaults) {
    View& view = *root;
    for (const LayoutAxis axis : {LayoutAxis::Horizontal, LayoutAxis::Vertical}) {
        EXPECT_EQ(view.contentHuggingPriority(axis), 250.0);
        EXPECT_EQ(view.contentCompressionResistancePriority(axis), 750.0);
        view.setContentHuggingPriority(axis == LayoutAxis::Horizontal ? 1.0 : 2.0, axis);
        view.setContentCompressionResistancePriority(axis == LayoutAxis::Horizontal ? 3.0 : 4.0, axis);
    }
    EXPECT_EQ(view.contentHuggingPriority(LayoutAxis::Horizontal), 1.0);
    EXPECT_EQ(view.contentHuggingPriority(LayoutAxis::Vertical), 2.0);
    EXPECT_EQ(view.contentCompressionResistancePriority(LayoutAxis::Horizontal), 3.0);
    EXPECT_EQ(view.contentCompressionResistancePriority(LayoutAxis::Vertical), 4.0);
}

// --- the size that is assigned

TEST_F(LayoutScopeTest, AssignedSize_IsStrongerThanARequiredOne) {
    const auto view = subview(root);
    activate({root->widthAnchor().constraintEqualToConstant(100),
              view->leftAnchor().constraintEqualTo(root->leftAnchor()),
              view->rightAnchor().constraintEqualTo(root->rightAnchor())});
    root->layoutIfNeeded();
    EXPECT_EQ(view->frame().width, 300.0);
    EXPECT_EQ(root->frame(), (Rect{10, 20, 300, 200}));
    EXPECT_EQ(root->systemLayoutSizeFitting({300, 0}, 999.0, 1.0).width, 100.0);
}

TEST_F(LayoutScopeTest, AutoresizedSubview_CountsWithItsFrame) {
    const auto fixed = create<View>(&View::initWithFrame, Rect{30, 40, 50, 60});
    root->addSubview(fixed);
    const auto view = subview(root);
    activate({view->leftAnchor().constraintEqualTo(fixed->rightAnchor(), 5),
              view->topAnchor().constraintEqualTo(fixed->bottomAnchor()),
              constraint(view->widthAnchor(), LayoutRelation::Equal, fixed->widthAnchor(), 1.0, 0.0),
              // Cannot hold: a frame is taken as it stands.
              fixed->heightAnchor().constraintEqualToConstant(10)});
    root->layoutIfNeeded();
    EXPECT_EQ(fixed->frame(), (Rect{30, 40, 50, 60}));
    EXPECT_EQ(view->frame(), (Rect{85, 100, 50, 0}));
    fixed->setFrame({0, 0, 70, 10});
    root->layoutIfNeeded();
    EXPECT_EQ(view->frame(), (Rect{75, 10, 70, 0}));
}

TEST_F(LayoutScopeTest, UnmentionedSubview_IsLeftAlone) {
    const auto view = create<View>(&View::initWithFrame, Rect{1, 2, 3, 4});
    view->setTranslatesAutoresizingMaskIntoConstraints(false);
    root->addSubview(view);
    root->layoutIfNeeded();
    EXPECT_EQ(view->frame(), (Rect{1, 2, 3, 4}));
}

TEST_F(LayoutScopeTest, DeeperView_CountsInItsOwnSuperviewsCoordinates) {
    const auto middle = subview(root);
    place(*middle, 40, 30, 100, 100);
    const auto deep = subview(middle);
    // Held by the root, the nearest view that contains both ends.
    activate({deep->leftAnchor().constraintEqualTo(root->leftAnchor(), 50),
              deep->rightAnchor().constraintEqualTo(root->rightAnchor(), -180),
              deep->topAnchor().constraintEqualTo(root->topAnchor(), 50),
              deep->heightAnchor().constraintEqualToConstant(7)});
    root->layoutIfNeeded();
    EXPECT_EQ(deep->frame(), (Rect{10, 20, 70, 7}));
}

// --- fitting

TEST_F(LayoutScopeTest, Fitting_ContentAgainstTheTarget) {
    const auto view = subview<LayoutContent>(root);
    view->size = {120.0, 30.0};
    activate({view->leftAnchor().constraintEqualTo(root->leftAnchor(), 10),
              root->rightAnchor().constraintEqualTo(view->rightAnchor(), 10),
              view->topAnchor().constraintEqualTo(root->topAnchor(), 5),
              root->bottomAnchor().constraintGreaterThanOrEqualTo(view->bottomAnchor(), 5)});
    // Weaker than hugging: the content's size. Between hugging and resistance: it may grow, not shrink.
    EXPECT_EQ(root->systemLayoutSizeFitting({400, 0}, 200.0, 200.0), (Size{140, 40}));
    EXPECT_EQ(root->systemLayoutSizeFitting({400, 0}, 300.0, 300.0), (Size{400, 40}));
    EXPECT_EQ(root->systemLayoutSizeFitting({100, 0}, 300.0, 300.0), (Size{140, 40}));
    // Stronger than resistance: the target.
    EXPECT_EQ(root->systemLayoutSizeFitting({100, 20}, 800.0, 800.0), (Size{100, 20}));
    EXPECT_EQ(root->systemLayoutSizeFitting({100, 0}, 800.0, 800.0), (Size{100, 10}));  // never below no height
    // Its frame has no part in it.
    EXPECT_EQ(root->frame(), (Rect{10, 20, 300, 200}));
}

TEST_F(LayoutScopeTest, Fitting_FollowsContentAndConstraints) {
    const auto view = subview<LayoutContent>(root);
    view->size = {120.0, 30.0};
    activate({view->topAnchor().constraintEqualTo(root->topAnchor()),
              root->bottomAnchor().constraintEqualTo(view->bottomAnchor())});
    EXPECT_EQ(root->systemLayoutSizeFitting({100, 0}, 1000.0, 1.0).height, 30.0);
    const int asked = view->asked;
    EXPECT_EQ(root->systemLayoutSizeFitting({100, 0}, 1000.0, 1.0).height, 30.0);
    EXPECT_EQ(view->asked, asked);
    view->setSize({120.0, 44.0});
    EXPECT_EQ(root->systemLayoutSizeFitting({100, 0}, 1000.0, 1.0).height, 44.0);
    const auto extra = view->heightAnchor().constraintEqualToConstant(70);
    extra->setActive(true);
    EXPECT_EQ(root->systemLayoutSizeFitting({100, 0}, 1000.0, 1.0).height, 70.0);
    extra->setActive(false);
    EXPECT_EQ(root->systemLayoutSizeFitting({100, 0}, 1000.0, 1.0).height, 44.0);
    view->setContentCompressionResistancePriority(0.5, LayoutAxis::Vertical);
    view->setContentHuggingPriority(0.5, LayoutAxis::Vertical);
    EXPECT_EQ(root->systemLayoutSizeFitting({100, 0}, 1000.0, 500.0).height, 0.0);
    view->removeFromSuperview();
    EXPECT_EQ(root->systemLayoutSizeFitting({100, 7}, 1000.0, 500.0).height, 7.0);
}

TEST_F(LayoutScopeTest, Fitting_WithoutConstraints_IsTheTargetOrTheContent) {
    EXPECT_EQ(root->systemLayoutSizeFitting({123, 45}, 750.0, 750.0), (Size{123, 45}));
    const auto label = create<Label>(&Label::initWithFrame, Rect{});
    label->setFont({FontFace::Text, FontWeight::Regular, 10.0});
    label->setText("four");
    EXPECT_EQ(label->systemLayoutSizeFitting({100, 0}, 1000.0, 1.0), (Size{100, 14}));
    EXPECT_EQ(label->systemLayoutSizeFitting({100, 0}, 1.0, 1.0), (Size{40, 14}));
}

TEST_F(LayoutScopeTest, Fitting_AtRequiredPriority_GoesBeforeOwnRequiredConstraints) {
    activate({root->widthAnchor().constraintEqualToConstant(100)});
    EXPECT_EQ(root->systemLayoutSizeFitting({80, 0}, 1000.0, 1.0).width, 80.0);
}

// --- scopes below scopes

TEST_F(LayoutScopeTest, OwnSizeOfASubview_CountsInTheScopeAbove) {
    const auto a = subview(root);
    const auto b = subview(root);
    activate(
        {b->leftAnchor().constraintEqualTo(a->rightAnchor()), a->leftAnchor().constraintEqualTo(root->leftAnchor())});
    const auto width = a->widthAnchor().constraintEqualToConstant(70);
    width->setActive(true);
    EXPECT_EQ(a->constraints(), std::vector{width});
    root->layoutIfNeeded();
    EXPECT_EQ(b->frame().x, 70.0);
    width->setActive(false);
    root->layoutIfNeeded();
    EXPECT_EQ(b->frame().x, 0.0);
    constraint(a->heightAnchor(), LayoutRelation::Equal, a->widthAnchor(), 0.5, 3.0)->setActive(true);
    a->widthAnchor().constraintEqualToConstant(30)->setActive(true);
    root->layoutIfNeeded();
    EXPECT_EQ(a->frame(), (Rect{0, 0, 30, 18}));
}

TEST_F(LayoutScopeTest, SubviewThatArrangesOthers_HasWhatTheseNeedAsContent) {
    const auto box = subview(root);
    const auto inner = subview<LayoutContent>(box);
    inner->size = {80.0, 20.0};
    for (const auto attribute :
         {LayoutAttribute::Top, LayoutAttribute::Bottom, LayoutAttribute::Left, LayoutAttribute::Right}) {
        inner->anchor(attribute).constraintEqualTo(box->anchor(attribute))->setActive(true);
    }
    activate({box->rightAnchor().constraintEqualTo(root->rightAnchor(), -10),
              box->topAnchor().constraintEqualTo(root->topAnchor())});
    root->layoutIfNeeded();
    EXPECT_EQ(box->frame(), (Rect{210, 0, 80, 20}));
    EXPECT_EQ(inner->frame(), (Rect{0, 0, 80, 20}));
    inner->setSize({100.0, 20.0});
    root->layoutIfNeeded();
    EXPECT_EQ(box->frame(), (Rect{190, 0, 100, 20}));
    EXPECT_EQ(inner->frame(), (Rect{0, 0, 100, 20}));
}

}  // namespace ktr::test
