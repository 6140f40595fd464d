#pragma once

#include <functional>
#include <memory>

#include "app/window/blocks/Block.h"
#include "platform/host/HostSnippetViewController.h"
#include "platform/ui/Window.h"

namespace ktr::app {

/// A friend's row as an answer has it, drawn and kept up to date by the plugin. It is read, not pressed. Main thread.
class FriendRow : public Block {
  public:
    explicit FriendRow(QWidget* parent = nullptr);
    ~FriendRow() override;

    /// Tells the controller that it appears. Its view may have more to say than one row: whoever makes it sees to that.
    void show(const std::shared_ptr<platform::HostSnippetViewController>& controller);
    /// Tells it that it disappears, and lets go of all that is the installed platform's.
    void letGo();
    const std::shared_ptr<platform::HostSnippetViewController>& controller() const { return controller_; }
    /// Called when what the controller knows may have become newer.
    void setChanged(std::function<void()> changed) { changed_ = std::move(changed); }

    int shapeHeight(int width) const override;
    QAccessible::Role role() const override { return QAccessible::StaticText; }

  protected:
    void paintEvent(QPaintEvent* event) override;

  private:
    class Client;
    void layOut();

    std::shared_ptr<Client> client_;
    std::shared_ptr<platform::Window> window_;
    std::shared_ptr<platform::HostSnippetViewController> controller_;
    std::function<void()> changed_;
    bool isPosted_ = false;
};

}  // namespace ktr::app
