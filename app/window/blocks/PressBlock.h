#pragma once

#include <functional>

#include "app/window/blocks/Block.h"

namespace ktr::app {

/// A block that can be pressed: by mouse, pen and finger, by Space and Enter, and by assistive technology. Main thread.
class PressBlock : public Block {
  public:
    explicit PressBlock(QWidget* parent = nullptr);

    /// Called when it was pressed; it may be gone afterwards.
    void setPressed(std::function<void()> pressed) { pressed_ = std::move(pressed); }
    int around() const override { return kAround; }
    void press() override;
    bool canBePressed() const override { return true; }
    QAccessible::Role role() const override { return QAccessible::Button; }

  protected:
    static constexpr int kAround = 6;

    bool isHovered() const { return hovered_ && isEnabled(); }
    bool isDown() const { return down_ && isEnabled(); }
    /// The keyboard's focus, come by a key.
    bool marksFocus() const { return marked_ && hasFocus(); }
    /// The ring around a shape whose corners are so round.
    void paintRing(QPainter& painter, const QRectF& shape, double corner) const;
    /// Highlight under a pointer, darker when pressed.
    void paintTouch(QPainter& painter, const QPainterPath& shape) const;

    bool event(QEvent* event) override;
    void mousePressEvent(QMouseEvent* event) override;
    void mouseMoveEvent(QMouseEvent* event) override;
    void mouseReleaseEvent(QMouseEvent* event) override;
    void keyPressEvent(QKeyEvent* event) override;
    void keyReleaseEvent(QKeyEvent* event) override;
    void focusInEvent(QFocusEvent* event) override;
    void focusOutEvent(QFocusEvent* event) override;
    void changeEvent(QEvent* event) override;

  private:
    void setDown(bool down);

    std::function<void()> pressed_;
    bool hovered_ = false;
    bool down_ = false;
    bool marked_ = false;
};

}  // namespace ktr::app
