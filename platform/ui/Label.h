#pragma once

#include <memory>
#include <string>

#include "platform/text/TextEngine.h"
#include "platform/ui/View.h"

namespace ktr::platform {

/// One text in one font. Its content is centred on the label's height. Takes no touches. Setting what is already set
/// costs nothing. Main thread.
class KTR_API Label : public View {
  public:
    Label();

    const std::string& text() const { return text_; }
    void setText(const std::string& text);
    const Font& font() const { return font_; }
    void setFont(const Font& font);
    const Color& textColor() const { return textColor_; }
    void setTextColor(const Color& color);
    TextAlignment textAlignment() const { return alignment_; }
    void setTextAlignment(TextAlignment alignment);
    /// 0 is no limit; 1 the default.
    int numberOfLines() const { return numberOfLines_; }
    void setNumberOfLines(int lines);
    LineBreakMode lineBreakMode() const { return lineBreakMode_; }
    void setLineBreakMode(LineBreakMode mode);

    /// The text as it is drawn at the label's present width: for painting, dumps and tests.
    std::shared_ptr<const TextLayout> textLayout() const;
    /// The end of the drawn text's first line in the label's coordinates (its trailing edge), for marks beside the
    /// text.
    Rect drawnTextRect() const;

    IntrinsicSize intrinsicContentSize(double widthLimit) const override;
    bool intrinsicHeightDependsOnWidth() const override { return numberOfLines_ != 1; }
    BaselineOffsets baselineOffsets() const override;
    AccessibilityRole accessibilityRole() const override { return AccessibilityRole::Text; }
    std::string accessibilityText() const override;

  protected:
    void draw(Canvas& canvas) const override;

  private:
    std::shared_ptr<const TextLayout> layoutForWidth(double width) const;
    void contentChanged();
    /// The one line at its natural width, when it can be drawn as it stands.
    std::shared_ptr<const TextLayout> naturalLayout() const;
    /// Where the drawn text's container begins.
    Point textOrigin(const TextLayout& layout) const;

    std::string text_;
    Font font_;
    Color textColor_ = Color::ofRole(ColorRole::StandardText);
    TextAlignment alignment_ = TextAlignment::Natural;
    int numberOfLines_ = 1;
    LineBreakMode lineBreakMode_ = LineBreakMode::TruncatingTail;
    /// What was laid out last at the natural width (which serves for drawing too, where one line fits) and at another
    /// width.
    mutable std::shared_ptr<const TextLayout> natural_;
    mutable std::shared_ptr<const TextLayout> drawn_;
    mutable double drawnWidth_ = -1.0;
};

}  // namespace ktr::platform
