#include "linux/paint/ImageDecoder.h"

#include <QIODevice>
#include <QImageReader>
#include <QTransform>
#include <algorithm>
#include <cstring>

#include "documents/ComputingTime.h"

namespace ktr::linux_ {

namespace {

/// Hands data out until the time is up, and ends then as if the data did.
class TimedData final : public QIODevice {
  public:
    TimedData(const platform::Bytes& data, std::chrono::nanoseconds time)
        : data_(data), deadline_(documents::computingTime() + time) {
        open(QIODevice::ReadOnly);
    }

    bool isLate() const { return isLate_; }
    bool isSequential() const override { return true; }

  protected:
    qint64 readData(char* to, qint64 most) override {
        isLate_ = isLate_ || documents::computingTime() >= deadline_;
        if (isLate_) {
            return -1;
        }
        // All that is asked for, which is little: Qt's reader of PNG takes nothing less well.
        const std::size_t piece = std::min(data_.size() - at_, static_cast<std::size_t>(most));
        std::memcpy(to, data_.data() + at_, piece);
        at_ += piece;
        return piece == 0 && most > 0 ? -1 : static_cast<qint64>(piece);
    }
    qint64 writeData(const char* /*from*/, qint64 /*size*/) override { return -1; }

  private:
    const platform::Bytes& data_;
    std::size_t at_ = 0;
    std::chrono::nanoseconds deadline_;
    bool isLate_ = false;
};

/// As it was held when the picture was taken.
QImage upright(const QImage& stored, int orientation) {
    constexpr int kMirrored[] = {2, 4, 5, 7};
    const bool isMirrored = std::find(std::begin(kMirrored), std::end(kMirrored), orientation) != std::end(kMirrored);
    QImage image = isMirrored ? stored.mirrored(true, false) : stored;
    switch (orientation) {
        case 3:
        case 4:
            return image.mirrored(true, true);
        case 6:
        case 7:
            return image.transformed(QTransform().rotate(90.0));
        case 5:
        case 8:
            return image.transformed(QTransform().rotate(270.0));
        default:
            return image;
    }
}

}  // namespace

std::optional<ImageDecoder::Picture> ImageDecoder::decode(const platform::Bytes& data, int longest,
                                                          std::chrono::nanoseconds time) {
    const auto picture = longest < 1 ? std::nullopt : PictureData::of(data);
    if (!picture) {
        return std::nullopt;
    }
    TimedData source(picture->essential, time);
    QImageReader reader(&source, picture->format == PictureData::Format::Png ? "png" : "jpeg");
    reader.setAutoDetectImageFormat(false);
    const QSize size(picture->width, picture->height);
    if (reader.size() != size) {
        return std::nullopt;
    }
    if (std::max(size.width(), size.height()) > longest) {
        reader.setScaledSize(size.scaled(longest, longest, Qt::KeepAspectRatio).expandedTo(QSize(1, 1)));
    }
    const QImage pixels = reader.read();
    if (pixels.isNull() || source.isLate()) {
        return std::nullopt;
    }
    constexpr int kFirstTurned = 5;
    return Picture{upright(pixels, picture->orientation),
                   picture->orientation < kFirstTurned ? size : size.transposed()};
}

}  // namespace ktr::linux_
