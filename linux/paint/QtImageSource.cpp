#include "linux/paint/QtImageSource.h"

#include <QDir>
#include <QImage>

#include "documents/FileReader.h"
#include "linux/paint/ImageDecoder.h"
#include "linux/paint/RasterImage.h"
#include "linux/paint/SvgImage.h"
#include "platform/base/LogArea.h"

namespace ktr::linux_ {

namespace {

/// More than a picture in a snippet shows.
constexpr int kLongestSide = 2048;

std::shared_ptr<const QtImage> pictureOf(const QString& path, double scale) {
    const auto read = documents::FileReader::read(path.toStdString(), {PictureData::kMostBytes, {}});
    const auto* data = std::get_if<std::string>(&read);
    if (data == nullptr) {
        return nullptr;
    }
    if (path.endsWith(u".svg")) {
        return SvgImage::fromSource(QByteArray::fromStdString(*data));
    }
    const auto picture = ImageDecoder::decode(platform::Bytes(data->begin(), data->end()), kLongestSide);
    if (!picture) {
        return nullptr;
    }
    const double pixels = scale > 0.0 ? scale : 1.0;
    return std::make_shared<RasterImage>(
        picture->pixels, platform::Size{picture->original.width() / pixels, picture->original.height() / pixels});
}

}  // namespace

QtImageSource::QtImageSource(const std::string& folder, std::shared_ptr<platform::Device> device)
    : device_(std::move(device)) {
    const QDir root(QString::fromStdString(folder));
    for (const QString& bundle : root.entryList(QDir::Dirs | QDir::NoDotAndDotDot, QDir::Name)) {
        readBundle(root.filePath(bundle), bundle.toStdString());
    }
}

void QtImageSource::readBundle(const QString& folder, const std::string& bundle) {
    const QDir dir(folder);
    for (const QString& name :
         dir.entryList({QStringLiteral("*.svg"), QStringLiteral("*.png")}, QDir::Files, QDir::Name)) {
        auto variant = NamedImage::Variant::parse(name);
        if (variant) {
            variant->picture = pictureOf(dir.filePath(name), variant->scale);
        }
        if (!variant || !variant->picture) {
            platform::areaLog(platform::LogArea::Paint)
                .line("The image %@ of %@ cannot be used", name.toStdString(), bundle);
            continue;
        }
        const Key key{bundle, variant->name.toStdString()};
        variants_[key].push_back(std::move(*variant));
    }
}

std::shared_ptr<platform::Image> QtImageSource::imageNamed(const std::string& name,
                                                           const std::string& bundleIdentifier) {
    const Key key{bundleIdentifier, name};
    const auto found = variants_.find(key);
    if (found == variants_.end()) {
        return nullptr;
    }
    const auto idiom = device_ ? device_->userInterfaceIdiom() : std::nullopt;
    auto& image = images_[{key, idiom ? static_cast<int>(*idiom) : -1}];
    if (image) {
        return image;
    }
    std::vector<NamedImage::Variant> own;
    std::vector<NamedImage::Variant> any;
    for (const auto& variant : found->second) {
        if (!variant.idiom) {
            any.push_back(variant);
        } else if (variant.idiom == idiom) {
            own.push_back(variant);
        }
    }
    if (own.empty() && any.empty()) {
        return nullptr;
    }
    image = std::make_shared<NamedImage>(own.empty() ? std::move(any) : std::move(own));
    return image;
}

std::shared_ptr<platform::Image> QtImageSource::imageFromData(const platform::Bytes& data) {
    const auto picture = ImageDecoder::decode(data, kLongestSide);
    if (!picture) {
        return nullptr;
    }
    return std::make_shared<RasterImage>(picture->pixels,
                                         platform::Size{static_cast<double>(picture->original.width()),
                                                        static_cast<double>(picture->original.height())});
}

}  // namespace ktr::linux_
