#include "host/conversation/BubbleView.h"

#include <QPainter>
#include <QTextBoundaryFinder>
#include <algorithm>
#include <cmath>

#include "host/conversation/Measures.h"
#include "host/conversation/Shapes.h"
#include "linux/paint/JapanesePhrases.h"
#include "platform/assistant/AssistantSettings.h"
#include "platform/assistant/Localization.h"
#include "platform/base/Platform.h"
#include "platform/text/TextEngine.h"

namespace ktr::host {

using platform::Platform;

WrappedSize wrappedSize(const std::string& text, const platform::Font& font, double width) {
    platform::TextContainer container;
    container.width = width;
    container.rightToLeft = Platform::installed()->assistant->languageIsRightToLeft();
    const auto layout = Platform::installed()->textEngine->layOut(platform::AttributedString(text, font), container);
    return {layout->usedSize(), layout->lines().size()};
}

namespace {

/// Of the phrases of a text that parts its words without blanks, the widest; 0 for any other. Such a text fills lines
/// that are narrower, too, with its words broken.
double widestPhrase(const std::string& text, const platform::Font& font) {
    const QString plain = QString::fromStdString(text);
    const QString joined = linux_::JapanesePhrases::joined(plain);
    if (joined == plain) {
        return 0.0;
    }
    constexpr double kUnbounded = 100000.0;
    double widest = 0.0;
    QTextBoundaryFinder phrases(QTextBoundaryFinder::Line, joined);
    for (qsizetype begin = 0, end = phrases.toNextBoundary(); end > begin; end = phrases.toNextBoundary()) {
        const std::string phrase = joined.mid(begin, end - begin).trimmed().remove(QChar(0x2060)).toStdString();
        widest = std::max(widest, std::ceil(wrappedSize(phrase, font, kUnbounded).size.width));
        begin = end;
    }
    return widest;
}

}  // namespace

double balancedWidth(const std::string& text, const platform::Font& font, double mostWidth) {
    const WrappedSize widest = wrappedSize(text, font, mostWidth);
    const double own = std::min(mostWidth, std::ceil(widest.size.width));
    if (widest.lines != 2 && widest.lines != 3) {
        return own;
    }
    double tooNarrow = std::floor(own / static_cast<double>(widest.lines + 1));
    if (const double phrase = widestPhrase(text, font); phrase <= own) {
        tooNarrow = std::max(tooNarrow, phrase - 1.0);
    }
    double enough = own;
    while (enough - tooNarrow > 1.0) {
        const double middle = std::floor((tooNarrow + enough) / 2.0);
        const WrappedSize tried = wrappedSize(text, font, middle);
        // A word wider than its line is broken, which balancing must not cause.
        const bool fits = tried.lines == widest.lines && tried.size.width <= middle;
        (fits ? enough : tooNarrow) = middle;
    }
    return enough;
}

bool BubbleView::initWithFrame(const platform::Rect& frame) {
    if (!View::initWithFrame(frame)) {
        return false;
    }
    label_ = platform::create<platform::Label>(&platform::Label::initWithFrame, platform::Rect{});
    chooseFont();
    label_->setNumberOfLines(0);
    label_->setLineBreakMode(platform::LineBreakMode::WordWrapping);
    addSubview(label_);
    return true;
}

void BubbleView::chooseFont() {
    label_->setFont(platform::preferredFont(platform::TextStyle::Body));
}

void BubbleView::setText(const std::string& text) {
    label_->setText(text);
}

platform::Size BubbleView::sizeForWidth(double mostWidth) const {
    if (label_->text().empty()) {
        return {};
    }
    const double textWidth = balancedWidth(label_->text(), label_->font(), mostWidth - 2.0 * measures::kBubbleSide);
    const platform::Size text = wrappedSize(label_->text(), label_->font(), textWidth).size;
    return {textWidth + 2.0 * measures::kBubbleSide, text.height + measures::kBubbleTop + measures::kBubbleBottom};
}

std::string BubbleView::accessibilityText() const {
    const auto& localization = *Platform::installed()->localization;
    return localization.text("ANNOUNCE_QUESTION", localization.hostBundleIdentifier());
}

void BubbleView::layoutSubviews() {
    const platform::Rect box = bounds();
    label_->setFrame({measures::kBubbleSide, measures::kBubbleTop, box.width - 2.0 * measures::kBubbleSide,
                      box.height - measures::kBubbleTop - measures::kBubbleBottom});
}

void BubbleView::draw(platform::Canvas& canvas) const {
    auto* qt = qtCanvas(canvas);
    if (qt == nullptr) {
        return;
    }
    const bool rightToLeft = Platform::installed()->assistant->languageIsRightToLeft();
    const auto shape = [&](double inset) {
        return bubblePath(toQt(bounds()).adjusted(inset, inset, -inset, -inset), measures::kBubbleCorner - inset,
                          measures::kBubbleTailCorner - inset, rightToLeft);
    };
    fillPath(*qt, shape(0.0), qt->palette().bubble);
    const auto& edge = qt->palette().bubbleEdge;
    if (edge.width > 0.0) {
        qt->painter().strokePath(shape(edge.width / 2.0), QPen(edge.color, edge.width));
    }
}

}  // namespace ktr::host
