#include "app/window/StatusLine.h"

#include <QPainter>
#include <QPainterPath>
#include <algorithm>
#include <cmath>

#include "platform/ui/Font.h"

namespace ktr::app {

namespace {

/// From the line's end to the button, whose words end 15 from it.
constexpr int kHelpEnd = 7;
constexpr double kDot = 8.0;
constexpr double kRingStroke = 1.5;
constexpr double kWarning = 14.0;
constexpr double kWarningStroke = 1.5;
constexpr double kHidden = 16.0;
constexpr double kHiddenStroke = 1.5;

QPainterPath warningPath() {
    QPainterPath path;
    path.moveTo(7.0, 1.6);
    path.lineTo(13.0, 12.2);
    path.lineTo(1.0, 12.2);
    path.closeSubpath();
    path.moveTo(7.0, 5.4);
    path.lineTo(7.0, 8.6);
    path.moveTo(7.0, 10.5);
    path.lineTo(7.0, 10.52);
    return path;
}

/// A place that is crossed out, in a box of 16.
QPainterPath hiddenPath() {
    QPainterPath path;
    // The head of the drop, an arc of radius 4.7 from (4.3, 3.9) to (12.7, 6.4).
    path.moveTo(4.3, 3.9);
    path.arcTo(3.315, 2.079, 9.4, 9.4, 142.2, -137.6);
    path.cubicTo(12.7, 7.4, 12.3, 8.5, 11.6, 9.7);
    path.moveTo(10.0, 11.9);
    path.lineTo(8.0, 14.2);
    path.cubicTo(5.5, 11.6, 3.3, 8.7, 3.3, 6.4);
    path.moveTo(2.0, 2.0);
    path.lineTo(14.0, 14.0);
    return path;
}

}  // namespace

StatusLine::StatusLine(QWidget* parent)
    : PlainWidget(parent),
      words_(new StatusWords(this)),
      help_(new Button(Button::Kind::Line, {}, Icon::None, parent == nullptr ? this : parent)),
      palette_(&linux_::Palette::of(linux_::ColorScheme::Light)) {
    words_->setTextFormat(Qt::PlainText);
    help_->hide();
    refreshFont();
}

void StatusLine::refreshFont() {
    lineHeight_ = static_cast<int>(std::ceil(platform::preferredFont(platform::TextStyle::Footnote).lineHeight()));
    words_->setContentsMargins(0, overhang(), 0, overhang());
    words_->update();
    help_->refresh();
}

void StatusLine::place(const QRect& lines) {
    setGeometry(lines.adjusted(0, -overhang(), 0, overhang()));
    const int across = help_->naturalWidth();
    const int high = help_->shapeHeight(across);
    const int x = layoutDirection() == Qt::RightToLeft ? lines.left() + kHelpEnd
                                                       : lines.left() + lines.width() - kHelpEnd - across;
    help_->placeShape({x, lines.top() + (lineHeight_ - high) / 2, across, high});
}

int StatusLine::helpRoom() const {
    return help_->words().isEmpty() ? 0 : help_->naturalWidth() + kHelpEnd;
}

void StatusLine::setHelp(const QString& words, const QString& otherwise) {
    if (help_->words() != words) {
        help_->setWords(words);
        showHelp();
    }
    if (const QString& name = words.isEmpty() ? otherwise : words; help_->accessibleName() != name) {
        help_->setAccessibleName(name);
    }
}

void StatusLine::showHelp() {
    help_->setVisible(isVisible() && !help_->words().isEmpty());
}

void StatusLine::showEvent(QShowEvent*) {
    showHelp();
}

void StatusLine::hideEvent(QHideEvent*) {
    help_->hide();
}

bool StatusLine::isPlaced() const {
    return height() == heightForWidth(width()) + 2 * overhang();
}

int StatusLine::heightForWidth(int width) const {
    return std::max(lineHeight_, words_->heightForWidth(width - kWords - helpRoom()));
}

void StatusLine::setStatus(const host::LiveStatus& status) {
    const QString words = QString::fromStdString(status.words);
    if (words_->text() != words) {
        words_->setText(words);
    }
    if (mark_ != status.mark) {
        mark_ = status.mark;
        update();
    }
}

void StatusLine::setColors(const linux_::Palette& palette) {
    palette_ = &palette;
    words_->setColors(palette);
    help_->setLook({&palette, help_->look().isStill});
    update();
}

void StatusLine::resizeEvent(QResizeEvent*) {
    const bool mirrored = layoutDirection() == Qt::RightToLeft;
    const int room = helpRoom();
    words_->setGeometry(mirrored ? room : kWords, 0, std::max(width() - kWords - room, 0), height());
}

void StatusLine::paintEvent(QPaintEvent*) {
    QPainter painter(this);
    painter.setRenderHint(QPainter::Antialiasing);
    const bool mirrored = layoutDirection() == Qt::RightToLeft;
    // Beside the first line.
    const QPointF centre(mirrored ? width() - kMarkCentre : kMarkCentre, overhang() + lineHeight_ / 2.0 + 0.5);
    switch (mark_) {
        case host::LiveStatus::Mark::Live:
            painter.setPen(Qt::NoPen);
            painter.setBrush(palette_->pine);
            painter.drawEllipse(centre, kDot / 2.0, kDot / 2.0);
            break;
        case host::LiveStatus::Mark::Waiting:
            painter.setPen(QPen(palette_->inkSoft, kRingStroke));
            painter.drawEllipse(centre, (kDot - kRingStroke) / 2.0, (kDot - kRingStroke) / 2.0);
            break;
        case host::LiveStatus::Mark::Warning:
            painter.translate(centre - QPointF(kWarning / 2.0, kWarning / 2.0));
            painter.setPen(QPen(palette_->warning, kWarningStroke, Qt::SolidLine, Qt::RoundCap, Qt::RoundJoin));
            painter.drawPath(warningPath());
            break;
        case host::LiveStatus::Mark::Hidden:
            painter.translate(centre - QPointF(kHidden / 2.0, kHidden / 2.0));
            painter.setPen(QPen(palette_->inkSoft, kHiddenStroke, Qt::SolidLine, Qt::RoundCap, Qt::RoundJoin));
            painter.drawPath(hiddenPath());
            break;
        case host::LiveStatus::Mark::None:
            break;
    }
}

}  // namespace ktr::app
