// What is painted, measured: every text is at least 4.5 to 1 against what it stands on.
#include <QApplication>
#include <QKeyEvent>
#include <QMouseEvent>
#include <algorithm>
#include <cmath>
#include <map>
#include <memory>

#include "app/window/AskField.h"
#include "app/window/ConversationWidget.h"
#include "app/window/StatusLine.h"
#include "platform/ui/Label.h"
#include "tests/unit/app/TestHost.h"

#include <gtest/gtest.h>

namespace ktr::app {

namespace {

using linux_::ColorScheme;
using linux_::Contrast;
using linux_::Palette;

/// WCAG 2.1, relative luminance.
double luminance(QRgb colour) {
    const auto channel = [](int value) {
        const double v = value / 255.0;
        return v <= 0.04045 ? v / 12.92 : std::pow((v + 0.055) / 1.055, 2.4);
    };
    return 0.2126 * channel(qRed(colour)) + 0.7152 * channel(qGreen(colour)) + 0.0722 * channel(qBlue(colour));
}

/// Of the colour that fills most of a part of a picture, and the one in it that stands out most: the ground and the
/// middle of the strokes.
double contrastWithin(const QImage& picture, const QRect& part) {
    std::map<QRgb, int> count;
    const QRect inside = part.intersected(picture.rect());
    for (int y = inside.top(); y <= inside.bottom(); ++y) {
        for (int x = inside.left(); x <= inside.right(); ++x) {
            ++count[picture.pixel(x, y)];
        }
    }
    if (count.empty()) {
        return 0.0;
    }
    const auto ground =
        std::max_element(count.begin(), count.end(), [](const auto& a, const auto& b) { return a.second < b.second; });
    double best = 1.0;
    for (const auto& [colour, times] : count) {
        const double a = luminance(colour) + 0.05;
        const double b = luminance(ground->first) + 0.05;
        best = std::max(best, std::max(a, b) / std::min(a, b));
    }
    return best;
}

}  // namespace

class KTRPaintedContrastTest : public ::testing::Test {
  public:
    void open(const std::string& name, bool dark, bool high) {
        widget.reset();
        host.reset();
        host::HostOptions options;
        options.dark = dark;
        options.highContrast = high;
        host = testHost(options, demoScenarios({name}));
        ASSERT_TRUE(host);
        host->settle(400.0);
        widget = std::make_unique<ConversationWidget>(*host);
        widget->resize(400, 900);
        widget->show();
        QApplication::processEvents();
    }
    void TearDown() override {
        widget.reset();
        host.reset();
    }
    void collect(const platform::View& view, std::vector<std::shared_ptr<platform::Label>>& labels) const {
        for (const auto& child : view.presentedSubviews()) {
            if (child->hidden()) {
                continue;
            }
            if (auto label = std::dynamic_pointer_cast<platform::Label>(child); label && !label->text().empty()) {
                labels.push_back(std::move(label));
            }
            collect(*child, labels);
        }
    }
    /// How many texts were measured.
    int measure(const std::string& where) {
        std::vector<std::shared_ptr<platform::Label>> labels;
        collect(*host->window(), labels);
        const QImage picture = widget->grab().toImage();
        for (const auto& label : labels) {
            const auto frame = label->frameInRoot();
            const QRectF part(frame.x, frame.y - widget->scrolled(), frame.width, frame.height);
            EXPECT_GE(contrastWithin(picture, part.toAlignedRect()), 4.5) << where << ": " << label->text();
        }
        return static_cast<int>(labels.size());
    }
    void mouse(QEvent::Type type, QPointF at) {
        QMouseEvent event(type, at, widget->mapToGlobal(at), Qt::LeftButton, Qt::LeftButton, Qt::NoModifier);
        QApplication::sendEvent(widget.get(), &event);
    }

