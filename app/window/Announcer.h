#pragma once

#include <QString>
#include <QWidget>

namespace ktr::app {

/// Has assistive technology say something by itself: an element without a place, which takes the message for its name
/// and then says that it is shown. Name changes and alerts are not spoken; where Qt knows announcements, one is sent
/// instead, and never both. It needs no listener that has looked at the window before. Main thread.
class Announcer : public QWidget {
  public:
    explicit Announcer(QWidget* window);

    void say(const QString& message);
    const QString& message() const { return message_; }

  private:
    QString message_;
};

}  // namespace ktr::app
