#pragma once

#include "app/window/blocks/Icon.h"
#include "app/window/blocks/PressBlock.h"

namespace ktr::app {

/// A button of one icon in a target of 44 points; its name is only spoken, and shown under a pointer. Main thread.
class IconButton : public PressBlock {
  public:
    enum class Tone { Pine, Soft, Ink };

    explicit IconButton(Icon icon, Tone tone = Tone::Pine, QWidget* parent = nullptr);

    void setName(const QString& name);
    /// Of its target.
    static int side() { return controlHeight(kSide); }

    /// Of what is painted of the icon in its middle: icons keep a margin in their square.
    static double inkSideOf(Icon icon) { return kInkShare * grown(iconSide(icon)); }

    int around() const override { return 0; }
    int shapeHeight(int /*width*/) const override { return side(); }
    int naturalWidth() const override { return side(); }

  protected:
    void paintEvent(QPaintEvent* event) override;

  private:
    static constexpr int kSide = 44;
    static constexpr double kInkShare = 0.7;

    const Icon icon_;
    const Tone tone_;
};

}  // namespace ktr::app
