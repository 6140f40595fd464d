#pragma once

#include <QTimer>

#include "app/window/Announcer.h"
#include "app/window/blocks/Words.h"

namespace ktr::app {

/// A sentence over the lower part of a window that goes by itself, or when it is pressed: for what could not be done
/// and has no other place. It is spoken, too. Main thread.
class Notice : public Block {
  public:
    explicit Notice(QWidget* window);

    void say(const QString& sentence);
    QString sentence() const { return isVisible() ? words_->text() : QString(); }
    /// Stands so far above the window's lower edge.
    void place(int above);

    int shapeHeight(int width) const override;
    QAccessible::Role role() const override { return QAccessible::AlertMessage; }

  protected:
    void paintEvent(QPaintEvent* event) override;
    void mousePressEvent(QMouseEvent* event) override;
    void lookChanged() override { words_->setLook(look()); }

  private:
    Words* words_;
    Announcer* announcer_;
    QTimer timer_;
    int above_ = 0;
};

}  // namespace ktr::app
