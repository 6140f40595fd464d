#include "platform/ui/Accessibility.h"

#include "platform/ui/Label.h"
#include "platform/ui/Window.h"
#include "tests/support/PlatformTest.h"

namespace ktr::test {

using namespace platform;

class AccessibilityTest : public PlatformTest {
  public:
    class Link : public View {
      public:
        AccessibilityRole accessibilityRole() const override { return AccessibilityRole::Link; }
    };

    static std::shared_ptr<Label> label(const std::string& text, const Rect& frame) {
        auto made = create<Label>(&View::initWithFrame, frame);
        made->setText(text);
        return made;
    }
    static std::vector<std::string> textsOf(const AccessibilityNode& node) {
        std::vector<std::string> texts;
        for (const auto& child : node.children) {
            texts.push_back(child.text);
        }
        return texts;
    }

    std::shared_ptr<Window> window = create<Window>(&View::initWithFrame, Rect{0, 0, 400, 800});
};

TEST_F(AccessibilityTest, ReadingOrder_IsTopToBottomThenLeadingToTrailing) {
    window->addSubview(label("name", {82, 28, 200, 22}));
    window->addSubview(label("age", {82, 50, 300, 18}));
    window->addSubview(label("distance", {330, 28, 55, 22}));
    window->addSubview(label("place", {82, 10, 300, 18}));
    EXPECT_EQ(textsOf(accessibilityTree(window, false)),
              (std::vector<std::string>{"place", "name", "distance", "age"}));
    EXPECT_EQ(textsOf(accessibilityTree(window, true)), (std::vector<std::string>{"place", "distance", "name", "age"}));
}

TEST_F(AccessibilityTest, Label_IsSpokenInsteadOfTheText) {
    const auto place = label("Harbour", {0, 0, 100, 20});
    place->setAccessibilityLabel("At Harbour");
    window->addSubview(place);
    EXPECT_EQ(textsOf(accessibilityTree(window, false)), std::vector<std::string>{"At Harbour"});
    place->setAccessibilityLabel(std::nullopt);
    EXPECT_EQ(textsOf(accessibilityTree(window, false)), std::vector<std::string>{"Harbour"});
}

TEST_F(AccessibilityTest, HiddenAndEmptyViews_AreSilent) {
    window->addSubview(label("", {0, 0, 100, 20}));
    const auto hidden = label("hidden", {0, 20, 100, 20});
    hidden->setHidden(true);
    window->addSubview(hidden);
    EXPECT_TRUE(accessibilityTree(window, false).children.empty());
}

TEST_F(AccessibilityTest, PlainViews_PassTheirChildrenOn) {
    const auto plain = create<View>(&View::initWithFrame, Rect{0, 0, 100, 100});
    plain->addSubview(label("inside", {5, 5, 50, 20}));
    window->addSubview(plain);
    const auto tree = accessibilityTree(window, false);
    ASSERT_EQ(tree.children.size(), 1U);
    EXPECT_EQ(tree.children[0].role, AccessibilityRole::Text);
    EXPECT_EQ(tree.children[0].frame, (Rect{5, 5, 50, 20}));
}

TEST_F(AccessibilityTest, Link_IsOneElementOfAllItsTexts) {
    const auto link = create<Link>(&View::initWithFrame, Rect{0, 0, 100, 100});
    link->addSubview(label("second", {0, 30, 50, 20}));
    link->addSubview(label("first", {0, 0, 50, 20}));
    window->addSubview(link);
    const auto tree = accessibilityTree(window, false);
    ASSERT_EQ(tree.children.size(), 1U);
    EXPECT_EQ(tree.children[0].text, "first, second");
    EXPECT_TRUE(tree.children[0].children.empty()) << "they would be read twice";
    EXPECT_EQ(accessibilityName(link, false), "first, second");
}

TEST_F(AccessibilityTest, TextsOfALink_ArePartedByTheLanguagesComma) {
    const auto link = create<Link>(&View::initWithFrame, Rect{0, 0, 100, 100});
    link->addSubview(label("second", {0, 30, 50, 20}));
    link->addSubview(label("first", {0, 0, 50, 20}));
    for (const auto& [language, expected] :
         std::vector<std::pair<std::optional<std::string>, std::string>>{{"ar-AE", "first\u060C second"},
                                                                         {"fa", "first\u060C second"},
                                                                         {"ja_JP", "first\u3001second"},
                                                                         {"zh-Hant", "first\uFF0Csecond"},
                                                                         {"he", "first, second"},
                                                                         {"arn", "first, second"},
                                                                         {std::nullopt, "first, second"}}) {
        assistant->language = language;
        EXPECT_EQ(accessibilityName(link, false), expected) << language.value_or("none");
    }
}

TEST_F(AccessibilityTest, LinkWithItsOwnText_SaysThatAlone) {
    const auto link = create<Link>(&View::initWithFrame, Rect{0, 0, 100, 100});
    link->setAccessibilityLabel("Map of Ann");
    link->addSubview(label("scale", {0, 0, 50, 20}));
    window->addSubview(link);
    const auto tree = accessibilityTree(window, false);
    EXPECT_EQ(tree.children.at(0).text, "Map of Ann");
    EXPECT_TRUE(tree.children[0].children.empty());
    EXPECT_EQ(accessibilityName(link, false), "Map of Ann");
}

TEST_F(AccessibilityTest, Press_FiresTheRecognizers_AndFailsOnceTheViewIsGone) {
    auto link = create<Link>(&View::initWithFrame, Rect{0, 0, 100, 100});
    int presses = 0;
    link->addGestureRecognizer(std::make_shared<TapGestureRecognizer>([&] { ++presses; }));
    link->addSubview(label("open", {0, 0, 50, 20}));
    window->addSubview(link);
    const auto tree = accessibilityTree(window, false);
    ASSERT_EQ(tree.children.size(), 1U);
    EXPECT_TRUE(tree.children[0].pressable);
    EXPECT_TRUE(accessibilityPress(tree.children[0]));
    EXPECT_EQ(presses, 1);
    link->removeFromSuperview();
    link.reset();
    EXPECT_FALSE(accessibilityPress(tree.children[0]));
}

}  // namespace ktr::test
