#pragma once

#include <functional>
#include <memory>
#include <string>

#include "host/conversation/BubbleView.h"
#include "host/conversation/CardView.h"
#include "host/conversation/FadeView.h"
#include "host/conversation/Motion.h"
#include "host/conversation/OffersView.h"
#include "host/conversation/RingView.h"
#include "host/conversation/StreetsLine.h"
#include "linux/paint/Palette.h"
#include "platform/base/NotificationCenter.h"
#include "platform/map/PlatformMapView.h"
#include "platform/ui/Label.h"
#include "platform/ui/View.h"

namespace ktr::host {

/// The words of a turn. Empty ones take no room; question and sentence are cut when they are longer than anybody reads.
struct TurnTexts {
    std::string longTime;   ///< "Today, 17:42": above the conversation's first turn
    std::string shortTime;  ///< "17:42": beside a card
    std::string question;
    std::string sentence;
};

/// A question, a sentence, a card and what can be done about them: one under the other, or side by side where there is
/// room. Main thread.
class TurnView : public platform::View {
  public:
    /// Bytes of a question or a sentence: whoever sends a megabyte must not hold up the window, which measures all of
    /// it.
    static constexpr std::size_t kLongestText = 4000;

    /// How it is with the question: while it waits a ring stands before it, and a mark where nothing came of it.
    enum class Progress { None, Asking, Failed };

    bool initWithFrame(const platform::Rect& frame) override;
    void setTexts(const TurnTexts& texts);
    void setSentence(const std::string& sentence);
    void setProgress(Progress progress);
    /// Said in the sentence's place as long as there is no sentence; empty: nothing.
    void setPatience(const std::string& words);
    /// What can be done about the answer, in the place of what could before.
    void setOffers(const Offers& offers);
    /// How somebody gets streets where the card's map has none: a line below the card offers it. Empty: nothing is
    /// offered.
    void setGetStreets(std::function<void()> get);
    /// Puts an answer into the card, which is not shown before.
    void setController(const std::shared_ptr<platform::HostSnippetViewController>& controller);
    /// Begins anew where the language or the text size may be another: with the fonts of now, and with a new card in
    /// the place of the old one. A still is kept, any other answer is taken away; texts stay until they are set.
    void renew();
    /// What the texts take their colours from that the host has of its own.
    void setPalette(const linux_::Palette& palette);
    const std::shared_ptr<CardView>& card() const { return card_; }
    const std::shared_ptr<RingView>& ring() const { return ring_; }
    const std::shared_ptr<OffersView>& offers() const { return offers_; }
    /// None where nothing is offered; hidden while there are streets.
    const std::shared_ptr<StreetsLine>& streets() const { return streets_; }
    /// Something has changed without anybody's word: the turn would be of another height now.
    bool isOutdated() const;
    Progress progress() const { return progress_; }
    const std::string& question() const { return texts_.question; }
    const std::string& sentence() const { return texts_.sentence; }
    platform::AccessibilityRole accessibilityRole() const override { return platform::AccessibilityRole::Group; }
    /// The question, else the sentence.
    std::string accessibilityText() const override {
        return texts_.question.empty() ? texts_.sentence : texts_.question;
    }

    /// Lays the turn out in a conversation of this width; its height, points. In a narrow conversation the time stands
    /// above, of the first turn with its day. A card that was laid out before grows or shrinks to its new height where
    /// everything may move; the height is the one of the moment.
    double layOut(double width, bool first);

    /// Not in a window that has no room for it.
    void setShowsTime(bool shows) { showsTime_ = shows; }
    void setMotionStyle(MotionStyle style) { style_ = style; }
    /// The turn comes now, or its answer does. Seconds.
    void arrive(double now);
    void answerArrives(double now);
    /// Brings everything to where it is at this moment; whether something goes on moving.
    bool advance(double now);
    /// Of the moment, points.
    double height() const { return height_; }
    /// How far the turn still is below its place, points.
    double rise() const { return riseOf(arrival_); }
    /// Whether something of the turn is said or shown in a rectangle of this view.
    bool showsSomethingIn(const platform::Rect& rect) const;
    /// How much of the card's shadow is seen, from 0 to 1.
    double cardOpacity() const;

  protected:
    void draw(platform::Canvas& canvas) const override;

  private:
    class MarkView;

    void showSentence();
    /// Hears from the maps of the installed platform.
    void followStreets();
    bool lacksStreets() const;
    void layOutStreets();
    void layOutOffers(double start, double width, bool atEnd);
    /// Beside the question's last line, whose bubble is there.
    void placeProgress(const platform::Rect& bubble, double parentWidth);
    void layOutNarrow(double width, bool first);
    void layOutWide(double width);
    double riseOf(const Motion& arrival) const;
    void setCardHeight(double height, double width);
    /// Puts sentence and card where they are at this moment, and finds the turn's height.
    void placeAnswer();
    void chooseFonts();
    /// The heights of what is said: the time, the question and the sentence.
    double layOutNarrowSpeech(double width, bool first);
    double layOutWideSpeech();
    platform::Size sentenceSize(double width) const;

    /// Where things stand once nothing moves, not mirrored.
    struct Places {
        double width = 0.0;
        platform::Rect sentence;  ///< in the speech
        double sentenceParent = 0.0;
        platform::Rect card;  ///< without its height
        double least = 0.0;   ///< of the turn's height
        double speechEnd = 0.0;
        platform::Rect offers;  ///< their content, without its upper edge
        bool offersFollowCard = false;
    };

    TurnTexts texts_;
    Places places_;
    double height_ = 0.0;
    bool showsTime_ = true;
    MotionStyle style_ = MotionStyle::None;
    double now_ = 0.0;
    Motion arrival_{1.0};
    Motion answerArrival_{1.0};
    Motion growth_;
    /// The width at which the card was laid out last; 0: never.
    double laidOutCard_ = 0.0;
    std::shared_ptr<platform::View> speech_;
    std::shared_ptr<platform::Label> time_;
    std::shared_ptr<BubbleView> bubble_;
    /// Around the sentence, which may come on its own.
    std::shared_ptr<FadeView> sentenceFade_;
    std::shared_ptr<platform::Label> sentence_;
    /// Before the question.
    std::shared_ptr<RingView> ring_;
    std::shared_ptr<MarkView> mark_;
    std::shared_ptr<CardView> card_;
    std::shared_ptr<OffersView> offers_;
    std::shared_ptr<StreetsLine> streets_;
    double streetsHeight_ = 0.0;
    /// That the card showed last.
    std::weak_ptr<platform::PlatformMapView> map_;
    platform::NotificationCenter::Token streetsChanged_;
    std::string patience_;
    Progress progress_ = Progress::None;
    const linux_::Palette* palette_ = nullptr;
};

}  // namespace ktr::host
