#include "app/conversation/TurnView.h"

#include <algorithm>

#include "app/conversation/Measures.h"
#include "app/conversation/Shapes.h"
#include "platform/assistant/AssistantSettings.h"
#include "platform/base/Platform.h"

namespace ktr::app {

using namespace platform;

namespace {

/// The end edge as a natural alignment has no name for it.
TextAlignment endAlignment() {
    return Platform::installed()->assistant->languageIsRightToLeft() ? TextAlignment::Left : TextAlignment::Right;
}

}  // namespace

bool TurnView::initWithFrame(const Rect& frame) {
    if (!View::initWithFrame(frame)) {
        return false;
    }
    time_ = create<Label>(&Label::initWithFrame, Rect{});
    time_->setFont(preferredFont(TextStyle::Footnote));
    bubble_ = create<BubbleView>(&BubbleView::initWithFrame, Rect{});
    sentence_ = create<Label>(&Label::initWithFrame, Rect{});
    sentence_->setFont(preferredFont(TextStyle::Body));
    sentence_->setNumberOfLines(0);
    sentence_->setLineBreakMode(LineBreakMode::WordWrapping);
    card_ = create<CardView>(&CardView::initWithFrame, Rect{});
    for (const std::shared_ptr<View>& view : {std::shared_ptr<View>(time_), std::shared_ptr<View>(bubble_),
                                              std::shared_ptr<View>(sentence_), std::shared_ptr<View>(card_)}) {
        addSubview(view);
    }
    return true;
}

void TurnView::setTexts(const TurnTexts& texts) {
    texts_ = texts;
    bubble_->setText(texts.question);
    bubble_->setHidden(texts.question.empty());
    sentence_->setText(texts.sentence);
    sentence_->setHidden(texts.sentence.empty());
}

void TurnView::place(View& view, const Rect& rect) {
    view.setFrame(mirrored(rect, width_, Platform::installed()->assistant->languageIsRightToLeft()));
}

double TurnView::sentenceHeight(double width) const {
    return wrappedSize(sentence_->text(), sentence_->font(), width).size.height;
}

double TurnView::layOut(double width, bool first) {
    width_ = width;
    return width >= measures::kWideFrom ? layOutWide(width) : layOutNarrow(width, first);
}

double TurnView::layOutNarrow(double width, bool first) {
    double y = 0.0;
    time_->setHidden(!first || texts_.longTime.empty());
    if (!time_->hidden()) {
        time_->setText(texts_.longTime);
        time_->setTextAlignment(TextAlignment::Center);
        y += measures::kTimeAbove;
        place(*time_, {measures::kGutter, y, width - 2.0 * measures::kGutter, time_->font().lineHeight()});
        y += time_->font().lineHeight() + measures::kTimeBelow;
    } else {
        y += first ? measures::kTimeAbove : measures::kCardToQuestion;
    }
    sentence_->setTextAlignment(TextAlignment::Natural);
    if (!bubble_->hidden()) {
        const Size size =
            bubble_->sizeForWidth(std::min(width * measures::kBubbleShare, width - 2 * measures::kGutter));
        place(*bubble_, {width - measures::kGutter - size.width, y, size.width, size.height});
        y += size.height + (sentence_->hidden() ? measures::kSentenceToCard : measures::kQuestionToSentence);
    }
    if (!sentence_->hidden()) {
        const double room = width - 2.0 * measures::kSentenceStart;
        const double height = sentenceHeight(room);
        place(*sentence_, {measures::kSentenceStart, y, room, height});
        y += height + measures::kSentenceToCard;
    }
    const double cardWidth = width - 2.0 * measures::kGutter;
    const double cardHeight = card_->heightForWidth(cardWidth);
    place(*card_, {measures::kGutter, y, cardWidth, cardHeight});
    return y + cardHeight;
}

double TurnView::layOutWide(double width) {
    const double cardWidth =
        std::min(measures::kWideCard, width - 2.0 * measures::kMargin - measures::kSpeechColumn - measures::kColumnGap);
    const double all = measures::kSpeechColumn + measures::kColumnGap + cardWidth;
    const double start = (width - all) / 2.0;
    const double columnEnd = start + measures::kSpeechColumn;
    const double textEnd = columnEnd - measures::kSpeechInset;
    const double textWidth = measures::kSpeechColumn - measures::kSpeechInset;
    double y = 0.0;
    if (!bubble_->hidden()) {
        const Size size = bubble_->sizeForWidth(measures::kSpeechColumn);
        place(*bubble_, {columnEnd - size.width, y, size.width, size.height});
        y += size.height + measures::kQuestionToSentence;
    }
    sentence_->setTextAlignment(endAlignment());
    if (!sentence_->hidden()) {
        const double height = sentenceHeight(textWidth);
        place(*sentence_, {textEnd - textWidth, y, textWidth, height});
        y += height + measures::kSentenceToTime;
    }
    time_->setHidden(texts_.shortTime.empty());
    if (!time_->hidden()) {
        time_->setText(texts_.shortTime);
        time_->setTextAlignment(endAlignment());
        place(*time_, {textEnd - textWidth, y, textWidth, time_->font().lineHeight()});
        y += time_->font().lineHeight();
    }
    const double cardHeight = card_->heightForWidth(cardWidth);
    place(*card_, {columnEnd + measures::kColumnGap, 0.0, cardWidth, cardHeight});
    return std::max(y, cardHeight);
}

}  // namespace ktr::app
