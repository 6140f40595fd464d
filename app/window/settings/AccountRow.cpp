#include "app/window/settings/AccountRow.h"

#include <QPainter>
#include <algorithm>
#include <utility>

namespace ktr::app {

namespace {

constexpr int kInset = 15;
constexpr int kFace = 54;
constexpr int kFacePadding = 10;
constexpr int kWords = 82;
constexpr int kPadding = 12;
constexpr int kBeforeButton = 12;
constexpr int kNarrowCard = 336;  ///< of a window of 360

/// An address has no blanks: it parts behind its signs.
QString parting(QString address) {
    for (const char sign : {'@', '.', ':'}) {
        address.replace(QLatin1Char(sign), QString(QLatin1Char(sign)) + BlockText::kMayPart);
    }
    return address;
}

}  // namespace

AccountRow::AccountRow(QWidget* parent)
    : Block(parent), signOut_(new Button(Button::Kind::Quiet, {}, Icon::None, this)) {}

void AccountRow::setTexts(const QString& name, const QString& address, const QString& signOut) {
    name_ = BlockText(parting(name), BlockStyle::Headline);
    address_ = BlockText(parting(address), BlockStyle::Subheadline);
    name_.keepWordsWhole();
    address_.keepWordsWhole();
    setAccessibleName(address.isEmpty() ? name : name + QStringLiteral(", ") + address);
    signOut_->setWords(signOut);
    place();
    askForRoom();
}

void AccountRow::setFace(std::shared_ptr<const linux_::QtImage> face) {
    face_ = std::move(face);
    update();
}

bool AccountRow::isStacked(int width) const {
    constexpr int kLeastWords = 90;
    return isVeryLarge() || width < kNarrowCard ||
           width - kWords - kInset - kBeforeButton - signOut_->naturalWidth() < kLeastWords;
}

int AccountRow::textWidth(int width) const {
    const int end = isStacked(width) ? kInset : kInset + kBeforeButton + signOut_->naturalWidth();
    return std::max(width - kWords - end, 1);
}

int AccountRow::textHeight(int width) const {
    return name_.heightFor(textWidth(width)) + address_.heightFor(textWidth(width));
}

int AccountRow::upperHeight(int width) const {
    return std::max(kFace + 2 * kFacePadding, textHeight(width) + 2 * kPadding);
}

int AccountRow::shapeHeight(int width) const {
    const int below = isStacked(width) ? signOut_->shapeHeight(width - 2 * kInset) + kPadding : 0;
    return upperHeight(width) + below;
}

void AccountRow::resizeEvent(QResizeEvent*) {
    place();
}

void AccountRow::refreshed() {
    place();
    askForRoom();
}

void AccountRow::place() {
    const bool stacked = isStacked(width());
    const int across = stacked ? std::min(signOut_->naturalWidth(), width() - 2 * kInset) : signOut_->naturalWidth();
    const int high = signOut_->shapeHeight(across);
    const int x = stacked ? kInset : width() - kInset - across;
    const int y = stacked ? upperHeight(width()) : (height() - high) / 2;
    signOut_->placeShape(mirrored(QRectF(x, y, across, high)).toRect());
    update();
}

void AccountRow::paintEvent(QPaintEvent*) {
    QPainter painter(this);
    painter.setRenderHint(QPainter::Antialiasing);
    const int upper = upperHeight(width());
    if (face_) {
        face_->draw(painter, mirrored({kInset, (upper - kFace) / 2.0, kFace, kFace}), colors());
    }
    const int across = textWidth(width());
    const double nameHigh = name_.heightFor(across);
    const double addressHigh = address_.heightFor(across);
    double y = (upper - nameHigh - addressHigh) / 2.0;
    name_.paint(painter, mirrored(QRectF(kWords, y, across, nameHigh)), colors().ink, colors(), isMirrored());
    y += nameHigh;
    address_.paint(painter, mirrored(QRectF(kWords, y, across, addressHigh)), colors().inkSoft, colors(), isMirrored());
}

}  // namespace ktr::app
