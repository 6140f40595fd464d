#pragma once

#include <QLineEdit>
#include <QTimer>

#include "linux/paint/Palette.h"

namespace ktr::app {

/// The line that is typed into: colours of the palette and a caret of its own, 2 wide in pine. Main thread.
class QuestionEdit : public QLineEdit {
  public:
    explicit QuestionEdit(QWidget* parent = nullptr);
    ~QuestionEdit() override;

    void setColors(const linux_::Palette& palette);

  protected:
    void paintEvent(QPaintEvent* event) override;
    void focusInEvent(QFocusEvent* event) override;
    void focusOutEvent(QFocusEvent* event) override;
    void changeEvent(QEvent* event) override;

  private:
    class CaretlessStyle;

    void showCaret();
    void alignToStart();
    QRect caret() const;

    std::unique_ptr<CaretlessStyle> style_;
    QTimer blink_;
    bool caretShown_ = false;
    QColor pine_;
};

}  // namespace ktr::app
