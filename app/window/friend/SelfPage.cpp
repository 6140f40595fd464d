#include "app/window/friend/SelfPage.h"

#include <utility>

#include "app/window/blocks/ListCard.h"

namespace ktr::app {

SelfPage::SelfPage(host::Host& host, SharingRow::Wish wish)
    : ColumnPage(Bar::With), host_(host), switch_(new SharingRow(host, std::move(wish))) {
    constexpr int kGap = 14;
    auto* card = new ListCard;
    card->add(switch_);
    column().add(card, {0});
    column().setMargins(8, kGap);
}

QString SelfPage::name() const {
    return QString::fromStdString(host_.text("PAGE_ME"));
}

void SelfPage::refreshed() {
    bar()->setTexts(name(), QString::fromStdString(host_.text("PAGE_BACK")));
    ColumnPage::refreshed();
    if (!std::exchange(hasAsked_, true)) {
        switch_->ask();
    }
}

}  // namespace ktr::app
