#pragma once

#include <functional>
#include <string>
#include <vector>

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
        std::string stop = {};  ///< the button's, while it stops
    };

    explicit AskField(const Texts& texts, QWidget* parent = nullptr);
    /// Where the language has become another.
    void setTexts(const Texts& texts);
    /// Where the text size has become another.
    void refreshFont();

    /// Called with what was typed, which is not blank; the field is empty then.
    void setAsked(std::function<void(const std::string&)> asked) { asked_ = std::move(asked); }
    /// Called when what is asked shall stop.
    void setStopped(std::function<void()> stopped) { stopped_ = std::move(stopped); }
    /// An answer is waited for: as long as nothing else is typed, the button stops it.
    void setAsking(bool isAsking);
    /// A question that may be sent once more, unless something else was typed meanwhile.
    void offer(const std::string& question);
    /// Takes an offered question out again, unless it was changed.
    void withdraw();
    /// What was asked before, by the keys Up and Down in an empty field; false for a key that means nothing of that.
    bool recall(const QKeyEvent& key);
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
    void pressed();
    void showButton();
    /// The ring is shown only where a key brought the focus.
    void markFocus(bool byKey);

    QuestionEdit* edit_;
    SendButton* button_;
    std::function<void(const std::string&)> asked_;
    std::function<void()> stopped_;
    Texts texts_;
    bool isAsking_ = false;
    QString offered_;
    /// The oldest first, and which of them stands in the field; behind the last: none.
    std::vector<QString> history_;
    std::size_t recalled_ = 0;
    const linux_::Palette* palette_;
    bool animated_ = true;
    bool marksFocus_ = false;
    /// Hears the edit and the button in the field's place: a widget that hears another counts for assistive technology
    /// as controlled by it, but does not say so itself.
    QObject listener_;
};

}  // namespace ktr::app
