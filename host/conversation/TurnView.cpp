#include "host/conversation/TurnView.h"

#include <QPainter>
#include <QString>
#include <algorithm>

#include "host/conversation/CutText.h"
#include "host/conversation/Measures.h"
#include "host/conversation/Shapes.h"
#include "host/conversation/WideColumns.h"
#include "platform/assistant/AssistantSettings.h"
#include "platform/assistant/Localization.h"
#include "platform/base/MainLoop.h"
#include "platform/base/Platform.h"

namespace ktr::host {

using namespace platform;

namespace {

/// What is said beside or above the card: a group of its own, so that it is read before the card wherever it stands.
class SpeechView : public View {
  public:
    AccessibilityRole accessibilityRole() const override { return AccessibilityRole::Group; }
};

/// The sentence that answers, named for who listens.
class AnswerView : public FadeView {
  public:
    AccessibilityRole accessibilityRole() const override { return AccessibilityRole::Group; }
    std::string accessibilityText() const override {
        const auto& localization = *Platform::installed()->localization;
        return localization.text("ANNOUNCE_ANSWER", localization.hostBundleIdentifier());
    }
};

bool rightToLeft() {
    return Platform::installed()->assistant->languageIsRightToLeft();
}

/// The end edge as an alignment: a natural one has no name for it.
TextAlignment endAlignment() {
    return rightToLeft() ? TextAlignment::Left : TextAlignment::Right;
}

bool isRightToLeft(char32_t c) {
    const QChar::Direction direction = QChar::direction(c);
    return direction == QChar::DirR || direction == QChar::DirAL;
}

/// A sentence runs as its language does, whoever's name it begins with: a mark of that direction goes before one that
/// would run the other way. One that has no letter of the language's direction is in another language.
std::string inItsDirection(const std::string& sentence) {
    const QString text = QString::fromStdString(sentence);
    const QList<uint> letters = text.toUcs4();
    const bool hasOwnLetters = std::any_of(letters.begin(), letters.end(), [](char32_t c) {
        return rightToLeft() ? isRightToLeft(c) : QChar::direction(c) == QChar::DirL;
    });
    if (!hasOwnLetters || text.isRightToLeft() == rightToLeft()) {
        return sentence;
    }
    return (rightToLeft() ? "\u200F" : "\u200E") + sentence;
}

void place(View& view, const Rect& rect, double parentWidth) {
    view.setFrame(mirrored(rect, parentWidth, rightToLeft()));
}

std::shared_ptr<PlatformMapView> mapIn(const View& view) {
    for (const auto& subview : view.subviews()) {
        auto map = std::dynamic_pointer_cast<PlatformMapView>(subview);
        if (map || (map = mapIn(*subview))) {
            return map;
        }
    }
    return nullptr;
}

}  // namespace

/// Before a question of which nothing came; the sentence says the same.
class TurnView::MarkView : public View {
  public:
    MarkView() { setUserInteractionEnabled(false); }

