#include "app/window/StatusWords.h"

#include <QAccessible>
#include <QAccessibleWidget>

namespace ktr::app {

namespace {

class Reading : public QAccessibleWidget {
  public:
    explicit Reading(StatusWords& words) : QAccessibleWidget(&words, QAccessible::StaticText) {}
    QString text(QAccessible::Text kind) const override {
        return kind == QAccessible::Name ? static_cast<StatusWords*>(widget())->text() : QString();
    }
};

QAccessibleInterface* readingOf(const QString& /*className*/, QObject* object) {
    auto* words = dynamic_cast<StatusWords*>(object);
    return words == nullptr ? nullptr : new Reading(*words);
}

}  // namespace

StatusWords::StatusWords(QWidget* parent) : QLabel(parent) {
    // Again changes nothing.
    QAccessible::removeFactory(readingOf);
    QAccessible::installFactory(readingOf);
    // A label with a name of its own tells nobody when its text changes; what is read is the text all the same.
    setAccessibleName(QStringLiteral("-"));
}

}  // namespace ktr::app
