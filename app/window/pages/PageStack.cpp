#include "app/window/pages/PageStack.h"

#include <QCoreApplication>
#include <QGraphicsOpacityEffect>
#include <QKeyEvent>
#include <QMouseEvent>
#include <cmath>

#include "app/window/Announcer.h"

namespace ktr::app {

namespace {

constexpr int kFrame = 16;  // milliseconds

}  // namespace

PageStack::PageStack(QWidget* window) : Block(window), announcer_(new Announcer(window)) {
    clock_.start();
    timer_.setInterval(kFrame);
    connect(&timer_, &QTimer::timeout, this, [this] { move(); });
    hide();
}

PageStack::~PageStack() {
    QCoreApplication::instance()->removeEventFilter(this);
}

void PageStack::open(std::unique_ptr<Page> page) {
    finish();
    if (open_.empty()) {
        // Its parts would keep the mouse's key, and fields the arrows, to themselves.
        QCoreApplication::instance()->installEventFilter(this);
    }
    setAttribute(Qt::WA_TransparentForMouseEvents, false);
    Page* opened = page.release();
    open_.push_back({opened, window()->focusWidget()});
    opened->setParent(this);
    opened->setLeave([this] { back(); });
    opened->setLook(look());
    opened->refresh();
    opened->setAccessibleName(opened->name());
    opened->setGeometry(rect());
    show();
    raise();
    opened->show();
    opened->raise();
    focusOn(*opened);
    announcer_->say(opened->name());
    begin(opened, 0.0, 1.0);
}

void PageStack::focusOn(Page& page) {
    QWidget* first = page.firstFocus();
    if (first == nullptr) {
        page.setFocusPolicy(Qt::ClickFocus);
        first = &page;
    }
    first->setFocus(Qt::OtherFocusReason);
}

void PageStack::letGo() {
    // One that is going has nothing left to show.
    finish();
    for (const Open& open : open_) {
        open.page->letGo();
    }
}

void PageStack::back() {
    if (!open_.empty() && open_.back().page->canBeLeft() && !open_.back().page->stepBack()) {
        take(false);
    }
}

void PageStack::closeAll() {
    if (!open_.empty()) {
        take(true);
    }
}

void PageStack::take(bool isAll) {
    finish();
    Page* gone = open_.back().page;
    QPointer<QWidget> focus = open_.back().before;
    open_.pop_back();
    while (isAll && !open_.empty()) {
        focus = open_.back().before;
        open_.back().page->deleteLater();
        open_.pop_back();
    }
    // What it calls from within itself may go on.
    gone->setLeave(nullptr);
    // Who presses now means what appears, not what fades.
    gone->setAttribute(Qt::WA_TransparentForMouseEvents);
    if (open_.empty()) {
        setAttribute(Qt::WA_TransparentForMouseEvents);
        QCoreApplication::instance()->removeEventFilter(this);
        showBelow(true);
    } else {
        open_.back().page->show();
        gone->raise();
    }
    if (focus != nullptr && focus->isVisible()) {
        focus->setFocus(Qt::OtherFocusReason);
    } else if (!open_.empty()) {
        focusOn(*open_.back().page);
    } else {
        window()->setFocus(Qt::OtherFocusReason);
    }
    if (!open_.empty()) {
        announcer_->say(open_.back().page->name());
    }
    begin(gone, 1.0, 0.0);
}

void PageStack::showBelow(bool isSeen) {
    if (below_) {
        below_(isSeen);
    }
}

void PageStack::begin(Page* page, double from, double to) {
    moving_ = page;
    isGoing_ = to < from;
    if (motion_ == host::MotionStyle::None || !window()->isVisible()) {
        share_ = host::Motion(to);
        finish();
        return;
    }
    const bool isReduced = motion_ == host::MotionStyle::Reduced;
    share_ = isReduced ? host::Motion::linear(from, to, seconds(), host::motions::kFade)
                       : host::Motion(from, to, seconds(), host::motions::kArrival);
    page->setGraphicsEffect(new QGraphicsOpacityEffect(page));
    timer_.start();
    move();
}

void PageStack::move() {
    if (moving_ == nullptr || share_.isOver(seconds())) {
        finish();
        return;
    }
    const double share = share_.at(seconds());
    static_cast<QGraphicsOpacityEffect*>(moving_->graphicsEffect())->setOpacity(share);
    const bool rises = motion_ == host::MotionStyle::Full;
    moving_->move(0, rises ? static_cast<int>(std::lround(host::motions::kRise * (1.0 - share))) : 0);
}

void PageStack::finish() {
    timer_.stop();
    if (moving_ == nullptr) {
        return;
    }
    Page* page = moving_;
    moving_ = nullptr;
    page->setGraphicsEffect(nullptr);
    page->move(0, 0);
    if (isGoing_) {
        page->letGo();
        page->hide();
        page->deleteLater();
        setVisible(isOpen());
        return;
    }
    for (const Open& open : open_) {
        open.page->setVisible(open.page == page);
    }
    showBelow(false);
}

void PageStack::resizeEvent(QResizeEvent*) {
    for (const Open& open : open_) {
        open.page->resize(size());
    }
    if (moving_ != nullptr) {
        moving_->resize(size());
    }
}

bool PageStack::meansBack(const QKeyEvent& key) const {
    const int arrow = isMirrored() ? Qt::Key_Right : Qt::Key_Left;
    return key.key() == Qt::Key_Back ||
           (key.key() == arrow && (key.modifiers() & ~Qt::KeypadModifier) == Qt::AltModifier);
}

void PageStack::keyPressEvent(QKeyEvent* event) {
    if (isOpen() && event->key() == Qt::Key_Escape) {
        back();
        return;
    }
    Block::keyPressEvent(event);
}

bool PageStack::eventFilter(QObject* object, QEvent* event) {
    const bool isBack =
        (event->type() == QEvent::MouseButtonPress && static_cast<QMouseEvent*>(event)->button() == Qt::BackButton) ||
        (event->type() == QEvent::KeyPress && meansBack(*static_cast<QKeyEvent*>(event)));
    const auto* widget = isBack ? dynamic_cast<QWidget*>(object) : nullptr;
    if (widget != nullptr && isAncestorOf(widget)) {
        back();
        return true;
    }
    return Block::eventFilter(object, event);
}

}  // namespace ktr::app
