#pragma once

#include <functional>

#include "app/window/blocks/BlockText.h"
#include "app/window/blocks/IconButton.h"

namespace ktr::app {

/// A row whose value is made less or more. Main thread.
class StepRow : public Block {
  public:
    explicit StepRow(QWidget* parent = nullptr);

    struct Texts {
        QString words, less, more;  ///< the last two are spoken
    };
    void setTexts(const Texts& texts);
    void setValue(const QString& value);
    /// By one step down or up; an end cannot be passed.
    void setStepped(const std::function<void(int)>& stepped);
    void setEnds(bool canBeLess, bool canBeMore);

    int shapeHeight(int width) const override;

  protected:
    void paintEvent(QPaintEvent* event) override;
    void resizeEvent(QResizeEvent* event) override;
    void refreshed() override;

  private:
    bool isStacked(int width) const;
    int valueWidth() const;
    int wordsHeight(int width) const;
    void place();

    BlockText words_, value_;
    IconButton* less_;
    IconButton* more_;
};

}  // namespace ktr::app
