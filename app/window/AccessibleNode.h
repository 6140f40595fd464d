#pragma once

#include <QAccessible>

#include "app/window/AccessibleConversation.h"

namespace ktr::app {

/// One node of a conversation, for assistive technology. Main thread.
class AccessibleNode : public QAccessibleInterface, public QAccessibleActionInterface {
  public:
    AccessibleNode(AccessibleConversation& conversation, const platform::View* view)
        : conversation_(conversation), view_(view) {}

    bool isValid() const override { return entry() != nullptr; }
    QObject* object() const override { return nullptr; }
    QWindow* window() const override;
    QAccessibleInterface* parent() const override;
    int childCount() const override;
    QAccessibleInterface* child(int index) const override;
    int indexOfChild(const QAccessibleInterface* child) const override;
    QAccessibleInterface* childAt(int x, int y) const override;
    QString text(QAccessible::Text kind) const override;
    void setText(QAccessible::Text, const QString&) override {}
    QRect rect() const override;
    QAccessible::Role role() const override;
    QAccessible::State state() const override;
    void* interface_cast(QAccessible::InterfaceType type) override;

    QStringList actionNames() const override;
    void doAction(const QString& name) override;
    QStringList keyBindingsForAction(const QString&) const override { return {}; }

  private:
    const AccessibleConversation::Entry* entry() const { return conversation_.find(view_); }

    AccessibleConversation& conversation_;
    const platform::View* view_;
};

}  // namespace ktr::app
