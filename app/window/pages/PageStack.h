#pragma once

#include <QElapsedTimer>
#include <QPointer>
#include <QTimer>
#include <memory>
#include <vector>

#include "app/window/pages/Page.h"
#include "host/conversation/Motion.h"

namespace ktr::app {

class Announcer;

/// The pages that are open over a window's conversation, the newest above. The way back is each page's own button,
/// Escape, Alt with the arrow that points back, a keyboard's and a mouse's key for it. Who has the focus and what a
/// screen reader hears follow. As large as the window, and hidden without pages. Main thread.
class PageStack : public Block {
  public:
    /// A child of the window that it covers.
    explicit PageStack(QWidget* window);
    ~PageStack() override;

    /// Takes the page over and shows it.
    void open(std::unique_ptr<Page> page);
    /// Leaves the newest page: for the one below it, or the conversation. Nothing happens where it cannot be left.
    void back();
    /// Leaves all pages, also one that cannot be left by itself.
    void closeAll();
    /// The installed platform is about to go: all pages let go of it.
    void letGo();
    bool isOpen() const { return !open_.empty(); }
    /// The newest page, or none.
    Page* current() const { return open_.empty() ? nullptr : open_.back().page; }
    /// Called with whether what lies below is seen: true as soon as the last page begins to go, false once a page
    /// covers it.
    void setBelow(std::function<void(bool isSeen)> below) { below_ = std::move(below); }
    void setMotion(host::MotionStyle style) { motion_ = style; }
    /// Whether a page is still coming or going.
    bool isMoving() const { return timer_.isActive(); }

    int shapeHeight(int /*width*/) const override { return height(); }

  protected:
    void resizeEvent(QResizeEvent* event) override;
    void keyPressEvent(QKeyEvent* event) override;
    bool eventFilter(QObject* object, QEvent* event) override;

  private:
    struct Open {
        Page* page;
        QPointer<QWidget> before;  ///< who had the focus
    };
    bool meansBack(const QKeyEvent& key) const;
    void focusOn(Page& page);
    void showBelow(bool isSeen);
    void take(bool isAll);
    void begin(Page* page, double from, double to);
    void move();
    void finish();
    double seconds() const { return static_cast<double>(clock_.nsecsElapsed()) * 1e-9; }

    Announcer* announcer_;
    std::vector<Open> open_;
    std::function<void(bool)> below_;
    host::MotionStyle motion_ = host::MotionStyle::Full;
    /// The page that comes or goes, and how much of it is there.
    QPointer<Page> moving_;
    bool isGoing_ = false;
    host::Motion share_;
    QTimer timer_;
    QElapsedTimer clock_;
};

}  // namespace ktr::app
