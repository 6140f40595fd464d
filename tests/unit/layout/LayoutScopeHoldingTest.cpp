// When a scope is solved again, and which constraints it holds.
#include "platform/layout/LayoutScope.h"

#include "platform/ui/Label.h"
#include "tests/unit/layout/LayoutScopeFixture.h"

namespace ktr::test {

using namespace platform;

// --- when

TEST_F(LayoutScopeTest, IsSolvedAgain_OnlyWhenAnInputChanged) {
    const auto label = subview<Label>(root);
    label->setText("text");
    const auto scope = std::make_unique<LayoutScope>(*root);
    scope->add({&label->leftAnchor().constraintEqualTo(root->leftAnchor(), 5)->rule(), 1});
    scope->layout();
    EXPECT_EQ(scope->solves(), 1);
    scope->layout();
    label->setText("text");
    label->setHidden(true);
    scope->invalidate();
    scope->layout();
    EXPECT_EQ(scope->solves(), 1);
    label->setText("texts");
    scope->invalidate();  // a view tells its own scope
    scope->layout();
    EXPECT_EQ(scope->solves(), 2);
    root->setFrame({0, 0, 300, 200});
    scope->layout();
    EXPECT_EQ(scope->solves(), 2);
    root->setFrame({0, 0, 301, 200});
    scope->layout();
    EXPECT_EQ(scope->solves(), 3);
}

TEST_F(LayoutScopeTest, ChangedContentDeepDown_ReachesTheRootsLayout) {
    const auto middle = subview(root);
    const auto view = subview<LayoutContent>(middle);
    view->size = {10.0, 10.0};
    activate({view->leftAnchor().constraintEqualTo(middle->leftAnchor(), 3)});
    root->layoutIfNeeded();
    view->setSize({20.0, 10.0});
    root->layoutIfNeeded();
    EXPECT_EQ(view->frame(), (Rect{3, 0, 20, 10}));
}

// --- holding

TEST_F(LayoutScopeTest, EqualConstraints_AreHeldOnce) {
    const auto view = subview(root);
    for (int i = 0; i < 100; ++i) {
        root->addConstraint(view->leftAnchor().constraintEqualTo(root->leftAnchor(), 5));
    }
    EXPECT_EQ(root->constraints().size(), 1U);
    root->addConstraint(view->leftAnchor().constraintEqualTo(root->leftAnchor(), 6));
    root->addConstraint(constraint(view->leftAnchor(), LayoutRelation::Equal, root->leftAnchor(), 1.0, 5.0, 999.0));
    EXPECT_EQ(root->constraints().size(), 3U);
    root->removeConstraint(view->leftAnchor().constraintEqualTo(root->leftAnchor(), 5));
    EXPECT_EQ(root->constraints().size(), 2U);
    root->layoutIfNeeded();
    EXPECT_EQ(view->frame().x, 6.0);
}

TEST_F(LayoutScopeTest, EqualConstraints_AreTakenAwayTogether) {
    const auto view = subview(root);
    const auto one = view->leftAnchor().constraintEqualTo(root->leftAnchor(), 5);
    const auto another = view->leftAnchor().constraintEqualTo(root->leftAnchor(), 5);
    root->addConstraints({one, another});
    EXPECT_TRUE(one->isActive());
    EXPECT_TRUE(another->isActive());
    root->removeConstraint(one);
    EXPECT_TRUE(root->constraints().empty());
    root->addConstraint(view->leftAnchor().constraintEqualTo(root->leftAnchor(), 5));
    EXPECT_FALSE(one->isActive());
    EXPECT_FALSE(another->isActive());
}

TEST_F(LayoutScopeTest, Active_IsHeldByTheNearestCommonAncestor) {
    const auto middle = subview(root);
    const auto a = subview(middle);
    const auto b = subview(middle);
    const auto inMiddle = a->leftAnchor().constraintEqualTo(b->leftAnchor());
    const auto inRoot = a->leftAnchor().constraintEqualTo(root->leftAnchor());
    const auto own = a->widthAnchor().constraintEqualToConstant(5);
    EXPECT_FALSE(inMiddle->isActive());
    activate({inMiddle, inRoot, own});
    EXPECT_TRUE(inMiddle->isActive());
    EXPECT_EQ(middle->constraints(), std::vector{inMiddle});
    EXPECT_EQ(root->constraints(), std::vector{inRoot});
    EXPECT_EQ(a->constraints(), std::vector{own});
    inMiddle->setActive(false);
    EXPECT_FALSE(inMiddle->isActive());
    EXPECT_TRUE(middle->constraints().empty());
}

TEST_F(LayoutScopeTest, ConstraintsThatNobodyKeeps_StayHeldAndCanBeTakenAway) {
    const auto view = subview(root);
    root->addConstraint(view->leftAnchor().constraintEqualTo(root->leftAnchor(), 5));
    root->addConstraint(view->topAnchor().constraintEqualTo(root->topAnchor(), 7));
    root->layoutIfNeeded();
    EXPECT_EQ(view->frame().x, 5.0);
    const auto held = root->constraints();
    ASSERT_EQ(held.size(), 2U);
    EXPECT_TRUE(held[0]->isActive());
    EXPECT_EQ(held[0]->constant(), 5.0);
    EXPECT_EQ(held[0]->first().view(), view);
    EXPECT_EQ(root->constraints(), held);
    held[0]->setActive(false);
    EXPECT_FALSE(held[0]->isActive());
    EXPECT_TRUE(held[1]->isActive());
    root->layoutIfNeeded();
    EXPECT_EQ(view->frame().x, 0.0);
    EXPECT_EQ(view->frame().y, 7.0);
}

TEST_F(LayoutScopeTest, ConstraintOutlivesItsViews) {
    auto view = subview(root);
    const auto inner = view->widthAnchor().constraintEqualToConstant(5);
    const auto outer = view->leftAnchor().constraintEqualTo(root->leftAnchor());
    activate({inner, outer});
    root->layoutIfNeeded();
    view->removeFromSuperview();
    view.reset();
    EXPECT_FALSE(inner->isActive());
    EXPECT_EQ(inner->first().view(), nullptr);
    root.reset();
    EXPECT_FALSE(outer->isActive());
    outer->setActive(true);
    EXPECT_FALSE(outer->isActive());
}

TEST_F(LayoutScopeTest, Activation_WithoutCommonAncestor_IsADebugLine) {
    const auto stranger = create<View>(&View::initWithFrame, Rect{});
    const auto view = subview(root);
    const auto lost = view->leftAnchor().constraintEqualTo(stranger->leftAnchor(), 3);
    lost->setActive(true);
    EXPECT_FALSE(lost->isActive());
    EXPECT_TRUE(
        log->has(LogLevel::Debug,
                 "A constraint whose views have no common ancestor is not activated: first.left = second.left + "
                 "3 @1000"));
}

TEST_F(LayoutScopeTest, ConstraintOnAViewThatLeft_SleepsUntilItIsBack) {
    const auto a = subview(root);
    const auto b = subview(root);
    activate({b->leftAnchor().constraintEqualTo(a->leftAnchor(), 5),
              a->leftAnchor().constraintEqualTo(root->leftAnchor(), 9)});
    root->layoutIfNeeded();
    EXPECT_EQ(b->frame().x, 14.0);
    a->removeFromSuperview();
    root->layoutIfNeeded();
    EXPECT_EQ(b->frame().x, 14.0);  // nothing is said of it any more: it stays
    root->addSubview(a);
    root->setFrame({0, 0, 100, 100});
    root->layoutIfNeeded();
    EXPECT_EQ(b->frame().x, 14.0);
}

TEST_F(LayoutScopeTest, ConstraintOnAViewThatDied_IsForgotten) {
    auto a = subview(root);
    activate({a->leftAnchor().constraintEqualTo(root->leftAnchor(), 9)});
    a->removeFromSuperview();
    a.reset();
    root->layoutIfNeeded();
    EXPECT_TRUE(root->constraints().empty());
}

TEST_F(LayoutScopeTest, Dump_NamesOwnerAndViews) {
    const auto view = subview(root);
    LayoutScope scope(*root);
    scope.add({&view->leftAnchor().constraintEqualTo(root->leftAnchor(), 5)->rule(), 1});
    EXPECT_EQ(scope.dump(),
              "level input\n"
              "  owner.width = 300                                holds\n"
              "  owner.height = 200                               holds\n"
              "level required\n"
              "  view1.x = 5                                      holds\n"
              "level 999.9990234\n"
              "  owner.width >= 0                                 room 300\n"
              "  owner.height >= 0                                room 200\n"
              "  view1.width >= 0                                 met\n"
              "  view1.height >= 0                                met\n"
              "variables\n"
              "  owner.width = 300\n"
              "  owner.height = 200\n"
              "  view1.width = 0\n"
              "  view1.height = 0\n"
              "  view1.x = 5\n"
              "  view1.y = 0\n");
}

TEST_F(LayoutScopeTest, WithoutAPlatform_LayoutWorks) {
    platform::Platform::install(nullptr);
    const auto view = subview(root);
    place(*view, 1, 2, 3, 4);
    root->layoutIfNeeded();
    EXPECT_EQ(view->frame(), (Rect{1, 2, 3, 4}));
}

}  // namespace ktr::test
