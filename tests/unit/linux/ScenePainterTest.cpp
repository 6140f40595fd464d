#include "linux/paint/ScenePainter.h"

#include <gtest/gtest.h>

#include <QDir>
#include <QFile>
#include <QPainter>
#include <QSvgRenderer>
#include <QTemporaryDir>
#include <limits>

#include "linux/paint/AvatarImage.h"
#include "linux/paint/QtTextEngine.h"
#include "linux/paint/RasterImage.h"

namespace ktr::linux_ {

using platform::AttributedString;
using platform::Color;
using platform::Font;

namespace {

class ScenePainterTest : public ::testing::Test {
  protected:
    std::string path(const char* name) const { return folder_.filePath(QString::fromLatin1(name)).toStdString(); }
    QByteArray read(const char* name) const {
        QFile file(folder_.filePath(QString::fromLatin1(name)));
        return file.open(QIODevice::ReadOnly) ? file.readAll() : QByteArray();
    }
    static void paint(QtCanvas& canvas) {
        QtTextEngine engine;
        const auto text = engine.layOut(AttributedString("Ann ليلى 佐藤 👍", Font()), {});
        canvas.draw(*text, {5, 5}, Color::ofRole(platform::ColorRole::StandardText));
        canvas.fill({0, 40, 100, 0.5}, Color::rgb(1, 0, 0));
        canvas.draw(*AvatarImage::blank(20), {5, 45, 20, 20});
    }

