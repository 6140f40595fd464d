#pragma once

#include <QColor>
#include <QImage>
#include <QPainterPath>
#include <QString>
#include <memory>

#include "linux/paint/Initials.h"
#include "linux/paint/QtImage.h"

namespace ktr::linux_ {

/// A person in a circle: letters on their colour, a photo, or the figure that stands for nobody. Letters and figure are
/// outlines, crisp at any scale. Main thread.
class AvatarImage final : public QtImage {
  public:
    /// `letterSize` in points; 0 follows the diameter. Letters that are wider than the circle allows are made smaller,
    /// point by point.
    static std::shared_ptr<AvatarImage> letters(double diameter, const Initials& initials, const QColor& color,
                                                double letterSize = 0.0);
    static std::shared_ptr<AvatarImage> photo(double diameter, const QImage& picture);
    static std::shared_ptr<AvatarImage> blank(double diameter);

    /// The size of the letters for a diameter, points.
    static double letterSizeFor(double diameter);

    platform::Size size() const override { return {diameter_, diameter_}; }
    void draw(QPainter& painter, const QRectF& rect, const Palette& palette) const override;

    /// The size that the letters are drawn at, after fitting, points; 0 without letters.
    double letterSize() const { return letterSize_; }
    const QColor& color() const { return color_; }
    bool isPhoto() const { return !photo_.isNull(); }
    bool isBlank() const { return !isPhoto() && letterSize_ <= 0.0; }

  private:
    explicit AvatarImage(double diameter) : diameter_(diameter) {}
    QImage cutToCircle(int pixels) const;

    double diameter_;
    double letterSize_ = 0.0;
    QColor color_;
    /// What is drawn in white, in a circle of this diameter; points.
    QPainterPath white_;
    QImage photo_;
    /// The photo as it was drawn last.
    mutable QImage cut_;
};

}  // namespace ktr::linux_
