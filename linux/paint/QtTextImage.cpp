#include "linux/paint/QtTextImage.h"

#include <QPainter>
#include <cmath>

#include "linux/paint/QtTextLayout.h"
#include "platform/base/MainLoop.h"
#include "platform/base/Platform.h"

namespace ktr::linux_ {

namespace {

/// Four bytes each. A row that fills a large screen has some two million.
constexpr double kMostPixels = 8e6;
constexpr double kSameScale = 1e-6;

}  // namespace

QtTextImage::QtTextImage(std::shared_ptr<const platform::TextLayout> layout, const platform::Size& size, double scale,
                         std::shared_ptr<LastPalette> lastPalette)
    : TextImage(std::move(layout), size), lastPalette_(std::move(lastPalette)) {
    pixels_ = make(scale, **lastPalette_);
    wanted_ = {{}, pixels_.scale, pixels_.palette};
}

QtTextImage::Pixels QtTextImage::make(double scale, const Palette& palette) const {
    Pixels made{{}, scale, &palette};
    const double width = std::ceil(size().width * scale - kSameScale);
    const double height = std::ceil(size().height * scale - kSameScale);
    const auto* text = dynamic_cast<const QtTextLayout*>(&layout());
    if (!(width >= 1.0) || !(height >= 1.0) || width * height > kMostPixels || text == nullptr ||
        text->lines().empty()) {
        return made;
    }
    QImage image(static_cast<int>(width), static_cast<int>(height), QImage::Format_ARGB32_Premultiplied);
    image.fill(Qt::transparent);
    QPainter painter(&image);
    painter.setRenderHints(QPainter::Antialiasing | QPainter::TextAntialiasing);
    painter.scale(scale, scale);
    // Baselines stand on whole pixels, as they do when the text itself is drawn.
    const double baseline = text->lines().front().baseline;
    const double shift = std::floor(baseline * scale + 0.5 + kSameScale) / scale - baseline;
    text->draw(painter, QPointF(0.0, shift), palette.ink, palette);
    painter.end();
    made.image = std::move(image);
    return made;
}

bool QtTextImage::drawPixels(QPainter& painter, QPointF topLeft, double scale, const Palette& shown) const {
    // What a window paints with may change, or go, while pixels are made in the background; what it was made of never
    // does, and has the same colours of texts.
    const Palette& palette = Palette::of(shown.scheme, shown.contrast);
    lastPalette_->store(&palette);
    if (pixels_.palette != &palette || std::abs(pixels_.scale - scale) > kSameScale) {
        makeInBackground(scale, palette);
        return false;
    }
    if (pixels_.image.isNull()) {
        return false;
    }
    const QRectF place(topLeft, QSizeF(pixels_.image.size()) / scale);
    painter.drawImage(place, pixels_.image);
    return true;
}

void QtTextImage::makeInBackground(double scale, const Palette& palette) const {
    const auto installed = platform::Platform::installed();
    const auto self = std::static_pointer_cast<const QtTextImage>(weak_from_this().lock());
    if (!self || !installed || !installed->mainLoop ||
        (wanted_.palette == &palette && std::abs(wanted_.scale - scale) <= kSameScale)) {
        return;
    }
    wanted_ = {{}, scale, &palette};
    // The loop outlives the work that it runs, and must not be ended by it.
    installed->mainLoop->runInBackground(
        [weak = std::weak_ptr(self), scale, colors = &palette, loop = installed->mainLoop.get()] {
            const auto image = weak.lock();
            if (!image) {
                return;
            }
            loop->post([weak, made = image->make(scale, *colors)] {
                const auto shown = weak.lock();
                if (shown && shown->wanted_.palette == made.palette && shown->wanted_.scale == made.scale) {
                    shown->pixels_ = made;
                }
            });
        });
}

}  // namespace ktr::linux_
