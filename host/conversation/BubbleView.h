#pragma once

#include <memory>
#include <string>

#include "platform/ui/Label.h"
#include "platform/ui/View.h"

namespace ktr::host {

/// The user's question in a bubble at the end edge. A question of two or three lines is balanced: as narrow as the same
/// number of lines allows. Main thread.
class BubbleView : public platform::View {
  public:
    bool initWithFrame(const platform::Rect& frame) override;
    void setText(const std::string& text);
    /// Takes the font that fits the text size of now.
    void chooseFont();
    /// The bubble's own size when it may be `mostWidth` wide; zero without a text.
    platform::Size sizeForWidth(double mostWidth) const;
    void layoutSubviews() override;
    platform::AccessibilityRole accessibilityRole() const override { return platform::AccessibilityRole::Group; }
    std::string accessibilityText() const override;

  protected:
    void draw(platform::Canvas& canvas) const override;

  private:
    std::shared_ptr<platform::Label> label_;
};

/// The size of a wrapped text, and how many lines it takes. Points.
struct WrappedSize {
    platform::Size size;
    std::size_t lines = 0;
};
WrappedSize wrappedSize(const std::string& text, const platform::Font& font, double width);
/// The narrowest whole width that keeps a text of two or three lines at its number of lines; else the text's own.
double balancedWidth(const std::string& text, const platform::Font& font, double mostWidth);

}  // namespace ktr::host
