#include "app/window/settings/MapPage.h"

#include <utility>

namespace ktr::app {

MapPage::MapPage(host::Host& host, QString map, const QString& second, std::function<void()> remove)
    : ColumnPage(Bar::With), host_(host), map_(std::move(map)), remove_(new Button(Button::Kind::Quiet)) {
    constexpr int kGap = 14;
    auto* card = new ListCard;
    auto* row = new ListRow(ListRow::Kind::Plain, map_);
    row->setSecond(second);
    card->add(row);
    column().add(card, {0});
    remove_->setWide(true);
    remove_->setTakesAway(true);
    remove_->setPressed(std::move(remove));
    column().add(remove_, {kGap});
    column().setMargins(8, kGap);
}

void MapPage::refreshed() {
    bar()->setTexts(name(), QString::fromStdString(host_.text("PAGE_BACK")));
    remove_->setWords(QString::fromStdString(host_.text("MAPS_REMOVE")));
    ColumnPage::refreshed();
}

}  // namespace ktr::app
