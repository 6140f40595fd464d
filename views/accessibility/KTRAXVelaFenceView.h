#pragma once

#include <memory>
#include <string>
#include <vector>

#include "views/KTRVelaFenceView.h"
#include "views/accessibility/AXRowRendering.h"

namespace ktr {

/// One fence in very large text: the name and the sentence as one styled text, rendered in the background into a
/// picture that flows around the avatar; the location indicator is painted over its end. A tap does what it does on the
/// plain row, and a screen reader hears the same. Its labels are none, and its separator has no width. Main thread.
class KTRAXVelaFenceView : public KTRVelaFenceView {
  public:
    /// At an ordinary text size the base sets the view up already.
    bool initWithFrame(const platform::Rect& frame) override;
    void setupView() override;
    /// Looks the contact up for the avatar, and renders the row's text anew.
    void updateFenceView() override;
    /// Renders the text in the background; the image, or none, follows on the main thread, and the view delegate is
    /// told.
    virtual void generateImageForView();
    /// The name; below it the sentence.
    virtual platform::AttributedString attributedStringForView() const;
    /// What the text flows around.
    virtual std::vector<platform::Rect> exclusionPaths() const;
    /// The image's height with its margins once there is one, whatever the width; until then the text's measured
    /// height. Points.
    double estimagedHeightForView() override;
    /// Renders again when the width has changed.
    void layoutSubviews() override;

    /// As wide as the row without its margins; 0 high until it has its image.
    std::shared_ptr<platform::ImageView> imageView() const { return rendering_->imageView(); }
    void setImageView(std::shared_ptr<platform::ImageView> view) { rendering_->setImageView(std::move(view)); }
    /// Made with the view from the installed platform. None: the row has no image.
    std::shared_ptr<platform::StyledTextRenderer> renderer() const { return rendering_->renderer(); }
    void setRenderer(std::shared_ptr<platform::StyledTextRenderer> renderer) {
        rendering_->setRenderer(std::move(renderer));
    }

  private:
    AXRowTexts texts() const;

    /// Made by `setupView`.
    std::shared_ptr<AXRowRendering> rendering_;
};

}  // namespace ktr
