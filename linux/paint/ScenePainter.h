#pragma once

#include <QByteArray>
#include <QImage>
#include <QString>
#include <functional>
#include <memory>
#include <optional>
#include <string>

#include "documents/StagedFiles.h"
#include "linux/paint/Palette.h"
#include "linux/paint/QtCanvas.h"
#include "platform/base/Geometry.h"
#include "platform/ui/View.h"

namespace ktr::linux_ {

/// Makes pictures of views: pixels in memory, or a file. The same views give the same picture, run after run. Main
/// thread, while a QGuiApplication exists.
class ScenePainter {
  public:
    /// Paints the scene on a canvas whose coordinates are points. A PNG is painted band by band, so that it is called
    /// for each: QtCanvas::seen says which part is wanted.
    using Paint = std::function<void(QtCanvas&)>;

    /// Neither side of a picture may have more pixels.
    static constexpr int kMostPixels = 32000;

    /// `size` in points; `scale` is pixels a point (and the grid that a vector picture snaps to).
    ScenePainter(platform::Size size, double scale, const Palette& palette);

    /// What lies behind the scene; the palette's window colour unless set. A transparent colour leaves PNG and SVG
    /// transparent.
    void setBackground(const QColor& color) { background_ = color; }
    /// A title for the file; SVG and PDF only.
    void setTitle(const QString& title) { title_ = title; }

    /// Why no picture of this size and scale can be made, or none.
    std::optional<std::string> refusal() const;
    /// A null image when refused.
    QImage image(const Paint& paint) const;
    /// Draws the format that the file's name ends in, .png, .svg or .pdf (one page), and writes it beside its place; it
    /// takes that when `files` are committed. None, or an error that names the file and the reason.
    std::optional<std::string> add(const std::string& path, const Paint& paint, documents::StagedFiles& files) const;
    /// The same of one file alone, which appears whole or not at all.
    std::optional<std::string> write(const std::string& path, const Paint& paint) const;

    /// Lays out a view and gives the painting of it, at the scene's origin.
    static Paint view(const std::shared_ptr<platform::View>& view);

  private:
    /// From `top` pixels below the picture's top on, where the device is a band of it.
    void paintOn(QPaintDevice& device, double painterScale, double pixelsPerDeviceUnit, const Paint& paint,
                 int top = 0) const;
    QByteArray svg(const Paint& paint) const;
    QByteArray pdf(const Paint& paint) const;
    QByteArray png(const Paint& paint) const;

    platform::Size size_;
    double scale_;
    const Palette& palette_;
    QColor background_;
    QString title_;
};

}  // namespace ktr::linux_
