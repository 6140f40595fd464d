#include "linux/paint/NamedImage.h"

#include <QStringList>
#include <limits>
#include <tuple>

#include "linux/device/LinuxDevice.h"

namespace ktr::linux_ {

std::optional<NamedImage::Variant> NamedImage::Variant::parse(const QString& fileName) {
    const qsizetype dot = fileName.lastIndexOf(u'.');
    if (dot <= 0) {
        return std::nullopt;
    }
    QStringList parts = fileName.left(dot).split(u'~');
    Variant variant;
    variant.name = parts.takeFirst();
    const qsizetype at = variant.name.lastIndexOf(u'@');
    if (at > 0) {
        const QString scale = variant.name.mid(at + 1);
        bool number = false;
        variant.scale = scale.chopped(1).toDouble(&number);
        if (!scale.endsWith(u'x') || !number || !(variant.scale > 0.0) || variant.scale > 10.0) {
            return std::nullopt;
        }
        variant.name.truncate(at);
    }
    for (const QString& part : parts) {
        if (part == u"dark") {
            variant.dark = true;
        } else if (part == u"contrast") {
            variant.contrast = true;
        } else if (const auto idiom = LinuxDevice::idiomNamed(part.toStdString())) {
            variant.idiom = idiom;
        } else {
            return std::nullopt;
        }
    }
    return variant;
}

const NamedImage::Variant& NamedImage::variantFor(const Palette& palette, double scale) const {
    const bool dark = palette.scheme == ColorScheme::Dark;
    const bool contrast = palette.contrast == Contrast::High;
    const Variant* best = &variants_.front();
    auto bestRank = std::make_tuple(-1, -1, -1, 0.0);
    for (const Variant& variant : variants_) {
        if ((variant.dark && !dark) || (variant.contrast && !contrast)) {
            continue;
        }
        const bool enough = variant.scale >= scale;
        const int fit = variant.scale == 0.0 ? 1 : enough ? 2 : 0;
        const double near = enough ? -variant.scale : variant.scale;
        const auto rank = std::make_tuple(variant.dark ? 1 : 0, variant.contrast ? 1 : 0, fit, near);
        if (rank > bestRank) {
            bestRank = rank;
            best = &variant;
        }
    }
    return *best;
}

platform::Size NamedImage::size() const {
    return variantFor(Palette::of(ColorScheme::Light), std::numeric_limits<double>::max()).picture->size();
}

void NamedImage::draw(QPainter& painter, const QRectF& rect, const Palette& palette) const {
    variantFor(palette, pixelsPerUnit(painter)).picture->draw(painter, rect, palette);
}

}  // namespace ktr::linux_
