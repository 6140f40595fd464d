#pragma once

#include "app/window/blocks/Block.h"
#include "app/window/blocks/BlockText.h"

namespace ktr::app {

/// Words on a page that are only read: its title, a line, a section's name, a note with a mark. Main thread.
class Words : public Block {
  public:
    enum class Tone { Ink, Soft };

    explicit Words(BlockStyle style, Tone tone = Tone::Ink, QWidget* parent = nullptr);

    void setText(const QString& text);
    const QString& text() const { return text_.text(); }
    void setAlignment(BlockAlignment alignment);
    void setBalanced(bool isBalanced);
    /// See BlockText.
    void keepWordsWhole();
    /// A warning before the first line.
    void setWarning(bool isWarning);

    /// Letters that are higher or deeper than a line reach beyond it, above and below.
    int around() const override;
    int shapeHeight(int width) const override;
    int naturalWidth() const override;
    /// Words that are not there yet only keep a place.
    QAccessible::Role role() const override {
        return text().isEmpty() ? QAccessible::Whitespace : QAccessible::StaticText;
    }

  protected:
    void paintEvent(QPaintEvent* event) override;

  private:
    int markRoom() const;

    const BlockStyle style_;
    const Tone tone_;
    BlockText text_;
    BlockAlignment alignment_ = BlockAlignment::Start;
    bool isBalanced_ = false;
    bool keepsWords_ = false;
    bool isWarning_ = false;
};

}  // namespace ktr::app
