#pragma once

#include <QAccessibleWidget>

#include "app/window/AccessibleConversation.h"

namespace ktr::app {

class ConversationWidget;

/// The conversation itself, for assistive technology: the nodes of its tree are its children. Main thread.
class AccessibleWidget : public QAccessibleWidget {
  public:
    AccessibleWidget(ConversationWidget& widget, AccessibleConversation& conversation);

    int childCount() const override;
    QAccessibleInterface* child(int index) const override;
    int indexOfChild(const QAccessibleInterface* child) const override;
    QAccessibleInterface* childAt(int x, int y) const override;

  private:
    AccessibleConversation& conversation_;
};

}  // namespace ktr::app
