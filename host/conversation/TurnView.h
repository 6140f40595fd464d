#pragma once

#include <memory>
#include <string>

#include "host/conversation/BubbleView.h"
#include "host/conversation/CardView.h"
#include "host/conversation/FadeView.h"
#include "host/conversation/Motion.h"
#include "platform/ui/Color.h"
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

/// A question, a sentence and a card: one under the other, or side by side where there is room. Main thread.
class TurnView : public platform::View {
  public:
    /// Bytes of a question or a sentence: whoever sends a megabyte must not hold up the window, which measures all of
    /// it.
    static constexpr std::size_t kLongestText = 4000;

    bool initWithFrame(const platform::Rect& frame) override;
    void setTexts(const TurnTexts& texts);
    void setSentence(const std::string& sentence);
    /// Puts an answer into the card, which is not shown before.
    void setController(const std::shared_ptr<platform::HostSnippetViewController>& controller);
    /// Begins anew where the language or the text size may be another: with the fonts of now, and with a new card in
    /// the place of the old one. A still is kept, any other answer is taken away; texts stay until they are set.
    void renew();
    /// Of the time.
    void setSoftColor(const platform::Color& color) { time_->setTextColor(color); }
    const std::shared_ptr<CardView>& card() const { return card_; }
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
    /// How much of the card's shadow is seen, from 0 to 1.
    double cardOpacity() const;

  protected:
    void draw(platform::Canvas& canvas) const override;

  private:
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
    std::shared_ptr<CardView> card_;
};

}  // namespace ktr::host
