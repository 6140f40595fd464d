#pragma once

#include <memory>
#include <optional>
#include <vector>

#include "platform/base/Geometry.h"
#include "platform/base/Url.h"
#include "platform/contacts/ContactAvatarController.h"
#include "platform/layout/VisualFormat.h"
#include "platform/ui/AttributedString.h"
#include "platform/ui/Label.h"
#include "views/FriendViewDelegate.h"
#include "views/ViewURLHandler.h"

namespace ktr {

/// Base of everything that a controller stacks in a snippet: a tap opens the URL that the subclass names, a press dims
/// the row. It also holds the parts that the rows of a friend share; other views leave them none. Main thread.
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

    /// The user's text size is an accessibility size now.
    static bool accessibilitySizeIsActive();
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

    // The parts of a friend's row
    std::shared_ptr<platform::ContactAvatarController> avatarViewController() const { return avatarViewController_; }
    void setAvatarViewController(std::shared_ptr<platform::ContactAvatarController> controller) {
        avatarViewController_ = std::move(controller);
        hasContact_ = false;
    }
    /// Holds the avatar's view.
    std::shared_ptr<platform::View> friendIconView() const { return friendIconView_; }
    void setFriendIconView(std::shared_ptr<platform::View> view) { friendIconView_ = std::move(view); }
    std::shared_ptr<platform::View> separatorView() const { return separatorView_; }
    void setSeparatorView(std::shared_ptr<platform::View> view) { separatorView_ = std::move(view); }
    bool separatorEnabled() const { return separatorEnabled_; }
    /// Shows or hides the hairline. It is shown until this is first called, though the flag reads false.
    void setSeparatorEnabled(bool enabled);

  protected:
    /// Makes the holder, 54 by 54 points, with the avatar's view in it, and adds it to the row.
    void setupAvatar();
    /// Makes the hairline and adds it to the row.
    void setupSeparator();
    /// A text of one line, cut at its end; not added yet.
    static std::shared_ptr<platform::Label> makeLabel(platform::TextStyle style, const platform::Color& color);
    /// What the rows' layout formats name: margins, the avatar's size, a hairline of one pixel of the main screen.
    static platform::VisualFormatMetrics layoutMetrics();
    /// Gives the avatar this contact, or an empty one, 0.1 seconds later. The row is held until then: it is the row
    /// that was filled that gets the avatar, whoever drops it. What it has already it is not given again.
    void assignContactLater(std::shared_ptr<platform::Contact> contact);
    /// The least height that the row's constraints allow at its present width, points.
    double fittingHeight();

  private:
    bool axSize_ = false;
    bool isRTLUI_ = false;
    bool separatorEnabled_ = false;
    // A list has a thousand of these: what is small stands together.
    /// Whether, and which, contact was given to the avatar, which keeps it; none for an empty one.
    bool hasContact_ = false;
    /// How many contacts are on their way to it.
    int contactsAwaited_ = 0;
    const platform::Contact* contact_ = nullptr;
    std::weak_ptr<ViewURLHandler> urlHandler_;
    std::weak_ptr<FriendViewDelegate> viewDelegate_;
    std::shared_ptr<platform::ContactAvatarController> avatarViewController_;
    std::shared_ptr<platform::View> friendIconView_;
    std::shared_ptr<platform::View> separatorView_;
};

}  // namespace ktr
