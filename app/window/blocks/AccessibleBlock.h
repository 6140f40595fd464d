#pragma once

#include "app/window/AccessiblePlain.h"
#include "app/window/blocks/Block.h"

namespace ktr::app {

/// A block for assistive technology: its role, its state, and pressing it where it can be pressed. Main thread.
class AccessibleBlock : public AccessiblePlain {
  public:
    /// Makes Qt ask here for the interfaces of blocks; again does nothing.
    static void install();

    explicit AccessibleBlock(Block& block) : AccessiblePlain(&block, block.role()), block_(block) {}

    /// What can be pressed and has no words yet only keeps its place.
    QAccessible::Role role() const override {
        return block_.canBePressed() && !canBePressed() ? QAccessible::Whitespace : block_.role();
    }
    QAccessible::State state() const override;
    void* interface_cast(QAccessible::InterfaceType type) override;
    QStringList actionNames() const override;
    void doAction(const QString& name) override;

  private:
    bool canBePressed() const { return block_.canBePressed() && !block_.accessibleName().isEmpty(); }

    Block& block_;
};

}  // namespace ktr::app
