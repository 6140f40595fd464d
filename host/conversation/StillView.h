#pragma once

#include <QImage>
#include <array>
#include <functional>
#include <memory>
#include <optional>
#include <string>
#include <vector>

#include "linux/paint/Palette.h"
#include "platform/base/Url.h"
#include "platform/ui/View.h"

namespace ktr::host {

/// What stays of a card when its controller goes: how it looked, what a screen reader said of it, and where a tap led.
/// It asks nothing and changes no more. Main thread.
class StillView : public platform::View {
  public:
    /// Pixels of a side of the picture; a card that is larger is kept coarser.
    static constexpr double kMostPixels = 8000.0;

    /// What a tap does.
    using Open = std::function<void(const platform::Url&)>;

    /// Takes the picture of a view that is laid out, in each palette, `scale` pixels a point. Every part of it that
    /// could be pressed leads to `page` from now on; none: a tap does nothing.
    static std::shared_ptr<StillView> of(const std::shared_ptr<platform::View>& view, double scale, bool rightToLeft,
                                         const std::optional<platform::Url>& page, const Open& open);

    /// The picture's own height, or less where it has to shrink to fit in; points. The picture stands at the leading
    /// edge.
    double heightForWidth(double width) const;
    void layoutSubviews() override;

  protected:
    void draw(platform::Canvas& canvas) const override;

  private:
    class Part;
    static std::size_t indexOf(const linux_::Palette& palette);
    void addPart(const platform::AccessibilityNode& node, const std::function<void()>& tapped);
    /// Of the picture as it is shown to the picture as it was taken.
    double shrink() const;
    /// The picture's rectangle in the view.
    platform::Rect place() const;

    platform::Size size_;
    bool rightToLeft_ = false;
    /// By `indexOf`: the desktop may wish for another scheme or contrast when there is nothing left to draw.
    std::array<QImage, 4> pictures_;
    std::vector<std::shared_ptr<Part>> parts_;
};

}  // namespace ktr::host
