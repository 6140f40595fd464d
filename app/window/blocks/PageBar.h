#pragma once

#include <functional>

#include "app/window/blocks/IconButton.h"
#include "app/window/blocks/Words.h"

namespace ktr::app {

/// The way back and a page's name. As wide as its page. Main thread.
class PageBar : public Block {
  public:
    explicit PageBar(QWidget* parent = nullptr);

    void setTexts(const QString& name, const QString& back);
    void setBack(std::function<void()> back) { back_->setPressed(std::move(back)); }
    IconButton& back() const { return *back_; }

    int shapeHeight(int width) const override;

  protected:
    void resizeEvent(QResizeEvent* event) override;
    void refreshed() override;

  private:
    void place();
    int nameWidth(int width) const;

    IconButton* back_;
    Words* name_;
};

}  // namespace ktr::app