    std::unique_ptr<host::Host> host;
    std::unique_ptr<ConversationWidget> widget;
};

TEST_F(KTRPaintedContrastTest, Measure_TellsPaleFromDark) {
    QImage picture(20, 20, QImage::Format_RGB32);
    picture.fill(QColor(255, 255, 255));
    picture.setPixelColor(3, 3, QColor(0x76, 0x76, 0x76));
    EXPECT_NEAR(contrastWithin(picture, picture.rect()), 4.54, 0.01);
    picture.setPixelColor(3, 3, QColor(0x99, 0x99, 0x99));
    EXPECT_LT(contrastWithin(picture, picture.rect()), 4.5);
}

TEST_F(KTRPaintedContrastTest, EveryTextOfAConversation) {
    for (const char* name : {"dinner", "fence-leaving", "sharing-hidden", "locating"}) {
        for (const bool dark : {false, true}) {
            for (const bool high : {false, true}) {
                open(name, dark, high);
                const std::string where = std::string(name) + (dark ? " dark" : " light") + (high ? " high" : "");
                EXPECT_GE(measure(where), 4) << "time, question, sentence and card";
            }
        }
    }
}

TEST_F(KTRPaintedContrastTest, RowUnderThePointerAndPressedRow) {
    for (const bool dark : {false, true}) {
        for (const bool high : {false, true}) {
            open("dinner", dark, high);
            mouse(QEvent::MouseMove, {200.0, 230.0});
            ASSERT_TRUE(widget->rows().isHovering());
            measure("under the pointer");
            mouse(QEvent::MouseButtonPress, {200.0, 230.0});
            measure("pressed");
            mouse(QEvent::MouseButtonRelease, {-50.0, -50.0});
        }
    }
}

TEST_F(KTRPaintedContrastTest, Accent_IsPaintedWhereTheKeyboardIs_InEveryScheme) {
    for (const bool dark : {false, true}) {
        open("dinner", dark, false);
        const auto painted = [this](const QColor& color) {
            const QImage picture = widget->grab().toImage();
            int count = 0;
            for (int y = 0; y < picture.height(); ++y) {
                for (int x = 0; x < picture.width(); ++x) {
                    count += picture.pixelColor(x, y) == color ? 1 : 0;
                }
            }
            return count;
        };
        const QColor own = widget->colors().pine;
        // The program's own sign has that colour too, and keeps it.
        const int sign = painted(own);
        widget->setFocus(Qt::TabFocusReason);
        QKeyEvent tab(QEvent::KeyPress, Qt::Key_Tab, Qt::NoModifier);
        QApplication::sendEvent(widget.get(), &tab);
        const int ring = painted(own) - sign;
        ASSERT_GT(ring, 200) << "the ring around a row";
        widget->setAccent(QColor(0x91, 0x41, 0xAC));
        const QColor accent = widget->colors().pine;
        EXPECT_EQ(painted(own), sign);
        EXPECT_EQ(painted(accent), ring);
        widget->setHighContrast(true);
        EXPECT_EQ(painted(accent), 0) << "high contrast has its own";
        widget->setHighContrast(false);
        EXPECT_EQ(painted(accent), ring);
        widget->setAccent(std::nullopt);
        EXPECT_EQ(painted(own), ring + sign);
    }
}

TEST_F(KTRPaintedContrastTest, FieldButtonAndStatusLine) {
    open("dinner", false, false);
    for (const auto scheme : {ColorScheme::Light, ColorScheme::Dark}) {
        for (const auto level : {Contrast::Normal, Contrast::High}) {
            const Palette& palette = Palette::of(scheme, level);
            QWidget paper;
            QPalette ground;
            ground.setColor(QPalette::Window, palette.window);
            paper.setPalette(ground);
            paper.resize(400, 200);
            auto* field = new AskField({"Ask about your friends", "Send"}, &paper);
            field->setAnimated(false);
            field->setColors(palette);
            field->setGeometry(0, 0, 380, AskField::shapeHeight() + 2 * AskField::kAround);
            auto* status = new StatusLine(&paper);
            status->setColors(palette);
            status->setStatus({host::LiveStatus::Mark::Warning, "Offline. Showing what was known at 17:42."});
            status->setGeometry(0, 120, 380, 30);
            const QRect words(field->x() + field->edit().x(), field->y() + field->edit().y(), 200,
                              field->edit().height());
            const auto button = [&] {
                return field->button().geometry().adjusted(14, 14, -14, -14).translated(field->pos());
            };
            QImage picture = paper.grab().toImage();
            EXPECT_GE(contrastWithin(picture, words), 4.5) << "the placeholder";
            EXPECT_GE(contrastWithin(picture, {StatusLine::kWords, 120, 300, 30}), 4.5) << "the status";
            EXPECT_GE(contrastWithin(picture, {0, 120, StatusLine::kWords, 30}), 3.0) << "its mark";
            EXPECT_GE(contrastWithin(picture, button()), 4.5) << "the arrow with nothing to send";
            field->edit().setText(QStringLiteral("Where is Ann?"));
            picture = paper.grab().toImage();
            EXPECT_GE(contrastWithin(picture, words), 4.5) << "what is typed";
            EXPECT_GE(contrastWithin(picture, button()), 4.5) << "the arrow";
        }
    }
}

TEST_F(KTRPaintedContrastTest, WishForContrast_IsHonouredWhileTheWindowIsOpen) {
    open("dinner", false, false);
    EXPECT_EQ(widget->colors().contrast, Contrast::Normal);
    widget->setHighContrast(true);
    EXPECT_EQ(widget->colors().contrast, Contrast::High);
    EXPECT_TRUE(host->settings().drawsHighContrast()) << "what stays of cards is drawn so too";
    EXPECT_EQ(widget->grab().toImage().pixelColor(2, 2), QColor(255, 255, 255));
    widget->setHighContrast(false);
    EXPECT_EQ(widget->colors().contrast, Contrast::Normal);
    // Who asked for it on the command line has it, whatever the desktop says.
    open("dinner", false, true);
    widget->setHighContrast(true);
    widget->setHighContrast(false);
    EXPECT_EQ(widget->colors().contrast, Contrast::High);
}

}  // namespace ktr::app
