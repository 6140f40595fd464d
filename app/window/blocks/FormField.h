#pragma once

#include <functional>

#include "app/window/QuestionEdit.h"
#include "app/window/blocks/IconButton.h"
#include "app/window/blocks/Words.h"

namespace ktr::app {

/// A line to fill in, with its label above and what is wrong with it below. Main thread.
class FormField : public Block {
  public:
    explicit FormField(QWidget* parent = nullptr);

    void setLabel(const QString& label);
    void setHint(const QString& hint);
    /// Marks it as wrong; empty: it is not.
    void setNote(const QString& note);
    QString note() const { return note_->text(); }
    /// Its letters are dots, until the eye is pressed. The names are spoken.
    void setSecret(const QString& show, const QString& hide);
    void setText(const QString& text) { edit_->setText(text); }
    QString text() const { return edit_->text(); }
    /// It can be read, but not changed.
    void setFixed(bool isFixed);
    /// Called with every change by the user, and when Enter is pressed.
    void setChanged(std::function<void()> changed) { changed_ = std::move(changed); }
    void setEntered(std::function<void()> entered) { entered_ = std::move(entered); }
    QuestionEdit& edit() const { return *edit_; }

    int shapeHeight(int width) const override;

  protected:
    void paintEvent(QPaintEvent* event) override;
    void resizeEvent(QResizeEvent* event) override;
    void mousePressEvent(QMouseEvent* event) override;
    bool eventFilter(QObject* object, QEvent* event) override;
    bool event(QEvent* event) override;
    void lookChanged() override;
    void refreshed() override;

  private:
    QRectF box() const;
    int labelHeight(int width) const;
    int boxHeight() const;
    void place();

    Words* label_;
    QuestionEdit* edit_;
    IconButton* eye_ = nullptr;
    Words* note_;
    QString show_, hide_;
    std::function<void()> changed_, entered_;
    QObject listener_;
};

}  // namespace ktr::app
