#include "app/window/blocks/Pill.h"

#include <QPainter>
#include <algorithm>

#include "host/conversation/Measures.h"
#include "host/conversation/Shapes.h"

namespace ktr::app {

namespace {

constexpr int kPersonHeight = 48;
constexpr int kFaceIn = 6;
constexpr int kFaceGap = 10;
constexpr int kPersonEnd = 18;
constexpr int kAroundName = 10;
constexpr double kQuestionCorner = 22.0;

}  // namespace

PersonPill::PersonPill(const QString& name, std::shared_ptr<const linux_::QtImage> face, QWidget* parent)
    : PressBlock(parent), name_(name, BlockStyle::Headline), face_(std::move(face)) {
    setAccessibleName(name);
}

int PersonPill::shapeHeight(int width) const {
    const int across = width - kFaceIn - kFace - kFaceGap - kPersonEnd;
    return std::max(controlHeight(kPersonHeight), name_.heightFor(across) + 2 * kAroundName);
}

int PersonPill::naturalWidth() const {
    return kFaceIn + kFace + kFaceGap + name_.naturalWidth() + kPersonEnd;
}

void PersonPill::paintEvent(QPaintEvent*) {
    QPainter painter(this);
    painter.setRenderHint(QPainter::Antialiasing);
    const QRectF box = shape();
    const double corner = std::min(box.height() / 2.0, controlHeight(kPersonHeight) / 2.0);
    const QPainterPath path = rounded(box, corner);
    painter.fillPath(path, colors().card);
    paintTouch(painter, path);
    const bool isChosen = isHovered() && colors().highlightEdge.width > 0.0;
    strokeInside(painter, box, corner, QPen(colors().fieldLine, isChosen ? colors().highlightEdge.width : 1.0));
    if (face_) {
        const double in = (controlHeight(kPersonHeight) - kFace) / 2.0;
        face_->draw(painter, mirrored({box.x() + kFaceIn, box.y() + in, kFace, kFace}), colors());
    }
    const double start = box.x() + kFaceIn + kFace + kFaceGap;
    const double across = box.right() - kPersonEnd - start;
    const int high = name_.heightFor(across);
    name_.paint(painter, mirrored({start, box.y() + (box.height() - high) / 2.0, across, static_cast<double>(high)}),
                colors().ink, colors(), isMirrored());
    paintRing(painter, box, corner);
}

UnaskedQuestion::UnaskedQuestion(const QString& question, QWidget* parent)
    : PressBlock(parent), words_(question, BlockStyle::Body, true) {
    setAccessibleName(question);
}

int UnaskedQuestion::shapeHeight(int width) const {
    using namespace host::measures;
    return words_.heightFor(width - 2 * kBubbleSide) + static_cast<int>(kBubbleTop + kBubbleBottom + 2.0);
}

int UnaskedQuestion::naturalWidth() const {
    return words_.naturalWidth() + static_cast<int>(2 * host::measures::kBubbleSide);
}

void UnaskedQuestion::paintEvent(QPaintEvent*) {
    using namespace host::measures;
    QPainter painter(this);
    painter.setRenderHint(QPainter::Antialiasing);
    const QRectF box = shape();
    const auto path = [&](double inset) {
        return host::bubblePath(box.adjusted(inset, inset, -inset, -inset), kQuestionCorner - inset,
                                kBubbleTailCorner - inset, isMirrored());
    };
    paintTouch(painter, path(0.0));
    const bool isChosen = isHovered() && colors().highlightEdge.width > 0.0;
    const double edge = isChosen ? colors().highlightEdge.width : 1.0;
    painter.strokePath(path(edge / 2.0), QPen(colors().fieldLine, edge));
    const double across = box.width() - 2 * kBubbleSide;
    const double high = words_.heightFor(across);
    words_.paint(painter, {box.x() + kBubbleSide, box.y() + kBubbleTop, across, high}, colors().ink, colors(),
                 isMirrored());
    paintRing(painter, box, kQuestionCorner);
}

}  // namespace ktr::app
