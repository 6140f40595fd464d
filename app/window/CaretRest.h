#pragma once

#include <QObject>
#include <QTimer>

namespace ktr::app {

/// Lets the carets of all fields stand still a while after the last key, click or change of focus: one that blinks on
/// wakes the processor twice a second for nobody. Main thread.
class CaretRest : public QObject {
  public:
    /// So long a caret blinks, milliseconds.
    static constexpr int kBlinks = 8000;

    /// Holds for the application, which outlives this.
    explicit CaretRest(int milliseconds = kBlinks);
    ~CaretRest() override;

  protected:
    bool eventFilter(QObject* object, QEvent* event) override;

  private:
    void rest();
    void wake();

    QTimer timer_;
    /// The desktop's, while carets rest; 0: they do not.
    int flashTime_ = 0;
};

}  // namespace ktr::app
