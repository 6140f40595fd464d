#pragma once

#include <memory>
#include <string>

#include "host/conversation/Offer.h"
#include "linux/paint/Palette.h"
#include "platform/ui/Label.h"
#include "platform/ui/View.h"

namespace ktr::host {

/// One offer: a form with a pill's or a bubble's corners that can be pressed, reached by keys and read aloud. Main
/// thread.
class OfferView : public platform::View {
  public:
    /// Of a line's target, before and behind its words, points.
    static constexpr double kLineSide = 12.0;

    bool initWithFrame(const platform::Rect& frame) override;
    void setOffer(const Offer& offer);
    void setPalette(const linux_::Palette& palette);
    Offer::Kind kind() const { return offer_.kind; }
    const std::string& words() const { return offer_.words; }
    /// Its own size when it may be `most` wide; words that do not fit wrap.
    platform::Size sizeForWidth(double most) const;
    /// The pointer is over it.
    void setHovered(bool isHovered);
    /// Of its corners, points; what lies around the form is the parent's to paint.
    double corner() const;

    void layoutSubviews() override;
    platform::AccessibilityRole accessibilityRole() const override { return platform::AccessibilityRole::Link; }
    std::string accessibilityText() const override { return offer_.words; }
    void touchesBegan(const platform::Touches& touches, const platform::TouchEvent& event) override;
    void touchesEnded(const platform::Touches& touches, const platform::TouchEvent& event) override;
    void touchesCancelled(const platform::Touches& touches, const platform::TouchEvent& event) override;

  protected:
    void draw(platform::Canvas& canvas) const override;

  private:
    /// Points: before and behind the words, above and below them, and the least height.
    struct Room {
        double before = 0.0;
        double behind = 0.0;
        double above = 0.0;
        double below = 0.0;
        double least = 0.0;
    };
    Room room() const;
    static platform::Font fontOf(Offer::Kind kind);
    void setDown(bool isDown);

    Offer offer_;
    std::shared_ptr<platform::Label> label_;
    bool isHovered_ = false;
    bool isDown_ = false;
};

}  // namespace ktr::host
