#include "app/conversation/TurnView.h"

#include <algorithm>

#include "app/conversation/Measures.h"
#include "app/conversation/Shapes.h"
#include "app/conversation/WideColumns.h"
#include "platform/assistant/AssistantSettings.h"
#include "platform/base/Platform.h"

namespace ktr::app {

using namespace platform;

namespace {

/// What is said beside or above the card: a group of its own, so that it is read before the card wherever it stands.
class SpeechView : public View {
  public:
    AccessibilityRole accessibilityRole() const override { return AccessibilityRole::Group; }
};

bool rightToLeft() {
    return Platform::installed()->assistant->languageIsRightToLeft();
}

/// The end edge as an alignment: a natural one has no name for it.
TextAlignment endAlignment() {
    return rightToLeft() ? TextAlignment::Left : TextAlignment::Right;
}

void place(View& view, const Rect& rect, double parentWidth) {
    view.setFrame(mirrored(rect, parentWidth, rightToLeft()));
}

}  // namespace

bool TurnView::initWithFrame(const Rect& frame) {
    if (!View::initWithFrame(frame)) {
        return false;
    }
    speech_ = create<SpeechView>(&SpeechView::initWithFrame, Rect{});
    time_ = create<Label>(&Label::initWithFrame, Rect{});
    time_->setFont(preferredFont(TextStyle::Footnote));
    bubble_ = create<BubbleView>(&BubbleView::initWithFrame, Rect{});
    sentence_ = create<Label>(&Label::initWithFrame, Rect{});
    sentence_->setFont(preferredFont(TextStyle::Body));
    sentence_->setNumberOfLines(0);
    sentence_->setLineBreakMode(LineBreakMode::WordWrapping);
    card_ = create<CardView>(&CardView::initWithFrame, Rect{});
    card_->setHidden(true);
    speech_->addSubview(time_);
    speech_->addSubview(bubble_);
    speech_->addSubview(sentence_);
    addSubview(speech_);
    addSubview(card_);
    return true;
}

void TurnView::setTexts(const TurnTexts& texts) {
    texts_ = texts;
    bubble_->setText(texts.question);
    bubble_->setHidden(texts.question.empty());
    setSentence(texts.sentence);
}

void TurnView::setSentence(const std::string& sentence) {
    texts_.sentence = sentence;
    sentence_->setText(sentence);
    sentence_->setHidden(sentence.empty());
}

void TurnView::setController(const std::shared_ptr<HostSnippetViewController>& controller) {
    card_->setController(controller);
    card_->setHidden(false);
}

double TurnView::sentenceHeight(double width) const {
    return wrappedSize(sentence_->text(), sentence_->font(), width).size.height;
}

double TurnView::layOut(double width, bool first) {
    return width >= measures::kWideFrom ? layOutWide(width) : layOutNarrow(width, first);
}

double TurnView::layOutNarrow(double width, bool first) {
    const double cardTop = layOutNarrowSpeech(width, first);
    speech_->setFrame({0.0, 0.0, width, cardTop});
    if (card_->hidden()) {
        return cardTop;
    }
    const double cardWidth = width - 2.0 * measures::kGutter;
    const double cardHeight = card_->heightForWidth(cardWidth);
    place(*card_, {measures::kGutter, cardTop, cardWidth, cardHeight}, width);
    return cardTop + cardHeight;
}

double TurnView::layOutNarrowSpeech(double width, bool first) {
    double y = 0.0;
    time_->setHidden(!first || texts_.longTime.empty());
    if (!time_->hidden()) {
        time_->setText(texts_.longTime);
        time_->setTextAlignment(TextAlignment::Center);
        y += measures::kTimeAbove;
        place(*time_, {measures::kGutter, y, width - 2.0 * measures::kGutter, time_->font().lineHeight()}, width);
        y += time_->font().lineHeight() + measures::kTimeBelow;
    } else {
        y += first ? measures::kTimeAbove : measures::kCardToQuestion;
    }
    if (!bubble_->hidden()) {
        const Size size =
            bubble_->sizeForWidth(std::min(width * measures::kBubbleShare, width - 2.0 * measures::kGutter));
        place(*bubble_, {width - measures::kGutter - size.width, y, size.width, size.height}, width);
        y += size.height + (sentence_->hidden() ? measures::kSentenceToCard : measures::kQuestionToSentence);
    }
    if (!sentence_->hidden()) {
        const double room = width - 2.0 * measures::kSentenceStart;
        const double height = sentenceHeight(room);
        sentence_->setTextAlignment(TextAlignment::Natural);
        place(*sentence_, {measures::kSentenceStart, y, room, height}, width);
        y += height + measures::kSentenceToCard;
    }
    return y;
}

double TurnView::layOutWide(double width) {
    const WideColumns columns = WideColumns::of(width);
    const double speechHeight = layOutWideSpeech();
    place(*speech_, {columns.speechStart, 0.0, measures::kSpeechColumn, speechHeight}, width);
    if (card_->hidden()) {
        return speechHeight;
    }
    const double cardHeight = card_->heightForWidth(columns.cardWidth);
    place(*card_, {columns.cardStart, 0.0, columns.cardWidth, cardHeight}, width);
    return std::max(speechHeight, cardHeight);
}

double TurnView::layOutWideSpeech() {
    constexpr double kColumn = measures::kSpeechColumn;
    constexpr double kTextWidth = kColumn - measures::kSpeechInset;
    double y = 0.0;
    if (!bubble_->hidden()) {
        const Size size = bubble_->sizeForWidth(kColumn);
        place(*bubble_, {kColumn - size.width, y, size.width, size.height}, kColumn);
        y += size.height + measures::kQuestionToSentence;
    }
    if (!sentence_->hidden()) {
        const double height = sentenceHeight(kTextWidth);
        sentence_->setTextAlignment(endAlignment());
        place(*sentence_, {0.0, y, kTextWidth, height}, kColumn);
        y += height + measures::kSentenceToTime;
    }
    time_->setHidden(texts_.shortTime.empty());
    if (!time_->hidden()) {
        time_->setText(texts_.shortTime);
        time_->setTextAlignment(endAlignment());
        place(*time_, {0.0, y, kTextWidth, time_->font().lineHeight()}, kColumn);
        y += time_->font().lineHeight();
    }
    return y;
}

}  // namespace ktr::app
