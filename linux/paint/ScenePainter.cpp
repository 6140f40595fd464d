#include "linux/paint/ScenePainter.h"

#include <QBuffer>
#include <QHashFunctions>
#include <QPageSize>
#include <QPainter>
#include <QPdfWriter>
#include <QSvgGenerator>
#include <algorithm>
#include <array>
#include <cmath>
#include <cstddef>
#include <future>

#include "linux/paint/PngEncoder.h"

namespace ktr::linux_ {

namespace {

/// Of a picture that is painted band by band: some 4 MB each.
constexpr int kBandPixels = 1000000;
constexpr int kLeastBand = 64;

int pixels(double points, double scale) {
    return static_cast<int>(std::ceil(points * scale - 1e-6));
}

std::string numbered(int width, int height) {
    return std::to_string(width) + " x " + std::to_string(height) + " pixels";
}

bool hasRightToLeft(const QString& text) {
    return std::any_of(text.begin(), text.end(), [](QChar c) {
        const QChar::Direction direction = c.direction();
        return direction == QChar::DirR || direction == QChar::DirAL;
    });
}

/// Each text stands for itself in an SVG file, where it is read from left to right: what is not begins with a mark that
/// says so, or its full stop would come out at the wrong end.
QByteArray withDirections(const QByteArray& svg) {
    constexpr char16_t kRightToLeft = 0x202B;
    constexpr char16_t kEnd = 0x202C;
    QByteArray made;
    made.reserve(svg.size());
    qsizetype done = 0;
    for (qsizetype at = svg.indexOf("<text"); at >= 0; at = svg.indexOf("<text", done)) {
        const qsizetype begin = svg.indexOf('>', at) + 1;
        const qsizetype end = svg.indexOf("</text>", begin);
        if (begin <= 0 || end < 0) {
            break;
        }
        const QString text = QString::fromUtf8(svg.mid(begin, end - begin));
        made += svg.mid(done, begin - done);
        made += hasRightToLeft(text) ? (QChar(kRightToLeft) + text + QChar(kEnd)).toUtf8() : text.toUtf8();
        done = end;
    }
    return made + svg.mid(done);
}

class FixedHashes {
  public:
    FixedHashes() { QHashSeed::setDeterministicGlobalSeed(); }
    ~FixedHashes() { QHashSeed::resetRandomGlobalSeed(); }
    FixedHashes(const FixedHashes&) = delete;
    FixedHashes& operator=(const FixedHashes&) = delete;
};

/// The creation date in a PDF would make each run's file another one.
QByteArray withoutDates(QByteArray pdf) {
    for (const QByteArray& key : {QByteArray("/CreationDate (D:"), QByteArray("/ModDate (D:")}) {
        const qsizetype at = pdf.indexOf(key);
        if (at < 0) {
            continue;
        }
        for (qsizetype i = at + key.size(); i < pdf.size() && pdf[i] != ')'; ++i) {
            if (pdf[i] >= '0' && pdf[i] <= '9') {
                pdf[i] = '0';
            }
        }
    }
    return pdf;
}

}  // namespace

ScenePainter::ScenePainter(platform::Size size, double scale, const Palette& palette)
    : size_(size), scale_(scale), palette_(palette), background_(palette.window) {}

std::optional<std::string> ScenePainter::refusal() const {
    if (!(scale_ > 0.0) || !(size_.width > 0.0) || !(size_.height > 0.0) || !std::isfinite(size_.width * scale_) ||
        !std::isfinite(size_.height * scale_)) {
        return "there is nothing to draw";
    }
    if (size_.width * scale_ > kMostPixels || size_.height * scale_ > kMostPixels) {
        const bool countable = size_.width * scale_ < 1e9 && size_.height * scale_ < 1e9;
        return (countable
                    ? "the picture would be " + numbered(pixels(size_.width, scale_), pixels(size_.height, scale_))
                    : std::string("the picture is far too large")) +
               "; at most " + std::to_string(kMostPixels) + " a side can be drawn. A smaller scale may help";
    }
    return std::nullopt;
}

void ScenePainter::paintOn(QPaintDevice& device, double painterScale, double pixelsPerDeviceUnit, const Paint& paint,
                           int top) const {
    QPainter painter(&device);
    painter.translate(0.0, -top);
    painter.setRenderHints(QPainter::Antialiasing | QPainter::TextAntialiasing | QPainter::SmoothPixmapTransform);
    painter.scale(painterScale, painterScale);
    QtCanvas canvas(painter, palette_, pixelsPerDeviceUnit);
    if (background_.alpha() > 0) {
        painter.fillRect(QRectF(0, 0, size_.width + 1.0, size_.height + 1.0), background_);
    }
    paint(canvas);
}

QImage ScenePainter::image(const Paint& paint) const {
    if (refusal()) {
        return {};
    }
    QImage image(pixels(size_.width, scale_), pixels(size_.height, scale_), QImage::Format_ARGB32_Premultiplied);
    if (image.isNull()) {
        return image;
    }
    image.fill(Qt::transparent);
    paintOn(image, scale_, 1.0, paint);
    return image;
}

QByteArray ScenePainter::svg(const Paint& paint) const {
    QByteArray data;
    QBuffer buffer(&data);
    buffer.open(QIODevice::WriteOnly);
    QSvgGenerator generator;
    generator.setOutputDevice(&buffer);
    const QSize whole(pixels(size_.width, 1.0), pixels(size_.height, 1.0));
    generator.setSize(whole);
    generator.setViewBox(QRect(QPoint(0, 0), whole));
    generator.setResolution(96);
    generator.setTitle(title_);
    paintOn(generator, 1.0, scale_, paint);
    return withDirections(data);
}

QByteArray ScenePainter::pdf(const Paint& paint) const {
    // Fonts stand in the file in the order of a hash: with a random seed each run would write another file.
    const FixedHashes fixed;
    QByteArray data;
    QBuffer buffer(&data);
    buffer.open(QIODevice::WriteOnly);
    {
        QPdfWriter writer(&buffer);
        writer.setTitle(title_);
        writer.setCreator(QStringLiteral("ktr"));
        const QPageSize page(QSizeF(size_.width, size_.height), QPageSize::Point, QString(), QPageSize::ExactMatch);
        writer.setPageSize(page);
        writer.setPageMargins(QMarginsF(0, 0, 0, 0));
        // A resolution above 72 keeps hairlines and letters in their places; the painter's unit stays the point.
        constexpr int kResolution = 720;
        writer.setResolution(kResolution);
        const double unitsPerPoint = kResolution / 72.0;
        paintOn(writer, unitsPerPoint, scale_ / unitsPerPoint, paint);
    }
    return withoutDates(std::move(data));
}

QByteArray ScenePainter::png(const Paint& paint) const {
    const int width = pixels(size_.width, scale_);
    const int height = pixels(size_.height, scale_);
    const int most = std::clamp(kBandPixels / width, kLeastBand, std::max(kLeastBand, height));
    PngEncoder encoder(width, height, background_.alpha() == 0xFF);
    // While one band is painted the one before it is packed, which takes several times as long; where no thread is to
    // be had this one packs it.
    std::array<QImage, 2> bands;
    std::future<void> packed;
    for (int top = 0; top < height; top += most) {
        QImage& band = bands[static_cast<std::size_t>(top / most % 2)];
        if (band.isNull()) {
            band = QImage(width, std::min(most, height - top), QImage::Format_ARGB32_Premultiplied);
        }
        if (band.isNull()) {
            break;
        }
        band.fill(Qt::transparent);
        paintOn(band, scale_, 1.0, paint, top);
        if (packed.valid()) {
            packed.get();
        }
        packed = std::async([&encoder, &band, rows = std::min(most, height - top)] { encoder.add(band, rows); });
    }
    if (packed.valid()) {
        packed.get();
    }
    return encoder.file();
}

std::optional<std::string> ScenePainter::add(const std::string& path, const Paint& paint,
                                             documents::StagedFiles& files) const {
    if (const auto reason = refusal()) {
        return path + ": " + *reason;
    }
    const QString name = QString::fromStdString(path);
    const QString format = name.section(u'.', -1).toLower();
    const bool known = format == u"png" || format == u"svg" || format == u"pdf";
    if (!known || !name.contains(u'.')) {
        return path + ": the name must end in .png, .svg or .pdf";
    }
    // Before the work of drawing, not after it.
    if (auto problem = documents::StagedFiles::refusal(path); !problem.empty()) {
        return problem;
    }
    const QByteArray data = format == u"png" ? png(paint) : format == u"svg" ? svg(paint) : pdf(paint);
    if (data.isEmpty()) {
        return path + ": there is not enough memory for the picture";
    }
    const auto problem = files.add(path, {data.constData(), static_cast<std::size_t>(data.size())});
    return problem.empty() ? std::nullopt : std::optional(problem);
}

std::optional<std::string> ScenePainter::write(const std::string& path, const Paint& paint) const {
    documents::StagedFiles files;
    if (auto problem = add(path, paint, files)) {
        return problem;
    }
    const auto problem = files.commit();
    return problem.empty() ? std::nullopt : std::optional(problem);
}

ScenePainter::Paint ScenePainter::view(const std::shared_ptr<platform::View>& view) {
    return [view](QtCanvas& canvas) {
        if (view) {
            view->layoutIfNeeded();
            view->paint(canvas, view->bounds());
        }
    };
}

}  // namespace ktr::linux_
