#pragma once

#include <memory>
#include <optional>

#include "host/conversation/RingView.h"
#include "host/conversation/StillView.h"
#include "platform/base/Timer.h"
#include "platform/host/HostSnippetViewController.h"
#include "platform/ui/ImageView.h"
#include "platform/ui/Label.h"
#include "platform/ui/View.h"

namespace ktr::host {

/// An answer: a header and the plugin's own view, cut to rounded corners. The highlight lies under the plugin's rows
/// and the focus ring over them; neither touches them. Main thread.
class CardView : public platform::View {
  public:
    bool initWithFrame(const platform::Rect& frame) override;

    /// Puts the controller's view under the header, and tells the controller that it appears.
    void setController(const std::shared_ptr<platform::HostSnippetViewController>& controller);
    /// None before an answer is there, and in a card that is a still.
    const std::shared_ptr<platform::HostSnippetViewController>& controller() const { return controller_; }
    /// Lets go of the controller and its view, which hears that it disappears. The header stays, over nothing.
    void letGo();
    /// Tells the controller that it disappears, or appears again, unless it was told so last. Its view stays.
    void setOnScreen(bool onScreen);
    bool isOnScreen() const { return isOnScreen_; }
    /// Puts a still in the place of the controller's view, which has been let go of.
    void setStill(const std::shared_ptr<StillView>& still);
    const std::shared_ptr<StillView>& still() const { return still_; }
    /// Takes the font that fits the text size of now.
    void chooseFont();
    /// Asks the controller for its height at this width and lays everything out; the card's height, points. The content
    /// has the height that the controller wants, or the one that its rows have, if that is larger. A card whose rows
    /// still wait for their images is folded: it is its header alone until they have them, for 0.25 seconds at most.
    double heightForWidth(double width);
    /// Something has changed without the controller's word: the card would be of another height now. The content has to
    /// be laid out.
    bool isOutdated() const;
    /// What changes in very large text takes its new place at once.
    bool growsAtOnce() const { return isLarge_; }
    void layoutSubviews() override;
    platform::AccessibilityRole accessibilityRole() const override { return platform::AccessibilityRole::Group; }
    std::string accessibilityText() const override { return title_->text(); }

    /// The plugin's part of the card.
    const std::shared_ptr<platform::View>& content() const { return content_; }
    const std::shared_ptr<RingView>& ring() const { return ring_; }
    /// Shows the ring as long as the controller searches. The controller does not tell when that ends: whoever turns
    /// the ring asks here.
    void updateRing();

    /// Rectangles in the card's coordinates; none: nothing is marked.
    void setHighlight(const std::optional<platform::Rect>& rect);
    void setFocus(const std::optional<platform::Rect>& rect);
    /// How much of the card is seen, from 0 to 1.
    void setOpacity(double opacity) { opacity_ = opacity; }

  protected:
    void draw(platform::Canvas& canvas) const override;

  private:
    class Overlay;

    void layOutHeader();
    void layOutContent(double width, double height);
    double headerHeight() const;
    /// The lower edge of what stands in the content, points.
    double lowerEdge() const;
    void unfold();
    void redraw(const std::optional<platform::Rect>& rect) const;

    std::shared_ptr<platform::HostSnippetViewController> controller_;
    std::shared_ptr<StillView> still_;
    std::shared_ptr<platform::ImageView> icon_;
    std::shared_ptr<platform::Label> title_;
    std::shared_ptr<RingView> ring_;
    std::shared_ptr<platform::View> content_;
    std::shared_ptr<Overlay> overlay_;
    std::optional<platform::Rect> highlight_;
    double contentHeight_ = 0.0;
    /// Of `lowerEdge` when the height was asked for.
    double knownEdge_ = 0.0;
    bool isFolded_ = false;
    bool isOnScreen_ = false;
    /// The text size of now is an accessibility size.
    bool isLarge_ = false;
    std::shared_ptr<platform::Timer> unfolding_;
    double opacity_ = 1.0;
};

}  // namespace ktr::host
