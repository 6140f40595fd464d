#pragma once

#include <memory>

#include "app/window/blocks/BlockText.h"
#include "app/window/blocks/PressBlock.h"
#include "linux/paint/QtImage.h"

namespace ktr::app {

/// A person to choose: face and name. Main thread.
class PersonPill : public PressBlock {
  public:
    /// The face is 36 points across.
    PersonPill(const QString& name, std::shared_ptr<const linux_::QtImage> face, QWidget* parent = nullptr);

    static constexpr int kFace = 36;
    int shapeHeight(int width) const override;
    int naturalWidth() const override;

  protected:
    void paintEvent(QPaintEvent* event) override;

  private:
    BlockText name_;
    std::shared_ptr<const linux_::QtImage> face_;
};

/// A question that may be asked with a tap: the bubble's form, empty. Main thread.
class UnaskedQuestion : public PressBlock {
  public:
    explicit UnaskedQuestion(const QString& question, QWidget* parent = nullptr);

    const QString& question() const { return words_.text(); }
    int shapeHeight(int width) const override;
    int naturalWidth() const override;

  protected:
    void paintEvent(QPaintEvent* event) override;

  private:
    BlockText words_;
};

}  // namespace ktr::app
