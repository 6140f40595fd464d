#include "linux/paint/SvgImage.h"

#include <QPainter>
#include <QXmlStreamReader>
#include <algorithm>

namespace ktr::linux_ {

namespace {

/// Whether a drawing stands by itself: read before the renderer sees it, which would follow what it refers to.
bool standsByItself(const QByteArray& source) {
    QXmlStreamReader reader(source);
    while (!reader.atEnd()) {
        const auto token = reader.readNext();
        if (token == QXmlStreamReader::DTD) {
            return false;
        }
        if (token != QXmlStreamReader::StartElement) {
            continue;
        }
        const auto name = reader.name();
        if (name == u"image" || name == u"script" || name == u"foreignObject" || name == u"video" || name == u"audio") {
            return false;
        }
        const auto attributes = reader.attributes();
        const bool refersInside = std::all_of(attributes.begin(), attributes.end(), [](const auto& attribute) {
            return attribute.name() != u"href" || attribute.value().startsWith(u'#');
        });
        if (!refersInside) {
            return false;
        }
    }
    return !reader.hasError();
}

}  // namespace

std::shared_ptr<SvgImage> SvgImage::fromSource(const QByteArray& source) {
    if (source.size() > kMostBytes || !standsByItself(source)) {
        return nullptr;
    }
    auto image = std::shared_ptr<SvgImage>(new SvgImage);
    if (!image->renderer_.load(source)) {
        return nullptr;
    }
    const QSize size = image->renderer_.defaultSize();
    return size.isEmpty() || size.width() > kMostSide || size.height() > kMostSide ? nullptr : image;
}

platform::Size SvgImage::size() const {
    const QSize size = renderer_.defaultSize();
    return {static_cast<double>(size.width()), static_cast<double>(size.height())};
}

void SvgImage::draw(QPainter& painter, const QRectF& rect, const Palette& /*palette*/) const {
    painter.save();
    painter.setRenderHint(QPainter::Antialiasing);
    renderer_.render(&painter, rect);
    painter.restore();
}

}  // namespace ktr::linux_
