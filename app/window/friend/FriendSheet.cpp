#include "app/window/friend/FriendSheet.h"

#include <QEvent>
#include <QPainter>
#include <QScroller>
#include <algorithm>

#include "app/window/pages/PageArea.h"

namespace ktr::app {

namespace {

constexpr int kText = 82;       ///< the start of all text
constexpr int kLargeText = 20;  ///< the same below the face, in very large text
constexpr int kInset = 15;
constexpr int kLinesUp = 2;  ///< into the row's lower margin
constexpr int kGap = 16;
constexpr int kActionsIn = 7;
constexpr int kBelowStreets = 4;
constexpr int kRingRoom = 5;  ///< that actions have above and below themselves

}  // namespace

FriendSheet::FriendSheet(QWidget* parent)
    : Block(parent),
      area_(new PageArea(this)),
      content_(new Content),
      row_(new FriendRow(content_)),
      person_(new ListRow(ListRow::Kind::Plain, {}, content_)),
      where_(new Words(BlockStyle::Subheadline, Words::Tone::Ink, content_)),
      howExactly_(new Words(BlockStyle::Subheadline, Words::Tone::Ink, content_)),
      offer_(new Button(Button::Kind::Quiet, {}, Icon::None, content_)),
      streets_(new StreetsRow(content_)) {
    area_->setWidget(content_);
    content_->setAutoFillBackground(false);
    content_->installEventFilter(this);
    QScroller::grabGesture(area_->viewport(), QScroller::TouchGesture);
    offer_->setWide(true);
    offer_->hide();
    streets_->hide();
    setHasPlace(false);
}

void FriendSheet::setPerson(const QString& name, const QString& sentence, std::shared_ptr<const linux_::QtImage> face) {
    person_->setFace(std::move(face));
    person_->setWords(name);
    person_->setSecond(sentence);
    askForRoom();
}

void FriendSheet::setHasPlace(bool hasPlace) {
    hasPlace_ = hasPlace;
    row_->setVisible(hasPlace);
    person_->setVisible(!hasPlace);
    place();
    askForRoom();
}

void FriendSheet::setLines(const QString& where, const QString& howExactly) {
    if (where != where_->text() || howExactly != howExactly_->text()) {
        where_->setText(where);
        howExactly_->setText(howExactly);
        place();
        askForRoom();
    }
}

void FriendSheet::setActions(const std::vector<Action>& actions) {
    const bool isSame =
        std::equal(actions.begin(), actions.end(), actions_.begin(), actions_.end(),
                   [](const Action& wanted, const RoundAction* there) { return wanted.icon == there->icon(); });
    if (isSame) {
        // Who has the focus, or is being listened to, stays.
        for (std::size_t i = 0; i < actions.size(); ++i) {
            actions_[i]->setWords(actions[i].words);
            actions_[i]->setPressed(actions[i].done);
        }
        return;
    }
    for (RoundAction* action : actions_) {
        action->hide();
        action->deleteLater();
    }
    actions_.clear();
    QWidget* before = howExactly_;
    for (const Action& wanted : actions) {
        auto* action = new RoundAction(wanted.icon, wanted.words, content_);
        action->setPressed(wanted.done);
        action->setLook(look());
        action->show();
        setTabOrder(before, action);
        before = action;
        actions_.push_back(action);
    }
    setTabOrder(before, offer_);
    setTabOrder(offer_, &streets_->action());
    place();
    askForRoom();
}

void FriendSheet::setOffer(const QString& words, std::function<void()> done) {
    offer_->setWords(words);
    offer_->setPressed(std::move(done));
    offer_->setVisible(!words.isEmpty());
    place();
    askForRoom();
}

void FriendSheet::setLacksStreets(bool lacks) {
    if (lacks == streets_->isHidden()) {
        streets_->setVisible(lacks);
        place();
        askForRoom();
    }
}

int FriendSheet::layOut(int width, bool places) const {
    int y = 0;
    const auto put = [&](Block& block, int x, int across) {
        const int height = block.shapeHeight(across);
        if (places) {
            block.placeShape(content_->mirrored(QRectF(x, y, across, height)).toRect());
        }
        y += height;
    };
    put(hasPlace_ ? static_cast<Block&>(*row_) : static_cast<Block&>(*person_), 0, width);
    const int start = isVeryLarge() ? kLargeText : kText;
    const bool hasLines = hasPlace_ && !(where_->text().isEmpty() && howExactly_->text().isEmpty());
    y -= hasLines ? kLinesUp : 0;
    for (Words* line : {where_, howExactly_}) {
        if (places) {
            line->setVisible(hasLines && !line->text().isEmpty());
        }
        if (hasLines && !line->text().isEmpty()) {
            put(*line, start, std::max(width - start - kInset, 1));
        }
    }
    y = layOutActions(width, y, places);
    if (!offer_->isHidden()) {
        y += actions_.empty() ? 0 : kGap - kRingRoom;
        put(*offer_, kInset, std::max(width - 2 * kInset, 1));
    }
    if (!streets_->isHidden()) {
        put(*streets_, 0, width);
        return y + kBelowStreets;
    }
    return y + kInset - (offer_->isHidden() && !actions_.empty() ? kRingRoom : 0);
}

int FriendSheet::layOutActions(int width, int y, bool places) const {
    if (actions_.empty()) {
        return y;
    }
    const int columns = isVeryLarge() ? 1 : static_cast<int>(actions_.size());
    const int across = std::max((width - 2 * kActionsIn) / columns, 1);
    y += kGap - kRingRoom;
    int column = 0;
    int lowest = y;
    for (RoundAction* action : actions_) {
        const int height = action->shapeHeight(across);
        if (places) {
            action->placeShape(content_->mirrored(QRectF(kActionsIn + column * across, y, across, height)).toRect());
        }
        lowest = std::max(lowest, y + height);
        if (++column == columns) {
            column = 0;
            y = lowest;
        }
    }
    return lowest;
}

int FriendSheet::shapeHeight(int width) const {
    return layOut(width, false);
}

void FriendSheet::place() {
    area_->setGeometry(rect());
    content_->resize(width(), std::max(layOut(width(), false), height()));
    layOut(width(), true);
}

void FriendSheet::resizeEvent(QResizeEvent*) {
    place();
}

bool FriendSheet::event(QEvent* event) {
    if (event->type() == QEvent::LayoutRequest) {
        place();
        askForRoom();
        return true;
    }
    return Block::event(event);
}

bool FriendSheet::eventFilter(QObject* object, QEvent* event) {
    if (object == content_ && event->type() == QEvent::LayoutRequest) {
        place();
        askForRoom();
    }
    return Block::eventFilter(object, event);
}

void FriendSheet::lookChanged() {
    content_->setLook(look());
}

void FriendSheet::refreshed() {
    content_->refresh();
    place();
}

void FriendSheet::paintEvent(QPaintEvent*) {
    QPainter painter(this);
    painter.setRenderHint(QPainter::Antialiasing);
    painter.fillPath(rounded(rect(), kCorner), colors().card);
    strokeInside(painter, rect(), kCorner, QPen(colors().cardEdge.color, colors().cardEdge.width));
}

}  // namespace ktr::app
