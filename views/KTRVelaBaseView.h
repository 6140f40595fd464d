#pragma once

#include <memory>
#include <optional>
#include <vector>

#include "platform/base/Geometry.h"
#include "platform/base/Url.h"
#include "platform/ui/AttributedString.h"
#include "platform/ui/View.h"
#include "views/FriendViewDelegate.h"
#include "views/ViewURLHandler.h"

namespace ktr {

/// Base of everything that a controller stacks in a snippet: a tap opens the URL that the subclass names, a press dims
/// the row. Main thread.
class KTRVelaBaseView : public platform::View {
  public:
    /// Points. Reads the text size and the language's direction once: a row made before they change keeps its layout.
    bool initWithFrame(const platform::Rect& frame) override;

    /// What a tap does: opens `urlForTouch` through `urlHandler`, which may be gone; nothing without a URL.
    virtual void viewTouched();
    /// None: a tap does nothing. The base gives none.
    virtual std::optional<platform::Url> urlForTouch();
    /// The height that the view wants at its present width, points. (The name is the one all callers know.) The base
    /// gives 0.
    virtual double estimagedHeightForView();
    /// The room that the text takes when it is wrapped at this width, points: the used rectangle with 0.5 points of
    /// padding at either end of a line, never hyphenated. Zero for a width that is not greater than 0 and for an empty
    /// text. The exclusion paths are rectangles in the text's coordinates that no line may touch.
    platform::Size sizeForText(const platform::AttributedString& text, double width,
                               const std::vector<platform::Rect>& exclusionPaths = {}) const;

    void touchesBegan(const platform::Touches& touches, const platform::TouchEvent& event) override;
    void touchesEnded(const platform::Touches& touches, const platform::TouchEvent& event) override;
    void touchesCancelled(const platform::Touches& touches, const platform::TouchEvent& event) override;

    /// The height of a snippet's map in points: 389 on a tablet, 219 on every other device and one that does not know.
    static double mapHeight();

    /// The user's text size was an accessibility size when the view was made.
    bool axSize() const { return axSize_; }
    void setAxSize(bool axSize) { axSize_ = axSize; }
    /// The assistant's language was written from right to left when the view was made.
    bool isRTLUI() const { return isRTLUI_; }
    void setIsRTLUI(bool isRTLUI) { isRTLUI_ = isRTLUI; }
    /// Held weakly, since the controller owns its rows; none when it is gone.
    std::shared_ptr<ViewURLHandler> urlHandler() const { return urlHandler_.lock(); }
    void setUrlHandler(std::weak_ptr<ViewURLHandler> handler) { urlHandler_ = std::move(handler); }
    std::shared_ptr<FriendViewDelegate> viewDelegate() const { return viewDelegate_.lock(); }
    void setViewDelegate(std::weak_ptr<FriendViewDelegate> delegate) { viewDelegate_ = std::move(delegate); }

  private:
    bool axSize_ = false;
    bool isRTLUI_ = false;
    std::weak_ptr<ViewURLHandler> urlHandler_;
    std::weak_ptr<FriendViewDelegate> viewDelegate_;
};

}  // namespace ktr
