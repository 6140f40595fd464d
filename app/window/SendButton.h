#pragma once

#include <QAbstractButton>
#include <QElapsedTimer>
#include <QTimer>

#include "host/conversation/Motion.h"
#include "linux/paint/Palette.h"

namespace ktr::app {

/// The round button that sends the question: pale while there is nothing to send, and a stop while an answer is waited
/// for. Main thread.
class SendButton : public QAbstractButton {
  public:
    /// Of its circle; the widget is larger by `kAround` on every side, for the ring of the keyboard's focus.
    static constexpr int kDiameter = 38;
    static constexpr int kAround = 5;

    explicit SendButton(QWidget* parent = nullptr);

    void setColors(const linux_::Palette& palette);
    /// Whether there is something to send.
    void setReady(bool ready, bool animated);
    /// Whether it stops what is asked instead of sending.
    void setStops(bool stops);
    bool stops() const { return stops_; }
    /// Whether the keyboard's focus is marked while the button has it.
    void setMarksFocus(bool marks);
    QSize sizeHint() const override;

  protected:
    void paintEvent(QPaintEvent* event) override;

  private:
    double seconds() const { return static_cast<double>(clock_.nsecsElapsed()) * 1e-9; }

    const linux_::Palette* palette_;
    QElapsedTimer clock_;
    QTimer timer_;
    host::Motion colour_;
    bool marksFocus_ = false;
    bool stops_ = false;
};

}  // namespace ktr::app
