#pragma once

#include <QScrollArea>
#include <functional>
#include <memory>
#include <vector>

#include "app/window/blocks/Button.h"
#include "app/window/blocks/ListRow.h"
#include "app/window/blocks/Words.h"
#include "app/window/friend/FriendRow.h"
#include "app/window/friend/RoundAction.h"
#include "app/window/friend/StreetsRow.h"

namespace ktr::app {

/// The card on a friend's page: who it is and where, and what can be done. What does not fit scrolls. Main thread.
class FriendSheet : public Block {
  public:
    static constexpr double kCorner = 20.0;

    explicit FriendSheet(QWidget* parent = nullptr);

    FriendRow& row() const { return *row_; }
    /// In the place of the row, for a friend without a place: face, name and a sentence.
    void setPerson(const QString& name, const QString& sentence, std::shared_ptr<const linux_::QtImage> face);
    /// Which of the two is shown.
    void setHasPlace(bool hasPlace);
    bool hasPlace() const { return hasPlace_; }
    /// Under the row; empty ones take no room.
    void setLines(const QString& where, const QString& howExactly);
    struct Action {
        Icon icon;
        QString words;
        std::function<void()> done;
    };
    /// Those that there are share the width.
    void setActions(const std::vector<Action>& actions);
    RoundAction* action(std::size_t index) const { return index < actions_.size() ? actions_[index] : nullptr; }
    /// A button below; without words there is none.
    void setOffer(const QString& words, std::function<void()> done);

    /// Below all else, that the map has no streets and what gets some; hidden at first.
    StreetsRow& streets() const { return *streets_; }
    void setLacksStreets(bool lacks);

    int shapeHeight(int width) const override;
    QAccessible::Role role() const override { return QAccessible::Grouping; }

  protected:
    void paintEvent(QPaintEvent* event) override;
    void resizeEvent(QResizeEvent* event) override;
    bool event(QEvent* event) override;
    bool eventFilter(QObject* object, QEvent* event) override;
    void lookChanged() override;
    void refreshed() override;

  private:
    /// What scrolls in the card.
    class Content : public Block {
      public:
        using Block::Block;
        int shapeHeight(int /*width*/) const override { return height(); }
    };
    /// Sets everything at this width, or only measures it; the height.
    int layOut(int width, bool places) const;
    int layOutActions(int width, int y, bool places) const;
    void place();

    QScrollArea* area_;
    Content* content_;
    FriendRow* row_;
    ListRow* person_;
    Words* where_;
    Words* howExactly_;
    std::vector<RoundAction*> actions_;
    Button* offer_;
    StreetsRow* streets_;
    bool hasPlace_ = false;
};

}  // namespace ktr::app
