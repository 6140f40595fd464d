#include "app/Description.h"

#include <gtest/gtest.h>

namespace ktr::app {

namespace {

using platform::AccessibilityNode;
using platform::AccessibilityRole;

AccessibilityNode node(AccessibilityRole role, std::string text, std::vector<AccessibilityNode> children = {}) {
    AccessibilityNode made;
    made.role = role;
    made.text = std::move(text);
    made.children = std::move(children);
    return made;
}

TEST(KTRDescriptionTest, Describe_WritesALineAnElementInOrder) {
    const auto tree = node(
        AccessibilityRole::Group, "",
        {node(AccessibilityRole::Text, "Where is Ann?"),
         node(AccessibilityRole::Group, "",
              {node(AccessibilityRole::Text, "Friends"), node(AccessibilityRole::Link, "Ann, At Work, Located now")}),
         node(AccessibilityRole::Image, "Map")});
    EXPECT_EQ(describe(tree), "Where is Ann?\nFriends\nAnn, At Work, Located now (link)\nMap (image)\n");
}

TEST(KTRDescriptionTest, Describe_LeavesOutWhatAGroupIsCalled) {
    const auto tree = node(AccessibilityRole::Group, "Question", {node(AccessibilityRole::Text, "Where is Ann?")});
    EXPECT_EQ(describe(tree), "Where is Ann?\n");
}

TEST(KTRDescriptionTest, Describe_KeepsLineEndsOutOfALine) {
    EXPECT_EQ(describe(node(AccessibilityRole::Text, "a\nb\tc")), "a b c\n");
}

TEST(KTRDescriptionTest, Describe_KeepsWhatSteersATerminalOutOfALine) {
    EXPECT_EQ(describe(node(AccessibilityRole::Text, "a\x1B[2J\u009B2J\u0085b\u2028c\u2029d\u00A0\u00E9\u2027")),
              "a [2J 2J b c d\u00A0\u00E9\u2027\n");
}

TEST(KTRDescriptionTest, Describe_SaysWhatALinkAndAPictureAreInTheLanguagesWords) {
    const auto tree = node(AccessibilityRole::Group, "",
                           {node(AccessibilityRole::Link, "آن"), node(AccessibilityRole::Image, "الخريطة")});
    EXPECT_EQ(describe(tree, {"%@ (رابط)", "%@ (صورة)"}), "آن (رابط)\nالخريطة (صورة)\n");
}

TEST(KTRDescriptionTest, Describe_OfNothingIsEmpty) {
    EXPECT_EQ(describe(node(AccessibilityRole::Group, "")), "");
}

}  // namespace

}  // namespace ktr::app
