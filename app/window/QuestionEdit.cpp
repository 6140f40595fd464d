#include "app/window/QuestionEdit.h"

#include <QClipboard>
#include <QContextMenuEvent>
#include <QEvent>
#include <QFocusEvent>
#include <QFontMetricsF>
#include <QGestureEvent>
#include <QGuiApplication>
#include <QInputMethodEvent>
#include <QMenu>
#include <QMimeData>
#include <QPainter>
#include <QProxyStyle>
#include <QStyleHints>
#include <QValidator>

namespace ktr::app {

namespace {

constexpr int kCaretWidth = 2;
/// From the caret on an empty line to the words that stand in for one.
constexpr int kCaretBefore = 3;
/// What Qt adds to the margins on both sides of a line's text.
constexpr int kOwnMargin = 2;
/// What Qt adds before the caret in the rectangle that it gives.
constexpr int kCaretSlack = 5;

}  // namespace

/// Qt's own caret has the colour of the text.
class QuestionEdit::CaretlessStyle : public QProxyStyle {
  public:
    int pixelMetric(PixelMetric metric, const QStyleOption* option, const QWidget* widget) const override {
        return metric == PM_TextCursorWidth ? 0 : QProxyStyle::pixelMetric(metric, option, widget);
    }
};

/// A question is one line: what is pasted, dropped or dictated may have several.
class QuestionEdit::OneLine : public QValidator {
  public:
    using QValidator::QValidator;
    State validate(QString& text, int& cursor) const override {
        const auto isEnd = [](QChar c) {
            return (c >= QLatin1Char('\n') && c <= QLatin1Char('\r')) || c == QChar(0x85) ||
                   c == QChar::LineSeparator || c == QChar::ParagraphSeparator;
        };
        for (qsizetype i = 0; i < text.size(); ++i) {
            if (!isEnd(text[i])) {
                continue;
            }
            if (text[i] == QLatin1Char('\r') && i + 1 < text.size() && text[i + 1] == QLatin1Char('\n')) {
                text.remove(i, 1);
                cursor -= cursor > i ? 1 : 0;
            }
            text[i] = QLatin1Char(' ');
        }
        return Acceptable;
    }
};

QuestionEdit::QuestionEdit(QWidget* parent) : QLineEdit(parent), style_(std::make_unique<CaretlessStyle>()) {
    setStyle(style_.get());
    setFrame(false);
    alignToStart();
    grabGesture(Qt::TapAndHoldGesture);
    setValidator(new OneLine(this));
    connect(&blink_, &QTimer::timeout, this, [this] {
        caretShown_ = !caretShown_;
        update(caret());
    });
    connect(this, &QLineEdit::cursorPositionChanged, this, [this] { showCaret(); });
    connect(this, &QLineEdit::textChanged, this, [this] { showCaret(); });
    connect(QGuiApplication::styleHints(), &QStyleHints::cursorFlashTimeChanged, this, [this] { showCaret(); });
}

QuestionEdit::~QuestionEdit() = default;

void QuestionEdit::setColors(const linux_::Palette& palette) {
    pine_ = palette.pine;
    QPalette colors = this->palette();
    colors.setColor(QPalette::Base, Qt::transparent);
    colors.setColor(QPalette::Window, Qt::transparent);
    colors.setColor(QPalette::Text, palette.ink);
    // The line's own placeholder would be cut where it does not fit.
    colors.setColor(QPalette::PlaceholderText, Qt::transparent);
    hint_ = palette.inkSoft;
    colors.setColor(QPalette::Highlight, palette.pine);
    colors.setColor(QPalette::HighlightedText, palette.onPine);
    setPalette(colors);
}

void QuestionEdit::alignToStart() {
    constexpr int kMargin = kBefore - kOwnMargin;
    const bool isMirrored = layoutDirection() == Qt::RightToLeft;
    setTextMargins(isMirrored ? 0 : kMargin, 0, isMirrored ? kMargin : 0, 0);
    // By itself, an empty line begins where the keyboard's language does, away from the words that stand in for a
    // question.
    setAlignment(layoutDirection() == Qt::RightToLeft ? Qt::AlignRight | Qt::AlignAbsolute | Qt::AlignVCenter
                                                      : Qt::AlignLeading | Qt::AlignVCenter);
}

void QuestionEdit::changeEvent(QEvent* event) {
    QLineEdit::changeEvent(event);
    if (event->type() == QEvent::LayoutDirectionChange) {
        alignToStart();
    }
}

QRect QuestionEdit::caret() const {
    const QRect around = cursorRect();
    if (text().isEmpty() && !composing_) {
        const int x = layoutDirection() == Qt::RightToLeft ? width() - kBefore + kCaretBefore - kCaretWidth
                                                           : kBefore - kCaretBefore;
        return {x, around.y(), kCaretWidth, around.height()};
    }
    return {std::min(around.x() + kCaretSlack, width() - kCaretWidth), around.y(), kCaretWidth, around.height()};
}

void QuestionEdit::showCaret() {
    if (!hasFocus()) {
        return;
    }
    caretShown_ = true;
    const int time = QGuiApplication::styleHints()->cursorFlashTime();
    if (time > 0) {
        blink_.start(time / 2);
    } else {
        blink_.stop();
    }
    update();
}

void QuestionEdit::paintEvent(QPaintEvent* event) {
    QLineEdit::paintEvent(event);
    if (text().isEmpty() && !composing_) {
        QPainter painter(this);
        painter.setFont(hintFont());
        painter.setPen(hint_);
        const bool isMirrored = layoutDirection() == Qt::RightToLeft;
        const QRect line = rect().adjusted(isMirrored ? 0 : kBefore, 0, isMirrored ? -kBefore : 0, 0);
        painter.drawText(line, static_cast<int>(alignment()) | Qt::TextSingleLine, placeholderText());
    }
    if (hasFocus() && caretShown_ && !hasSelectedText()) {
        QPainter painter(this);
        painter.fillRect(caret(), pine_);
    }
}

QFont QuestionEdit::hintFont() const {
    constexpr int kSmallest = 8;  // pixels
    QFont small = font();
    const auto fits = [this](const QFont& tried) {
        return QFontMetricsF(tried).horizontalAdvance(placeholderText()) <= width() - kBefore;
    };
    while (!fits(small) && small.pixelSize() > kSmallest) {
        small.setPixelSize(small.pixelSize() - 1);
    }
    return small;
}

bool QuestionEdit::event(QEvent* event) {
    if (event->type() == QEvent::Gesture) {
        auto* gestures = static_cast<QGestureEvent*>(event);
        if (const QGesture* hold = gestures->gesture(Qt::TapAndHoldGesture);
            hold != nullptr && hold->state() == Qt::GestureFinished) {
            showMenu(static_cast<const QTapAndHoldGesture*>(hold)->position().toPoint());
        }
        return true;
    }
    return QLineEdit::event(event);
}

void QuestionEdit::contextMenuEvent(QContextMenuEvent* event) {
    showMenu(event->globalPos());
}

/// The toolkit's own menu is in the toolkit's language.
void QuestionEdit::showMenu(QPoint at) {
    auto* menu = new QMenu(this);
    menu->setAttribute(Qt::WA_DeleteOnClose);
    const auto add = [&](const QString& words, bool isPossible, auto done) {
        QAction* action = menu->addAction(words);
        action->setEnabled(isPossible);
        connect(action, &QAction::triggered, this, done);
    };
    const QMimeData* there = QGuiApplication::clipboard()->mimeData();
    add(menuTexts_.cut, hasSelectedText(), &QLineEdit::cut);
    add(menuTexts_.copy, hasSelectedText(), &QLineEdit::copy);
    add(menuTexts_.paste, there != nullptr && there->hasText(), &QLineEdit::paste);
    add(menuTexts_.selectAll, !text().isEmpty(), &QLineEdit::selectAll);
    menu->popup(at);
}

void QuestionEdit::inputMethodEvent(QInputMethodEvent* event) {
    composing_ = !event->preeditString().isEmpty();
    QLineEdit::inputMethodEvent(event);
    update();
}

void QuestionEdit::focusInEvent(QFocusEvent* event) {
    const int cursor = cursorPosition();
    QLineEdit::focusInEvent(event);
    // By itself a key that comes here selects everything, and the next letter would replace what was typed.
    if (event->reason() == Qt::TabFocusReason || event->reason() == Qt::BacktabFocusReason ||
        event->reason() == Qt::ShortcutFocusReason) {
        setCursorPosition(cursor);
    }
    showCaret();
}

void QuestionEdit::focusOutEvent(QFocusEvent* event) {
    blink_.stop();
    caretShown_ = false;
    QLineEdit::focusOutEvent(event);
    update();
}

}  // namespace ktr::app
