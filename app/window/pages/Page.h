#pragma once

#include <functional>

#include "app/window/blocks/Block.h"

namespace ktr::app {

/// What fills a window in place of its conversation: settings, a friend, signing in. It covers what lies below. Main
/// thread.
class Page : public Block {
  public:
    explicit Page(QWidget* parent = nullptr) : Block(parent) {}

    /// What a screen reader says when it opens, in the present language.
    virtual QString name() const = 0;
    /// Who has the keyboard's focus at first; null: the page itself.
    virtual QWidget* firstFocus() const { return nullptr; }
    /// Whether the way back leads out of it: not where nobody is signed in.
    virtual bool canBeLeft() const { return true; }
    /// One step back within the page; false where it has none.
    virtual bool stepBack() { return false; }

    /// The page wants to be left; given by the stack that it is in.
    void setLeave(std::function<void()> leave) { leave_ = std::move(leave); }
    void leave() {
        if (leave_) {
            leave_();
        }
    }

    /// Lets go of everything that is the installed platform's, which is about to go; `refresh` follows with another.
    virtual void letGo() {}

    /// A page is as large as its window.
    int shapeHeight(int /*width*/) const override { return height(); }
    QAccessible::Role role() const override { return QAccessible::Grouping; }

  protected:
    void paintEvent(QPaintEvent* event) override;

  private:
    std::function<void()> leave_;
};

}  // namespace ktr::app
