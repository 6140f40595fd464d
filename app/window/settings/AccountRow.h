#pragma once

#include "app/window/blocks/Block.h"
#include "app/window/blocks/BlockText.h"
#include "app/window/blocks/Button.h"
#include "linux/paint/QtImage.h"

namespace ktr::app {

/// Who is signed in, and the button that signs out: beside it, or below where there is no room. Main thread.
class AccountRow : public Block {
  public:
    explicit AccountRow(QWidget* parent = nullptr);

    void setTexts(const QString& name, const QString& address, const QString& signOut);
    /// 54 points across.
    void setFace(std::shared_ptr<const linux_::QtImage> face);
    Button& signOut() const { return *signOut_; }

    int shapeHeight(int width) const override;
    QAccessible::Role role() const override { return QAccessible::StaticText; }

  protected:
    void paintEvent(QPaintEvent* event) override;
    void resizeEvent(QResizeEvent* event) override;
    void refreshed() override;

  private:
    bool isStacked(int width) const;
    int textWidth(int width) const;
    int textHeight(int width) const;
    int upperHeight(int width) const;
    void place();

    BlockText name_, address_;
    std::shared_ptr<const linux_::QtImage> face_;
    Button* signOut_;
};

}  // namespace ktr::app
