#pragma once

#include <functional>
#include <vector>

#include "app/window/blocks/ListCard.h"
#include "app/window/pages/ColumnPage.h"
#include "host/Host.h"

namespace ktr::app {

/// A page on which one of several is chosen, at once. Main thread.
class ChoicePage : public ColumnPage {
  public:
    struct Choice {
        QString words;
    };
    /// What the page offers, in the present language.
    using Offer = std::function<std::vector<Choice>()>;

    /// `title`: a key of the host's texts.
    ChoicePage(host::Host& host, const char* title, Offer offer, int chosen, std::function<void(int)> choose);

    QString name() const override;
    QWidget* firstFocus() const override;
    ListRow& row(int index) const;

  protected:
    void refreshed() override;

  private:
    host::Host& host_;
    const char* const title_;
    const Offer offer_;
    int chosen_;
    const std::function<void(int)> choose_;
    ListCard* card_;
};

}  // namespace ktr::app
