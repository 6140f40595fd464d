#include "app/window/friend/SelfPage.h"

#include "app/window/blocks/ListCard.h"

namespace ktr::app {

SelfPage::SelfPage(host::Host& host, Wish wish)
    : ColumnPage(Bar::With), host_(host), wish_(std::move(wish)), switch_(new ListRow(ListRow::Kind::Switch)) {
    constexpr int kGap = 14;
    auto* card = new ListCard;
    card->add(switch_);
    column().add(card, {0});
    column().setMargins(8, kGap);
    switch_->setPressed([this] { say(!isSeen_.value_or(false)); });
}

QString SelfPage::name() const {
    return QString::fromStdString(host_.text("PAGE_ME"));
}

void SelfPage::refreshed() {
    setTexts();
    ColumnPage::refreshed();
    if (!hasAsked_) {
        hasAsked_ = true;
        say(std::nullopt);
    }
}

void SelfPage::setTexts() {
    bar()->setTexts(name(), QString::fromStdString(host_.text("PAGE_BACK")));
    switch_->setWords(QString::fromStdString(host_.text("SHARING_SWITCH")));
    const char* second = hasFailed_ ? "SHARING_FAILED"
                         : !isSeen_ ? "SHARING_UNKNOWN"
                         : *isSeen_ ? "SHARING_ON"
                                    : "SHARING_OFF";
    switch_->setSecond(QString::fromStdString(host_.text(second)));
    switch_->setChecked(isSeen_.value_or(false));
    // What is not known cannot be turned round; and no second wish overtakes the first.
    switch_->setHeld(!wish_ || isAsking_ || (!isSeen_ && !hasFailed_));
}

void SelfPage::say(std::optional<bool> wish) {
    if (!wish_ || isAsking_) {
        return;
    }
    isAsking_ = true;
    wish_(wish, [self = std::weak_ptr(self_), wasWish = wish.has_value()](std::optional<bool> isSeen) {
        if (const auto page = self.lock()) {
            (*page)->heard(isSeen, wasWish);
        }
    });
    setTexts();
}

void SelfPage::heard(std::optional<bool> isSeen, bool wasWish) {
    isAsking_ = false;
    hasFailed_ = !isSeen && wasWish;
    isSeen_ = isSeen ? isSeen : isSeen_;
    setTexts();
}

}  // namespace ktr::app
