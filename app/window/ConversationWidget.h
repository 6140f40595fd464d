#pragma once

#include <QElapsedTimer>
#include <QPointF>
#include <QScrollBar>
#include <QTimer>
#include <QTouchEvent>
#include <QWidget>
#include <memory>
#include <optional>

#include "app/window/KineticScroll.h"
#include "app/window/RingTurner.h"
#include "app/window/RowFocus.h"
#include "app/window/Voice.h"
#include "host/Host.h"
#include "linux/paint/Palette.h"
#include "platform/ui/TouchDispatcher.h"
#include "platform/ui/Window.h"

namespace ktr::app {

class AccessibleConversation;

/// Shows a host's conversation: paints what changed, scrolls, and turns what mouse, pen, finger and keyboard do into
/// touches. One point is one logical pixel. Main thread.
class ConversationWidget : public QWidget {
  public:
    /// The host outlives the widget.
    explicit ConversationWidget(host::Host& host, QWidget* parent = nullptr);
    ~ConversationWidget() override;

    host::Host& host() const { return host_; }
    /// From the view tree's coordinates to the widget's: points that are scrolled away at the top.
    double scrolled() const { return bar_->value(); }
    void scrollTo(double y);
    /// Puts the newest turn at the top.
    void scrollToNewest(bool moves = false);
    /// What the arrow keys and the page keys do.
    void scrollBy(const QKeyEvent& key);
    /// A turn was added, which is the newest then; a turn got its answer.
    void turnCame(host::TurnView& turn);
    void answerCame(host::TurnView& turn);
    /// A turn looks another way, or has gone.
    void turnsChanged() { layOut(); }
    void setReducedMotion(bool reduced);
    /// Whether anybody sees the window; so it is at first. Nothing turns while nobody does.
    void setSeen(bool seen);
    /// The desktop's wish, besides that of the options; the host has it too, for its stills.
    void setHighContrast(bool high);
    /// The desktop's colours; none: those of the toolkit.
    void setDesktopDark(std::optional<bool> dark);
    /// The colour of what can be done; none: the palette's own.
    void setAccent(const std::optional<QColor>& accent);
    const linux_::Palette& colors() const { return palette_; }
    /// Called after the colours have become others.
    void setPaletteChanged(std::function<void()> changed) { paletteChanged_ = std::move(changed); }
    const RowFocus& rows() const { return rows_; }
    /// Called when what is shown may stand elsewhere than before.
    void setMoved(std::function<void()> moved) { moved_ = std::move(moved); }
    /// What stands over the top end corner reaches so far from both edges.
    void setCorner(const QSizeF& corner);
    /// Whether something is said or shown in a rectangle of the widget.
    bool showsSomethingIn(const QRectF& rect) const;
    /// The host has made everything anew: cards are others, and the language may be.
    void remade();
    /// Made once somebody asks for it; from then on it hears what changes.
    AccessibleConversation& accessible();
    bool isAccessed() const { return accessible_ != nullptr; }
    /// Gives a row the keyboard's focus; false when it is none.
    bool focusRow(const platform::View* row);
    /// Something besides the rows may have changed that a listener wants to hear of.
    void tellListeners() { voice_->changed(); }
    /// How often something was painted: what a test asks to see that only what changed is.
    const QRegion& lastPainted() const { return lastPainted_; }

  protected:
    bool event(QEvent* event) override;
    void paintEvent(QPaintEvent* event) override;
    void resizeEvent(QResizeEvent* event) override;
    void wheelEvent(QWheelEvent* event) override;
    void mousePressEvent(QMouseEvent* event) override;
    void mouseMoveEvent(QMouseEvent* event) override;
    void mouseReleaseEvent(QMouseEvent* event) override;
    void leaveEvent(QEvent* event) override;
    void focusInEvent(QFocusEvent* event) override;
    void focusOutEvent(QFocusEvent* event) override;
    void keyPressEvent(QKeyEvent* event) override;
    void changeEvent(QEvent* event) override;
    void contextMenuEvent(QContextMenuEvent* event) override;
    bool focusNextPrevChild(bool next) override;

  private:
    class Client;

    void layOut();
    void requestLayout();
    void layOutWindow();
    void layOutMarked();
    /// Tells assistive technology.
    void rowsChanged();
    /// The next picture of what moves.
    void move();
    void startMoving();
    /// The user, or the desktop, wants nothing to slide or turn.
    bool standsStill() const;
    void chooseMotion();
    void stopScrolling() { scrollFrom_.reset(); }
    /// Tells the cards which of them are scrolled away, once scrolling rests.
    void lookLater();
    void look();
    bool isOnScreen(const host::TurnView& turn) const;
    bool isLow() const;
    /// Where the turn stands on screen that the reader's eye is on: the first that is seen.
    std::shared_ptr<host::TurnView> anchor() const;
    void keepInPlace(const std::shared_ptr<host::TurnView>& turn, double before);
    /// Lays out again after a card's height changed; its top, or else its bottom, stays where it is on screen.
    void resizeCard(platform::HostSnippetViewController& controller, bool pinTop);
    void updateBar();
    void tellMoved() const;
    /// How far is scrolled when the newest turn is at the top, points.
    double newestTop() const;
    void choosePalette();
    bool touch(QTouchEvent& event);
    void fling();
    /// A finger has rested for as long as it takes to ask for a menu.
    void held();
    /// What can be copied at a point of the widget; empty where nothing is said.
    std::string textAt(QPointF point) const;
    /// A menu to copy a text; none for an empty one.
    void offerCopy(const std::string& text, QPoint at);
    void showFocus();
    /// False for a key that means nothing to rows, as all do while none has the focus.
    bool moveAmongRows(int key);
    platform::Point inTree(QPointF point) const { return {point.x(), point.y() + scrolled()}; }
    double seconds() const;

    host::Host& host_;
    std::unique_ptr<AccessibleConversation> accessible_;
    std::shared_ptr<Client> client_;
    std::shared_ptr<platform::TouchDispatcher> touches_;
    RowFocus rows_;
    std::optional<bool> desktopDark_;
    std::optional<QColor> accent_;
    linux_::Palette palette_ = linux_::Palette::of(linux_::ColorScheme::Light);
    std::function<void()> paletteChanged_;
    std::function<void()> moved_;
    QSizeF corner_;
    std::unique_ptr<Voice> voice_;
    bool reducedMotion_ = false;
    QScrollBar* bar_;
    RingTurner rings_;
    QTimer flingTimer_;
    QTimer holdTimer_;
    QTimer motionTimer_;
    QTimer restTimer_;
    /// Where the way to the newest turn began; none: nothing scrolls by itself.
    std::optional<double> scrollFrom_;
    host::Motion scroll_;
    QElapsedTimer clock_;
    KineticScroll kinetic_;
    /// Where the finger went down, while it has not moved far enough to scroll.
    std::optional<QPointF> tap_;
    double contentHeight_ = 0.0;
    double wheelRest_ = 0.0;
    bool layingOut_ = false;
    bool layoutRequested_ = false;
    bool heightsChanged_ = false;
    bool isSeen_ = true;
    QRegion lastPainted_;
};

}  // namespace ktr::app
