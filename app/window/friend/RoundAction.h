#pragma once

#include "app/window/blocks/BlockText.h"
#include "app/window/blocks/Icon.h"
#include "app/window/blocks/PressBlock.h"

namespace ktr::app {

/// A round button with its name under it; in very large text beside it. Main thread.
class RoundAction : public PressBlock {
  public:
    RoundAction(Icon icon, const QString& words, QWidget* parent = nullptr);

    Icon icon() const { return icon_; }
    void setWords(const QString& words);
    int around() const override { return 0; }
    int shapeHeight(int width) const override;

  protected:
    void paintEvent(QPaintEvent* event) override;
    void refreshed() override { askForRoom(); }

  private:
    static constexpr int kDisc = 44;
    static constexpr int kToWords = 5;
    static constexpr int kBeside = 12;
    static constexpr int kRoom = 5;  ///< for the ring, above and below

    const Icon icon_;
    BlockText words_;
};

}  // namespace ktr::app
