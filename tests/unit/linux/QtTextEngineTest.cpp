#include "linux/paint/QtTextEngine.h"

#include <gtest/gtest.h>

#include <QImage>
#include <QPainter>
#include <QTextLayout>
#include <atomic>
#include <set>
#include <thread>

namespace ktr::linux_ {

using namespace platform;

namespace {

const Font kBody{FontFace::Text, FontWeight::Regular, 16.0};

class QtTextEngineTest : public ::testing::Test {
  protected:
    std::shared_ptr<const QtTextLayout> layOut(const std::string& text, double width, int lines = 1,
                                               bool rightToLeft = false) {
        TextContainer container;
        container.width = width;
        container.maximumLines = lines;
        container.lineBreakMode = LineBreakMode::TruncatingTail;
        container.rightToLeft = rightToLeft;
        return std::dynamic_pointer_cast<const QtTextLayout>(engine_.layOut(AttributedString(text, kBody), container));
    }
    static QString drawnText(const QtTextLayout& layout) {
        return layout.shaped()->shapedAgain().pieces.back().recipe.text;
    }
    static std::unique_ptr<QTextLayout> shapedAgain(const QtTextLayout& layout) {
        return std::move(layout.shaped()->shapedAgain().pieces.back().layout);
    }
    static QImage drawn(const QtTextLayout& layout, const QColor& color = Qt::black,
                        ColorScheme scheme = ColorScheme::Light) {
        QImage image(300, 120, QImage::Format_ARGB32_Premultiplied);
        image.fill(Qt::white);
        QPainter painter(&image);
        layout.draw(painter, {0, 20}, color, Palette::of(scheme));
        return image;
    }
    /// The columns that hold ink.
    static std::pair<int, int> inkColumns(const QImage& image) {
        int left = image.width();
        int right = -1;
        for (int y = 0; y < image.height(); ++y) {
            for (int x = 0; x < image.width(); ++x) {
                if (qGray(image.pixel(x, y)) < 200) {
                    left = std::min(left, x);
                    right = std::max(right, x);
                }
            }
        }
        return {left, right};
    }

