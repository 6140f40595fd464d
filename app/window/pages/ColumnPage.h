#pragma once

#include "app/window/blocks/Column.h"
#include "app/window/blocks/PageBar.h"
#include "app/window/pages/Page.h"
#include "app/window/pages/PageArea.h"
#include "app/window/pages/PageHandle.h"

namespace ktr::app {

/// A page of blocks below each other that scrolls, with a page bar above where it can be left, and with what stays at
/// the lower edge. Main thread.
class ColumnPage : public Page {
  public:
    enum class Bar { With, Without };

    explicit ColumnPage(Bar bar, QWidget* parent = nullptr);

    Column& column() const { return *column_; }
    /// None without one.
    PageBar* bar() const { return bar_; }
    /// Takes over what stays at the lower edge, where that leaves at least as much room as it takes; else it scrolls
    /// along, below all else.
    void setLower(Block* lower);
    /// Scrolls so that a block is seen.
    void reveal(const QWidget& block);

  protected:
    void resizeEvent(QResizeEvent* event) override;
    bool event(QEvent* event) override;
    bool eventFilter(QObject* object, QEvent* event) override;
    void lookChanged() override;
    void refreshed() override;
    /// Of the column, where the window is wider.
    virtual int mostWidth() const { return 480; }

  private:
    void place();
    /// At the lower edge of so much room, or in the column, below so much; the height that it takes there.
    int placeLower(int above, int columnHeight);
    void moveLower(QWidget* parent);

    PageBar* bar_ = nullptr;
    PageArea* area_;
    PageHandle* handle_;
    Column* column_;
    Block* lower_ = nullptr;
    /// Hears what the scroll bars say: a widget that did would count as controlled by them for assistive technology.
    QObject listener_;
};

}  // namespace ktr::app
