#include "app/window/blocks/FormField.h"

#include <QEvent>
#include <QPainter>
#include <algorithm>

namespace ktr::app {

namespace {

constexpr int kBoxHeight = 48;
constexpr int kCorner = 14;
constexpr int kInset = 15;
constexpr int kLabelBelow = 5;
constexpr int kNoteAbove = 8;
constexpr int kTyped = 8;  ///< above and below the line that is typed into, at least
constexpr int kEyeEnd = 2;

}  // namespace

FormField::FormField(QWidget* parent)
    : Block(parent),
      label_(new Words(BlockStyle::Subheadline, Words::Tone::Ink, this)),
      edit_(new QuestionEdit(this)),
      note_(new Words(BlockStyle::Subheadline, Words::Tone::Ink, this)) {
    note_->setWarning(true);
    note_->hide();
    edit_->setFont(BlockText::typingFont(BlockStyle::Body));
    edit_->installEventFilter(this);
    setFocusProxy(edit_);
    connect(edit_, &QLineEdit::textEdited, &listener_, [this] {
        if (changed_) {
            changed_();
        }
    });
    connect(edit_, &QLineEdit::returnPressed, &listener_, [this] {
        if (entered_) {
            entered_();
        }
    });
}

void FormField::setLabel(const QString& label) {
    label_->setText(label);
    edit_->setAccessibleName(label);
    askForRoom();
}

void FormField::setHint(const QString& hint) {
    edit_->setPlaceholderText(hint);
}

void FormField::setNote(const QString& note) {
    note_->setText(note);
    note_->setVisible(!note.isEmpty());
    edit_->setAccessibleDescription(note);
    place();
    askForRoom();
}

void FormField::setSecret(const QString& show, const QString& hide) {
    show_ = show;
    hide_ = hide;
    if (eye_ == nullptr) {
        edit_->setEchoMode(QLineEdit::Password);
        edit_->setInputMethodHints(Qt::ImhSensitiveData | Qt::ImhNoPredictiveText | Qt::ImhNoAutoUppercase);
        eye_ = new IconButton(Icon::Show, IconButton::Tone::Soft, this);
        eye_->setLook(look());
        eye_->setPressed([this] {
            const bool isHidden = edit_->echoMode() == QLineEdit::Password;
            edit_->setEchoMode(isHidden ? QLineEdit::Normal : QLineEdit::Password);
            eye_->setName(isHidden ? hide_ : show_);
        });
        setTabOrder(edit_, eye_);
    }
    eye_->setName(edit_->echoMode() == QLineEdit::Password ? show_ : hide_);
    place();
}

void FormField::setFixed(bool isFixed) {
    edit_->setReadOnly(isFixed);
    update();
}

int FormField::labelHeight(int width) const {
    return label_->shapeHeight(width - 2 * kInset) + kLabelBelow;
}

int FormField::boxHeight() const {
    const int line = static_cast<int>(BlockText::fontOf(BlockStyle::Body).lineHeight());
    return std::max(controlHeight(kBoxHeight), line + 2 * kTyped);
}

int FormField::shapeHeight(int width) const {
    const int note = note_->isHidden() ? 0 : kNoteAbove + note_->shapeHeight(width - 2 * kInset);
    return labelHeight(width) + boxHeight() + note;
}

QRectF FormField::box() const {
    return QRectF(0, labelHeight(width()), width(), boxHeight());
}

void FormField::place() {
    const int across = width() - 2 * kInset;
    label_->placeShape(mirrored(QRectF(kInset, 0, across, labelHeight(width()) - kLabelBelow)).toRect());
    const QRectF in = box();
    const int eye = eye_ == nullptr ? 0 : IconButton::side();
    const double editEnd = eye_ == nullptr ? kInset : eye + kEyeEnd;
    const double editStart = kInset - QuestionEdit::kBefore;
    edit_->setGeometry(
        mirrored(QRectF(editStart, in.y() + 2, width() - editStart - editEnd, in.height() - 4)).toRect());
    if (eye_ != nullptr) {
        eye_->placeShape(
            mirrored(QRectF(width() - kEyeEnd - eye, in.y() + (in.height() - eye) / 2.0, eye, eye)).toRect());
    }
    note_->placeShape(mirrored(QRectF(kInset, in.bottom() + kNoteAbove, across, note_->shapeHeight(across))).toRect());
    update();
}

void FormField::resizeEvent(QResizeEvent*) {
    place();
}

bool FormField::event(QEvent* event) {
    if (event->type() == QEvent::LayoutRequest) {
        place();
        askForRoom();
        return true;
    }
    return Block::event(event);
}

void FormField::lookChanged() {
    edit_->setColors(colors());
}

void FormField::refreshed() {
    edit_->setFont(BlockText::typingFont(BlockStyle::Body));
    place();
    askForRoom();
}

void FormField::mousePressEvent(QMouseEvent*) {
    edit_->setFocus(Qt::MouseFocusReason);
}

bool FormField::eventFilter(QObject* object, QEvent* event) {
    if (event->type() == QEvent::FocusIn || event->type() == QEvent::FocusOut) {
        update();
    }
    return Block::eventFilter(object, event);
}

void FormField::paintEvent(QPaintEvent*) {
    QPainter painter(this);
    painter.setRenderHint(QPainter::Antialiasing);
    const QRectF in = box();
    painter.fillPath(rounded(in, kCorner), colors().card);
    const bool isWrong = !note_->isHidden();
    const bool isMarked = isWrong || edit_->hasFocus();
    const QColor edge = isWrong ? colors().warning : edit_->hasFocus() ? colors().pine : colors().fieldLine;
    strokeInside(painter, in, kCorner, QPen(edge, isMarked ? 2.0 : 1.0));
}

}  // namespace ktr::app
