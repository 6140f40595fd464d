#pragma once

#include <QLineEdit>
#include <QTimer>
#include <memory>
#include <utility>

#include "linux/paint/Palette.h"

namespace ktr::app {

/// The line that is typed into, whose line ends are blanks wherever they come from: colours of the palette, a
/// placeholder that is never cut, and a caret of its own, 2 wide in pine. Main thread.
class QuestionEdit : public QLineEdit {
  public:
    /// From its start edge to its text and its placeholder: room for the caret, which stands before an empty line.
    static constexpr int kBefore = 5;

    explicit QuestionEdit(QWidget* parent = nullptr);
    ~QuestionEdit() override;

    void setColors(const linux_::Palette& palette);
    /// Of its menu.
    struct MenuTexts {
        QString cut, copy, paste, selectAll;
    };
    void setMenuTexts(MenuTexts texts) { menuTexts_ = std::move(texts); }
    /// What the placeholder is written in: small enough for all of it.
    QFont hintFont() const;

  protected:
    void paintEvent(QPaintEvent* event) override;
    void focusInEvent(QFocusEvent* event) override;
    void focusOutEvent(QFocusEvent* event) override;
    void changeEvent(QEvent* event) override;
    void inputMethodEvent(QInputMethodEvent* event) override;
    void contextMenuEvent(QContextMenuEvent* event) override;
    bool event(QEvent* event) override;

  private:
    class CaretlessStyle;
    class OneLine;

    void showMenu(QPoint at);
    void showCaret();
    void alignToStart();
    QRect caret() const;

    std::unique_ptr<CaretlessStyle> style_;
    MenuTexts menuTexts_;
    QTimer blink_;
    bool caretShown_ = false;
    bool composing_ = false;
    QColor pine_;
    QColor hint_;
};

}  // namespace ktr::app
