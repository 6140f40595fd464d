#include "app/window/Announcer.h"

#include <QAccessible>

#include "app/window/AccessiblePlain.h"

namespace ktr::app {

namespace {

class Notice : public AccessiblePlain {
  public:
    explicit Notice(Announcer& announcer) : AccessiblePlain(&announcer, QAccessible::Notification) {}
    QString text(QAccessible::Text kind) const override {
        return kind == QAccessible::Name ? static_cast<Announcer*>(widget())->message() : QString();
    }
    QAccessible::State state() const override {
        QAccessible::State state;
        state.readOnly = true;
        // Between two messages there is nothing to come upon.
        state.invisible = static_cast<Announcer*>(widget())->message().isEmpty();
        return state;
    }
};

QAccessibleInterface* noticeOf(const QString& /*className*/, QObject* object) {
    auto* announcer = dynamic_cast<Announcer*>(object);
    return announcer == nullptr ? nullptr : new Notice(*announcer);
}

}  // namespace

Announcer::Announcer(QWidget* window) : QWidget(window) {
    setFocusPolicy(Qt::NoFocus);
    setAttribute(Qt::WA_TransparentForMouseEvents);
    hide();
    // Again changes nothing.
    QAccessible::removeFactory(noticeOf);
    QAccessible::installFactory(noticeOf);
}

void Announcer::say(const QString& message) {
#if QT_VERSION >= QT_VERSION_CHECK(6, 8, 0)
    QAccessibleAnnouncementEvent event(this, message);
    QAccessible::updateAccessibility(&event);
#else
    if (!message_.isEmpty()) {
        QAccessibleEvent gone(this, QAccessible::ObjectHide);
        QAccessible::updateAccessibility(&gone);
    }
    // It stays until the next one: whoever was told of it asks for its name later.
    message_ = message;
    QAccessibleEvent shown(this, QAccessible::ObjectShow);
    QAccessible::updateAccessibility(&shown);
#endif
}

}  // namespace ktr::app
