#pragma once

#include "app/window/blocks/IconButton.h"

namespace ktr::app {

class ConversationWidget;

/// Opens the settings. It stands over the top end corner of the conversation, and is there while nothing lies beneath
/// it. Main thread.
class SettingsButton : public IconButton {
  public:
    /// The conversation is a child of the same parent.
    SettingsButton(ConversationWidget& conversation, QWidget* parent);

    /// Takes its place beside or over the conversation, and tells that how far it reaches.
    void place();
    /// Shows or hides it, as what lies beneath it wants.
    void look();

  private:
    /// The side of its icon, with what that keeps free around itself.
    static double clearSide();

    ConversationWidget& conversation_;
};

}  // namespace ktr::app
