#include "linux/paint/TextKey.h"

#include <gtest/gtest.h>

namespace ktr::linux_ {

using namespace platform;

namespace {

AttributedString::Run run(const std::string& text, std::optional<Color> color, TextAlignment alignment) {
    return {text, {FontFace::Light, FontWeight::Bold, 13.5}, color, {alignment, LineBreakMode::TruncatingTail}};
}

TextContainer unusual() {
    TextContainer container;
    container.width = 123.25;
    container.exclusionPaths = {{1, 2, 3, 4}, {5, 6, 7, 8}};
    container.lineFragmentPadding = 5.0;
    container.hyphenationFactor = 0.5;
    container.maximumLines = 3;
    container.lineBreakMode = LineBreakMode::TruncatingTail;
    container.alignment = TextAlignment::Center;
    container.rightToLeft = true;
    return container;
}

}  // namespace

TEST(TextKeyTest, GivesBackWhatItWasMadeOf) {
    AttributedString text;
    text.append(run("Ann \xD7\x90", Color::rgb(0.1, 0.2, 0.3, 0.4), TextAlignment::Natural));
    text.append(run(std::string("a\0b", 3), Color::ofRole(ColorRole::Highlight), TextAlignment::Right));
    text.append({"plain", {}, std::nullopt, {}});
    const TextKey key(text, unusual());
    EXPECT_EQ(key.text(), text);
    EXPECT_EQ(key.container(), unusual());
    const TextKey endless({"x", {}}, {});
    EXPECT_EQ(endless.text(), AttributedString("x", {}));
    EXPECT_EQ(endless.container(), TextContainer());
}

TEST(TextKeyTest, WhateverDiffers_IsAnotherKey) {
    const AttributedString text("Ann", {});
    const TextKey key(text, unusual());
    EXPECT_EQ(key, TextKey(text, unusual()));
    EXPECT_EQ(key.hash(), TextKey(text, unusual()).hash());
    EXPECT_FALSE(key == TextKey({"Ben", {}}, unusual()));
    EXPECT_FALSE(key == TextKey({"Ann", {FontFace::Thin, FontWeight::Regular, 16.0}}, unusual()));
    AttributedString parts;
    parts.append({"A", {}, std::nullopt, {}});
    parts.append({"nn", {}, std::nullopt, {}});
    EXPECT_FALSE(key == TextKey(parts, unusual()));
    for (const auto change :
         {+[](TextContainer& c) { c.width += 1.0; }, +[](TextContainer& c) { c.maximumLines = 1; },
          +[](TextContainer& c) { c.exclusionPaths.pop_back(); },
          +[](TextContainer& c) { c.lineFragmentPadding = 0.0; }, +[](TextContainer& c) { c.hyphenationFactor = 0.0; },
          +[](TextContainer& c) { c.lineBreakMode = LineBreakMode::WordWrapping; },
          +[](TextContainer& c) { c.alignment = TextAlignment::Right; },
          +[](TextContainer& c) { c.rightToLeft = false; }}) {
        TextContainer changed = unusual();
        change(changed);
        EXPECT_FALSE(key == TextKey(text, changed));
    }
}

}  // namespace ktr::linux_
