#pragma once

#include <QColor>
#include <QFont>
#include <QPainter>
#include <QPainterPath>
#include <QString>

namespace ktr::linux_ {

/// One line of a map's writing as outlines, so that it looks the same at every scale and in every direction. A value;
/// any thread, while a QGuiApplication exists.
class MapText {
  public:
    struct Look {
        int size = 12;  ///< points
        bool isBold = false;
        bool isItalic = false;  ///< for names of water
    };

    /// `language` (BCP 47) chooses the forms of Han characters.
    MapText(const QString& text, const QString& language, const Look& look);

    double width() const { return width_; }
    double ascent() const { return ascent_; }
    double descent() const { return descent_; }
    /// The letters' own extent about the start of the baseline.
    QRectF ink() const { return outline_.boundingRect(); }
    /// From (0, 0), the left end of the baseline.
    const QPainterPath& outline() const { return outline_; }
    /// A halo of `haloWidth` points (half of it outside the letters), then the letters.
    void draw(QPainter& painter, QPointF baseline, const QColor& ink, const QColor& halo, double haloWidth) const;

  private:
    QPainterPath outline_;
    double width_ = 0.0;
    double ascent_ = 0.0;
    double descent_ = 0.0;
};

}  // namespace ktr::linux_
