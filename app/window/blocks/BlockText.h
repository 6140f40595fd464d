#pragma once

#include <QColor>
#include <QFont>
#include <QRectF>
#include <QString>
#include <memory>

#include "linux/paint/QtTextLayout.h"
#include "platform/ui/Font.h"

class QPainter;

namespace ktr::app {

enum class BlockStyle { Title, Headline, Body, Subheadline, Footnote, FootnoteBold };
enum class BlockAlignment { Start, Centre, End };

/// A text as blocks set it: in as many lines as it needs, in the text engine of the installed platform and at its text
/// size; without a platform it takes no room. A value. Main thread.
class BlockText {
  public:
    /// Between two letters, a line may end there; it takes no room.
    static constexpr QChar kMayPart{0x200B};

    BlockText() = default;
    explicit BlockText(QString text, BlockStyle style = BlockStyle::Body, bool isBalanced = false)
        : text_(std::move(text)), style_(style), isBalanced_(isBalanced) {}

    /// Where a word is wider than its line, everything is set smaller, down to half its size, so that nothing is broken
    /// inside a word.
    void keepWordsWhole() { keepsWords_ = true; }

    static platform::Font fontOf(BlockStyle style);
    /// The same for a line that is typed into.
    static QFont typingFont(BlockStyle style);

    const QString& text() const { return text_; }
    bool isEmpty() const { return text_.isEmpty(); }
    /// On one line, whole points; 0 without words.
    int naturalWidth() const;
    int heightFor(double width) const;
    /// Into a box; what needs more height than it has goes on below.
    void paint(QPainter& painter, const QRectF& box, const QColor& color, const linux_::Palette& palette,
               bool rightToLeft, BlockAlignment alignment = BlockAlignment::Start) const;

  private:
    std::shared_ptr<const linux_::QtTextLayout> layOut(double width, bool rightToLeft, BlockAlignment alignment) const;
    double widthWithin(double width) const;
    platform::Font fontWithin(double width) const;

    QString text_;
    BlockStyle style_ = BlockStyle::Body;
    bool isBalanced_ = false;
    bool keepsWords_ = false;
};

}  // namespace ktr::app
