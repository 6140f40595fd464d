#include "app/window/blocks/Words.h"

#include <QPainter>

#include "app/window/blocks/Icon.h"

namespace ktr::app {

namespace {

constexpr int kMarkGap = 8;

}  // namespace

Words::Words(BlockStyle style, Tone tone, QWidget* parent)
    : Block(parent),
      style_(style),
      tone_(tone),
      isBalanced_(style == BlockStyle::Title),
      keepsWords_(style == BlockStyle::Title) {
    setFocusPolicy(Qt::NoFocus);
    setAttribute(Qt::WA_TransparentForMouseEvents);
}

void Words::setText(const QString& text) {
    if (text != text_.text()) {
        text_ = BlockText(text, style_, isBalanced_);
        if (keepsWords_) {
            text_.keepWordsWhole();
        }
        setAccessibleName(text);
        askForRoom();
    }
}

void Words::setAlignment(BlockAlignment alignment) {
    alignment_ = alignment;
    update();
}

void Words::setBalanced(bool isBalanced) {
    isBalanced_ = isBalanced;
    text_ = BlockText(text_.text(), style_, isBalanced);
    if (keepsWords_) {
        text_.keepWordsWhole();
    }
    askForRoom();
}

void Words::keepWordsWhole() {
    keepsWords_ = true;
    text_.keepWordsWhole();
    askForRoom();
}

void Words::setWarning(bool isWarning) {
    isWarning_ = isWarning;
    askForRoom();
}

int Words::markRoom() const {
    return isWarning_ ? static_cast<int>(grown(iconSide(Icon::Warning))) + kMarkGap : 0;
}

int Words::around() const {
    return static_cast<int>(BlockText::fontOf(style_).lineHeight() / 4.0);
}

int Words::shapeHeight(int width) const {
    return text_.heightFor(width - markRoom());
}

int Words::naturalWidth() const {
    return text_.naturalWidth() + markRoom();
}

void Words::paintEvent(QPaintEvent*) {
    QPainter painter(this);
    const QRectF inside = shape();
    const QRectF box = mirrored(inside.adjusted(markRoom(), 0, 0, 0));
    text_.paint(painter, box, tone_ == Tone::Soft ? colors().inkSoft : colors().ink, colors(), isMirrored(),
                alignment_);
    if (isWarning_) {
        const double side = grown(iconSide(Icon::Warning));
        const double top = (BlockText::fontOf(style_).lineHeight() - side) / 2.0;
        paintIcon(painter, Icon::Warning, mirrored({inside.x(), inside.y() + std::max(top, 0.0), side, side}),
                  colors().warning, false);
    }
}

}  // namespace ktr::app
