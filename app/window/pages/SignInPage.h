#pragma once

#include <memory>
#include <vector>

#include "app/window/blocks/Button.h"
#include "app/window/blocks/Flow.h"
#include "app/window/blocks/FormField.h"
#include "app/window/blocks/Picture.h"
#include "app/window/blocks/Words.h"
#include "app/window/pages/ColumnPage.h"
#include "host/Host.h"
#include "linux/configuration/SignIn.h"

namespace ktr::app {

/// Where nobody is signed in, or not any more: service, person and secret, or a link in place of them, and what is
/// wrong with them in words. Whoever shows it closes it once somebody is signed in. Main thread.
class SignInPage : public ColumnPage {
  public:
    /// What is known of the one who was signed in before; empty: nobody was.
    struct Before {
        std::string host;
        std::string person;
    };

    /// The host outlives the page.
    SignInPage(host::Host& host, std::unique_ptr<linux_::SignIn> signIn, const Before& before);

    /// Called once somebody is signed in; the page may be gone afterwards.
    void setDone(std::function<void()> done) { done_ = std::move(done); }

    QString name() const override;
    QWidget* firstFocus() const override;
    bool canBeLeft() const override { return false; }

    /// A link that somebody sent: it stands in the field, and nothing is asked before the button is pressed.
    void offerLink(const QString& link);

    /// Only while a link is asked for instead of the other three.
    FormField& link() const { return *link_; }
    /// From one way to the other.
    Button& otherWay() const { return *otherWay_; }
    FormField& address() const { return *address_; }
    FormField& person() const { return *person_; }
    FormField& secret() const { return *secret_; }
    Button& go() const { return *go_; }
    Button& cancel() const { return *cancel_; }
    /// Offers to keep the secret in a file; only where the keyring does not.
    Button& inFile() const { return *inFile_; }

  protected:
    void refreshed() override;
    void resizeEvent(QResizeEvent* event) override;
    int mostWidth() const override { return 424; }

  private:
    QString text(const char* key) const;
    /// With the host that was asked in its words.
    QString textAbout(const char* key, const std::string& host) const;
    void changed();
    std::vector<FormField*> fields() const { return {link_, address_, person_, secret_}; }
    void setByLink(bool isByLink);
    bool isFull() const;
    void begin(linux_::SignIn::Place place);
    void stop();
    void ended(const linux_::SignIn::Result& result);
    void clearNotes();
    void setChecking(bool isChecking);
    void complain(FormField& field, const QString& note);

    host::Host& host_;
    const std::unique_ptr<linux_::SignIn> signIn_;
    const bool isAgain_;
    bool isRetry_ = false;
    bool isByLink_ = false;
    std::function<void()> done_;
    Picture* icon_;
    Words* title_;
    Words* line_;
    FormField* link_;
    FormField* address_;
    FormField* person_;
    FormField* secret_;
    Words* note_;
    Flow* buttons_;
    Button* go_;
    Button* cancel_;
    Button* inFile_;
    Button* otherWay_;
    Words* footnote_;
};

}  // namespace ktr::app