    QtTextEngine engine_;
};

}  // namespace

TEST_F(QtTextEngineTest, TextThatIsAskedForAgain_IsNotShapedAgain) {
    const auto first = layOut("Ann Marsh", 200);
    const auto count = engine_.shapedCount();
    EXPECT_EQ(layOut("Ann Marsh", 200)->shaped(), first->shaped());
    EXPECT_EQ(engine_.shapedCount(), count);
}

TEST_F(QtTextEngineTest, TextThatFits_IsShapedOnceForAllWidths) {
    layOut("Ann Marsh", 200);
    const auto count = engine_.shapedCount();
    EXPECT_EQ(layOut("Ann Marsh", 250)->lines().size(), 1U);
    EXPECT_EQ(layOut("Ann Marsh", 180, 0)->lines().size(), 1U);
    EXPECT_EQ(engine_.shapedCount(), count);
}

TEST_F(QtTextEngineTest, Cache_IsBounded) {
    const auto first = layOut("Ann Marsh", 200);
    for (int i = 0; i < 5000; ++i) {
        layOut("Ann Marsh " + std::to_string(i), 2000);
    }
    const auto count = engine_.shapedCount();
    layOut("Ann Marsh", 200);
    EXPECT_GT(engine_.shapedCount(), count);
}

TEST_F(QtTextEngineTest, SetLanguage_ChoosesTheFormsOfHan) {
    EXPECT_EQ(FontChoice(QStringLiteral("ja")).hanFamily(u"直"), QStringLiteral("Noto Sans CJK JP"));
    EXPECT_EQ(FontChoice(QStringLiteral("zh-Hans")).hanFamily(u"直"), QStringLiteral("Noto Sans CJK SC"));
    EXPECT_EQ(FontChoice(QStringLiteral("zh-TW")).hanFamily(u"直"), QStringLiteral("Noto Sans CJK TC"));
    EXPECT_EQ(FontChoice(QStringLiteral("zh-Hant-HK")).hanFamily(u"直"), QStringLiteral("Noto Sans CJK HK"));
    EXPECT_EQ(FontChoice(QStringLiteral("ko-KR")).hanFamily(u"直"), QStringLiteral("Noto Sans CJK KR"));
    EXPECT_EQ(FontChoice(QStringLiteral("zh-Hans")).hanFamily(u"直です"), QStringLiteral("Noto Sans CJK JP"));
    const auto before = drawn(*layOut("直", 100));
    engine_.setLanguage(QStringLiteral("zh-Hans"));
    EXPECT_NE(drawn(*layOut("直", 100)), before);
}

TEST_F(QtTextEngineTest, Stretches_FollowTheScripts) {
    const auto stretches = FontChoice().stretches(u"Ann ليلى، 佐藤 (नि) e\u0301");
    std::vector<QString> families;
    qsizetype end = 0;
    for (const auto& stretch : stretches) {
        EXPECT_EQ(stretch.start, end);
        end = stretch.start + stretch.length;
        families.push_back(stretch.family);
    }
    const QString base = FontChoice::baseFamily();
    EXPECT_EQ(families,
              (std::vector<QString>{base, QStringLiteral("Noto Sans Arabic"), base, QStringLiteral("Noto Sans CJK JP"),
                                    base, QStringLiteral("Noto Sans Devanagari"), base}));
}

TEST_F(QtTextEngineTest, FontFamilies_EmojiComeAfterEveryTextFont) {
    const auto families = FontChoice::spec(kBody, 16, QStringLiteral("Noto Sans Arabic")).font().families();
    EXPECT_EQ(families.indexOf(QStringLiteral("Noto Sans Arabic")), 0);
    EXPECT_EQ(families.indexOf(QStringLiteral("Noto Sans")), 1);
    EXPECT_EQ(families.indexOf(QStringLiteral("Noto Color Emoji")), 2);
}

TEST_F(QtTextEngineTest, Font_IsRegularOrBoldAndNeverHinted) {
    const auto weight = [](FontFace face, FontWeight wanted) {
        return FontChoice::spec({face, wanted, 16}, 16, FontChoice::baseFamily()).font().weight();
    };
    EXPECT_EQ(weight(FontFace::Text, FontWeight::Semibold), QFont::Bold);
    EXPECT_EQ(weight(FontFace::Text, FontWeight::Regular), QFont::Normal);
    EXPECT_EQ(weight(FontFace::Rounded, FontWeight::Regular), QFont::Normal);
    // The pinned fonts have neither face.
    EXPECT_EQ(weight(FontFace::Light, FontWeight::Regular), QFont::Normal);
    EXPECT_EQ(weight(FontFace::Thin, FontWeight::Regular), QFont::Normal);
    EXPECT_EQ(FontChoice::spec(kBody, 16, FontChoice::baseFamily()).font().hintingPreference(), QFont::PreferNoHinting);
}

TEST_F(QtTextEngineTest, FontOfAText_DoesNotDependOnTheTextsBeforeIt) {
    const QImage alone = drawn(*layOut("→ 直 ★", 200));
    layOut("Ann 你好", 200);
    engine_.setLanguage(QStringLiteral("ko"));
    layOut("直", 200);
    engine_.setLanguage({});
    EXPECT_EQ(drawn(*layOut("→ 直 ★", 200)), alone);
}

TEST_F(QtTextEngineTest, CutText_EndsInOneEllipsisAfterAWholeWord) {
    const auto layout = layOut("Bartholomew Featherstonehaugh", 102);
    const QString text = drawnText(*layout);
    EXPECT_EQ(text.count(QChar(0x2026)), 1);
    EXPECT_FALSE(text.contains(u" …"));
}

TEST_F(QtTextEngineTest, CutText_UsesTheRoomThatThereIs) {
    const std::string name = "Bartholomew Featherstonehaugh-Cholmondeley";
    for (double width = 30; width < 200; width += 7) {
        const auto layout = layOut(name, width);
        // One letter more would not have fitted: the widest is less than its em.
        EXPECT_GT(layout->usedSize().width, width - 16.0);
        EXPECT_LE(layout->usedSize().width, width + 0.01);
    }
}

TEST_F(QtTextEngineTest, CutRightToLeftText_HasItsEllipsisAtTheLeft) {
    const std::string name = "ليلى بنت عبد الرحمن بن عبد العزيز الحدادية";
    for (const bool rightToLeft : {false, true}) {
        const auto layout = layOut(name, 150, 1, rightToLeft);
        ASSERT_TRUE(layout->isTruncated());
        const auto shaped = shapedAgain(*layout);
        const int ellipsis = static_cast<int>(shaped->text().indexOf(QChar(0x2026)));
        const QTextLine line = shaped->lineAt(0);
        const auto run = line.glyphRuns(ellipsis, 1);
        ASSERT_FALSE(run.isEmpty());
        EXPECT_LT(run.front().positions().front().x(), layout->lines()[0].box.x + 5.0) << rightToLeft;
    }
}

TEST_F(QtTextEngineTest, CutLeftToRightTextInARightToLeftInterface_HasItsEllipsisAtTheRight) {
    const auto layout = layOut("Bartholomew Featherstonehaugh", 120, 1, true);
    const auto shaped = shapedAgain(*layout);
    const int ellipsis = static_cast<int>(shaped->text().indexOf(QChar(0x2026)));
    const auto run = shaped->lineAt(0).glyphRuns(ellipsis, 1);
    ASSERT_FALSE(run.isEmpty());
    EXPECT_GT(run.front().positions().front().x(), layout->lines()[0].box.maxX() - 20.0);
}

TEST_F(QtTextEngineTest, LongName_IsShapedNoFurtherThanItCanShow) {
    std::string name;
    for (int i = 0; i < 10000; ++i) {
        name += "Bartholomew";
    }
    EXPECT_LT(drawnText(*layOut(name, 200)).size(), 100);
    // What no picture can show is not measured.
    const auto natural = layOut(name, std::numeric_limits<double>::infinity());
    EXPECT_TRUE(natural->isTruncated());
    EXPECT_LE(natural->usedSize().width, 32000.0);
    EXPECT_GT(natural->usedSize().width, 31900.0);
}

TEST_F(QtTextEngineTest, LongTextOfMarksWithoutWidth_IsDrawnAllTheSame) {
    std::string name = "a";
    for (int i = 0; i < 20000; ++i) {
        name += "\xCC\x81";  // combining acute accent
    }
    const auto layout = layOut(name + "b", 200);
    EXPECT_EQ(layout->lines().size(), 1U);
    EXPECT_DOUBLE_EQ(layout->usedSize().height, kBody.lineHeight());
}

TEST_F(QtTextEngineTest, EndlessWord_BreaksAnywhere) {
    const auto layout = layOut(std::string(100000, 'm'), 300, 0);
    ASSERT_GT(layout->lines().size(), 1000U);
    for (const auto& line : layout->lines()) {
        ASSERT_LE(line.box.width, 300.01);
    }
    EXPECT_FALSE(layout->isTruncated());
    // Words of any sensible length are not torn.
    const auto whole = layOut(std::string(16, 'm') + " " + std::string(8, 'm'), 280, 0);
    ASSERT_EQ(whole->lines().size(), 2U);
    EXPECT_NEAR(whole->lines()[0].box.width, 2 * whole->lines()[1].box.width, 0.1);
}

TEST_F(QtTextEngineTest, LimitOfLines_CutsTheLastOne) {
    const auto layout = layOut("Ann went to the fish market and then home along the harbour", 150, 2);
    ASSERT_EQ(layout->lines().size(), 2U);
    EXPECT_TRUE(layout->isTruncated());
    EXPECT_TRUE(drawnText(*layout).contains(QChar(0x2026)));
    EXPECT_LE(layout->lines()[1].box.width, 150.01);
}

TEST_F(QtTextEngineTest, WrappedLinesOfTallScripts_DoNotOverlap) {
    const std::string tibetan = "འབྲུག་ཡུལ་གྱི་རྒྱལ་ས་ཐིམ་ཕུ་ཡིན། འབྲུག་ཡུལ་གྱི་རྒྱལ་ས་ཐིམ་ཕུ་ཡིན།";
    const auto layout = layOut(tibetan, 120, 0);
    ASSERT_GT(layout->lines().size(), 1U);
    EXPECT_GT(layout->lines()[0].box.height, kBody.lineHeight());
    for (std::size_t i = 1; i < layout->lines().size(); ++i) {
        EXPECT_DOUBLE_EQ(layout->lines()[i].box.y, layout->lines()[i - 1].box.maxY());
    }
}

TEST_F(QtTextEngineTest, FractionalSize_IsScaledNotRounded) {
    const auto width = [this](double size) {
        return engine_.layOut(AttributedString("Bartholomew", {FontFace::Text, FontWeight::Regular, size}), {})
            ->usedSize()
            .width;
    };
    EXPECT_NEAR(width(16.4), width(16.0) * 16.4 / 16.0, 1e-6);
    EXPECT_NEAR(width(16.6), width(17.0) * 16.6 / 17.0, 1e-6);
}

TEST_F(QtTextEngineTest, SizesThatAreNone_AreDrawnSmall) {
    for (const double size : {0.0, -5.0, std::numeric_limits<double>::quiet_NaN()}) {
        const auto layout = engine_.layOut(AttributedString("a", {FontFace::Text, FontWeight::Regular, size}), {});
        EXPECT_EQ(layout->lines().size(), 1U);
        EXPECT_LT(layout->usedSize().width, 2.0);
    }
}

TEST_F(QtTextEngineTest, RunsTakeTheirColours_OthersTheGivenOne) {
    AttributedString text;
    text.append({"MMM", kBody, Color::rgb(1, 0, 0), {}});
    text.append({"MMM", kBody, std::nullopt, {}});
    text.append({"MMM", kBody, Color::ofRole(ColorRole::StandardText), {}});
    const auto layout = std::dynamic_pointer_cast<const QtTextLayout>(engine_.layOut(text, {}));
    const auto colors = [&](ColorScheme scheme) {
        const QImage image = drawn(*layout, QColor(0, 0, 255), scheme);
        std::set<QRgb> found;
        for (int y = 0; y < image.height(); ++y) {
            for (int x = 0; x < image.width(); ++x) {
                found.insert(image.pixel(x, y));
            }
        }
        return found;
    };
    const auto light = colors(ColorScheme::Light);
    EXPECT_TRUE(light.contains(qRgb(255, 0, 0)));
    EXPECT_TRUE(light.contains(qRgb(0, 0, 255)));
    EXPECT_TRUE(light.contains(qRgb(0x2B, 0x26, 0x20)));
    EXPECT_TRUE(colors(ColorScheme::Dark).contains(qRgb(0xF2, 0xEC, 0xE1)));
}

TEST_F(QtTextEngineTest, Emoji_AreInColourAlsoAmongBoldLetters) {
    AttributedString text("Ann 👍 1️⃣", {FontFace::Text, FontWeight::Bold, 32.0});
    const auto layout = std::dynamic_pointer_cast<const QtTextLayout>(engine_.layOut(text, {}));
    const QImage image = drawn(*layout);
    int colored = 0;
    int blue = 0;
    for (int y = 0; y < image.height(); ++y) {
        for (int x = 0; x < image.width(); ++x) {
            const QColor c = image.pixelColor(x, y);
            colored += c.saturation() > 120 ? 1 : 0;
            blue += c.saturation() > 120 && c.blue() > c.red() + 60 ? 1 : 0;
        }
    }
    EXPECT_GT(colored, 300);
    EXPECT_GT(blue, 100);  // the key of the keycap
}

TEST_F(QtTextEngineTest, Overrides_DoNotTurnRoundWhatFollows) {
    AttributedString text;
    text.append(
        {"\xE2\x80\xAE"
         "abc",
         kBody,
         std::nullopt,
         {}});  // right-to-left override, left open
    text.append({"XYZ", kBody, std::nullopt, {}});
    AttributedString alone("XYZ", kBody);
    const auto both = std::dynamic_pointer_cast<const QtTextLayout>(engine_.layOut(text, {}));
    const auto shaped = shapedAgain(*both);
    const QTextLine line = shaped->lineAt(0);
    const int x = static_cast<int>(shaped->text().indexOf(u'X'));
    EXPECT_LT(line.cursorToX(x), line.cursorToX(x + 1));
    EXPECT_GT(line.cursorToX(x), 10.0);
}

TEST_F(QtTextEngineTest, TextStandsWhereItsBoxSays) {
    for (const bool rightToLeft : {false, true}) {
        for (const std::string name : {"Hamburg", "ليلى حداد", "נועם"}) {
            const auto layout = layOut(name, 280, 1, rightToLeft);
            const auto [left, right] = inkColumns(drawn(*layout));
            EXPECT_NEAR(left, layout->lines()[0].box.x, 3.0) << name;
            EXPECT_NEAR(right + 1, layout->lines()[0].box.maxX(), 3.0) << name;
        }
    }
}

TEST_F(QtTextEngineTest, WorkerThreads_DrawTheSame) {
    const std::string text = "Ann ليلى 佐藤 👍 went to the fish market and then home";
    const QImage expected = drawn(*layOut(text, 150, 0));
    std::atomic<int> different = 0;
    std::vector<std::thread> threads;
    for (int t = 0; t < 4; ++t) {
        threads.emplace_back([&] {
            QtTextEngine own;
            TextContainer container;
            container.width = 150;
            for (int i = 0; i < 5; ++i) {
                for (TextEngine* engine : {static_cast<TextEngine*>(&own), static_cast<TextEngine*>(&engine_)}) {
                    const auto layout = std::dynamic_pointer_cast<const QtTextLayout>(
                        engine->layOut(AttributedString(text, kBody), container));
                    different += drawn(*layout) == expected ? 0 : 1;
                }
            }
        });
    }
    for (auto& thread : threads) {
        thread.join();
    }
    EXPECT_EQ(different, 0);
}

TEST_F(QtTextEngineTest, LayoutOfAThreadThatEnded_IsDrawnByTheMainThread) {
    std::shared_ptr<const TextLayout> layout;
    TextContainer container;
    container.width = 150;
    const AttributedString text("Ann ليلى 佐藤 👍", kBody);
    std::thread([&] { layout = engine_.layOut(text, container); }).join();
    QtTextEngine other;
    EXPECT_EQ(drawn(dynamic_cast<const QtTextLayout&>(*layout)),
              drawn(dynamic_cast<const QtTextLayout&>(*other.layOut(text, container))));
}

}  // namespace ktr::linux_
