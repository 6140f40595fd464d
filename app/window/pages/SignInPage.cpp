#include "app/window/pages/SignInPage.h"

#include <algorithm>

#include "linux/paint/QtImage.h"
#include "platform/base/Bundle.h"
#include "platform/base/Format.h"
#include "platform/base/Platform.h"
#include "platform/ui/Image.h"

namespace ktr::app {

namespace {

constexpr int kTextInset = 27;
constexpr int kIconSide = 56;
constexpr int kIconTop = 44;
constexpr int kLowerMargin = 20;
constexpr int kWideFrom = 900;
constexpr double kWideTop = 0.2;  ///< of the height

}  // namespace

SignInPage::SignInPage(host::Host& host, std::unique_ptr<linux_::SignIn> signIn, Before before)
    : ColumnPage(Bar::Without),
      host_(host),
      signIn_(std::move(signIn)),
      isAgain_(!before.person.empty()),
      icon_(new Picture(kIconSide)),
      title_(new Words(BlockStyle::Title)),
      line_(new Words(BlockStyle::Body, Words::Tone::Soft)),
      address_(new FormField),
      person_(new FormField),
      secret_(new FormField),
      note_(new Words(BlockStyle::Subheadline)),
      buttons_(new Flow),
      go_(new Button(Button::Kind::Main)),
      cancel_(new Button(Button::Kind::Quiet)),
      inFile_(new Button(Button::Kind::Quiet)),
      footnote_(new Words(BlockStyle::Footnote, Words::Tone::Soft)) {
    line_->setBalanced(true);
    footnote_->setAlignment(BlockAlignment::Centre);
    note_->setWarning(true);
    column().add(icon_, {kIconTop, kTextInset, kTextInset, false});
    column().add(title_, {18, kTextInset, kTextInset});
    column().add(line_, {6, kTextInset, kTextInset});
    column().add(address_, {24});
    column().add(person_, {14});
    column().add(secret_, {14});
    column().add(note_, {12, kTextInset, kTextInset});
    buttons_->setFilling(true);
    column().add(buttons_, {22});
    buttons_->add(go_);
    buttons_->add(cancel_);
    column().add(inFile_, {8});
    column().beginBottom(kLowerMargin);
    column().add(footnote_, {20, kTextInset, kTextInset});
    note_->hide();
    cancel_->hide();
    inFile_->hide();
    inFile_->setWide(true);
    address_->setText(QString::fromStdString(before.host));
    person_->setText(QString::fromStdString(before.person));
    for (FormField* field : {address_, person_, secret_}) {
        field->setChanged([this] { changed(); });
        field->setEntered([this] { go_->press(); });
    }
    go_->setPressed([this] { begin(linux_::SignIn::Place::Keyring); });
    cancel_->setPressed([this] { stop(); });
    inFile_->setPressed([this] { begin(linux_::SignIn::Place::File); });
    changed();
}

QString SignInPage::text(const char* key) const {
    return QString::fromStdString(host_.text(key));
}

QString SignInPage::textAbout(const char* key, const std::string& host) const {
    return QString::fromStdString(platform::formatted(host_.text(key), {platform::FormatArgument(host)}));
}

QString SignInPage::name() const {
    return text("SIGN_IN_TITLE");
}

QWidget* SignInPage::firstFocus() const {
    for (const FormField* field : {address_, person_}) {
        if (field->text().isEmpty()) {
            return &field->edit();
        }
    }
    return &secret_->edit();
}

void SignInPage::refreshed() {
    const auto& platform = host_.platform();
    icon_->setImage(std::dynamic_pointer_cast<const linux_::QtImage>(
        platform->images->imageNamed("appIcon_dyn", platform::kSnippetsBundle)));
    title_->setText(text("SIGN_IN_TITLE"));
    line_->setText(text(isAgain_ ? "STATUS_SIGN_IN" : "SIGN_IN_LINE"));
    address_->setLabel(text("SIGN_IN_ADDRESS"));
    address_->setHint(QStringLiteral("brin.example"));
    person_->setLabel(text("SIGN_IN_YOU"));
    secret_->setLabel(text("SIGN_IN_SECRET"));
    secret_->setSecret(text("SIGN_IN_SHOW"), text("SIGN_IN_HIDE"));
    cancel_->setWords(text("SIGN_IN_CANCEL"));
    inFile_->setWords(text("SIGN_IN_IN_FILE"));
    footnote_->setText(text("SIGN_IN_KEYRING"));
    setChecking(signIn_->isUnderWay());
    ColumnPage::refreshed();
}

void SignInPage::resizeEvent(QResizeEvent* event) {
    const int top = width() >= kWideFrom ? static_cast<int>(height() * kWideTop) : kIconTop;
    column().setAbove(icon_, top);
    ColumnPage::resizeEvent(event);
}

void SignInPage::clearNotes() {
    for (FormField* field : {address_, person_, secret_}) {
        field->setNote({});
    }
    note_->setText({});
    note_->hide();
    inFile_->hide();
    isRetry_ = false;
    column().askForRoom();
}

void SignInPage::changed() {
    clearNotes();
    setChecking(false);
}

void SignInPage::setChecking(bool isChecking) {
    for (FormField* field : {address_, person_, secret_}) {
        field->setFixed(isChecking);
    }
    const bool isFull =
        !address_->text().trimmed().isEmpty() && !person_->text().trimmed().isEmpty() && !secret_->text().isEmpty();
    go_->setWords(text(isChecking ? "SIGN_IN_CHECKING" : isRetry_ ? "SIGN_IN_RETRY" : "SIGN_IN_GO"));
    go_->setBusy(isChecking);
    go_->setEnabled(isFull && !isChecking);
    cancel_->setVisible(isChecking);
    buttons_->askForRoom();
}

void SignInPage::begin(linux_::SignIn::Place place) {
    clearNotes();
    signIn_->begin(
        {address_->text().toStdString(), person_->text().trimmed().toStdString(), secret_->text().toStdString(), place},
        [this](const linux_::SignIn::Result& result) { ended(result); });
    setChecking(true);
    cancel_->setFocus(Qt::OtherFocusReason);
}

void SignInPage::stop() {
    signIn_->cancel();
    setChecking(false);
    go_->setFocus(Qt::OtherFocusReason);
}

void SignInPage::complain(FormField& field, const QString& note) {
    field.setNote(note);
    field.edit().setFocus(Qt::OtherFocusReason);
    reveal(field);
}

void SignInPage::ended(const linux_::SignIn::Result& result) {
    using Outcome = linux_::SignIn::Outcome;
    isRetry_ = result.outcome == Outcome::NothingAnswers || result.outcome == Outcome::Failing;
    setChecking(false);
    const auto say = [this](const QString& words) {
        note_->setText(words);
        note_->show();
        column().askForRoom();
        reveal(*note_);
    };
    switch (result.outcome) {
        case Outcome::Done:
            if (done_) {
                done_();
            }
            break;
        case Outcome::BadAddress:
            complain(*address_, text("SIGN_IN_BAD_ADDRESS"));
            break;
        case Outcome::NothingAnswers:
            complain(*address_, textAbout("SIGN_IN_NOTHING_ANSWERS", result.host));
            break;
        case Outcome::NotTrusted:
            complain(*address_, textAbout("SIGN_IN_NOT_TRUSTED", result.host));
            break;
        case Outcome::NoService:
            complain(*address_, textAbout("SIGN_IN_NO_SERVICE", result.host));
            break;
        case Outcome::Failing:
            complain(*address_, textAbout("SIGN_IN_FAILING", result.host));
            break;
        case Outcome::Unknown:
            complain(*secret_, text("SIGN_IN_UNKNOWN"));
            break;
        case Outcome::NoKeyring:
            go_->setWords(text("SIGN_IN_UNLOCK"));
            inFile_->show();
            say(text("SIGN_IN_LOCKED"));
            go_->setFocus(Qt::OtherFocusReason);
            break;
        case Outcome::NotWritten:
            say(text("SIGN_IN_NOT_WRITTEN"));
            go_->setFocus(Qt::OtherFocusReason);
            break;
    }
}

}  // namespace ktr::app
