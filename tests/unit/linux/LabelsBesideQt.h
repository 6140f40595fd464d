#pragma once

#include <gtest/gtest.h>

#include <QImage>
#include <QPainter>
#include <cmath>
#include <ostream>

#include "linux/paint/LineBreaker.h"
#include "linux/paint/LineShaper.h"
#include "linux/paint/ShapedText.h"

namespace ktr::test {

/// A text on one line.
struct Label {
    std::string text;
    double size = 16.0;
    platform::FontWeight weight = platform::FontWeight::Regular;
    bool rightToLeft = false;

    platform::AttributedString string() const { return {text, platform::Font{platform::FontFace::Text, weight, size}}; }
    platform::TextContainer container() const {
        platform::TextContainer made;
        made.maximumLines = 1;
        made.lineBreakMode = platform::LineBreakMode::TruncatingTail;
        made.alignment = platform::TextAlignment::Left;
        made.rightToLeft = rightToLeft;
        return made;
    }
};

inline std::ostream& operator<<(std::ostream& out, const Label& label) {
    return out << '"' << label.text << "\", " << label.size
               << (label.weight == platform::FontWeight::Regular ? "" : ", bold")
               << (label.rightToLeft ? ", right to left" : "");
}

/// Labels as they are set out of words, beside Qt's own layout of the same.
class LabelsBesideQt : public ::testing::Test {
  protected:
    static int pixels(const Label& label) { return static_cast<int>(std::round(label.size)); }
    std::optional<linux_::LineShaper::Line> shaped(const Label& label) {
        const linux_::PreparedText text(label.string(), linux_::PreparedText::Options::of(label.container()));
        const platform::Font font{platform::FontFace::Text, label.weight, label.size};
        const double scale = label.size / pixels(label);
        return shaper_.shaped(text, fonts_, pixels(label), text.isRightToLeft(0, text.text.size(), label.rightToLeft),
                              font.ascent() / scale);
    }
    linux_::BrokenText byQt(const Label& label) const {
        const linux_::PreparedText text(label.string(), linux_::PreparedText::Options::of(label.container()));
        const platform::TextContainer container = label.container();
        return linux_::LineBreaker(text, container, fonts_).run();
    }
    template <class Draw>
    static QImage drawn(const Draw& draw) {
        QImage image(700, 70, QImage::Format_ARGB32_Premultiplied);
        image.fill(Qt::white);
        QPainter painter(&image);
        painter.setRenderHint(QPainter::Antialiasing);
        painter.translate(8.0, 4.0);
        draw(painter);
        return image;
    }
    static QImage drawn(const linux_::ShapedText& text) {
        return drawn([&](QPainter& painter) {
            painter.scale(2.0, 2.0);
            text.draw(painter, {0.0, 0.0}, Qt::black, linux_::Palette::of(linux_::ColorScheme::Light));
        });
    }
    linux_::ShapedText asQtDrawsIt(const Label& label) const {
        return {linux_::TextKey(label.string(), label.container()), fonts_, byQt(label)};
    }
    linux_::ShapedText asItIsDrawn(const Label& label, linux_::LineShaper::Line line) const {
        return {linux_::TextKey(label.string(), label.container()), fonts_, label.size / pixels(label),
                std::move(line.glyphs)};
    }

    linux_::FontChoice fonts_{QStringLiteral("en-GB")};
    linux_::LineShaper shaper_;
};

}  // namespace ktr::test
