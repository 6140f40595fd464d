#pragma once

#include <memory>
#include <vector>

#include "host/conversation/FadeView.h"
#include "host/conversation/Offer.h"
#include "host/conversation/OfferView.h"

namespace ktr::host {

/// What can be done about an answer: buttons and people side by side where they fit, else below each other; questions
/// that can be asked at the end edge, with a title above them. Main thread.
class OffersView : public FadeView {
  public:
    /// Around its content, for the ring of the keyboard's focus. Points.
    static constexpr double kAround = 6.0;

    bool initWithFrame(const platform::Rect& frame) override;
    void setOffers(const Offers& offers);
    /// Takes the fonts that fit the text size of now.
    void chooseFonts() { setOffers(Offers(given_)); }
    const std::vector<std::shared_ptr<OfferView>>& offers() const { return offers_; }
    bool isEmpty() const { return offers_.empty() && title_->hidden() && note_->hidden(); }
    /// Whether its offers are questions, which stand at the end.
    bool asksOn() const;
    void setPalette(const linux_::Palette& palette);
    /// Lays the content out in this width, at the end edge or else where offers of their kind stand; its height,
    /// points. The view's frame is larger by `kAround` on every side.
    double layOut(double width, bool atEnd);
    /// Which of its offers has the keyboard's focus, and which the pointer; of others nothing is marked.
    void mark(const platform::View* focused, const platform::View* hovered);

    platform::AccessibilityRole accessibilityRole() const override { return platform::AccessibilityRole::Group; }
    std::string accessibilityText() const override { return ""; }

  protected:
    void draw(platform::Canvas& canvas) const override;

  private:
    double layOutPills(double width, double top, bool atEnd);

    Offers given_;
    std::vector<std::shared_ptr<OfferView>> offers_;
    std::shared_ptr<platform::Label> title_;
    std::shared_ptr<platform::Label> note_;
    std::weak_ptr<platform::View> focused_;
    const linux_::Palette* palette_ = nullptr;
};

}  // namespace ktr::host
