#include "app/window/checkup/CheckUpPage.h"

#include <QApplication>
#include <QClipboard>
#include <algorithm>
#include <set>
#include <utility>

#include "linux/device/NetworkTime.h"
#include "platform/base/Format.h"

namespace ktr::app {

namespace {

constexpr int kTextStart = 27;
constexpr int kAboveSection = 20;
constexpr int kBelowSection = 8;
constexpr int kToCard = 14;
constexpr int kTop = 8;
constexpr int kSaysCopied = 2000;  // milliseconds

}  // namespace

CheckUpPage::CheckUpPage(host::Host& host, CheckUp::Places places, Window window)
    : ColumnPage(Bar::With),
      host_(host),
      places_(std::move(places)),
      window_(std::move(window)),
      title_(new Words(BlockStyle::Title)),
      line_(new Words(BlockStyle::Body, Words::Tone::Soft)),
      troubles_(new ListCard),
      fineName_(new Words(BlockStyle::Subheadline, Words::Tone::Soft)),
      fine_(new ListCard),
      again_(new Button(Button::Kind::Main, {}, Icon::Again)),
      copy_(new Button(Button::Kind::Quiet, {}, Icon::Copy)),
      aside_(owner_) {
    title_->setBalanced(true);
    line_->setBalanced(true);
    column().add(title_, {0, kTextStart, kTextStart});
    column().add(line_, {2, kTextStart, kTextStart});
    column().add(troubles_, {kToCard});
    column().add(fineName_, {kAboveSection, kTextStart, kTextStart});
    column().add(fine_, {kBelowSection});
    column().setMargins(kTop, kToCard);
    fine_->setParted(false);
    auto* lower = new Flow;
    lower->setFilling(true);
    lower->add(again_);
    lower->add(copy_);
    copy_->setWide(true);
    setLower(lower);
    again_->setPressed([this] { look(); });
    copy_->setPressed([this] {
        std::vector<CheckUp::Finding> all;
        for (const auto& finding : findings_) {
            if (finding) {
                all.push_back(*finding);
            }
        }
        copyText(CheckUp::text(all));
        copy_->setWords(text("FRIEND_COPIED"));
        copied_.start(kSaysCopied);
    });
    copied_.setSingleShot(true);
    connect(&copied_, &QTimer::timeout, &owner_, [this] { copy_->setWords(text("CHECK_REPORT")); });
}

QString CheckUpPage::text(const char* key) const {
    return QString::fromStdString(host_.text(key));
}

QString CheckUpPage::name() const {
    return text("CHECK_UP");
}

void CheckUpPage::refreshed() {
    bar()->setTexts(name(), text("PAGE_BACK"));
    fineName_->setText(text("CHECK_FINE"));
    copy_->setWords(text("CHECK_REPORT"));
    show();
    ColumnPage::refreshed();
    if (!std::exchange(hasLooked_, true)) {
        look();
    }
}

void CheckUpPage::look() {
    ++round_;
    findings_.clear();
    looking_ = 1;
    show();
    // Which things there are to look at stands in a file, too.
    aside_.run([this, round = round_, places = places_]() -> linux_::Aside::Then {
        return [this, round, checks = CheckUp::checks(places)] {
            if (round != round_) {
                return;
            }
            checks_ = checks;
            findings_.assign(checks_.size() + 1, std::nullopt);
            looking_ = 0;
            for (std::size_t i = 0; i < checks_.size(); ++i) {
                lookAt(i);
            }
            findings_.back() = CheckUp::letters();
            show();
        };
    });
}

void CheckUpPage::lookAt(std::size_t index) {
    ++looking_;
    aside_.run([this, index, round = round_, check = checks_[index]]() -> linux_::Aside::Then {
        return [this, index, round, finding = CheckUp::runOne(check)] {
            if (round == round_) {
                found(index, finding);
            }
        };
    });
}

void CheckUpPage::found(std::size_t index, CheckUp::Finding finding) {
    --looking_;
    findings_[index] = std::move(finding);
    show();
}

QString CheckUpPage::titleWords(int wrong) const {
    if (isLooking()) {
        return text("SIGN_IN_CHECKING");
    }
    return wrong == 0 ? text("CHECK_WELL")
                      : QString::fromStdString(platform::formatted(host_.text("CHECK_HANDS"),
                                                                   {platform::FormatArgument(std::int64_t{wrong})}));
}

void CheckUpPage::show() {
    const QWidget* focus = QApplication::focusWidget();
    const bool hadFocus = focus != nullptr && troubles_->isAncestorOf(focus);
    troubles_->clear();
    fine_->clear();
    // One cause may be seen at several things.
    std::set<CheckUp::Cause> told;
    for (const auto& finding : findings_) {
        if (finding && finding->state == CheckUp::State::Wrong && told.insert(finding->cause).second) {
            addTrouble(*finding);
        } else if (finding && finding->state == CheckUp::State::Fine) {
            addFine(*finding);
        }
    }
    title_->setText(titleWords(static_cast<int>(told.size())));
    line_->setText(isLooking() ? QString() : text(told.empty() ? "CHECK_NOW" : "CHECK_REST"));
    again_->setWords(text("CHECK_AGAIN"));
    again_->setEnabled(!isLooking());
    troubles_->setVisible(!told.empty());
    fineName_->setVisible(!fine_->rows().empty());
    fine_->setVisible(!fine_->rows().empty());
    if (hadFocus) {
        auto* next =
            troubles_->rows().empty() ? again_ : &static_cast<TroubleRow*>(troubles_->rows().front())->button();
        next->setFocus(Qt::OtherFocusReason);
    }
}

void CheckUpPage::addTrouble(const CheckUp::Finding& finding) {
    const auto trouble = CheckUpWords::of(finding.cause);
    const QString cause = QString::fromStdString(
        platform::formatted(host_.text(trouble.cause), {platform::FormatArgument(finding.detail)}));
    auto* row = new TroubleRow(text(trouble.title), cause, text(CheckUpWords::wordsOf(trouble.mend)));
    row->button().setPressed([this, mends = trouble.mend, finding] { mend(mends, finding); });
    troubles_->add(row);
}

void CheckUpPage::addFine(const CheckUp::Finding& finding) {
    if (const char* key = CheckUpWords::nameOf(finding.thing)) {
        auto* row = new ListRow(ListRow::Kind::Fine, text(key));
        row->setValue(QString::fromStdString(finding.detail));
        fine_->add(row);
    }
}

void CheckUpPage::mend(CheckUpWords::Mend mend, const CheckUp::Finding& finding) {
    using Mend = CheckUpWords::Mend;
    switch (mend) {
        case Mend::SignIn:
        case Mend::SignInAgain:
            window_.signIn();
            return;
        case Mend::Settings:
            window_.showSettings();
            return;
        case Mend::CopyCommand:
            copyText(finding.remedy);
            return;
        case Mend::SetClock:
            setClock(finding.cause);
            return;
        case Mend::Unlock:
            window_.readAccountAgain();
            break;
        case Mend::TryAgain:
        case Mend::AskAgain:
            break;
    }
    lookAgainFor(finding.cause);
}

void CheckUpPage::lookAgainFor(CheckUp::Cause cause) {
    for (std::size_t i = 0; i < checks_.size(); ++i) {
        if (findings_[i] && findings_[i]->state == CheckUp::State::Wrong && findings_[i]->cause == cause) {
            lookAt(i);
        }
    }
    show();
}

void CheckUpPage::setClock(CheckUp::Cause cause) {
    aside_.run([this, cause, bus = places_.systemBus]() -> linux_::Aside::Then {
        // What came of it is seen by the clock itself.
        linux_::NetworkTime::turnOn(bus);
        return [this, cause] { lookAgainFor(cause); };
    });
}

void CheckUpPage::copyText(const std::string& words) {
    QApplication::clipboard()->setText(QString::fromStdString(words));
}

}  // namespace ktr::app
