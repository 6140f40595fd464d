#include "app/window/StatusWords.h"

#include <QAccessible>
#include <QPainter>
#include <algorithm>
#include <cmath>

#include "app/window/AccessiblePlain.h"
#include "platform/base/Platform.h"
#include "platform/ui/Font.h"

namespace ktr::app {

namespace {

/// What letters may reach beyond their width.
constexpr int kBeside = 2;

class Reading : public AccessiblePlain {
  public:
    explicit Reading(StatusWords& words) : AccessiblePlain(&words, QAccessible::StaticText) {}
    /// A line that says nothing only keeps its place.
    QAccessible::Role role() const override {
        return static_cast<StatusWords*>(widget())->text().isEmpty() ? QAccessible::Whitespace
                                                                     : QAccessible::StaticText;
    }
    QString text(QAccessible::Text kind) const override {
        return kind == QAccessible::Name ? static_cast<StatusWords*>(widget())->text() : QString();
    }
};

QAccessibleInterface* readingOf(const QString& /*className*/, QObject* object) {
    auto* words = dynamic_cast<StatusWords*>(object);
    return words == nullptr ? nullptr : new Reading(*words);
}

}  // namespace

StatusWords::StatusWords(QWidget* parent) : QLabel(parent), palette_(&linux_::Palette::of(linux_::ColorScheme::Light)) {
    // Again changes nothing.
    QAccessible::removeFactory(readingOf);
    QAccessible::installFactory(readingOf);
    // A label with a name of its own announces no change of its text; what is read is the text all the same.
    setAccessibleName(QStringLiteral("-"));
}

void StatusWords::setColors(const linux_::Palette& palette) {
    palette_ = &palette;
    update();
}

std::shared_ptr<const linux_::QtTextLayout> StatusWords::layOut(int width) const {
    const auto installed = platform::Platform::installed();
    if (!installed || !installed->textEngine) {
        return nullptr;
    }
    platform::TextContainer container;
    container.width = std::max(width - kBeside, 1);
    container.rightToLeft = layoutDirection() == Qt::RightToLeft;
    const platform::AttributedString words(text().toStdString(),
                                           platform::preferredFont(platform::TextStyle::Footnote));
    return std::dynamic_pointer_cast<const linux_::QtTextLayout>(installed->textEngine->layOut(words, container));
}

int StatusWords::heightForWidth(int width) const {
    const auto layout = layOut(width);
    return layout ? static_cast<int>(std::ceil(layout->usedSize().height)) : 0;
}

void StatusWords::paintEvent(QPaintEvent*) {
    if (const auto layout = layOut(width())) {
        QPainter painter(this);
        painter.setRenderHint(QPainter::Antialiasing);
        const QPointF origin(layoutDirection() == Qt::RightToLeft ? kBeside : 0, contentsRect().top());
        layout->draw(painter, origin, palette_->inkSoft, *palette_);
    }
}

}  // namespace ktr::app
