#pragma once

#include <QString>
#include <memory>
#include <optional>
#include <vector>

#include "linux/paint/QtImage.h"
#include "platform/ui/Device.h"

namespace ktr::linux_ {

/// One picture in the variants that a bundle has of it. Which variant is shown is decided when it is painted, by the
/// palette and the device's pixels: an image that is kept follows light and dark. Main thread.
class NamedImage final : public QtImage {
  public:
    /// A file of the bundle. Its name tells what it is for: NAME[@SCALEx][~IDIOM][~dark][~contrast].svg (or .png),
    /// IDIOM being phone, tablet, desktop or display. `location~dark.svg` is for dark appearances, `icon@1x.svg` for
    /// screens of one pixel a point. Of a PNG the scale (1 without one) says how many pixels make a point.
    struct Variant {
        QString name;
        /// 0: any.
        double scale = 0.0;
        std::optional<platform::UserInterfaceIdiom> idiom;
        bool dark = false;
        bool contrast = false;
        std::shared_ptr<const QtImage> picture;

        /// None for a name with an unknown part.
        static std::optional<Variant> parse(const QString& fileName);
    };

    /// At least one variant. Only those of one idiom (or of none) are meant to be given.
    explicit NamedImage(std::vector<Variant> variants) : variants_(std::move(variants)) {}

    /// Points; that of the variant for light screens.
    platform::Size size() const override;
    void draw(QPainter& painter, const QRectF& rect, const Palette& palette) const override;

    /// The variant for an appearance and so many pixels a point: dark before contrast before scale. Of the scales the
    /// smallest that is enough, then one for any scale, then the largest.
    const Variant& variantFor(const Palette& palette, double scale) const;

  private:
    std::vector<Variant> variants_;
};

}  // namespace ktr::linux_
