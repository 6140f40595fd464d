#include <gmock/gmock.h>

#include <chrono>
#include <cmath>
#include <string>

#include "platform/text/TextImage.h"
#include "tests/contract/TextEngineContract.h"
#include "tests/support/FixedTextEngine.h"

namespace ktr::test {

using namespace platform;

namespace {

constexpr double kFit = 0.01;
const std::string kSentence = "You will hear when they arrive at the old harbour by the fish market";
/// Latin, Arabic, Hebrew, Han, hangul, Devanagari, Thai, a family of emoji.
const std::vector<std::string> kNames = {"Ann Marsh", "ليلى حداد",  "נועם ברק",  "佐藤 美咲",
                                         "김민준",    "अनन्या शर्मा", "สมชาย ใจดี", "👩‍👩‍👧‍👦"};

}  // namespace

TEST_P(TextEngineContract, EmptyText_HasNoLinesAndNoSize) {
    const auto layout = engine_->layOut(AttributedString(), {});
    EXPECT_TRUE(layout->lines().empty());
    EXPECT_EQ(layout->usedSize(), Size());
    EXPECT_FALSE(layout->isTruncated());
}

TEST_P(TextEngineContract, OneLine_IsAsHighAsItsFontInEveryScript) {
    for (const auto& name : kNames) {
        const auto layout = layOut(name, oneLine(300));
        ASSERT_EQ(layout->lines().size(), 1U) << name;
        EXPECT_DOUBLE_EQ(layout->lines()[0].box.height, body().lineHeight()) << name;
        EXPECT_DOUBLE_EQ(layout->lines()[0].box.y, 0.0) << name;
        EXPECT_DOUBLE_EQ(layout->lines()[0].baseline, body().ascent()) << name;
        EXPECT_DOUBLE_EQ(layout->usedSize().height, body().lineHeight()) << name;
        EXPECT_GT(layout->usedSize().width, 0.0) << name;
    }
}

TEST_P(TextEngineContract, UnlimitedLinesWithoutAnEnd_AreOneLine) {
    for (const auto& name : kNames) {
        const auto layout = layOut(name, {});
        ASSERT_EQ(layout->lines().size(), 1U) << name;
        EXPECT_DOUBLE_EQ(layout->lines()[0].box.height, body().lineHeight()) << name;
        EXPECT_DOUBLE_EQ(layout->lines()[0].box.x, 0.0) << name;
    }
}

TEST_P(TextEngineContract, Padding_CountsOnBothSides) {
    auto padded = oneLine(300);
    padded.lineFragmentPadding = 5.0;
    const auto layout = layOut("Ann Marsh", padded);
    EXPECT_DOUBLE_EQ(layout->usedSize().width, naturalWidth("Ann Marsh") + 10.0);
    EXPECT_DOUBLE_EQ(layout->lines()[0].box.x, 5.0);
    EXPECT_DOUBLE_EQ(layout->lines()[0].box.width, naturalWidth("Ann Marsh"));
}

TEST_P(TextEngineContract, Padding_NarrowsTheRoom) {
    auto padded = oneLine(naturalWidth("Ann Marsh") + 4.0);
    EXPECT_FALSE(layOut("Ann Marsh", padded)->isTruncated());
    padded.lineFragmentPadding = 5.0;
    EXPECT_TRUE(layOut("Ann Marsh", padded)->isTruncated());
}

TEST_P(TextEngineContract, MeasuredWidth_HoldsTheTextEvenALittleShort) {
    for (const auto& name : kNames) {
        const double width = naturalWidth(name);
        for (const double room : {width, width - 0.9 * kFit}) {
            EXPECT_FALSE(layOut(name, oneLine(room))->isTruncated()) << name;
            EXPECT_EQ(layOut(name, wrapped(room))->lines().size(), 1U) << name;
        }
    }
}

TEST_P(TextEngineContract, WrappedLines_KeepTheirPlacesAtTheirOwnWidth) {
    const auto layout = layOut(kSentence, wrapped(20 * body().size));
    const auto again = layOut(kSentence, wrapped(layout->usedSize().width));
    ASSERT_EQ(again->lines().size(), layout->lines().size());
    EXPECT_DOUBLE_EQ(again->usedSize().width, layout->usedSize().width);
}

TEST_P(TextEngineContract, TextThatDoesNotFitOnOneLine_IsCutAndFits) {
    std::string families;
    for (int i = 0; i < 10; ++i) {
        families += "👩‍👩‍👧‍👦";
    }
    const std::vector<std::string> names = {"Bartholomew Featherstonehaugh-Cholmondeley",
                                            "ليلى بنت عبد الرحمن بن عبد العزيز الحدادية البغدادية",
                                            "佐藤美咲佐藤美咲佐藤美咲佐藤美咲佐藤美咲佐藤美咲", families};
    for (const auto& name : names) {
        const auto layout = layOut(name, oneLine(120));
        ASSERT_EQ(layout->lines().size(), 1U) << name;
        EXPECT_TRUE(layout->isTruncated()) << name;
        EXPECT_LE(layout->usedSize().width, 120 + kFit) << name;
        EXPECT_GT(layout->usedSize().width, 60.0) << name;
        EXPECT_DOUBLE_EQ(layout->usedSize().height, body().lineHeight()) << name;
    }
}

TEST_P(TextEngineContract, RoomForLessThanAnEllipsis_IsOneCutLine) {
    const auto layout = layOut("Ann Marsh", oneLine(1.0));
    ASSERT_EQ(layout->lines().size(), 1U);
    EXPECT_TRUE(layout->isTruncated());
    EXPECT_LE(layout->usedSize().width, 1.0 + kFit);
}

TEST_P(TextEngineContract, TextWithASecondParagraph_IsCutOnOneLine) {
    const auto layout = layOut("Ann\nMarsh", oneLine(300));
    ASSERT_EQ(layout->lines().size(), 1U);
    EXPECT_TRUE(layout->isTruncated());
}

TEST_P(TextEngineContract, Wrapping_StacksLinesThatFit) {
    const auto layout = layOut(kSentence, wrapped(12 * body().size));
    ASSERT_GT(layout->lines().size(), 1U);
    EXPECT_FALSE(layout->isTruncated());
    double y = 0.0;
    for (const auto& line : layout->lines()) {
        EXPECT_LE(line.box.width, 12 * body().size + kFit);
        EXPECT_DOUBLE_EQ(line.box.y, y);
        EXPECT_DOUBLE_EQ(line.baseline, y + body().ascent());
        EXPECT_DOUBLE_EQ(line.box.height, body().lineHeight());
        y = line.box.maxY();
    }
    EXPECT_DOUBLE_EQ(layout->usedSize().height, y);
}

TEST_P(TextEngineContract, WordWiderThanTheLine_BreaksAnywhere) {
    const auto layout = layOut(std::string(60, 'M'), wrapped(100));
    ASSERT_GT(layout->lines().size(), 2U);
    for (const auto& line : layout->lines()) {
        EXPECT_LE(line.box.width, 100 + kFit);
    }
}

TEST_P(TextEngineContract, NoLineBeginsWithAMarkOfJapanese) {
    // Each letter is an em wide, so that the lines' widths say where they begin.
    const std::u32string letters = U"見守っています。コーヒーショップの「ピアー」にちょっと寄りました、待って！";
    const std::string text = "見守っています。コーヒーショップの「ピアー」にちょっと寄りました、待って！";
    const double em = body().size;
    for (double room = 3.0; room < 16.0; room += 0.5) {
        const auto layout = layOut(text, wrapped(room * em));
        std::size_t begin = 0;
        for (const auto& line : layout->lines()) {
            ASSERT_LT(begin, letters.size()) << room;
            EXPECT_EQ(std::u32string(U"、。！」ーっゃょッョ").find(letters[begin]), std::u32string::npos)
                << "at " << begin << ", " << room << " wide";
            EXPECT_LE(line.box.width, room * em + kFit);
            begin += static_cast<std::size_t>(std::lround(line.box.width / em));
        }
        EXPECT_EQ(begin, letters.size()) << room;
    }
}

TEST_P(TextEngineContract, LineOfMarksAlone_IsFilled) {
    const auto layout = layOut("あーーーーーーーーーーーーーーーーーーー", wrapped(10.0 * body().size));
    EXPECT_EQ(layout->lines().size(), 2U);
}

TEST_P(TextEngineContract, MarksWithoutEnd_AreBrokenLikeLetters) {
    std::string marks;
    for (int i = 0; i < 300000; ++i) {
        marks += "。";
    }
    const auto begin = std::chrono::steady_clock::now();
    const auto layout = layOut(marks, wrapped(20.0 * body().size));
    EXPECT_GE(layout->lines().size(), 15000U);
    // Half a second; it is minutes when each line reads all the rest.
    EXPECT_LT(std::chrono::steady_clock::now() - begin, std::chrono::seconds(60));
}

TEST_P(TextEngineContract, LineFeed_BeginsALine) {
    const auto layout = layOut("a\nb", wrapped(300));
    ASSERT_EQ(layout->lines().size(), 2U);
    EXPECT_DOUBLE_EQ(layout->usedSize().height, 2.0 * body().lineHeight());
}

TEST_P(TextEngineContract, LineEndAtTheEnd_IsAnEmptyLineOfItsFont) {
    for (const std::string& end : std::vector<std::string>{"\n", "\r\n"}) {
        if (end != "\n" && GetParam().name == "FixedTextEngine") {
            continue;  // the double knows one kind of line end
        }
        const auto layout = layOut("Ann" + end, wrapped(300));
        ASSERT_EQ(layout->lines().size(), 2U);
        EXPECT_DOUBLE_EQ(layout->usedSize().height, 2.0 * body().lineHeight());
        EXPECT_DOUBLE_EQ(layout->usedSize().width, naturalWidth("Ann"));
        EXPECT_DOUBLE_EQ(layout->lines()[1].box.width, 0.0);
    }
    EXPECT_DOUBLE_EQ(layOut("\n", wrapped(300))->usedSize().height, 2.0 * body().lineHeight());
    EXPECT_DOUBLE_EQ(layOut("Ann\n\n", wrapped(300))->usedSize().height, 3.0 * body().lineHeight());
    AttributedString text("Ann", body());
    text.append({"\n", headline(), std::nullopt, {}});
    EXPECT_DOUBLE_EQ(engine_->layOut(text, wrapped(300))->lines().at(1).box.height, headline().lineHeight());
    EXPECT_FALSE(layOut("Ann\n", oneLine(300))->isTruncated());
    EXPECT_EQ(layOut("Ann\n", oneLine(300))->lines().size(), 1U);
}

TEST_P(TextEngineContract, SoftHyphen_BreaksAWordWhereThereIsHyphenationOnly) {
    const std::string text = "Ann au\u00ADto";
    auto container = wrapped(naturalWidth("Ann au-") + 0.5);
    const auto whole = layOut(text, container);
    ASSERT_EQ(whole->lines().size(), 2U);
    EXPECT_NEAR(whole->lines()[0].box.width, naturalWidth("Ann"), 0.1);
    EXPECT_NEAR(whole->lines()[1].box.width, naturalWidth("auto"), 0.1);
    container.hyphenationFactor = 1.0;
    const auto hyphenated = layOut(text, container);
    ASSERT_EQ(hyphenated->lines().size(), 2U);
    EXPECT_NEAR(hyphenated->lines()[0].box.width, naturalWidth("Ann au-"), 0.6);
}

TEST_P(TextEngineContract, WordTooLongBesideAnExclusion_StandsBelowItWhenItFitsThere) {
    const double size = body().size;
    auto container = wrapped(12 * size);
    container.exclusionPaths = {{0.0, 0.0, 9 * size, 30.0}};
    const std::string word = "WWWWWWW";
    ASSERT_GT(naturalWidth(word), 3 * size);
    ASSERT_LT(naturalWidth(word), 12 * size);
    const auto below = layOut(word, container);
    ASSERT_EQ(below->lines().size(), 1U);
    EXPECT_DOUBLE_EQ(below->lines()[0].box.y, 30.0);
    EXPECT_DOUBLE_EQ(below->lines()[0].box.x, 0.0);
    EXPECT_NEAR(below->lines()[0].box.width, naturalWidth(word), kFit);
    // What no line holds breaks where it stands.
    EXPECT_DOUBLE_EQ(layOut(std::string(40, 'W'), container)->lines()[0].box.y, 0.0);
    // What fits beside stays there.
    EXPECT_DOUBLE_EQ(layOut("W " + word, container)->lines()[0].box.x, 9 * size);
    EXPECT_DOUBLE_EQ(layOut("W " + word, container)->lines()[1].box.y, 30.0);
}

TEST_P(TextEngineContract, WritingDirection_LeavesTheRoomOfATextAsItIs) {
    for (const auto& name : kNames) {
        for (const auto direction : {WritingDirection::LeftToRight, WritingDirection::RightToLeft}) {
            AttributedString text;
            const ParagraphStyle style = {TextAlignment::Left, LineBreakMode::WordWrapping, direction};
            text.append({name, body(), std::nullopt, style});
            text.append({"\n", body(), std::nullopt, style});
            text.append({name, body(), std::nullopt, style});
            const auto layout = engine_->layOut(text, wrapped(300));
            ASSERT_EQ(layout->lines().size(), 2U) << name;
            EXPECT_NEAR(layout->usedSize().width, naturalWidth(name), 0.1) << name;
            EXPECT_DOUBLE_EQ(layout->lines()[0].box.x, 0.0) << name;
        }
    }
}

TEST_P(TextEngineContract, ImageOfALayout_IsOfTheSizeThatWasAsked) {
    const std::shared_ptr<const TextLayout> layout = layOut(kSentence, wrapped(150));
    const auto image = engine_->image(layout, {150.0, 200.0}, 2.0);
    ASSERT_NE(image, nullptr);
    EXPECT_EQ(image->size(), (Size{150.0, 200.0}));
    EXPECT_EQ(&image->layout(), layout.get());
}

TEST_P(TextEngineContract, LimitOfLines_CutsWhatGoesOn) {
    auto two = wrapped(8 * body().size);
    two.maximumLines = 2;
    two.lineBreakMode = LineBreakMode::TruncatingTail;
    const auto layout = layOut(kSentence, two);
    ASSERT_EQ(layout->lines().size(), 2U);
    EXPECT_TRUE(layout->isTruncated());
    for (const auto& line : layout->lines()) {
        EXPECT_LE(line.box.width, 8 * body().size + kFit);
    }
    two.width = 2000;
    EXPECT_FALSE(layOut(kSentence, two)->isTruncated());
}

TEST_P(TextEngineContract, NaturalAlignment_IsTheLeadingEdgeOfTheInterface) {
    for (const auto& name : kNames) {
        auto container = oneLine(300);
        EXPECT_DOUBLE_EQ(layOut(name, container)->lines()[0].box.x, 0.0) << name;
        container.rightToLeft = true;
        EXPECT_DOUBLE_EQ(layOut(name, container)->lines()[0].box.maxX(), 300.0) << name;
    }
}

TEST_P(TextEngineContract, Alignment_OfTheContainerAndOfARun) {
    const double width = naturalWidth("Ann");
    auto container = oneLine(300);
    container.alignment = TextAlignment::Center;
    EXPECT_NEAR(layOut("Ann", container)->lines()[0].box.x, (300 - width) / 2.0, 1e-9);
    container.alignment = TextAlignment::Right;
    EXPECT_NEAR(layOut("Ann", container)->lines()[0].box.x, 300 - width, 1e-9);
    AttributedString centred;
    centred.append({"Ann", body(), std::nullopt, {TextAlignment::Center, LineBreakMode::WordWrapping}});
    EXPECT_NEAR(engine_->layOut(centred, container)->lines()[0].box.x, (300 - width) / 2.0, 1e-9);
}

TEST_P(TextEngineContract, Alignment_OfWrappedLinesIsEachLinesOwn) {
    auto container = wrapped(12 * body().size);
    container.alignment = TextAlignment::Right;
    const auto layout = layOut(kSentence, container);
    ASSERT_GT(layout->lines().size(), 1U);
    for (const auto& line : layout->lines()) {
        EXPECT_NEAR(line.box.maxX(), container.width, 1e-9);
    }
}

TEST_P(TextEngineContract, Exclusion_IsTouchedByNoLine) {
    for (const bool trailing : {false, true}) {
        auto container = wrapped(20 * body().size);
        const Rect hole = {trailing ? container.width - 87.0 : 0.0, 0.0, 87.0, 30.0};
        container.exclusionPaths = {hole};
        const auto layout = layOut(kSentence, container);
        ASSERT_GT(layout->lines().size(), 2U);
        bool below = false;
        for (const auto& line : layout->lines()) {
            EXPECT_FALSE(line.box.intersects(hole));
            EXPECT_GE(line.box.x, 0.0);
            EXPECT_LE(line.box.maxX(), container.width + kFit);
            below = below || (line.box.y >= hole.maxY() && line.box.x == 0.0);
        }
        EXPECT_TRUE(below);
        EXPECT_DOUBLE_EQ(layout->lines()[0].box.x, trailing ? 0.0 : 87.0);
    }
}

TEST_P(TextEngineContract, SeveralFontsInALine_MakeItAsHighAsTheHighest) {
    AttributedString text;
    text.append({"Ann ", body(), std::nullopt, {}});
    text.append({"Marsh", headline(), std::nullopt, {}});
    const auto layout = engine_->layOut(text, oneLine(500));
    ASSERT_EQ(layout->lines().size(), 1U);
    EXPECT_DOUBLE_EQ(layout->lines()[0].box.height, headline().lineHeight());
    EXPECT_DOUBLE_EQ(layout->lines()[0].baseline, headline().ascent());
}

TEST_P(TextEngineContract, MalformedText_IsShownAsReplacements) {
    const std::string replacement = "\xEF\xBF\xBD";
    EXPECT_DOUBLE_EQ(naturalWidth("a\xFF"
                                  "b"),
                     naturalWidth("a" + replacement + "b"));
    EXPECT_DOUBLE_EQ(naturalWidth("a\xED\xA0\x80"), naturalWidth("a" + replacement + replacement + replacement));
}

TEST_P(TextEngineContract, NameOfAHundredThousandLetters_IsCutLikeAnother) {
    const auto layout = layOut(std::string(100000, 'a'), oneLine(120));
    ASSERT_EQ(layout->lines().size(), 1U);
    EXPECT_TRUE(layout->isTruncated());
    EXPECT_LE(layout->usedSize().width, 120 + kFit);
    EXPECT_GT(layout->usedSize().width, 90.0);
}

TEST_P(TextEngineContract, SameQuestion_HasTheSameAnswer) {
    const auto first = layOut(kSentence, wrapped(150));
    const auto second = layOut(kSentence, wrapped(150));
    ASSERT_EQ(first->lines().size(), second->lines().size());
    for (std::size_t i = 0; i < first->lines().size(); ++i) {
        EXPECT_EQ(first->lines()[i].box, second->lines()[i].box);
        EXPECT_EQ(first->lines()[i].baseline, second->lines()[i].baseline);
    }
}

INSTANTIATE_TEST_SUITE_P(Double, TextEngineContract,
                         ::testing::Values(TextEngineCase{"FixedTextEngine",
                                                          [] { return std::make_shared<FixedTextEngine>(); }}),
                         nameOfCase);

}  // namespace ktr::test
