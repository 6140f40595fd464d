#include "app/window/pages/SignInPage.h"

#include <algorithm>

#include "linux/configuration/SignInLink.h"
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
constexpr int kIconToTitle = 18;
constexpr int kLowTop = 16;
/// A lower window has no icon, and one that is lower still no line: what is to be filled in is seen.
constexpr int kLow = 420;
constexpr int kVeryLow = 300;
constexpr int kLowerMargin = 20;
constexpr int kWideFrom = 900;
constexpr double kWideTop = 0.2;  ///< of the height

}  // namespace

SignInPage::SignInPage(host::Host& host, std::unique_ptr<linux_::SignIn> signIn, const Before& before)
    : ColumnPage(Bar::Without),
      host_(host),
      signIn_(std::move(signIn)),
      isAgain_(!before.person.empty()),
      icon_(new Picture(kIconSide)),
      title_(new Words(BlockStyle::Title)),
      line_(new Words(BlockStyle::Body, Words::Tone::Soft)),
      link_(new FormField),
      address_(new FormField),
      person_(new FormField),
      secret_(new FormField),
      note_(new Words(BlockStyle::Subheadline)),
      buttons_(new Flow),
      go_(new Button(Button::Kind::Main)),
      cancel_(new Button(Button::Kind::Quiet)),
      inFile_(new Button(Button::Kind::Quiet)),
      otherWay_(new Button(Button::Kind::Text)),
      footnote_(new Words(BlockStyle::Footnote, Words::Tone::Soft)) {
    line_->setBalanced(true);
    footnote_->setAlignment(BlockAlignment::Centre);
    note_->setWarning(true);
    column().add(icon_, {kIconTop, kTextInset, kTextInset, false});
    column().add(title_, {kIconToTitle, kTextInset, kTextInset});
    column().add(line_, {6, kTextInset, kTextInset});
    column().add(link_, {24});
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
    column().add(otherWay_, {20, kTextInset, kTextInset, false, true});
    column().add(footnote_, {0, kTextInset, kTextInset});
    link_->hide();
    otherWay_->setPressed([this] {
        setByLink(!isByLink_);
        firstFocus()->setFocus(Qt::OtherFocusReason);
    });
    note_->hide();
    cancel_->hide();
    inFile_->hide();
    inFile_->setWide(true);
    address_->setText(QString::fromStdString(before.host));
    person_->setText(QString::fromStdString(before.person));
    for (FormField* field : fields()) {
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
    if (isByLink_) {
        return &link_->edit();
    }
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
    line_->setText(text(isByLink_ ? "SIGN_IN_LINK_LINE" : isAgain_ ? "STATUS_SIGN_IN" : "SIGN_IN_LINE"));
    link_->setLabel(text("SIGN_IN_LINK"));
    otherWay_->setWords(text(isByLink_ ? "SIGN_IN_USE_SECRET" : "SIGN_IN_HAVE_LINK"));
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
    const bool isLow = height() < kLow;
    column().setAbove(icon_, top);
    column().setAbove(title_, isLow ? kLowTop : kIconToTitle);
    icon_->setVisible(!isLow);
    // In the place of the line, whoever was signed in before reads why they are asked.
    line_->setVisible(height() >= kVeryLow || isAgain_);
    ColumnPage::resizeEvent(event);
}

void SignInPage::clearNotes() {
    for (FormField* field : fields()) {
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
    if (isByLink_) {
        return;
    }
    // A link that is pasted into another field is meant as one; and no secret stays in a field that shows it.
    for (FormField* field : {address_, person_, secret_}) {
        if (linux_::SignInLink::read(field->text().toStdString())) {
            const QString link = field->text();
            field->setText({});
            offerLink(link);
            return;
        }
    }
}

void SignInPage::offerLink(const QString& link) {
    if (signIn_->isUnderWay()) {
        return;
    }
    setByLink(true);
    link_->setText(link);
    setChecking(false);
    go_->setFocus(Qt::OtherFocusReason);
}

void SignInPage::setByLink(bool isByLink) {
    isByLink_ = isByLink;
    clearNotes();
    link_->setVisible(isByLink);
    for (FormField* field : {address_, person_, secret_}) {
        field->setVisible(!isByLink);
    }
    refresh();
}

bool SignInPage::isFull() const {
    return isByLink_ ? !link_->text().trimmed().isEmpty()
                     : !address_->text().trimmed().isEmpty() && !person_->text().trimmed().isEmpty() &&
                           !secret_->text().isEmpty();
}

void SignInPage::setChecking(bool isChecking) {
    for (FormField* field : fields()) {
        field->setFixed(isChecking);
    }
    go_->setWords(text(isChecking ? "SIGN_IN_CHECKING" : isRetry_ ? "SIGN_IN_RETRY" : "SIGN_IN_GO"));
    go_->setBusy(isChecking);
    go_->setEnabled(isFull() && !isChecking);
    otherWay_->setVisible(!isChecking);
    cancel_->setVisible(isChecking);
    buttons_->askForRoom();
}

void SignInPage::begin(linux_::SignIn::Place place) {
    clearNotes();
    signIn_->begin({address_->text().toStdString(), person_->text().trimmed().toStdString(),
                    secret_->text().toStdString(), place, isByLink_ ? link_->text().toStdString() : std::string()},
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
    FormField& where = isByLink_ ? *link_ : *address_;
    switch (result.outcome) {
        case Outcome::Done:
            if (done_) {
                done_();
            }
            break;
        case Outcome::BadAddress:
            complain(where, text(isByLink_ ? "SIGN_IN_BAD_LINK" : "SIGN_IN_BAD_ADDRESS"));
            break;
        case Outcome::NothingAnswers:
            complain(where, textAbout("SIGN_IN_NOTHING_ANSWERS", result.host));
            break;
        case Outcome::NotTrusted:
            complain(where, textAbout("SIGN_IN_NOT_TRUSTED", result.host));
            break;
        case Outcome::NoService:
            complain(where, textAbout("SIGN_IN_NO_SERVICE", result.host));
            break;
        case Outcome::Failing:
            complain(where, textAbout("SIGN_IN_FAILING", result.host));
            break;
        case Outcome::Unknown:
            complain(isByLink_ ? *link_ : *secret_, text(isByLink_ ? "SIGN_IN_LINK_SPENT" : "SIGN_IN_UNKNOWN"));
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
