#pragma once

#include <QPointF>
#include <QTextLayout>
#include <memory>
#include <mutex>
#include <optional>
#include <vector>

#include "linux/ui/Palette.h"
#include "platform/text/TextEngine.h"

class QPainter;

namespace ktr::linux_ {

/// A shaped text with its lines in place. Shared between layouts that differ in their alignment only. Any thread:
/// drawing is serialised, because the shaper fills caches while it draws.
class ShapedText {
  public:
    /// Part of the text in a colour; none takes the colour that is drawn with.
    struct ColorRange {
        int start = 0;
        int length = 0;
        std::optional<platform::Color> color;
    };

    /// Glyphs are shaped at whole sizes; `scale` takes the layout's units to points. Its first `lines` lines are drawn.
    /// `colors` is empty for a text in one colour, else it covers the text.
    ShapedText(std::unique_ptr<QTextLayout> layout, double scale, int lines, std::vector<ColorRange> colors)
        : layout_(std::move(layout)), scale_(scale), lines_(lines), colors_(std::move(colors)) {}

    const QTextLayout& layout() const { return *layout_; }
    double scale() const { return scale_; }
    void draw(QPainter& painter, QPointF origin, const QColor& color, const Palette& palette) const;

  private:
    std::unique_ptr<QTextLayout> layout_;
    double scale_;
    int lines_;
    std::vector<ColorRange> colors_;
    mutable std::mutex mutex_;
};

/// See platform::TextLayout. Immutable; any thread.
class QtTextLayout final : public platform::TextLayout {
  public:
    /// A shaped text and where its origin stands in the container. Points.
    struct Piece {
        std::shared_ptr<const ShapedText> shaped;
        QPointF offset;
    };

    QtTextLayout(std::vector<Piece> pieces, std::vector<Line> lines, double padding, bool truncated);

    platform::Size usedSize() const override { return usedSize_; }
    const std::vector<Line>& lines() const override { return lines_; }
    bool isTruncated() const override { return truncated_; }
    const std::vector<Piece>& pieces() const { return pieces_; }
    /// The container's top left corner at `origin`, points; runs without a colour take `color`.
    void draw(QPainter& painter, QPointF origin, const QColor& color, const Palette& palette) const;

  private:
    std::vector<Piece> pieces_;
    std::vector<Line> lines_;
    platform::Size usedSize_;
    bool truncated_;
};

}  // namespace ktr::linux_
