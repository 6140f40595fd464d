#include "app/window/settings/ChoicePage.h"

#include <utility>

namespace ktr::app {

ChoicePage::ChoicePage(host::Host& host, const char* title, Offer offer, int chosen, std::function<void(int)> choose)
    : ColumnPage(Bar::With),
      host_(host),
      title_(title),
      offer_(std::move(offer)),
      chosen_(chosen),
      choose_(std::move(choose)),
      card_(new ListCard) {
    constexpr int kGap = 14;
    column().add(card_, {0});
    column().setMargins(8, kGap);
    card_->setParted(false);
    for (std::size_t i = 0; i < offer_().size(); ++i) {
        auto* row = new ListRow(ListRow::Kind::Choice);
        row->setChecked(static_cast<int>(i) == chosen_);
        row->setPressed([this, index = static_cast<int>(i)] {
            this->row(chosen_).setChecked(false);
            this->row(index).setChecked(true);
            chosen_ = index;
            choose_(index);
        });
        card_->add(row);
    }
}

ListRow& ChoicePage::row(int index) const {
    return *static_cast<ListRow*>(card_->rows()[static_cast<std::size_t>(index)]);
}

QString ChoicePage::name() const {
    return QString::fromStdString(host_.text(title_));
}

QWidget* ChoicePage::firstFocus() const {
    return &row(chosen_);
}

void ChoicePage::refreshed() {
    bar()->setTexts(name(), QString::fromStdString(host_.text("PAGE_BACK")));
    const auto choices = offer_();
    for (std::size_t i = 0; i < choices.size(); ++i) {
        row(static_cast<int>(i)).setWords(choices[i].words);
    }
    ColumnPage::refreshed();
}

}  // namespace ktr::app
