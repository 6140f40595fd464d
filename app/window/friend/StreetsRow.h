#pragma once

#include <functional>

#include "app/window/blocks/Button.h"
#include "app/window/blocks/Words.h"

namespace ktr::app {

/// The line of a friend's page whose map has no streets: that there are none, and what gets some. Side by side, or one
/// below the other where the words would have too little room. Main thread.
class StreetsRow : public Block {
  public:
    explicit StreetsRow(QWidget* parent = nullptr);

    void setTexts(const QString& words, const QString& action);
    Button& action() const { return *action_; }

    int shapeHeight(int width) const override;
    QAccessible::Role role() const override { return QAccessible::Grouping; }

  protected:
    void resizeEvent(QResizeEvent* event) override;
    void refreshed() override { place(); }

  private:
    /// Not mirrored.
    struct Places {
        QRect words, action;
        int height = 0;
    };
    Places placesFor(int width) const;
    void place();

    Words* words_;
    Button* action_;
};

}  // namespace ktr::app
