#pragma once

#include <memory>

#include "platform/assistant/AssistantObject.h"
#include "platform/base/Geometry.h"
#include "platform/host/HeaderItem.h"
#include "platform/host/SnippetHostDelegate.h"
#include "platform/ui/View.h"

namespace ktr::platform {

/// Base of what draws a snippet. A host makes one through a plugin's factory, sets its delegate, asks its height for a
/// width, puts its view into its own tree, tells it when it comes and goes, and drops it. Main thread.
class KTR_API HostSnippetViewController : public Object {
  public:
    ~HostSnippetViewController() override;
    /// False when the controller cannot be made; the base always can.
    virtual bool init();

    std::shared_ptr<SnippetHostDelegate> delegate() const { return delegate_.lock(); }
    virtual void setDelegate(const std::shared_ptr<SnippetHostDelegate>& delegate);

    /// The controller's view, loaded on first use.
    std::shared_ptr<View> view();
    std::shared_ptr<View> viewIfLoaded() const { return view_; }
    void setView(std::shared_ptr<View> view) { view_ = std::move(view); }
    /// Makes the view. The base makes a plain one.
    virtual void loadView();
    virtual void viewWillAppear(bool animated);
    virtual void viewWillDisappear(bool animated);
    virtual void updateViewConstraints();

    /// Points; for a width in points.
    virtual double desiredHeightForWidth(double width);
    /// May be none.
    virtual std::shared_ptr<HeaderItem> sashItem();
    /// Whether what the snippet is about is still being looked for; a host may show that something goes on. It can end
    /// without the height or anything else changing, so a host that shows it asks again and again. Cheap. The base
    /// looks for nothing.
    virtual bool isSearching() const;
    /// The snippet as it stands now, with the newest that the service said in it: another controller that is made of it
    /// shows the same. A host asks before it makes its cards anew. None: there is nothing newer than what the
    /// controller was made of; so it is with the base.
    virtual std::shared_ptr<AssistantObject> currentSnippet() const;

    void setDefaultViewInsets(const EdgeInsets& insets) { insets_ = insets; }
    const EdgeInsets& defaultViewInsets() const { return insets_; }

  private:
    std::weak_ptr<SnippetHostDelegate> delegate_;
    std::shared_ptr<View> view_;
    /// A host's margins around a snippet that does not ask for others.
    EdgeInsets insets_ = {15.0, 15.0, 15.0, 15.0};
};

/// What a plugin's principal class answers. Main thread.
class KTR_API SnippetControllerFactory : public Object {
  public:
    ~SnippetControllerFactory() override;
    /// A new controller, or none for an object of a kind that the plugin does not draw. The object may be none.
    virtual std::shared_ptr<HostSnippetViewController> viewControllerForSnippet(
        const std::shared_ptr<AssistantObject>& snippet) = 0;
    /// Texts for speaking about an object; none when the plugin has none.
    virtual std::shared_ptr<Object> speakableNamespaceProviderForCueObject(
        const std::shared_ptr<AssistantObject>& object) = 0;
};

}  // namespace ktr::platform
