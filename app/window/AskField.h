#pragma once

#include <functional>
#include <string>

#include "app/window/PlainWidget.h"
#include "app/window/QuestionEdit.h"
#include "app/window/SendButton.h"

namespace ktr::app {

/// The field in which questions are typed. Its shape is inset by `kAround`, where the ring of the keyboard's focus
/// stands. Main thread.
class AskField : public PlainWidget {
  public:
    static constexpr int kAround = 7;

    /// Of its shape, at the present text size.
    static int shapeHeight();

    struct Texts {
        std::string placeholder;
        std::string send;
        std::string name = {};  ///< spoken, of the field; empty: the placeholder
    };

    explicit AskField(const Texts& texts, QWidget* parent = nullptr);
    /// Where the language has become another.
    void setTexts(const Texts& texts);
    /// Where the text size has become another.
    void refreshFont();

    /// Called with what was typed, which is not blank; the field is empty then.
    void setAsked(std::function<void(const std::string&)> asked) { asked_ = std::move(asked); }
    void setColors(const linux_::Palette& palette);
    void setAnimated(bool animated) { animated_ = animated; }
    QuestionEdit& edit() const { return *edit_; }
    SendButton& button() const { return *button_; }

  protected:
    void paintEvent(QPaintEvent* event) override;
    void resizeEvent(QResizeEvent* event) override;
    void mousePressEvent(QMouseEvent* event) override;
    bool eventFilter(QObject* object, QEvent* event) override;

  private:
    void send();
    /// The ring is shown only where a key brought the focus.
    void markFocus(bool byKey);

    QuestionEdit* edit_;
    SendButton* button_;
    std::function<void(const std::string&)> asked_;
    const linux_::Palette* palette_;
    bool animated_ = true;
    bool marksFocus_ = false;
    /// Hears the edit and the button in the field's place: a widget that hears another counts for assistive technology
    /// as controlled by it, but does not say so itself.
    QObject listener_;
};

}  // namespace ktr::app