  protected:
    void draw(Canvas& canvas) const override {
        if (auto* qt = qtCanvas(canvas)) {
            paintIcon(qt->painter(), Icon::Warning, toQt(bounds()), qt->palette().warning, false);
        }
    }
};

bool TurnView::initWithFrame(const Rect& frame) {
    if (!View::initWithFrame(frame)) {
        return false;
    }
    speech_ = create<SpeechView>(&SpeechView::initWithFrame, Rect{});
    time_ = create<Label>(&Label::initWithFrame, Rect{});
    bubble_ = create<BubbleView>(&BubbleView::initWithFrame, Rect{});
    sentence_ = create<Label>(&Label::initWithFrame, Rect{});
    sentence_->setNumberOfLines(0);
    sentence_->setLineBreakMode(LineBreakMode::WordWrapping);
    card_ = create<CardView>(&CardView::initWithFrame, Rect{});
    card_->setHidden(true);
    ring_ = create<RingView>(&RingView::initWithFrame, Rect{});
    mark_ = create<MarkView>(&MarkView::initWithFrame, Rect{});
    offers_ = create<OffersView>(&OffersView::initWithFrame, Rect{});
    chooseFonts();
    speech_->addSubview(time_);
    speech_->addSubview(bubble_);
    sentenceFade_ = create<AnswerView>(&AnswerView::initWithFrame, Rect{});
    sentenceFade_->addSubview(sentence_);
    speech_->addSubview(sentenceFade_);
    speech_->addSubview(ring_);
    speech_->addSubview(mark_);
    addSubview(speech_);
    addSubview(card_);
    addSubview(offers_);
    setProgress(Progress::None);
    return true;
}

void TurnView::chooseFonts() {
    time_->setFont(preferredFont(TextStyle::Footnote));
    sentence_->setFont(preferredFont(TextStyle::Body));
    bubble_->chooseFont();
    card_->chooseFont();
    offers_->chooseFonts();
}

void TurnView::renew() {
    if (!card_->still()) {
        card_->letGo();
        card_->removeFromSuperview();
        card_ = create<CardView>(&CardView::initWithFrame, Rect{});
        card_->setHidden(true);
        addSubview(card_);
    }
    // What comes next stands at once in its own size.
    laidOutCard_ = 0.0;
    chooseFonts();
    if (streets_) {
        streets_->renew();
        followStreets();
    }
}

void TurnView::setGetStreets(std::function<void()> get) {
    if (!get) {
        if (streets_) {
            streets_->removeFromSuperview();
            streets_ = nullptr;
            streetsChanged_.remove();
        }
        return;
    }
    if (!streets_) {
        streets_ = create<StreetsLine>(&StreetsLine::initWithFrame, Rect{});
        streets_->setHidden(true);
        if (palette_ != nullptr) {
            streets_->setPalette(*palette_);
        }
        addSubview(streets_);
        // One that is there may have told already.
        map_ = mapIn(*card_->content());
        followStreets();
    }
    streets_->setGet(std::move(get));
}

void TurnView::followStreets() {
    const auto installed = Platform::installed();
    streetsChanged_ = installed->notificationCenter->addObserver(
        kMapStreetsChangedNotification, [target = weak(this)](const Notification& told) {
            const auto self = target.lock();
            const auto map = std::dynamic_pointer_cast<PlatformMapView>(told.sender);
            if (!self || !map || !map->isDescendantOf(*self->card_)) {
                return;
            }
            self->map_ = map;
            // Perhaps in the middle of a layout.
            Platform::installed()->mainLoop->post([target] {
                if (const auto turn = target.lock()) {
                    turn->setNeedsLayout();
                }
            });
        });
}

bool TurnView::lacksStreets() const {
    const auto map = map_.lock();
    return map && !card_->hidden() && map->isDescendantOf(*card_) && !map->hasStreets();
}

bool TurnView::isOutdated() const {
    return card_->isOutdated() || (streets_ && streets_->hidden() == lacksStreets());
}

void TurnView::setTexts(const TurnTexts& texts) {
    texts_ = texts;
    texts_.question = cutText(texts.question, kLongestText);
    bubble_->setText(texts_.question);
    bubble_->setHidden(texts.question.empty());
    setSentence(texts.sentence);
}

void TurnView::setSentence(const std::string& sentence) {
    texts_.sentence = cutText(sentence, kLongestText);
    showSentence();
}

void TurnView::setPatience(const std::string& words) {
    patience_ = words;
    showSentence();
}

void TurnView::showSentence() {
    const bool isPatience = texts_.sentence.empty();
    const std::string& words = isPatience ? patience_ : texts_.sentence;
    sentence_->setText(inItsDirection(words));
    sentence_->setTextColor(isPatience && palette_ != nullptr ? textColor(palette_->inkSoft)
                                                              : Color::ofRole(ColorRole::StandardText));
    sentence_->setHidden(words.empty());
    sentenceFade_->setHidden(words.empty());
}

void TurnView::setProgress(Progress progress) {
    progress_ = progress;
    ring_->setHidden(progress != Progress::Asking);
    mark_->setHidden(progress != Progress::Failed);
}

void TurnView::setOffers(const Offers& offers) {
    offers_->setOffers(offers);
    setNeedsLayout();
}

void TurnView::setPalette(const linux_::Palette& palette) {
    palette_ = &palette;
    time_->setTextColor(textColor(palette.inkSoft));
    offers_->setPalette(palette);
    if (streets_) {
        streets_->setPalette(palette);
    }
    showSentence();
}

void TurnView::setController(const std::shared_ptr<HostSnippetViewController>& controller) {
    card_->setController(controller);
    card_->setHidden(false);
}

Size TurnView::sentenceSize(double width) const {
    const WrappedSize widest = wrappedSize(sentence_->text(), sentence_->font(), width);
    if (widest.lines != 2 && widest.lines != 3) {
        return {width, widest.size.height};
    }
    const double balanced = balancedWidth(sentence_->text(), sentence_->font(), width);
    return {balanced, wrappedSize(sentence_->text(), sentence_->font(), balanced).size.height};
}

double TurnView::layOut(double width, bool first) {
    places_.width = width;
    const bool isWide = width >= measures::kWideFrom;
    if (isWide) {
        layOutWide(width);
    } else {
        layOutNarrow(width, first);
    }
    places_.offersFollowCard = !isWide;
    if (!card_->hidden()) {
        setCardHeight(card_->heightForWidth(places_.card.width), places_.card.width);
    }
    layOutStreets();
    placeAnswer();
    return height_;
}

void TurnView::layOutNarrow(double width, bool first) {
    const double cardTop = layOutNarrowSpeech(width, first);
    speech_->setFrame({0.0, 0.0, width, cardTop});
    places_.least = cardTop;
    places_.speechEnd = cardTop - (sentence_->hidden() ? 0.0 : measures::kSentenceToCard);
    places_.card = {measures::kGutter, cardTop, width - 2.0 * measures::kGutter, 0.0};
    // Questions keep to the edge at which the question stands.
    const double start = offers_->asksOn() ? measures::kGutter : measures::kSentenceStart;
    layOutOffers(start, width - start - measures::kGutter, false);
}

void TurnView::layOutStreets() {
    if (streets_) {
        streets_->setHidden(!lacksStreets());
        streetsHeight_ = streets_->hidden() ? 0.0 : streets_->heightForWidth(places_.card.width);
    }
}

void TurnView::layOutOffers(double start, double width, bool atEnd) {
    places_.offers = {start, 0.0, width, offers_->hidden() ? 0.0 : offers_->layOut(width, atEnd)};
}

void TurnView::setCardHeight(double height, double width) {
    const bool moves = style_ == MotionStyle::Full && laidOutCard_ == width && !card_->growsAtOnce();
    laidOutCard_ = width;
    if (!moves) {
        growth_ = Motion(height);
    } else if (height != growth_.target()) {
        growth_ = Motion(growth_.at(now_), height, now_, motions::kGrowth);
    }
}

void TurnView::placeAnswer() {
    const double rise = riseOf(answerArrival_);
    place(*sentenceFade_, places_.sentence.offsetBy(0.0, rise), places_.sentenceParent);
    sentence_->setFrame(sentenceFade_->bounds());
    height_ = places_.least;
    if (!card_->hidden()) {
        Rect card = places_.card.offsetBy(0.0, rise);
        card.height = growth_.at(now_);
        place(*card_, card, places_.width);
        height_ = std::max(height_, places_.card.y + card.height);
        if (streets_ && !streets_->hidden()) {
            const double top = card.maxY() + measures::kCardToStreets;
            place(*streets_, {card.x, top, card.width, streetsHeight_}, places_.width);
            height_ = std::max(height_, top - rise + streetsHeight_);
        }
    }
    if (!offers_->hidden()) {
        constexpr double kAround = OffersView::kAround;
        const bool followsCard = places_.offersFollowCard && !card_->hidden();
        const double gap = offers_->asksOn() ? measures::kSentenceToQuestions : measures::kSentenceToOffers;
        const double top = (followsCard ? height_ : places_.speechEnd) + gap;
        Rect offers = places_.offers.offsetBy(-kAround, top + rise - kAround);
        offers.width += 2.0 * kAround;
        offers.height += 2.0 * kAround;
        place(*offers_, offers, places_.width);
        height_ = std::max(height_, top + places_.offers.height + measures::kOffersToQuestion);
    }
}

double TurnView::riseOf(const Motion& arrival) const {
    return style_ == MotionStyle::Full ? motions::kRise * (1.0 - arrival.at(now_)) : 0.0;
}

bool TurnView::showsSomethingIn(const Rect& rect) const {
    const Rect whole = frameInRoot();
    const auto meets = [&](const View& view, const Rect& shown) {
        const Rect there = view.frameInRoot();
        return !view.hidden() && shown.offsetBy(there.x - whole.x, there.y - whole.y).intersects(rect);
    };
    const auto isIn = [&](const std::shared_ptr<View>& view) { return view && meets(*view, view->bounds()); };
    // The time's label is as wide as the conversation, and the offers have a line each.
    const auto& offers = offers_->subviews();
    return meets(*time_, time_->drawnTextRect()) || isIn(bubble_) || isIn(ring_) || isIn(mark_) ||
           (!sentence_->hidden() && isIn(sentenceFade_)) || isIn(card_) || isIn(streets_) ||
           (!offers_->hidden() && std::any_of(offers.begin(), offers.end(), isIn));
}

double TurnView::cardOpacity() const {
    return arrival_.at(now_) * answerArrival_.at(now_);
}

void TurnView::arrive(double now) {
    if (style_ != MotionStyle::None) {
        arrival_ = Motion(0.0, 1.0, now, style_ == MotionStyle::Full ? motions::kArrival : motions::kFade);
    }
}

void TurnView::answerArrives(double now) {
    if (style_ != MotionStyle::None) {
        answerArrival_ = Motion(0.0, 1.0, now, style_ == MotionStyle::Full ? motions::kArrival : motions::kFade);
    }
}

bool TurnView::advance(double now) {
    const auto isOver = [&](double moment) {
        return arrival_.isOver(moment) && answerArrival_.isOver(moment) && growth_.isOver(moment);
    };
    const bool moved = !isOver(now_);
    now_ = now;
    const bool moves = !isOver(now);
    if (moved || moves) {
        sentenceFade_->setOpacity(answerArrival_.at(now));
        offers_->setOpacity(answerArrival_.at(now));
        card_->setOpacity(answerArrival_.at(now));
        if (streets_) {
            streets_->setOpacity(answerArrival_.at(now));
        }
        placeAnswer();
        setNeedsDisplay();
    }
    return moves;
}

void TurnView::draw(Canvas& canvas) const {
    auto* qt = qtCanvas(canvas);
    const double opacity = arrival_.at(now_);
    if (qt != nullptr && opacity < 1.0) {
        // Holds for everything in the turn: the caller restores the canvas when it leaves it.
        qt->painter().setOpacity(qt->painter().opacity() * opacity);
    }
}

void TurnView::placeProgress(const Rect& bubble, double parentWidth) {
    const double middle = bubble.maxY() - measures::kBubbleBottom - sentence_->font().lineHeight() / 2.0;
    const auto put = [&](View& view, double side) {
        place(view, {bubble.x - measures::kRingToBubble - side, middle - side / 2.0, side, side}, parentWidth);
    };
    put(*ring_, measures::kRing);
    put(*mark_, measures::kMark);
}

double TurnView::layOutNarrowSpeech(double width, bool first) {
    double y = 0.0;
    const std::string& time = first ? texts_.longTime : texts_.shortTime;
    time_->setHidden(!showsTime_ || time.empty());
    if (!time_->hidden()) {
        time_->setText(time);
        time_->setTextAlignment(TextAlignment::Center);
        y += first ? measures::kTimeAbove : measures::kCardToQuestion;
        place(*time_, {measures::kGutter, y, width - 2.0 * measures::kGutter, time_->font().lineHeight()}, width);
        y += time_->font().lineHeight() + measures::kTimeBelow;
    } else {
        y += first ? measures::kTimeAbove : measures::kCardToQuestion;
    }
    if (!bubble_->hidden()) {
        const Size size =
            bubble_->sizeForWidth(std::min(width * measures::kBubbleShare, width - 2.0 * measures::kGutter));
        const Rect bubble{width - measures::kGutter - size.width, y, size.width, size.height};
        place(*bubble_, bubble, width);
        placeProgress(bubble, width);
        y += size.height + (sentence_->hidden() ? measures::kSentenceToCard : measures::kQuestionToSentence);
    }
    if (!sentence_->hidden()) {
        const double room = width - 2.0 * measures::kSentenceStart;
        const Size size = sentenceSize(room);
        sentence_->setTextAlignment(TextAlignment::Natural);
        places_.sentence = {measures::kSentenceStart, y, size.width, size.height};
        places_.sentenceParent = width;
        y += size.height + measures::kSentenceToCard;
    }
    return y;
}

void TurnView::layOutWide(double width) {
    const WideColumns columns = WideColumns::of(width);
    const double speechHeight = layOutWideSpeech();
    place(*speech_, {columns.speechStart, 0.0, measures::kSpeechColumn, speechHeight}, width);
    places_.least = speechHeight;
    places_.speechEnd = speechHeight;
    layOutOffers(columns.speechStart, measures::kSpeechColumn - measures::kSpeechInset, true);
    places_.card = {columns.cardStart, 0.0, columns.cardWidth, 0.0};
}

double TurnView::layOutWideSpeech() {
    constexpr double kColumn = measures::kSpeechColumn;
    constexpr double kTextWidth = kColumn - measures::kSpeechInset;
    double y = 0.0;
    if (!bubble_->hidden()) {
        const Size size = bubble_->sizeForWidth(kColumn);
        const Rect bubble{kColumn - size.width, y, size.width, size.height};
        place(*bubble_, bubble, kColumn);
        placeProgress(bubble, kColumn);
        y += size.height + measures::kQuestionToSentence;
    }
    if (!sentence_->hidden()) {
        const Size size = sentenceSize(kTextWidth);
        sentence_->setTextAlignment(endAlignment());
        places_.sentence = {kTextWidth - size.width, y, size.width, size.height};
        places_.sentenceParent = kColumn;
        y += size.height + measures::kSentenceToTime;
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

}  // namespace ktr::host