    QTemporaryDir folder_;
    ScenePainter painter_{{200, 80}, 2.0, Palette::of(ColorScheme::Light)};
};

}  // namespace

TEST_F(ScenePainterTest, Image_HasTheScalesPixelsOnTheWindowsColour) {
    const QImage image = painter_.image(paint);
    EXPECT_EQ(image.size(), QSize(400, 160));
    EXPECT_EQ(image.pixelColor(399, 159), Palette::of(ColorScheme::Light).window);
    EXPECT_EQ(image.pixelColor(10, 80), QColor(Qt::red));
    EXPECT_NE(image.pixelColor(10, 81), QColor(Qt::red));
    ScenePainter dark({10.2, 10}, 1.5, Palette::of(ColorScheme::Dark));
    const QImage small = dark.image([](QtCanvas&) {});
    EXPECT_EQ(small.size(), QSize(16, 15));
    EXPECT_EQ(small.pixelColor(15, 14), Palette::of(ColorScheme::Dark).window);
}

TEST_F(ScenePainterTest, TransparentBackground_StaysTransparent) {
    painter_.setBackground(Qt::transparent);
    EXPECT_EQ(painter_.image(paint).pixelColor(399, 159).alpha(), 0);
}

TEST_F(ScenePainterTest, Files_AreTheSameEveryTime) {
    for (const char* ending : {".png", ".svg"}) {
        const std::string first = std::string("a") + ending;
        const std::string second = std::string("b") + ending;
        ASSERT_EQ(painter_.write(path(first.c_str()), paint), std::nullopt);
        ASSERT_EQ(painter_.write(path(second.c_str()), paint), std::nullopt);
        EXPECT_FALSE(read(first.c_str()).isEmpty());
        EXPECT_EQ(read(first.c_str()), read(second.c_str())) << ending;
    }
    EXPECT_TRUE(read("a.png").startsWith("\x89PNG"));
    EXPECT_TRUE(read("a.svg").contains("<svg"));
    // Nothing else is left in the folder.
    EXPECT_EQ(QDir(folder_.path()).entryList(QDir::Files | QDir::Hidden).size(), 4);
}

TEST_F(ScenePainterTest, PdfFile_HoldsNoDate) {
    ASSERT_EQ(painter_.write(path("a.pdf"), paint), std::nullopt);
    const QByteArray pdf = read("a.pdf");
    EXPECT_TRUE(pdf.startsWith("%PDF"));
    EXPECT_TRUE(pdf.contains("/CreationDate (D:00000000000000"));
    EXPECT_TRUE(pdf.contains("/MediaBox [0 0 200.000000 80.000000]"));
}

// Its text elements stand for themselves and are read from left to right, unless they say otherwise.
TEST_F(ScenePainterTest, SvgFile_SaysWhichTextsRunFromRightToLeft) {
    const auto words = [](QtCanvas& canvas) {
        QtTextEngine engine(QStringLiteral("ar"));
        const auto arabic = engine.layOut(AttributedString("سأتابع ذلك.", Font()), {});
        canvas.draw(*arabic, {5, 5}, Color::ofRole(platform::ColorRole::StandardText));
        const auto english = engine.layOut(AttributedString("I’ll look.", Font()), {});
        canvas.draw(*english, {5, 40}, Color::ofRole(platform::ColorRole::StandardText));
    };
    ASSERT_EQ(painter_.write(path("a.svg"), words), std::nullopt);
    const QString svg = QString::fromUtf8(read("a.svg"));
    const auto marked = [](const QString& word) { return QChar(0x202B) + word + QChar(0x202C); };
    EXPECT_TRUE(svg.contains(marked(QStringLiteral("سأتابع")))) << svg.toStdString();
    EXPECT_TRUE(svg.contains(marked(QStringLiteral("ذلك"))));
    EXPECT_EQ(svg.count(QChar(0x202B)), svg.count(QChar(0x202C)));
    const QString english = svg.section(QStringLiteral("<text"), -1).section(u'>', 1).section(u'<', 0, 0);
    EXPECT_TRUE(english.contains(QStringLiteral("look"))) << english.toStdString();
    EXPECT_FALSE(english.contains(QChar(0x202B)));
}

// SVG files have no clips here: what is cut has to be cut before it is written.
TEST_F(ScenePainterTest, SvgFile_KeepsTheRoundedCornersOfWhatIsCut) {
    const auto scene = [](QtCanvas& canvas) {
        platform::Path round;
        round.addEllipse({10, 10, 60, 60});
        canvas.save();
        canvas.clip(round);
        canvas.fill(platform::Rect{10, 10, 60, 60}, Color::rgb(1, 0, 0));
        QImage blue(60, 60, QImage::Format_RGB32);
        blue.fill(Qt::blue);
        canvas.draw(RasterImage(blue, {60, 60}), {10, 40, 60, 30});
        canvas.restore();
    };
    ASSERT_EQ(painter_.write(path("a.svg"), scene), std::nullopt);
    QSvgRenderer drawn(read("a.svg"));
    ASSERT_TRUE(drawn.isValid());
    QImage pixels(200, 80, QImage::Format_RGB32);
    pixels.fill(Qt::white);
    QPainter painter(&pixels);
    drawn.render(&painter, QRectF(0, 0, 200, 80));
    painter.end();
    EXPECT_EQ(pixels.pixelColor(40, 20), QColor(Qt::red));
    EXPECT_EQ(pixels.pixelColor(40, 60), QColor(Qt::blue));
    for (const QPoint& corner : {QPoint(12, 12), QPoint(68, 12), QPoint(12, 68), QPoint(68, 68)}) {
        EXPECT_EQ(pixels.pixelColor(corner), Palette::of(ColorScheme::Light).window) << corner.x() << ' ' << corner.y();
    }
}

TEST_F(ScenePainterTest, PngFile_IsTheImage) {
    ASSERT_EQ(painter_.write(path("a.png"), paint), std::nullopt);
    const QImage read(QString::fromStdString(path("a.png")));
    EXPECT_EQ(read.convertToFormat(QImage::Format_RGB32), painter_.image(paint).convertToFormat(QImage::Format_RGB32));
}

// Its bands are painted one by one: what stands on their edges must not show it.
TEST_F(ScenePainterTest, TallPngFile_IsTheImage) {
    const ScenePainter tall({4000, 700}, 1.0, Palette::of(ColorScheme::Light));
    int bands = 0;
    const auto scene = [&bands](QtCanvas& canvas) {
        ++bands;
        for (int i = 0; i < 100; ++i) {
            platform::Path circle;
            circle.addEllipse({13.3 * i, 7.1 * i, 90.0, 90.0});
            canvas.fill(circle, platform::Color::ofRole(platform::ColorRole::Highlight));
            canvas.fill(platform::Rect{20.0 * i, 6.9 * i, 15.0, 0.5},
                        platform::Color::ofRole(platform::ColorRole::StandardText));
        }
    };
    ASSERT_EQ(tall.write(path("a.png"), scene), std::nullopt);
    EXPECT_GE(bands, 3);
    const QImage read(QString::fromStdString(path("a.png")));
    EXPECT_EQ(read.convertToFormat(QImage::Format_RGB32), tall.image(scene).convertToFormat(QImage::Format_RGB32));
}

TEST_F(ScenePainterTest, TallPngFile_IsNeverInMemoryAsAWhole) {
    const ScenePainter tall({400, 30000}, 1.0, Palette::of(ColorScheme::Light));
    double most = 0.0;
    double sum = 0.0;
    const auto scene = [&](QtCanvas& canvas) {
        const platform::Rect seen = canvas.seen({0.0, 0.0, 400.0, 30000.0});
        most = std::max(most, seen.height);
        sum += seen.height;
    };
    ASSERT_EQ(tall.write(path("a.png"), scene), std::nullopt);
    EXPECT_LE(most, 2500.0);
    EXPECT_GE(sum, 30000.0);
    EXPECT_LE(sum, 32500.0);
}

TEST_F(ScenePainterTest, PictureBeyondTheLimit_IsRefusedByName) {
    const ScenePainter tall({100, 20000}, 2.0, Palette::of(ColorScheme::Light));
    EXPECT_TRUE(tall.image(paint).isNull());
    const auto error = tall.write(path("tall.png"), paint);
    ASSERT_TRUE(error);
    EXPECT_EQ(*error, path("tall.png") +
                          ": the picture would be 200 x 40000 pixels; at most 32000 a side can be drawn. A smaller "
                          "scale may help");
    EXPECT_FALSE(QFile::exists(QString::fromStdString(path("tall.png"))));
    EXPECT_EQ(ScenePainter({100, 16000}, 2.0, Palette::of(ColorScheme::Light)).refusal(), std::nullopt);
}

TEST_F(ScenePainterTest, SizesThatAreNone_AreRefused) {
    for (const double size : {0.0, -1.0, std::numeric_limits<double>::quiet_NaN()}) {
        EXPECT_TRUE(ScenePainter({100, size}, 2.0, Palette::of(ColorScheme::Light)).refusal());
        EXPECT_TRUE(ScenePainter({100, 100}, size, Palette::of(ColorScheme::Light)).refusal());
    }
    EXPECT_TRUE(ScenePainter({1e300, 100}, 1e300, Palette::of(ColorScheme::Light)).refusal());
}

TEST_F(ScenePainterTest, UnknownEnding_IsAnError) {
    EXPECT_EQ(painter_.write(path("a.gif"), paint), path("a.gif") + ": the name must end in .png, .svg or .pdf");
    EXPECT_TRUE(painter_.write(path("png"), paint));
}

TEST_F(ScenePainterTest, PlaceThatCannotBeWritten_IsAnErrorWithNameAndReason) {
    const std::string file = path("none/a.png");
    const auto error = painter_.write(file, paint);
    ASSERT_TRUE(error);
    EXPECT_TRUE(error->starts_with(file + ": cannot be written: "));
    EXPECT_GT(error->size(), (file + ": cannot be written: ").size());
}

}  // namespace ktr::linux_
