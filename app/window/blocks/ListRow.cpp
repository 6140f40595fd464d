#include "app/window/blocks/ListRow.h"

#include <QPainter>
#include <algorithm>

#include "host/conversation/Measures.h"

namespace ktr::app {

namespace {

constexpr int kInset = 15;
constexpr int kGap = 12;
constexpr int kBeforeEnd = 8;
constexpr int kLeast = 52;
constexpr int kLeastChoice = 46;
constexpr int kLeastFine = 38;
constexpr int kPadding = 10;
constexpr int kChoiceWords = 51;
constexpr int kFineWords = 45;
constexpr int kFaceAxis = 42;
constexpr int kFaceWords = 82;
constexpr int kNarrowCard = 336;  ///< of a window of 360
constexpr int kFrame = 16;        // milliseconds
constexpr double kSlide = 0.12;   // seconds
constexpr QSizeF kSwitch(48, 28);
constexpr double kChoice = 22.0;

}  // namespace

ListRow::ListRow(Kind kind, const QString& words, QWidget* parent) : PressBlock(parent), kind_(kind) {
    clock_.start();
    timer_.setInterval(kFrame);
    connect(&timer_, &QTimer::timeout, this, [this] {
        if (knob_.isOver(seconds())) {
            timer_.stop();
        }
        update();
    });
    setWords(words);
    choosePressing();
}

void ListRow::choosePressing() {
    const bool can = canBePressed();
    setFocusPolicy(can ? Qt::TabFocus : Qt::NoFocus);
    setAttribute(Qt::WA_TransparentForMouseEvents, !can);
    setCursor(can ? Qt::PointingHandCursor : Qt::ArrowCursor);
}

bool ListRow::canBePressed() const {
    return kind_ != Kind::Plain && kind_ != Kind::Fine && !isHeld_;
}

QAccessible::Role ListRow::role() const {
    switch (kind_) {
        case Kind::Switch:
            return QAccessible::CheckBox;
        case Kind::Choice:
            return QAccessible::RadioButton;
        default:
            return canBePressed() ? QAccessible::Button : QAccessible::StaticText;
    }
}

void ListRow::nameIt() {
    QStringList parts;
    for (const BlockText* part : {&words_, &second_, &value_}) {
        if (!part->isEmpty()) {
            parts << part->text();
        }
    }
    setAccessibleName(parts.join(QStringLiteral(", ")));
    askForRoom();
}

void ListRow::setWords(const QString& words) {
    words_ = BlockText(words, face_ || kind_ == Kind::Adds ? BlockStyle::Headline : BlockStyle::Body);
    nameIt();
}

void ListRow::setSecond(const QString& second) {
    second_ = BlockText(second, BlockStyle::Subheadline);
    nameIt();
}

void ListRow::setValue(const QString& value) {
    value_ = BlockText(value, kind_ == Kind::Fine ? BlockStyle::Subheadline : BlockStyle::Body);
    nameIt();
}

void ListRow::setFace(std::shared_ptr<const linux_::QtImage> face) {
    face_ = std::move(face);
    setWords(words_.text());
}

void ListRow::setChecked(bool isChecked) {
    if (isChecked == isChecked_) {
        return;
    }
    isChecked_ = isChecked;
    const double now = seconds();
    const double to = isChecked ? 1.0 : 0.0;
    const bool slides = kind_ == Kind::Switch && !look().isStill && isVisible();
    knob_ = slides ? host::Motion::linear(knob_.at(now), to, now, kSlide) : host::Motion(to);
    if (slides) {
        timer_.start();
    }
    QAccessible::State changed;
    changed.checked = true;
    QAccessibleStateChangeEvent event(this, changed);
    QAccessible::updateAccessibility(&event);
    update();
}

void ListRow::setHeld(bool isHeld) {
    isHeld_ = isHeld;
    choosePressing();
    askForRoom();
}

void ListRow::setEnds(bool isFirst, bool isLast) {
    isFirst_ = isFirst;
    isLast_ = isLast;
    update();
}

double ListRow::startOfWords() const {
    if (face_) {
        return kFaceWords;
    }
    if (kind_ == Kind::Choice) {
        return kChoiceWords + grown(kChoice) - kChoice;
    }
    const double tick = iconSide(Icon::Fine);
    return kind_ == Kind::Fine ? kFineWords + grown(tick) - tick : kInset;
}

QSizeF ListRow::endSize() const {
    switch (kind_) {
        case Kind::Leads:
            return isHeld_ ? QSizeF() : QSizeF(grown(iconSide(Icon::Chevron)), grown(iconSide(Icon::Chevron)));
        case Kind::Adds:
            return {grown(iconSide(Icon::More)), grown(iconSide(Icon::More))};
        case Kind::Switch:
            return {grown(kSwitch.width()), grown(kSwitch.height())};
        default:
            return {0.0, 0.0};
    }
}

ListRow::Plan ListRow::planFor(int width) const {
    Plan plan;
    const QSizeF end = endSize();
    const bool isStacked = isVeryLarge();
    // Very large text stands above its control.
    const bool isEndBelow = isStacked && kind_ == Kind::Switch;
    const double endRoom = end.width() > 0.0 && !isEndBelow ? end.width() + kBeforeEnd : 0.0;
    const double start = startOfWords();
    const double across = width - start - kInset - endRoom;
    const bool isValueBelow = !value_.isEmpty() && (isStacked || width < kNarrowCard ||
                                                    words_.naturalWidth() + kGap + value_.naturalWidth() > across);
    const double valueWidth = isValueBelow || value_.isEmpty() ? 0.0 : value_.naturalWidth() + kGap;
    const double wordsHeight = words_.heightFor(across - valueWidth);
    const double secondHeight = second_.heightFor(across);
    const double valueHeight = isValueBelow ? value_.heightFor(across) : 0.0;
    const double endHeight = isEndBelow ? end.height() + kPadding : 0.0;
    const double face = face_ ? face_->size().height + 2.0 * kPadding : 0.0;
    const double text = wordsHeight + secondHeight + valueHeight + endHeight;
    const int least = controlHeight(kind_ == Kind::Choice ? kLeastChoice : kind_ == Kind::Fine ? kLeastFine : kLeast);
    plan.height = std::max({least, static_cast<int>(text) + 2 * kPadding, static_cast<int>(face)});
    double y = (plan.height - text) / 2.0;
    plan.words = {start, y, across - valueWidth, wordsHeight};
    if (!isValueBelow) {
        const double own = value_.heightFor(valueWidth);
        plan.value = {start + across - valueWidth, y + (wordsHeight - own) / 2.0, valueWidth, own};
    }
    y += wordsHeight;
    plan.second = {start, y, across, secondHeight};
    y += secondHeight;
    if (isValueBelow) {
        plan.value = {start, y, across, valueHeight};
        y += valueHeight;
    }
    plan.end = isEndBelow ? QRectF(start, y + kPadding, end.width(), end.height())
                          : QRectF(width - kInset - end.width(), (plan.height - end.height()) / 2.0, end.width(),
                                   end.height());
    if (face_) {
        const double side = face_->size().width;
        plan.face = {kFaceAxis - side / 2.0, kPadding, side, side};
    }
    return plan;
}

int ListRow::shapeHeight(int width) const {
    return planFor(width).height;
}

QPainterPath ListRow::outline() const {
    constexpr double kBeyond = 2.0 * host::measures::kCardCorner;
    const QRectF whole = QRectF(rect()).adjusted(0, isFirst_ ? 0.0 : -kBeyond, 0, isLast_ ? 0.0 : kBeyond);
    return rounded(whole, host::measures::kCardCorner);
}

void ListRow::paintSwitch(QPainter& painter, const QRectF& box) {
    const double grow = box.height() / kSwitch.height();
    const double on = knob_.at(seconds());
    const bool isOn = on >= 0.5;
    const bool isHigh = colors().contrast == linux_::Contrast::High;
    constexpr double kOffEdge = 1.5;
    if (isOn) {
        painter.fillPath(rounded(box, box.height() / 2.0), isHeld_ ? colors().inkSoft : colors().pine);
    }
    if (!isOn || isHigh) {
        strokeInside(painter, box, box.height() / 2.0,
                     QPen(isHigh ? colors().ink : colors().fieldLine, isOn && isHigh ? 2.0 : kOffEdge));
    }
    const double knob = (isOn ? 22.0 : 20.0) * grow;
    const double inset = (box.height() - knob) / 2.0;
    const double travel = box.width() - knob - 2.0 * inset;
    const double x = isMirrored() ? box.right() - inset - knob - travel * on : box.x() + inset + travel * on;
    painter.setPen(Qt::NoPen);
    painter.setBrush(isOn ? colors().onPine : colors().fieldLine);
    painter.drawEllipse(QRectF(x, box.y() + inset, knob, knob));
}

void ListRow::paintChoice(QPainter& painter, const QRectF& box) const {
    const QColor color = isChecked_ ? colors().pine : colors().fieldLine;
    strokeInside(painter, box, box.height() / 2.0, QPen(color, isChecked_ ? 2.0 : 1.5));
    if (isChecked_) {
        const double dot = grown(10.0) / 2.0;
        painter.setPen(Qt::NoPen);
        painter.setBrush(color);
        painter.drawEllipse(box.center(), dot, dot);
    }
}

void ListRow::paintEnd(QPainter& painter, const QRectF& end) {
    switch (kind_) {
        case Kind::Leads:
            if (!isHeld_) {
                paintIcon(painter, Icon::Chevron, end, colors().pine, isMirrored());
            }
            break;
        case Kind::Adds:
            paintIcon(painter, Icon::More, end, colors().pine, false);
            break;
        case Kind::Switch:
            paintSwitch(painter, end);
            break;
        default:
            break;
    }
}

void ListRow::paintEvent(QPaintEvent*) {
    QPainter painter(this);
    painter.setRenderHint(QPainter::Antialiasing);
    const Plan plan = planFor(width());
    const QPainterPath shape = outline();
    painter.setClipRect(rect());
    if (canBePressed()) {
        paintTouch(painter, shape);
        if (isHovered() && colors().highlightEdge.width > 0.0) {
            strokeInside(painter, QRectF(rect()), host::measures::kCardCorner,
                         QPen(colors().highlightEdge.color, colors().highlightEdge.width));
        }
    }
    const bool rtl = isMirrored();
    words_.paint(painter, mirrored(plan.words), kind_ == Kind::Adds ? colors().pine : colors().ink, colors(), rtl);
    second_.paint(painter, mirrored(plan.second), colors().inkSoft, colors(), rtl);
    const bool isBelow = plan.value.top() >= plan.words.bottom();
    value_.paint(painter, mirrored(plan.value), colors().inkSoft, colors(), rtl,
                 isBelow ? BlockAlignment::Start : BlockAlignment::End);
    if (face_) {
        face_->draw(painter, mirrored(plan.face), colors());
    }
    const double middle = plan.words.center().y();
    if (kind_ == Kind::Choice) {
        paintChoice(painter, mirrored({kInset, middle - grown(kChoice) / 2.0, grown(kChoice), grown(kChoice)}));
    } else if (kind_ == Kind::Fine) {
        const double side = grown(iconSide(Icon::Fine));
        paintIcon(painter, Icon::Fine, mirrored({kInset, middle - side / 2.0, side, side}), colors().pine, false);
    }
    paintEnd(painter, mirrored(plan.end));
    if (marksFocus()) {
        constexpr double kIn = host::measures::kFocusInset;
        strokeInside(painter, QRectF(rect()).adjusted(kIn, kIn, -kIn, -kIn), host::measures::kFocusCorner,
                     QPen(colors().pine, colors().focusRing));
    }
}

}  // namespace ktr::app
