#pragma once

#include <QPainterPath>
#include <QPointF>
#include <memory>
#include <vector>

#include "linux/paint/Palette.h"
#include "linux/paint/ShapedText.h"
#include "platform/text/TextEngine.h"

class QPainter;

namespace ktr::linux_ {

/// See platform::TextLayout. Immutable; any thread.
class QtTextLayout final : public platform::TextLayout {
  public:
    /// The shaped text's origin is `offset` points from the container's left edge; none without text.
    QtTextLayout(std::shared_ptr<const ShapedText> shaped, double offset, std::vector<Line> lines, double padding,
                 bool truncated);

    platform::Size usedSize() const override { return usedSize_; }
    const std::vector<Line>& lines() const override { return lines_; }
    bool isTruncated() const override { return truncated_; }
    const std::shared_ptr<const ShapedText>& shaped() const { return shaped_; }
    /// The container's top left corner at `origin`, points; runs without a colour take `color`.
    void draw(QPainter& painter, QPointF origin, const QColor& color, const Palette& palette) const;
    /// The letters' outlines in the container's coordinates; without glyphs that are pictures.
    QPainterPath outline() const;

  private:
    std::shared_ptr<const ShapedText> shaped_;
    /// To the right.
    double offset_;
    std::vector<Line> lines_;
    platform::Size usedSize_;
    bool truncated_;
};

}  // namespace ktr::linux_
