#include "service/Common.h"

#include "model/ContactsUtilities.h"
#include "platform/base/Assert.h"
#include "platform/base/Platform.h"
#include "platform/base/Region.h"
#include "platform/base/Utf8.h"
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

}  // namespace

std::shared_ptr<Common> Common::sharedInstance() {
    KTR_ASSERT_MAIN_THREAD();
    return platform::shared<Common>();
}

std::shared_ptr<Common> Common::makeShared() {
    return std::make_shared<Common>();
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
    const std::string cut = cutNumber(phoneNumber.value_or(""));
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
