#include "app/window/ConversationWidget.h"

#include <QApplication>
#include <QPainter>
#include <QStyle>
#include <algorithm>
#include <cmath>
#include <utility>

#include "app/window/AccessibleConversation.h"
#include "app/window/ScrollBarStyle.h"
#include "host/conversation/Measures.h"
#include "linux/paint/QtCanvas.h"

namespace ktr::app {

using linux_::ColorScheme;
using linux_::Contrast;
using linux_::Palette;

namespace {

constexpr int kFrame = 16;  // milliseconds
/// Scrolling rests after so long: what only passes by is told nothing. Milliseconds.
constexpr int kRest = 250;
/// A lower window shows no times, and leaves the room above the first turn scrolled away.
constexpr int kLowestUsual = 300;

}  // namespace

/// What the view tree asks of its window.
class ConversationWidget::Client : public platform::WindowClient {
  public:
    explicit Client(ConversationWidget& widget) : widget_(widget) {}
    void windowNeedsDisplay(const platform::Rect& rect) override {
        const QRectF there(rect.x, rect.y - widget_.scrolled(), rect.width, rect.height);
        widget_.update(there.toAlignedRect());
    }
    void windowNeedsLayout() override { widget_.requestLayout(); }

  private:
    ConversationWidget& widget_;
};

ConversationWidget::ConversationWidget(host::Host& host, QWidget* parent)
    : QWidget(parent),
      host_(host),
      client_(std::make_shared<Client>(*this)),
      touches_(std::make_shared<platform::TouchDispatcher>(host.window())),
      rows_(host.window(), host.conversation(), host.rightToLeft()),
      voice_(std::make_unique<Voice>(host, *this)),
      bar_(new QScrollBar(Qt::Vertical, this)),
      rings_(
          host.conversation(), [this] { return standsStill(); },
          [this](const host::TurnView& turn) { return isSeen_ && isOnScreen(turn); }) {
    setAttribute(Qt::WA_OpaquePaintEvent);
    setAttribute(Qt::WA_AcceptTouchEvents);
    setMouseTracking(true);
    setFocusPolicy(Qt::StrongFocus);
    setMinimumSize(280, 200);
    setLayoutDirection(host.rightToLeft() ? Qt::RightToLeft : Qt::LeftToRight);
    clock_.start();
    bar_->setFocusPolicy(Qt::NoFocus);
    bar_->setCursor(Qt::ArrowCursor);
    connect(bar_, &QScrollBar::valueChanged, this, [this] {
        update();
        AccessibleConversation::moved(*this);
        tellMoved();
        lookLater();
    });
    restTimer_.setSingleShot(true);
    restTimer_.setInterval(kRest);
    connect(&restTimer_, &QTimer::timeout, this, [this] { look(); });
    flingTimer_.setInterval(kFrame);
    connect(&flingTimer_, &QTimer::timeout, this, [this] { fling(); });
    motionTimer_.setInterval(kFrame);
    connect(&motionTimer_, &QTimer::timeout, this, [this] { move(); });
    constexpr int kHold = 600;  // milliseconds
    holdTimer_.setSingleShot(true);
    holdTimer_.setInterval(kHold);
    connect(&holdTimer_, &QTimer::timeout, this, [this] { held(); });
    host_.window()->setClient(client_);
    host_.delegate().resize = [this](platform::HostSnippetViewController& controller, bool pinTop) {
        resizeCard(controller, pinTop);
    };
    choosePalette();
    chooseMotion();
    AccessibleConversation::install();
}

ConversationWidget::~ConversationWidget() {
    accessible_.reset();
    host_.delegate().resize = nullptr;
    // The conversation stays.
    host_.conversation()->setPalette(Palette::of(palette_.scheme, palette_.contrast));
}

AccessibleConversation& ConversationWidget::accessible() {
    if (!accessible_) {
        accessible_ = std::make_unique<AccessibleConversation>(*this);
    }
    return *accessible_;
}

void ConversationWidget::remade() {
    setLayoutDirection(host_.rightToLeft() ? Qt::RightToLeft : Qt::LeftToRight);
    rows_.setRightToLeft(host_.rightToLeft());
    choosePalette();
    // What it waits with has gone with the platform.
    voice_ = std::make_unique<Voice>(host_, *this);
    layOut();
}

double ConversationWidget::seconds() const {
    return static_cast<double>(clock_.nsecsElapsed()) * 1e-9;
}

void ConversationWidget::choosePalette() {
    const bool systemIsDark = desktopDark_.value_or(QApplication::palette().color(QPalette::Window).lightness() < 128);
    const host::HostSettings& settings = host_.settings();
    const bool highContrast = settings.drawsHighContrast();
    const Palette& plain = Palette::of(settings.dark.value_or(systemIsDark) ? ColorScheme::Dark : ColorScheme::Light,
                                       highContrast ? Contrast::High : Contrast::Normal);
    // Always in the same place: whoever was shown the colours keeps looking there.
    palette_ = accent_ ? plain.withAccent(*accent_) : plain;
    host_.conversation()->setPalette(palette_);
    bar_->setStyleSheet(scrollBarStyle(palette_));
    update();
    if (paletteChanged_) {
        paletteChanged_();
    }
}

void ConversationWidget::layOut() {
    layoutRequested_ = false;
    heightsChanged_ = false;
    layingOut_ = true;
    const auto turn = anchor();
    const double before = turn ? host_.conversation()->topOf(*turn) : 0.0;
    host_.conversation()->advance(seconds());
    host_.conversation()->setShowsTimes(!isLow());
    contentHeight_ = host_.layOut(width());
    layingOut_ = false;
    updateBar();
    keepInPlace(turn, before);
    startMoving();
    rows_.refresh();
    rings_.update();
    update();
    rowsChanged();
    tellMoved();
    lookLater();
    if (heightsChanged_) {
        requestLayout();
    }
}

void ConversationWidget::rowsChanged() {
    AccessibleConversation::changed(*this);
    voice_->changed();
}

bool ConversationWidget::standsStill() const {
    return reducedMotion_ || style()->styleHint(QStyle::SH_Widget_Animation_Duration, nullptr, this) == 0;
}

void ConversationWidget::chooseMotion() {
    host_.conversation()->setMotionStyle(standsStill() ? host::MotionStyle::Reduced : host::MotionStyle::Full);
}

void ConversationWidget::startMoving() {
    if (!motionTimer_.isActive() && (scrollFrom_ || host_.conversation()->advance(seconds()))) {
        motionTimer_.start();
    }
}

std::shared_ptr<host::TurnView> ConversationWidget::anchor() const {
    const auto& turns = host_.conversation()->turns();
    const auto seen =
        std::find_if(turns.begin(), turns.end(), [&](const auto& turn) { return turn->frame().maxY() > scrolled(); });
    return seen == turns.end() ? nullptr : *seen;
}

void ConversationWidget::keepInPlace(const std::shared_ptr<host::TurnView>& turn, double before) {
    const double moved = turn ? host_.conversation()->topOf(*turn) - before : 0.0;
    if (moved != 0.0) {
        scrollTo(scrolled() + moved);
        if (scrollFrom_) {
            *scrollFrom_ += moved;
        }
    }
}

void ConversationWidget::move() {
    const auto& conversation = host_.conversation();
    const auto turn = anchor();
    const double before = turn ? conversation->topOf(*turn) : 0.0;
    layingOut_ = true;
    const bool moves = conversation->advance(seconds());
    contentHeight_ = conversation->frame().height;
    host_.window()->setFrame(conversation->frame());
    host_.window()->layoutIfNeeded();
    layingOut_ = false;
    updateBar();
    keepInPlace(turn, before);
    rows_.refresh();
    if (scrollFrom_) {
        scrollTo(*scrollFrom_ + (newestTop() - *scrollFrom_) * scroll_.at(seconds()));
        if (scroll_.isOver(seconds())) {
            stopScrolling();
        }
    }
    update();
    tellMoved();
    if (!moves && !scrollFrom_) {
        motionTimer_.stop();
        AccessibleConversation::changed(*this);
    }
}

void ConversationWidget::requestLayout() {
    if (layingOut_ || layoutRequested_) {
        return;
    }
    layoutRequested_ = true;
    QMetaObject::invokeMethod(
        this,
        [this] {
            if (layoutRequested_) {
                layOutMarked();
            }
        },
        Qt::QueuedConnection);
}

void ConversationWidget::layOutWindow() {
    layingOut_ = true;
    host_.window()->layoutIfNeeded();
    layingOut_ = false;
    rowsChanged();
}

/// What has changed within its card, such as a distance when the user moves. Where a card is of another height now, by
/// its controller's word or without it, everything is laid out.
void ConversationWidget::layOutMarked() {
    layoutRequested_ = false;
    const auto& turns = host_.conversation()->turns();
    if (heightsChanged_) {
        layOut();
        return;
    }
    layOutWindow();
    if (std::any_of(turns.begin(), turns.end(), [](const auto& turn) { return turn->isOutdated(); })) {
        layOut();
    }
}

void ConversationWidget::updateBar() {
    // Below the newest turn there is always room enough to bring it to the top.
    const double extent = std::max(contentHeight_, newestTop() + height());
    const int most = std::max(static_cast<int>(std::ceil(extent)) - height(), 0);
    bar_->setPageStep(height());
    bar_->setRange(0, most);
    bar_->setVisible(most > 0);
    bar_->setGeometry(host_.rightToLeft() ? 0 : width() - kScrollBarWidth, 0, kScrollBarWidth, height());
}

void ConversationWidget::resizeCard(platform::HostSnippetViewController& controller, bool pinTop) {
    const auto& turns = host_.conversation()->turns();
    const auto turn = std::find_if(turns.begin(), turns.end(),
                                   [&](const auto& t) { return t->card()->controller().get() == &controller; });
    if (turn == turns.end()) {
        return;
    }
    if (pinTop) {
        // At the next turn, once for all rows that tell.
        heightsChanged_ = true;
        requestLayout();
        return;
    }
    // At once: a bottom that stays while its card grows would push everything else about.
    host_.conversation()->setMotionStyle(host::MotionStyle::None);
    const double before = (*turn)->card()->frameInRoot().maxY() - scrolled();
    layOut();
    scrollTo((*turn)->card()->frameInRoot().maxY() - before);
    chooseMotion();
}

void ConversationWidget::scrollTo(double y) {
    bar_->setValue(static_cast<int>(std::lround(y)));
}

double ConversationWidget::newestTop() const {
    const auto& turns = host_.conversation()->turns();
    if (turns.size() < 2) {
        return isLow() ? host_.conversation()->head() : 0.0;
    }
    // Side by side, question and card begin at their turn's very top: the space above them belongs to neither.
    const double above = width() >= host::measures::kWideFrom ? host::measures::kCardToQuestion : 0.0;
    return host_.conversation()->topOf(*turns.back()) - above;
}

void ConversationWidget::scrollToNewest(bool moves) {
    if (host_.conversation()->turns().size() < 2 && newestTop() == 0.0) {
        return;
    }
    if (moves && host_.conversation()->motionStyle() == host::MotionStyle::Full) {
        scrollFrom_ = scrolled();
        scroll_ = host::Motion(0.0, 1.0, seconds(), host::motions::kArrival);
        startMoving();
    } else {
        scrollTo(newestTop());
    }
}

void ConversationWidget::turnCame(host::TurnView& turn) {
    turn.arrive(seconds());
    layOut();
    scrollToNewest(true);
}

void ConversationWidget::answerCame(host::TurnView& turn) {
    turn.answerArrives(seconds());
    layOut();
    voice_->answerCame(turn);
}

void ConversationWidget::setDesktopDark(std::optional<bool> dark) {
    if (std::exchange(desktopDark_, dark) != dark) {
        choosePalette();
    }
}

void ConversationWidget::setAccent(const std::optional<QColor>& accent) {
    if (std::exchange(accent_, accent) != accent) {
        choosePalette();
    }
}

void ConversationWidget::setHighContrast(bool high) {
    if (high != host_.settings().desktopHighContrast) {
        host_.setDesktopHighContrast(high);
        choosePalette();
    }
}

bool ConversationWidget::isLow() const {
    return window()->height() < kLowestUsual;
}

void ConversationWidget::tellMoved() const {
    if (moved_) {
        moved_();
    }
}

void ConversationWidget::setCorner(const QSizeF& corner) {
    if (std::exchange(corner_, corner) != corner) {
        host_.conversation()->setCorner({corner.width(), corner.height()});
        layOut();
    }
}

bool ConversationWidget::showsSomethingIn(const QRectF& rect) const {
    return host_.conversation()->showsSomethingIn({rect.x(), rect.y() + scrolled(), rect.width(), rect.height()});
}

bool ConversationWidget::isOnScreen(const host::TurnView& turn) const {
    // Without a card it is its question that waits.
    const auto part = turn.card()->hidden() ? turn.frameInRoot() : turn.card()->frameInRoot();
    return part.maxY() > scrolled() && part.y < scrolled() + height();
}

void ConversationWidget::lookLater() {
    restTimer_.start();
}

void ConversationWidget::look() {
    host_.tellWhatIsSeen([this](const host::TurnView& turn) { return isOnScreen(turn); });
    rings_.update();
}

void ConversationWidget::setSeen(bool seen) {
    isSeen_ = seen;
    rings_.update();
}

void ConversationWidget::setReducedMotion(bool reduced) {
    reducedMotion_ = reduced;
    chooseMotion();
    rings_.update();
}

void ConversationWidget::scrollBy(const QKeyEvent& key) {
    keyPressEvent(const_cast<QKeyEvent*>(&key));
}

void ConversationWidget::paintEvent(QPaintEvent* event) {
    if (layoutRequested_) {
        // What is painted is in place; heights follow with the turn that was asked for.
        layOutWindow();
    }
    lastPainted_ = event->region();
    QPainter painter(this);
    painter.setRenderHints(QPainter::Antialiasing | QPainter::TextAntialiasing | QPainter::SmoothPixmapTransform);
    painter.setClipRegion(event->region());
    painter.fillRect(event->rect(), palette_.window);
    painter.translate(0.0, -scrolled());
    linux_::QtCanvas canvas(painter, palette_);
    const QRectF dirty = QRectF(event->rect()).translated(0.0, scrolled());
    host_.window()->paint(canvas, {dirty.x(), dirty.y(), dirty.width(), dirty.height()});
}

void ConversationWidget::resizeEvent(QResizeEvent*) {
    layOut();
}

void ConversationWidget::changeEvent(QEvent* event) {
    if (event->type() == QEvent::ApplicationPaletteChange || event->type() == QEvent::PaletteChange) {
        choosePalette();
    }
    QWidget::changeEvent(event);
}

}  // namespace ktr::app
