#include "app/window/checkup/TroubleRow.h"

#include <QPainter>
#include <algorithm>

namespace ktr::app {

namespace {

constexpr int kInset = 15;
constexpr int kMarkTop = 16;
constexpr double kMark = 16.0;
constexpr int kWords = 45;
constexpr int kTop = 13;
constexpr int kToCause = 2;
constexpr int kToButton = 11;
constexpr int kBelow = 15;

}  // namespace

TroubleRow::TroubleRow(const QString& title, const QString& cause, const QString& mends, QWidget* parent)
    : Block(parent),
      title_(title, BlockStyle::Headline),
      cause_(cause, BlockStyle::Subheadline, true),
      button_(new Button(Button::Kind::Quiet, mends, Icon::None, this)) {
    setAccessibleName(title + QLatin1Char(' ') + cause);
    // Heard by itself, it says what it is for.
    button_->setAccessibleDescription(title);
}

double TroubleRow::markSide() const {
    return grown(kMark);
}

double TroubleRow::start() const {
    return kWords + markSide() - kMark;
}

int TroubleRow::across(int width) const {
    return std::max(static_cast<int>(width - start()) - kInset, 1);
}

int TroubleRow::textHeight(int width) const {
    const int cause = cause_.isEmpty() ? 0 : kToCause + cause_.heightFor(across(width));
    return kTop + title_.heightFor(across(width)) + cause;
}

int TroubleRow::shapeHeight(int width) const {
    return textHeight(width) + kToButton + button_->shapeHeight(across(width)) + kBelow;
}

void TroubleRow::resizeEvent(QResizeEvent*) {
    place();
}

void TroubleRow::refreshed() {
    place();
    askForRoom();
}

void TroubleRow::place() {
    const int wide = std::min(button_->naturalWidth(), across(width()));
    button_->placeShape(
        mirrored(QRectF(start(), textHeight(width()) + kToButton, wide, button_->shapeHeight(wide))).toRect());
    update();
}

void TroubleRow::paintEvent(QPaintEvent*) {
    QPainter painter(this);
    painter.setRenderHint(QPainter::Antialiasing);
    const double side = markSide();
    paintIcon(painter, Icon::Warning, mirrored({kInset, kMarkTop, side, side}), colors().warning, false);
    const int wide = across(width());
    const double title = title_.heightFor(wide);
    title_.paint(painter, mirrored(QRectF(start(), kTop, wide, title)), colors().ink, colors(), isMirrored());
    cause_.paint(painter, mirrored(QRectF(start(), kTop + title + kToCause, wide, cause_.heightFor(wide))),
                 colors().inkSoft, colors(), isMirrored());
}

}  // namespace ktr::app
