#pragma once

#include <QAccessible>
#include <QPainterPath>
#include <QWidget>

#include "linux/paint/Palette.h"

namespace ktr::host {
class CardShadow;
}

namespace ktr::app {

/// How everything in a window looks now.
struct Look {
    const linux_::Palette* palette = &linux_::Palette::of(linux_::ColorScheme::Light);
    bool isStill = false;  ///< nothing slides or turns
};

/// A piece of a page: text, button, field, card. Its shape is the widget without what stands around it, where the ring
/// of the keyboard's focus is drawn. Points; "start" and "end" follow the widget's direction. Main thread.
class Block : public QWidget {
  public:
    explicit Block(QWidget* parent = nullptr);

    /// On each side of the shape.
    virtual int around() const { return 0; }
    /// Of the shape, where it is so wide.
    virtual int shapeHeight(int width) const = 0;
    /// Of the shape, where nothing else says how wide it is.
    virtual int naturalWidth() const { return 0; }
    /// What lies under a shape without being part of it, in its parent's coordinates: a shadow. The parent keeps what
    /// was blurred, for all that stands on it.
    virtual void paintUnder(QPainter& painter, const QRectF& shape, host::CardShadow& shadow) const;

    const linux_::Palette& colors() const { return *look_.palette; }
    const Look& look() const { return look_; }
    /// Of this and of all blocks in it.
    void setLook(const Look& look);
    /// Text size, language or direction have become others: of this and of all blocks in it.
    void refresh();

    void placeShape(const QRect& shape);
    QRect shape() const;
    /// The mirror image of a rectangle in this widget, where it runs from right to left.
    QRectF mirrored(const QRectF& rect) const;
    bool isMirrored() const { return layoutDirection() == Qt::RightToLeft; }
    /// Tells the page that the block needs another height.
    void askForRoom();

    /// What assistive technology takes it for. What can be pressed offers that as an action.
    virtual QAccessible::Role role() const { return QAccessible::Client; }
    virtual bool canBePressed() const { return false; }
    virtual bool isCheckable() const { return false; }
    virtual bool isChecked() const { return false; }
    virtual void press() {}

  protected:
    /// Called when the look has changed; children have theirs by then.
    virtual void lookChanged() {}
    virtual void refreshed() {}
    /// Whether very large text is set: rows put text above control then, and controls are higher.
    static bool isVeryLarge();
    /// A control's height at the present text size.
    static int controlHeight(int usual) { return static_cast<int>(grown(usual)); }
    /// The side of an icon or of a mark at the present text size, whole points.
    static double grown(double usual);

  private:
    Look look_;
};

/// Paints an edge wholly inside a rounded rectangle.
void strokeInside(QPainter& painter, const QRectF& rect, double corner, const QPen& pen);
QPainterPath rounded(const QRectF& rect, double corner);

}  // namespace ktr::app
