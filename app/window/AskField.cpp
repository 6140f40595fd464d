#include "app/window/AskField.h"

#include <QFocusEvent>
#include <QKeyEvent>
#include <QPainter>

#include "linux/paint/FontChoice.h"
#include "platform/base/Platform.h"
#include "platform/ui/Device.h"
#include "platform/ui/Font.h"

namespace ktr::app {

namespace {

constexpr int kHeight = 48;
constexpr int kLargeHeight = 80;
constexpr int kStart = 14;
constexpr int kEnd = 5;  ///< so that the button's circle and the field's end have one centre
constexpr int kRingOutside = 4;

QFont fieldFont() {
    const auto font = platform::preferredFont(platform::TextStyle::Body);
    return linux_::FontChoice::spec(font, static_cast<int>(font.size), linux_::FontChoice::baseFamily()).font();
}

void strokeRound(QPainter& painter, const QRectF& rect, const QColor& color, double width) {
    const QRectF inner = rect.adjusted(width / 2.0, width / 2.0, -width / 2.0, -width / 2.0);
    painter.setPen(QPen(color, width));
    painter.setBrush(Qt::NoBrush);
    painter.drawRoundedRect(inner, inner.height() / 2.0, inner.height() / 2.0);
}

/// Each time that a name is set, who listens hears that it has changed, also where it has not.
void callIt(QWidget& widget, const std::string& name) {
    const QString wanted = QString::fromStdString(name);
    if (widget.accessibleName() != wanted) {
        widget.setAccessibleName(wanted);
    }
}

}  // namespace

int AskField::shapeHeight() {
    const auto installed = platform::Platform::installed();
    const bool large = installed && platform::isAccessibilityCategory(installed->device->contentSizeCategory());
    return large ? kLargeHeight : kHeight;
}

void AskField::refreshFont() {
    edit_->setFont(fieldFont());
    update();
}

AskField::AskField(const Texts& texts, QWidget* parent)
    : PlainWidget(parent),
      edit_(new QuestionEdit(this)),
      button_(new SendButton(this)),
      palette_(&linux_::Palette::of(linux_::ColorScheme::Light)) {
    edit_->setFont(fieldFont());
    setTexts(texts);
    setCursor(Qt::IBeamCursor);
    setTabOrder(edit_, button_);
    edit_->installEventFilter(this);
    button_->installEventFilter(this);
    connect(edit_, &QLineEdit::textChanged, &listener_, [this] { showButton(); });
    connect(edit_, &QLineEdit::returnPressed, &listener_, [this] { send(); });
    connect(button_, &QAbstractButton::clicked, &listener_, [this] { pressed(); });
}

void AskField::setTexts(const Texts& texts) {
    texts_ = texts;
    edit_->setPlaceholderText(QString::fromStdString(texts.placeholder));
    callIt(*edit_, texts.name.empty() ? texts.placeholder : texts.name);
    showButton();
}

void AskField::showButton() {
    const bool isEmpty = edit_->text().trimmed().isEmpty();
    const bool stops = isAsking_ && isEmpty && stopped_;
    button_->setStops(stops);
    button_->setReady(stops || !isEmpty, animated_);
    const std::string& name = stops ? texts_.stop : texts_.send;
    button_->setToolTip(QString::fromStdString(name));
    callIt(*button_, name);
}

void AskField::setAsking(bool isAsking) {
    if (isAsking != isAsking_) {
        isAsking_ = isAsking;
        showButton();
    }
}

void AskField::offer(const std::string& question) {
    if (edit_->text().isEmpty()) {
        offered_ = QString::fromStdString(question);
        edit_->setText(offered_);
        edit_->deselect();
    }
}

void AskField::withdraw() {
    if (!offered_.isEmpty() && edit_->text() == offered_) {
        edit_->clear();
    }
    offered_.clear();
}

void AskField::pressed() {
    if (button_->stops()) {
        stopped_();
    } else {
        send();
    }
}

bool AskField::recall(const QKeyEvent& key) {
    const bool older = key.key() == Qt::Key_Up;
    if ((!older && key.key() != Qt::Key_Down) || (key.modifiers() & ~Qt::KeypadModifier) != Qt::NoModifier) {
        return false;
    }
    // What somebody is typing is not taken from under their hands.
    const bool isBrowsing = recalled_ < history_.size() && edit_->text() == history_[recalled_];
    if (!isBrowsing && !edit_->text().isEmpty()) {
        return false;
    }
    const std::size_t from = isBrowsing ? recalled_ : history_.size();
    if (older ? from == 0 : from >= history_.size()) {
        return false;
    }
    recalled_ = older ? from - 1 : from + 1;
    edit_->setText(recalled_ < history_.size() ? history_[recalled_] : QString());
    return true;
}

void AskField::send() {
    const QString text = edit_->text().trimmed();
    if (text.isEmpty()) {
        return;
    }
    constexpr std::size_t kMostRecalled = 50;
    if (history_.empty() || history_.back() != text) {
        history_.push_back(text);
    }
    if (history_.size() > kMostRecalled) {
        history_.erase(history_.begin());
    }
    recalled_ = history_.size();
    edit_->clear();
    edit_->setFocus();
    if (asked_) {
        asked_(text.toStdString());
    }
}

void AskField::setColors(const linux_::Palette& palette) {
    palette_ = &palette;
    edit_->setColors(palette);
    button_->setColors(palette);
    update();
}

void AskField::markFocus(bool byKey) {
    marksFocus_ = byKey;
    button_->setMarksFocus(byKey);
    update();
}

bool AskField::eventFilter(QObject* object, QEvent* event) {
    if (event->type() == QEvent::FocusIn) {
        const auto reason = static_cast<QFocusEvent*>(event)->reason();
        markFocus(reason == Qt::TabFocusReason || reason == Qt::BacktabFocusReason ||
                  reason == Qt::ShortcutFocusReason);
    } else if (event->type() == QEvent::FocusOut || event->type() == QEvent::MouseButtonPress) {
        markFocus(false);
    }
    return QWidget::eventFilter(object, event);
}

void AskField::mousePressEvent(QMouseEvent*) {
    edit_->setFocus(Qt::MouseFocusReason);
}

void AskField::resizeEvent(QResizeEvent*) {
    const int buttonSize = button_->sizeHint().width();
    const int editWidth =
        width() - 2 * kAround - kStart - kEnd - SendButton::kDiameter - kStart / 2 + QuestionEdit::kBefore;
    const int editHeight = shapeHeight() - 8;
    const bool mirrored = layoutDirection() == Qt::RightToLeft;
    const int buttonX = kAround + kEnd - SendButton::kAround;
    button_->setGeometry(mirrored ? buttonX : width() - buttonX - buttonSize, (height() - buttonSize) / 2, buttonSize,
                         buttonSize);
    const int editX = kAround + kStart - QuestionEdit::kBefore;
    edit_->setGeometry(mirrored ? width() - editX - editWidth : editX, (height() - editHeight) / 2, editWidth,
                       editHeight);
}

void AskField::paintEvent(QPaintEvent*) {
    QPainter painter(this);
    painter.setRenderHint(QPainter::Antialiasing);
    const QRectF shape = QRectF(rect()).adjusted(kAround, kAround, -kAround, -kAround);
    painter.setPen(Qt::NoPen);
    painter.setBrush(palette_->card);
    painter.drawRoundedRect(shape, shape.height() / 2.0, shape.height() / 2.0);
    strokeRound(painter, shape, palette_->fieldLine, 1.0);
    if (marksFocus_ && edit_->hasFocus()) {
        const double out = kRingOutside;
        strokeRound(painter, shape.adjusted(-out, -out, out, out), palette_->pine, palette_->focusRing);
    }
}

}  // namespace ktr::app
