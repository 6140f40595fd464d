#pragma once

#include <functional>
#include <memory>

#include "host/conversation/FadeView.h"
#include "host/conversation/OfferView.h"
#include "platform/ui/Label.h"

namespace ktr::host {

/// The line under a card whose map has no streets: that there are none, and what gets some. Side by side, or one below
/// the other where the words would have too little room. Main thread.
class StreetsLine : public FadeView {
  public:
    bool initWithFrame(const platform::Rect& frame) override;
    /// Called by a press.
    void setGet(std::function<void()> get);
    /// Takes the words of the language of now, and the fonts that fit the text size.
    void renew();
    void setPalette(const linux_::Palette& palette);
    /// What it needs where it is so wide, points.
    double heightForWidth(double width) const;
    /// Which view has the keyboard's focus, and which the pointer.
    void mark(const platform::View* focused, const platform::View* hovered);
    const std::shared_ptr<OfferView>& action() const { return action_; }

    void layoutSubviews() override;
    platform::AccessibilityRole accessibilityRole() const override { return platform::AccessibilityRole::Group; }
    std::string accessibilityText() const override { return ""; }

  protected:
    void draw(platform::Canvas& canvas) const override;

  private:
    /// Not mirrored.
    struct Places {
        platform::Rect words;
        platform::Rect action;
        double height = 0.0;
    };
    Places placesFor(double width) const;

    std::function<void()> get_;
    std::shared_ptr<platform::Label> words_;
    std::shared_ptr<OfferView> action_;
    const linux_::Palette* palette_ = nullptr;
    bool isFocused_ = false;
};

}  // namespace ktr::host
