#include "service/Common.h"

#include "model/ContactsUtilities.h"
#include "model/LogCategory.h"
#include "platform/base/Assert.h"
#include "platform/base/DeviceInformation.h"
#include "platform/base/Platform.h"
#include "platform/base/Preferences.h"
#include "platform/base/Region.h"
#include "platform/base/Utf8.h"
#include "platform/client/DeviceOwnerAccount.h"
#include "platform/client/FriendLocationRestrictions.h"
#include "platform/client/KTServerInteractionController.h"
#include "platform/contacts/PhoneNumberLibrary.h"
#include "service/DecimalDigits.h"

namespace ktr {

using platform::PhoneNumberLibrary;
using platform::Platform;

namespace {

/// Whether a phone number may begin with this character.
bool beginsNumber(char32_t c) {
    return isDecimalDigit(c) ||
           (c < 0x80 && std::string_view("+()*#-").find(static_cast<char>(c)) != std::string::npos);
}

/// From the first character that a number may begin with; all of it when there is none.
std::string cutNumber(const std::string& text) {
    for (std::size_t at = 0; at < text.size();) {
        const auto step = platform::decodeUtf8(text, at);
        if (beginsNumber(step.codePoint)) {
            return text.substr(at);
        }
        at += step.length;
    }
    return text;
}

std::shared_ptr<platform::DeviceInformation> deviceInformation() {
    const auto installed = Platform::installed();
    return installed ? installed->deviceInformation : nullptr;
}

void storeRedirectedHost(const std::optional<std::string>& host) {
    if (const auto installed = Platform::installed(); installed && installed->preferences) {
        installed->preferences->setValue(RedirectedHostKey, host, PreferencesBundleID);
        installed->preferences->synchronize(PreferencesBundleID);
    }
}

}  // namespace

std::shared_ptr<Common> Common::sharedInstance() {
    KTR_ASSERT_MAIN_THREAD();
    return platform::shared<Common>();
}

std::shared_ptr<Common> Common::makeShared() {
    auto common = platform::create<Common>(&Common::init);
    if (common) {
        common->loadAccountInfo();
    }
    return common;
}

bool Common::init() {
    isRenewingAccountCredentials_ = false;
    if (const auto installed = Platform::installed()) {
        redirects_ = installed->notificationCenter->addObserver(
            platform::kKTCommandRedirectedNotification,
            [self = platform::weak(this)](const platform::Notification& notification) {
                if (const auto common = self.lock()) {
                    common->redirected(notification);
                }
            });
    }
    return true;
}

void Common::loadAccountInfo() {
    const auto installed = Platform::installed();
    const auto account = installed && installed->accounts ? installed->accounts->deviceOwnerAccount() : nullptr;
    const auto person = account ? account->personIdentifier() : std::nullopt;
    if (!person) {
        isAccountPresent_ = false;
        return;
    }
    isAccountPresent_ = true;
    username_ = account->userName().value_or("");
    personID_ = *person;
    const auto token = account->tokenOfType(platform::kFriendLocationService);
    appToken_ = token.value_or("");
    ktrHost_ = account->hostNameOfType(platform::kFriendLocationService).value_or("");
    isTokenAccessible_ = token.has_value();
    accountInfoLoaded_ = true;
}

void Common::loadAccountInfoIfNeeded() {
    KTR_ASSERT_MAIN_THREAD();
    if (!accountInfoLoaded_) {
        loadAccountInfo();
    }
}

void Common::clearKTRAccount() {
    username_.clear();
    personID_.clear();
    appToken_.clear();
    ktrHost_.clear();
    accountInfoLoaded_ = false;
    isTokenAccessible_ = false;
    isAccountPresent_ = false;
}

std::string Common::username() {
    loadAccountInfoIfNeeded();
    return username_;
}

std::string Common::personID() {
    loadAccountInfoIfNeeded();
    return personID_;
}

std::string Common::appToken() {
    loadAccountInfoIfNeeded();
    return appToken_;
}

bool Common::tokenIsNotAccessible() {
    loadAccountInfoIfNeeded();
    return !isTokenAccessible_;
}

bool Common::hasKTRUser() {
    loadAccountInfoIfNeeded();
    return isAccountPresent_;
}

std::optional<std::string> Common::deviceUDID() const {
    const auto information = deviceInformation();
    return information ? information->uniqueDeviceIdentifier() : std::nullopt;
}

std::optional<std::string> Common::productType() const {
    const auto information = deviceInformation();
    return information ? information->productType() : std::nullopt;
}

std::optional<std::string> Common::buildVersion() const {
    const auto information = deviceInformation();
    return information ? information->operatingSystemBuild() : std::nullopt;
}

std::optional<std::string> Common::osVersion() {
    if (!osVersion_) {
        const auto information = deviceInformation();
        auto version = information ? information->operatingSystemVersion() : std::nullopt;
        if (const auto first = version ? version->find('.') : std::string::npos; first != std::string::npos) {
            version = version->substr(0, version->find('.', first + 1));
        }
        osVersion_ = version;
    }
    return *osVersion_;
}

bool Common::isLocked() const {
    using platform::DeviceLock;
    const auto installed = Platform::installed();
    const int state =
        installed && installed->deviceLock ? installed->deviceLock->lockState() : DeviceLock::kWithoutLock;
    const bool locked =
        state == DeviceLock::kLocked || state == DeviceLock::kLocking || state == DeviceLock::kNeverUnlocked;
    LogCategory_Unspecified()->line("Locked state is %i", locked ? 1 : 0);
    return locked;
}

void Common::redirected(const platform::Notification& notification) {
    const auto command = std::dynamic_pointer_cast<platform::KTJSONCommand>(notification.sender);
    if (!command || !command->wasRedirected()) {
        return;
    }
    const std::string host = command->redirectedHost();
    LogCategory_Unspecified()->write(platform::LogLevel::Info, "REDIRECT: %@ -> %@", command->originalHost(), host);
    storeRedirectedHost(host);
}

std::string Common::redirectedHost() const {
    const auto installed = Platform::installed();
    return installed && installed->preferences
               ? installed->preferences->value(RedirectedHostKey, PreferencesBundleID).value_or("")
               : "";
}

void Common::flushRedirection() {
    storeRedirectedHost(std::nullopt);
}

bool Common::isAppRestricted() const {
    const auto installed = Platform::installed();
    return installed && installed->restrictions && installed->restrictions->isFriendLocationRestricted();
}

bool Common::isKTRAllowed() const {
    const auto installed = Platform::installed();
    return installed && installed->restrictions && installed->restrictions->isFriendLocationAllowed();
}

std::string Common::defaultCountryCode() {
    const auto installed = Platform::installed();
    auto code = installed->telephony->homeCountryCode();
    if (!code) {
        code = installed->region->countryCode();
    }
    return platform::asciiLowercased(code.value_or("us"));
}

bool Common::isHandleEmail(const std::optional<std::string>& handle) const {
    return handle && handle->find('@') != std::string::npos;
}

std::string Common::completeNumberForPhoneNumber(const std::optional<std::string>& phoneNumber) const {
    std::string cut = cutNumber(phoneNumber.value_or(""));
    if (cut.empty()) {
        return cut;
    }
    const auto library = Platform::installed()->phoneNumbers;
    const auto parsed = library->parse(cut, defaultCountryCode());
    const auto printed = parsed ? library->text(*parsed, PhoneNumberLibrary::kFormatE164) : std::nullopt;
    return printed.value_or(cut);
}

std::vector<std::string> Common::handlesForVAPerson(const std::shared_ptr<platform::VAPerson>& person) const {
    std::vector<std::string> handles;
    if (!person) {
        return handles;
    }
    const auto add = [this, &handles](const std::optional<std::string>& number) {
        if (auto complete = completeNumberForPhoneNumber(number); !complete.empty()) {
            handles.push_back(std::move(complete));
        }
    };
    for (const auto& phone : person->phones) {
        if (phone) {
            add(phone->number);
        }
    }
    if (handles.empty()) {
        const auto contact = ContactsUtilities::contactForAssistantId(person->identifier);
        for (const std::string& number : ContactsUtilities::phoneNumbersForContact(contact)) {
            add(number);
        }
    }
    for (const auto& email : person->emails) {
        if (email && email->emailAddress) {
            handles.push_back(*email->emailAddress);
        }
    }
    return handles;
}

}  // namespace ktr
