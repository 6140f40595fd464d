// One-line labels are set out of words that are kept: to the widths, and to the pixels, that Qt's own layout gives.
#include <gtest/gtest.h>

#include <random>

#include "tests/support/NoMoreFiles.h"
#include "tests/unit/linux/LabelsBesideQt.h"

namespace ktr::linux_ {

using platform::FontWeight;
using test::Label;

namespace {

using Words = std::vector<std::vector<std::string>>;

/// Latin (with Greek and Cyrillic), Arabic, Hebrew, Han with kana, Hangul; then what stands between them.
const Words kWords = {
    {"Ann",  "Marsh",  "Tómas", "Jökull", "AVATAR",  "Tylly",     "Ffion", "Yıldız", "Łódź",
     "Юлия", "Ким",    "Ωμέγα", "Toy.",   "O'Brien", "Wolf-Yves", "LTA",   "office", "Featherstonehaugh",
     "Dr.",  "ǅungla", "1,5",   "km",     "McVay"},
    {"ليلى", "حداد", "رصيف", "العبّارات", "محمد", "لا", "السلام", "عليكم", "ي", "بيتي", "کرمان", "۱۲۳", "٤٥", "پارک،"},
    {"נועם", "ברק", "תל־אביב", "שלום", "ירושלים", "צ'רלי", "ף", "בית", "ספר.", "רחוב"},
    {"佐藤", "美咲", "図書館", "東京", "さくら", "タワー", "東京駅", "北京", "ラーメン", "、", "「海」", "々"},
    {"김", "민준", "서울역", "한국어", "안녕", "이지은", "부산", "값", "힣"}};
const std::vector<std::string> kEmoji = {"🌞",      "🏠",  "👩‍👩‍👧", "❤️", "👋🏽", "🇯🇵", "☕",
                                         "✈️", "😀😀", "🧑‍💻",        "⚓︎", "1️⃣"};
const std::vector<std::string> kOthers = {"12", "3.5", "(4)", "–",   "…", "№ 7", "&", "/",
                                          "·",  "€5",  "→",   "[x]", "@", "99%", "½"};

class Labels {
  public:
    explicit Labels(unsigned seed) : random_(seed) {}

    /// Words of one script for the most part, and something else now and then.
    Label next() {
        Label label;
        const auto& script = kWords[below(kWords.size())];
        const std::size_t words = 1 + below(4);
        for (std::size_t i = 0; i < words; ++i) {
            label.text += i > 0 ? (below(6) == 0 ? "\u00a0" : " ") : "";
            switch (below(12)) {
                case 0:
                    label.text += one(kEmoji);
                    break;
                case 1:
                    label.text += one(kOthers);
                    break;
                case 2:
                    label.text += one(kWords[below(kWords.size())]) + (below(2) == 0 ? one(kOthers) : "");
                    break;
                case 3:
                    label.text += std::to_string(below(100000));
                    break;
                default:
                    label.text += one(script);
            }
        }
        label.size = std::vector<double>{13.0, 16.0, 22.0, 11.0, 16.5}[below(5)];
        label.weight = below(3) == 0 ? FontWeight::Bold : FontWeight::Regular;
        label.rightToLeft = below(4) == 0;
        return label;
    }
    std::size_t below(std::size_t end) { return random_() % end; }

  private:
    std::string one(const std::vector<std::string>& list) { return list[below(list.size())]; }

    std::mt19937 random_;
};

class LineShaperTest : public test::LabelsBesideQt {};

TEST_F(LineShaperTest, TwoThousandLabels_AreAsWideAsQtSetsThem) {
    Labels labels(1);
    int set = 0;
    for (int i = 0; i < 2000; ++i) {
        const Label label = labels.next();
        const auto line = shaped(label);
        if (!line) {
            continue;  // left to Qt
        }
        ++set;
        ASSERT_DOUBLE_EQ(line->width * label.size / pixels(label), byQt(label).lines.front().box.width) << label;
    }
    EXPECT_GT(set, 1950);
}

TEST_F(LineShaperTest, Labels_AreDrawnAsQtDrawsThem) {
    Labels labels(2);
    for (int i = 0; i < 600; ++i) {
        const Label label = labels.next();
        auto line = shaped(label);
        if (!line) {
            continue;
        }
        ASSERT_EQ(drawn(asItIsDrawn(label, std::move(*line))), drawn(asQtDrawsIt(label))) << label;
    }
}

TEST_F(LineShaperTest, Words_AreShapedOnce) {
    for (const char* name : {"Ann Marsh 🌞", "Ann 🌞 Marsh", "Marsh Ann", "🌞 Marsh"}) {
        ASSERT_TRUE(shaped({name}));
    }
    // Two words, an emoji and a blank.
    EXPECT_EQ(shaper_.shapedWords(), 4U);
    ASSERT_TRUE(shaped({"Ann", 22.0}));
    EXPECT_EQ(shaper_.shapedWords(), 5U);
}

// Names have numbers, distances are numbers: beside letters of any script each new one took Qt's layout.
TEST_F(LineShaperTest, NewNumbersBesideAnyScript_AreSetWithoutQtsLayout) {
    const std::vector<std::string> names = {"Ann", "Юлия", "ليلى حداد", "נועם ברק", "佐藤 美咲", "さくら", "김 민준"};
    const auto setBeside = [&](int number) {
        for (const std::string& name : names) {
            const Label label{name + " " + std::to_string(number++)};
            const auto line = shaped(label);
            ASSERT_TRUE(line) << label;
            EXPECT_DOUBLE_EQ(line->width, byQt(label).lines.front().box.width) << label;
        }
    };
    setBeside(100);
    const std::size_t before = shaper_.wordsShapedByQt();
    const std::size_t words = shaper_.shapedWords();
    setBeside(200);
    EXPECT_EQ(shaper_.shapedWords(), words + names.size()) << "the numbers alone are new";
    EXPECT_EQ(shaper_.wordsShapedByQt(), before);
}

// Its library gives one of boxes then, which ends the program when it is asked for its name.
TEST_F(LineShaperTest, FontThatCannotBeOpened_IsLeftToQt) {
    if (!test::NoMoreFiles::kIsPossible) {
        GTEST_SKIP() << "not under this sanitizer";
    }
    const test::NoMoreFiles none;
    EXPECT_FALSE(shaped({"ليلى"})) << "a font that no other test has opened before";
}

// What was asked for lately stays; all else goes.
TEST_F(LineShaperTest, ManyWords_AreForgottenButTheLatest) {
    for (int i = 0; i < 10000; ++i) {
        ASSERT_TRUE(shaped({"n" + std::to_string(i)}));
        ASSERT_TRUE(shaped({"Ann"}));
    }
    std::size_t before = shaper_.shapedWords();
    ASSERT_TRUE(shaped({"Ann n9999"}));
    EXPECT_EQ(shaper_.shapedWords(), before + 1) << "the blank alone";
    before = shaper_.shapedWords();
    ASSERT_TRUE(shaped({"n0"}));
    EXPECT_EQ(shaper_.shapedWords(), before + 1);
}

TEST_F(LineShaperTest, WhatOnlyTheWholeLineTells_IsLeftToQt) {
    for (const char* text : {" Ann", "Ann ", "Ann\u200f 5", "\u2068Ann\u2069 5", "two\nlines", "1\ufe0f\u20e3"}) {
        EXPECT_FALSE(shaped({text})) << text;
    }
    EXPECT_FALSE(shaped({std::string(401, 'a')}));
    EXPECT_FALSE(shaped({"large", 101.0}));
}

}  // namespace

}  // namespace ktr::linux_
