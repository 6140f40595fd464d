#pragma once

#include <QAccessible>
#include <QElapsedTimer>
#include <memory>
#include <string>
#include <unordered_map>
#include <vector>

#include "host/heard/NameChanges.h"
#include "platform/ui/Accessibility.h"

namespace ktr::app {

class ConversationWidget;

/// What assistive technology sees of a conversation: an interface a node of the accessibility tree. A node's identity
/// is its view's, so that it survives every update of the tree. Main thread.
class AccessibleConversation {
  public:
    /// Makes Qt ask here for the interfaces of ConversationWidgets; again does nothing.
    static void install();
    /// The tree may have changed: tells what did.
    static void changed(ConversationWidget& widget);
    /// The widget scrolled: rectangles are other ones.
    static void moved(ConversationWidget& widget);
    /// The keyboard's focus came to a row.
    static void focused(ConversationWidget& widget);

    explicit AccessibleConversation(ConversationWidget& widget) : widget_(widget) { clock_.start(); }
    ~AccessibleConversation();
    AccessibleConversation(const AccessibleConversation&) = delete;
    AccessibleConversation& operator=(const AccessibleConversation&) = delete;

    /// A node of the present tree, with its place in it.
    struct Entry {
        std::weak_ptr<platform::View> view;
        const platform::View* parent = nullptr;  ///< null: the widget itself
        std::vector<const platform::View*> children;
        platform::AccessibilityNode node;  ///< without its children and without what it says: that is read when asked
    };

    ConversationWidget& widget() const { return widget_; }
    /// None for a view that is not in the tree (any more).
    const Entry* find(const platform::View* view);
    const std::vector<const platform::View*>& topLevel();
    /// What is said of it now; empty for a view that is not in the tree.
    std::string nameOf(const platform::View* view);
    /// Made on first use; null for a view that is not in the tree.
    QAccessibleInterface* interfaceFor(const platform::View* view);

  private:
    void rebuild();
    void add(const platform::AccessibilityNode& node, const platform::View* parent);
    void update();
    /// Whether a listener wants to hear that the element's name has changed; the first time it is only taken note of.
    bool isNews(const platform::View& view);

    ConversationWidget& widget_;
    bool built_ = false;
    std::unordered_map<const platform::View*, Entry> entries_;
    std::vector<const platform::View*> topLevel_;
    std::unordered_map<const platform::View*, QAccessible::Id> interfaces_;
    host::NameChanges changes_;
    QElapsedTimer clock_;
};

}  // namespace ktr::app
