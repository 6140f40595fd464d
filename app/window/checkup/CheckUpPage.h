#pragma once

#include <QTimer>
#include <functional>
#include <optional>
#include <string>
#include <vector>

#include "app/window/blocks/Flow.h"
#include "app/window/blocks/ListCard.h"
#include "app/window/blocks/Words.h"
#include "app/window/checkup/CheckUpWords.h"
#include "app/window/checkup/TroubleRow.h"
#include "app/window/pages/ColumnPage.h"
#include "host/Host.h"
#include "linux/device/Aside.h"
#include "linux/doctor/CheckUp.h"

namespace ktr::app {

/// Everything that the program stands on, in words: what is wrong, each with one button that mends it, and what is
/// fine. It looks when it opens, each thing by itself while nobody waits. Main thread.
class CheckUpPage : public ColumnPage {
  public:
    /// What the page leaves to its window. None of it is empty.
    struct Window {
        std::function<void()> signIn;
        std::function<void()> showSettings;
        std::function<void()> readAccountAgain;
    };

    /// The host outlives the page.
    CheckUpPage(host::Host& host, linux_::CheckUp::Places places, Window window);

    QString name() const override;
    QWidget* firstFocus() const override { return again_; }

    const Words& title() const { return *title_; }
    const ListCard& troubles() const { return *troubles_; }
    const ListCard& fine() const { return *fine_; }
    Button& again() const { return *again_; }
    Button& copy() const { return *copy_; }
    /// Whether it still looks.
    bool isLooking() const { return looking_ > 0; }

  protected:
    void refreshed() override;

  private:
    using CheckUp = linux_::CheckUp;

    QString text(const char* key) const;
    /// Looks at everything anew.
    void look();
    /// Looks at one thing anew.
    void lookAt(std::size_t index);
    /// The same for all things that are wrong for this cause.
    void lookAgainFor(CheckUp::Cause cause);
    /// Sets it from the network.
    void setClock(CheckUp::Cause cause);
    void found(std::size_t index, CheckUp::Finding finding);
    void show();
    void addTrouble(const CheckUp::Finding& finding);
    void addFine(const CheckUp::Finding& finding);
    void mend(CheckUpWords::Mend mend, const CheckUp::Finding& finding);
    void copyText(const std::string& words);
    QString titleWords(int wrong) const;

    host::Host& host_;
    const CheckUp::Places places_;
    const Window window_;
    std::vector<CheckUp::Check> checks_;
    std::vector<std::optional<CheckUp::Finding>> findings_;
    /// Of the look that is under way; what an earlier one still brings is not shown.
    int round_ = 0;
    int looking_ = 0;
    bool hasLooked_ = false;
    Words* title_;
    Words* line_;
    ListCard* troubles_;
    Words* fineName_;
    ListCard* fine_;
    Button* again_;
    Button* copy_;
    QTimer copied_;
    QObject owner_;
    linux_::Aside aside_;
};

}  // namespace ktr::app
