#pragma once

#include <QElapsedTimer>
#include <QTimer>
#include <memory>

#include "app/window/blocks/BlockText.h"
#include "app/window/blocks/Icon.h"
#include "app/window/blocks/PressBlock.h"
#include "host/conversation/Motion.h"
#include "linux/paint/QtImage.h"

namespace ktr::app {

/// A row of a list card: words, a second line, a value, and what stands at its end. Main thread.
class ListRow : public PressBlock {
  public:
    enum class Kind {
        Plain,   ///< only read
        Leads,   ///< to another page: a chevron
        Adds,    ///< words in pine and a plus
        Switch,  ///< acts at once
        Choice,  ///< one of several
        Fine,    ///< a tick before the words, only read
    };

    explicit ListRow(Kind kind, const QString& words = {}, QWidget* parent = nullptr);

    void setWords(const QString& words);
    void setSecond(const QString& second);
    void setValue(const QString& value);
    /// 42 or 54 points across, before bold words.
    void setFace(std::shared_ptr<const linux_::QtImage> face);
    /// Of a switch and a choice; nobody is told.
    void setChecked(bool isChecked);
    /// Shown, but not to be changed here.
    void setHeld(bool isHeld);
    /// Its place in the card, whose corners it shares.
    void setEnds(bool isFirst, bool isLast);

    int around() const override { return 0; }
    int shapeHeight(int width) const override;
    QAccessible::Role role() const override;
    bool canBePressed() const override;
    bool isCheckable() const override { return kind_ == Kind::Switch || kind_ == Kind::Choice; }
    bool isChecked() const override { return isChecked_; }

  protected:
    void paintEvent(QPaintEvent* event) override;
    void refreshed() override { askForRoom(); }

  private:
    /// Where things are, at a width; not mirrored.
    struct Plan {
        QRectF words, second, value, face, end;
        int height = 0;
    };
    Plan planFor(int width) const;
    double startOfWords() const;
    QSizeF endSize() const;
    void nameIt();
    void choosePressing();
    QPainterPath outline() const;
    void paintEnd(QPainter& painter, const QRectF& end);
    void paintSwitch(QPainter& painter, const QRectF& box);
    void paintChoice(QPainter& painter, const QRectF& box) const;
    double seconds() const { return static_cast<double>(clock_.nsecsElapsed()) * 1e-9; }

    const Kind kind_;
    BlockText words_, second_, value_;
    std::shared_ptr<const linux_::QtImage> face_;
    bool isChecked_ = false;
    bool isHeld_ = false;
    bool isFirst_ = true;
    bool isLast_ = true;
    QElapsedTimer clock_;
    QTimer timer_;
    host::Motion knob_;
};

}  // namespace ktr::app
