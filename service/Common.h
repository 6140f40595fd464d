#pragma once

#include <memory>
#include <optional>
#include <string>
#include <vector>

#include "platform/assistant/VAPerson.h"
#include "platform/base/Bundle.h"
#include "platform/base/NotificationCenter.h"
#include "platform/base/Object.h"

namespace ktr {

/// The plugin's domain of the preferences.
inline constexpr const char* PreferencesBundleID = platform::kSnippetsBundle;
/// The preference that holds the host (with its port, if any) to which the service last redirected a command.
inline constexpr const char* RedirectedHostKey = "RedirectedHostKey";

/// What the service commands need to know about the user and the device: the owner's account, facts about the device,
/// the host that the service redirected to, and the handles by which the service knows people. One per installed
/// platform. Nothing here reports an error: what is not there is none or empty. Main thread, but for `redirected`.
class Common : public platform::Object {
  public:
    /// Made on first use, with the account loaded; none without a platform.
    static std::shared_ptr<Common> sharedInstance();
    static std::shared_ptr<Common> makeShared();
    /// Listens for redirects.
    virtual bool init();

    /// Reads the owner's account. Without one (or one without a person identifier) it only clears the mark that an
    /// account is present, and each of the lazy accessors below tries again: somebody who signs in later is noticed.
    /// Once an account has been read it is not read again, until `clearKTRAccount`.
    void loadAccountInfo();
    void clearKTRAccount();
    /// Lazy; empty without an account.
    std::string username();
    std::string personID();
    /// Lazy; empty when there is none or it could not be read. Never stored elsewhere and never logged.
    std::string appToken();
    /// Lazy.
    bool tokenIsNotAccessible();
    bool hasKTRUser();
    /// The host that the account names, with its port, if any; as it was loaded last, without loading.
    const std::string& ktrHost() const { return ktrHost_; }
    bool accountInfoLoaded() const { return accountInfoLoaded_; }
    bool isRenewingAccountCredentials() const { return isRenewingAccountCredentials_; }

    std::optional<std::string> deviceUDID() const;
    std::optional<std::string> productType() const;
    std::optional<std::string> buildVersion() const;
    /// The first two components ("17.2" of "17.2.1"), or the only one; as it was at the first call.
    std::optional<std::string> osVersion();
    /// Whether the device is locked, is locking, or has not been unlocked since it was started.
    bool isLocked() const;

    /// Remembers the host that a command, the notification's sender, was redirected to: later commands start there,
    /// also in later processes. Any thread.
    void redirected(const platform::Notification& notification);
    /// Empty when none is remembered.
    std::string redirectedHost() const;
    void flushRedirection();

    /// The platform's answers as they stand; a platform that does not tell restricts nothing and allows nothing.
    bool isAppRestricted() const;
    bool isKTRAllowed() const;

    /// Two letters in lower case (ISO 3166-1): the telephony service's home country, else the current locale's, else
    /// "us".
    static std::string defaultCountryCode();

    /// Whether the handle contains "@"; any other one is a phone number. False for none.
    bool isHandleEmail(const std::optional<std::string>& handle) const;
    /// A number as typed in a contact, from its first decimal digit (of any script) or character of "+()*#-" on, in
    /// E.164 when it can be understood, else as cut. Empty when nothing is left.
    std::string completeNumberForPhoneNumber(const std::optional<std::string>& phoneNumber) const;
    /// The person's numbers, completed (or those of their contact when the person has none that is usable), then their
    /// e-mail addresses as they are. May be empty and may hold duplicates.
    std::vector<std::string> handlesForVAPerson(const std::shared_ptr<platform::VAPerson>& person) const;

  private:
    void loadAccountInfoIfNeeded();

    bool accountInfoLoaded_ = false;
    bool isRenewingAccountCredentials_ = false;
    bool isTokenAccessible_ = false;
    bool isAccountPresent_ = false;
    std::string personID_;
    std::string appToken_;
    std::string ktrHost_;
    std::string username_;
    /// Outer none: not asked yet.
    std::optional<std::optional<std::string>> osVersion_;
    platform::NotificationCenter::Token redirects_;
};

}  // namespace ktr
