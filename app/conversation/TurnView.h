#pragma once

#include <memory>
#include <string>

#include "app/conversation/BubbleView.h"
#include "app/conversation/CardView.h"
#include "platform/ui/Color.h"
#include "platform/ui/Label.h"
#include "platform/ui/View.h"

namespace ktr::app {

/// The words of a turn. Empty ones take no room.
struct TurnTexts {
    std::string longTime;   ///< "Today, 17:42": above the conversation's first turn
    std::string shortTime;  ///< "17:42": beside a card
    std::string question;
    std::string sentence;
};

/// A question, a sentence and a card: one under the other, or side by side where there is room. Main thread.
class TurnView : public platform::View {
  public:
    bool initWithFrame(const platform::Rect& frame) override;
    void setTexts(const TurnTexts& texts);
    void setSentence(const std::string& sentence);
    /// Puts an answer into the card, which is not shown before.
    void setController(const std::shared_ptr<platform::HostSnippetViewController>& controller);
    /// Of the time.
    void setSoftColor(const platform::Color& color) { time_->setTextColor(color); }
    const std::shared_ptr<CardView>& card() const { return card_; }
    platform::AccessibilityRole accessibilityRole() const override { return platform::AccessibilityRole::Group; }

    /// Lays the turn out in a conversation of this width; its height, points. Only the first turn of a narrow
    /// conversation shows its time, above.
    double layOut(double width, bool first);

  private:
    double layOutNarrow(double width, bool first);
    double layOutWide(double width);
    /// The heights of what is said: the time, the question and the sentence.
    double layOutNarrowSpeech(double width, bool first);
    double layOutWideSpeech();
    double sentenceHeight(double width) const;

    TurnTexts texts_;
    std::shared_ptr<platform::View> speech_;
    std::shared_ptr<platform::Label> time_;
    std::shared_ptr<BubbleView> bubble_;
    std::shared_ptr<platform::Label> sentence_;
    std::shared_ptr<CardView> card_;
};

}  // namespace ktr::app
