#pragma once

#include <functional>
#include <memory>
#include <vector>

#include "host/conversation/CardShadow.h"
#include "host/conversation/TurnView.h"
#include "linux/paint/Palette.h"
#include "platform/ui/View.h"

namespace ktr::host {

/// Turns from the oldest to the newest. It is laid out by `layOut` alone, never by constraints, since its height
/// follows from its width. Main thread.
class ConversationView : public platform::View {
  public:
    /// Adds a turn at the end.
    void addTurn(const std::shared_ptr<TurnView>& turn);
    void removeTurn(const std::shared_ptr<TurnView>& turn);
    const std::vector<std::shared_ptr<TurnView>>& turns() const { return turns_; }
    /// Lays everything out for a width and takes the height that it needs, which is returned; points.
    double layOut(double width);

    /// How somebody gets streets where a card's map has none; empty: nothing is offered.
    void setGetStreets(std::function<void()> get);
    /// Whether a narrow conversation has room for its times; laid out with the next width.
    void setShowsTimes(bool shows) { showsTimes_ = shows; }
    /// What a host puts over the top end corner reaches so far from both edges; nothing at first. In a narrow
    /// conversation the first turn begins below it where the two would meet; laid out with the next width.
    void setCorner(const platform::Size& corner) { corner_ = corner; }
    /// How much room that takes above the first turn, points.
    double head() const { return head_; }
    /// Whether something is said or shown in a rectangle of this view.
    bool showsSomethingIn(const platform::Rect& rect) const;
    /// What may move from now on; no turn does, until this is called. Pins and maps do not glide in reduced motion.
    void setMotionStyle(MotionStyle style);
    MotionStyle motionStyle() const { return style_; }
    /// Brings everything to where it is at this moment, seconds; whether something goes on moving.
    bool advance(double now);
    /// Where a turn's top is once it has arrived, points; 0 for a turn that is none of these.
    double topOf(const TurnView& turn) const;

    /// What the host's own texts take their colours from.
    void setPalette(const linux_::Palette& palette);

  protected:
    void draw(platform::Canvas& canvas) const override;

  private:
    /// Puts the turns one under the other, and takes the height that this needs.
    void stack(double width);
    double headFor(double width) const;

    MotionStyle style_ = MotionStyle::None;
    bool moves_ = false;
    bool showsTimes_ = true;
    platform::Size corner_;
    double head_ = 0.0;
    std::vector<std::shared_ptr<TurnView>> turns_;
    const linux_::Palette* palette_ = nullptr;
    std::function<void()> getStreets_;
    /// Painting keeps what it blurred.
    mutable CardShadow shadow_;
};

}  // namespace ktr::host
