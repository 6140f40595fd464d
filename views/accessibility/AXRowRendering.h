#pragma once

#include <cstdint>
#include <memory>
#include <optional>
#include <vector>

#include "platform/text/StyledTextRenderer.h"
#include "platform/ui/ImageView.h"
#include "views/KTRVelaBaseView.h"
#include "views/accessibility/AXRowTexts.h"

namespace ktr {

/// The picture of an accessibility row's texts: rendered in the background, shown on the main thread. An older
/// rendering never replaces a newer one, and one that comes when the row is gone ends silently. Main thread.
class AXRowRendering : public platform::Object {
  public:
    /// Makes the image view, and the renderer of the installed platform.
    bool initForRow(const KTRVelaBaseView& row);

    const std::shared_ptr<platform::ImageView>& imageView() const { return imageView_; }
    void setImageView(std::shared_ptr<platform::ImageView> view) { imageView_ = std::move(view); }
    /// None: nothing is rendered, and the row has no image.
    const std::shared_ptr<platform::StyledTextRenderer>& renderer() const { return renderer_; }
    void setRenderer(std::shared_ptr<platform::StyledTextRenderer> renderer) { renderer_ = std::move(renderer); }

    /// Renders the texts at the image view's width, or, before its first layout, at the row's width without the
    /// margins; where that leaves nothing, it waits to be asked again once there is a layout. Then shows the image, or
    /// none, and tells the row's view delegate.
    void render(const KTRVelaBaseView& row, AXRowTexts texts, std::vector<platform::Rect> exclusionPaths);
    /// The row was laid out, and what was rendered for another width, or waits for one, has to be rendered.
    bool isDue(const KTRVelaBaseView& row) const;

    /// What keeps the text clear of the avatar: a rectangle at the leading edge. Points, in the image's coordinates.
    static std::vector<platform::Rect> exclusionPaths(const KTRVelaBaseView& row);
    /// The height of a row whose texts are measured, not rendered: with the margins and the separator, points.
    static double measuredHeight(const KTRVelaBaseView& row, const platform::AttributedString& text);

  private:
    struct Input {
        AXRowTexts texts;
        double width = 0.0;
        platform::StyledTextOptions options;
        bool operator==(const Input&) const = default;
    };
    struct Rendered {
        Input input;
        std::shared_ptr<platform::TextImage> image;
    };

    double widthFor(const KTRVelaBaseView& row) const;
    void install(const KTRVelaBaseView& row, std::uint64_t generation, std::shared_ptr<const Rendered> rendered);

    std::shared_ptr<platform::ImageView> imageView_;
    std::shared_ptr<platform::StyledTextRenderer> renderer_;
    std::shared_ptr<const Rendered> last_;
    std::uint64_t started_ = 0;
    std::uint64_t installed_ = 0;
    /// Of what was asked for last; none before, and 0 while it waits for a layout.
    std::optional<double> width_;
};

}  // namespace ktr
