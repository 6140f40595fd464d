#include "model/KTRVALocation.h"

#include "model/ContactsUtilities.h"
#include "model/LogCategory.h"
#include "model/PluginBundle.h"
#include "platform/assistant/AssistantSettings.h"
#include "platform/base/CurrentPlatform.h"
#include "platform/base/FilledText.h"
#include "platform/base/Platform.h"
#include "platform/base/Utf8.h"
#include "platform/contacts/PhoneNumberLibrary.h"
#include "service/Common.h"
#include "service/DecimalDigits.h"
#include "service/KTRVAUtils.h"

namespace ktr {

using platform::AssistantObject;
using platform::Contact;
using platform::Dictionary;
using platform::Image;
using platform::Platform;
using platform::PlatformLocation;
using platform::VAKtrLocation;
using platform::Value;
using platform::VAPerson;
using platform::VAPersonAttribute;

namespace {

/// The app group whose preferences may override the units of distances.
constexpr const char* kAppGroup = "group.org.ktr";

struct SharedDistanceCalculator {
    static std::shared_ptr<SharedDistanceCalculator> makeShared() {
        const auto installed = Platform::installed();
        auto holder = std::make_shared<SharedDistanceCalculator>();
        holder->calculator = installed->distanceCalculators->makeDistanceCalculator(
            {kAppGroup, installed->assistant->languageCode(), installed->region->localeIdentifier(),
             installed->localization});
        return holder;
    }
    std::shared_ptr<platform::DistanceCalculator> calculator;
};

// A null or wrongly typed member reads as an absent one.

const Dictionary* dictionaryAt(const Dictionary* dictionary, const char* key) {
    const Value* value = dictionary != nullptr ? dictionary->find(key) : nullptr;
    return value != nullptr ? value->dictionary() : nullptr;
}

std::optional<std::string> textAt(const Dictionary& dictionary, const char* key) {
    const Value* value = dictionary.find(key);
    const std::string* text = value != nullptr ? value->string() : nullptr;
    return text != nullptr ? std::optional<std::string>(*text) : std::nullopt;
}

std::optional<double> numberAt(const Dictionary& dictionary, const char* key) {
    const Value* value = dictionary.find(key);
    return value != nullptr ? value->number() : std::nullopt;
}

/// The first label of the list, or none.
std::optional<std::string> firstLabel(const Dictionary& location) {
    const Value* labels = location.find("labels");
    if (labels == nullptr || labels->array() == nullptr) {
        return std::nullopt;
    }
    for (const Value& element : *labels->array()) {
        const Dictionary* entry = element.dictionary();
        if (auto label = entry != nullptr ? textAt(*entry, "label") : std::nullopt) {
            return label;
        }
    }
    return std::nullopt;
}

/// Puts the name and the assistant's identifier of a contact, if there is one, into a person.
void describe(VAPerson& person, const std::shared_ptr<Contact>& contact) {
    if (!contact) {
        return;
    }
    const auto installed = Platform::installed();
    person.firstName = contact->givenName;
    person.lastName = contact->familyName;
    person.fullName =
        installed->contactFormatter->stringFromContact(*contact, platform::ContactFormatterStyle::FullName);
    person.identifier = installed->assistantContacts->assistantIdentifierForContact(*contact);
}

const std::optional<std::string>& noHandle() {
    static const std::optional<std::string> none;
    return none;
}

}  // namespace

bool KTRVALocation::initWithVelaLocation(const std::shared_ptr<VAKtrLocation>& velaLocation) {
    if (!init()) {
        return false;
    }
    velaLocation_ = velaLocation;
    return true;
}

bool KTRVALocation::initWithHandle(const std::optional<std::string>& handle, const std::shared_ptr<VAPerson>& vaPerson,
                                   const std::optional<Dictionary>& dictionary) {
    if (!init()) {
        return false;
    }
    decodeHandle(handle, vaPerson, dictionary);
    return true;
}

std::shared_ptr<KTRVALocation> KTRVALocation::locationWithVelaLocation(
    const std::shared_ptr<VAKtrLocation>& velaLocation) {
    return platform::create<KTRVALocation>(&KTRVALocation::initWithVelaLocation, velaLocation);
}

std::shared_ptr<KTRVALocation> KTRVALocation::locationWithHandle(const std::optional<std::string>& handle,
                                                                 const std::shared_ptr<VAPerson>& vaPerson,
                                                                 const std::optional<Dictionary>& dictionary) {
    return platform::create<KTRVALocation>(&KTRVALocation::initWithHandle, handle, vaPerson, dictionary);
}

std::shared_ptr<KTRVALocation> KTRVALocation::locationWithEntry(const std::string& handle,
                                                                const std::shared_ptr<VAPerson>& vaPerson,
                                                                const Dictionary* entry) {
    auto record = platform::create<KTRVALocation>(&KTRVALocation::init);
    if (record) {
        record->decodeEntry(handle, vaPerson, entry);
    }
    return record;
}

void KTRVALocation::decodeHandle(const std::optional<std::string>& handle, const std::shared_ptr<VAPerson>& vaPerson,
                                 const std::optional<Dictionary>& dictionary) {
    decodeEntry(handle, vaPerson, dictionary ? &*dictionary : nullptr);
}

void KTRVALocation::decodeEntry(const std::optional<std::string>& handle, const std::shared_ptr<VAPerson>& vaPerson,
                                const Dictionary* entry) {
    velaLocation_ = std::make_shared<VAKtrLocation>();
    auto person = vaPerson;
    if (!person) {
        person = Common::sharedInstance()->isHandleEmail(handle) ? personForEmailFromContacts(handle)
                                                                 : personForPhoneFromContacts(handle);
    }
    if (isLineWanted(platform::LogLevel::Debug)) {
        LogCategory_Unspecified()->write(platform::LogLevel::Debug, "VAPerson found: %@", person);
    }
    velaLocation_->friend_ = std::make_shared<VAPersonAttribute>();
    velaLocation_->friend_->object = std::move(person);
    velaLocation_->friend_->data = handle;
    if (entry == nullptr) {
        return;
    }
    if (const auto distance = textAt(*entry, "distanceInMeters")) {
        velaLocation_->distance = numberFormatter()->numberFromString(*distance);
    }
    const Dictionary* location = dictionaryAt(entry, "location");
    if (const Dictionary* address = dictionaryAt(location, "address")) {
        decodeAddress(*address);
    }
    if (location != nullptr) {
        decodeFix(*location);
    }
}

void KTRVALocation::decodeAddress(const Dictionary& address) {
    velaLocation_->city = textAt(address, "locality");
    // Only an absent state code falls back to the area: one that is present and null is meant to be none.
    velaLocation_->stateCode = textAt(address, address.contains("stateCode") ? "stateCode" : "administrativeArea");
}

void KTRVALocation::decodeFix(const Dictionary& location) {
    velaLocation_->latitude = numberAt(location, "latitude");
    velaLocation_->longitude = numberAt(location, "longitude");
    velaLocation_->accuracy = numberAt(location, "horizontalAccuracy");
    velaLocation_->locationDate = KTRVAUtils::timeIntervalForMillisecondsSince1970(numberAt(location, "timestamp"));
    velaLocation_->street = textAt(location, "streetAddress");
    velaLocation_->label = firstLabel(location);
}

std::shared_ptr<VAPerson> KTRVALocation::personForEmailFromContacts(const std::optional<std::string>& email) const {
    auto person = std::make_shared<VAPerson>();
    person->emails.push_back(std::make_shared<platform::VAEmail>());
    person->emails.back()->emailAddress = email;
    describe(*person, ContactsUtilities::contactForEmail(email));
    return person;
}

std::shared_ptr<VAPerson> KTRVALocation::personForPhoneFromContacts(const std::optional<std::string>& phone) const {
    auto person = std::make_shared<VAPerson>();
    person->phones.push_back(std::make_shared<platform::VAPhone>());
    person->phones.back()->number = phone;
    describe(*person, ContactsUtilities::contactForPhone(phone));
    return person;
}

std::shared_ptr<platform::NumberFormatter> KTRVALocation::numberFormatter() {
    return platform::currentPlatform()->decimalNumbers;
}

const VAPerson* KTRVALocation::person() const {
    return velaLocation_ && velaLocation_->friend_ ? velaLocation_->friend_->object.get() : nullptr;
}

std::string KTRVALocation::friendName() const {
    const auto* friendPerson = person();
    if (friendPerson != nullptr && friendPerson->fullName && !friendPerson->fullName->empty()) {
        return *friendPerson->fullName;
    }
    return friendHandlePretty();
}

const std::optional<std::string>& KTRVALocation::friendEmail() const {
    const auto* friendPerson = person();
    const bool isThere = friendPerson != nullptr && !friendPerson->emails.empty() && friendPerson->emails.back();
    return isThere ? friendPerson->emails.back()->emailAddress : noHandle();
}

const std::optional<std::string>& KTRVALocation::friendPhone() const {
    const auto* friendPerson = person();
    const bool isThere = friendPerson != nullptr && !friendPerson->phones.empty() && friendPerson->phones.back();
    return isThere ? friendPerson->phones.back()->number : noHandle();
}

const std::optional<std::string>& KTRVALocation::friendHandle() const {
    const auto& email = friendEmail();
    return email ? email : friendPhone();
}

std::string KTRVALocation::friendHandlePretty() const {
    if (const auto& email = friendEmail()) {
        return *email;
    }
    return formatPhoneNumber(friendPhone().value_or(""));
}

std::string KTRVALocation::unformattedHandle() const {
    if (const auto& email = friendEmail()) {
        return *email;
    }
    return unformatPhoneNumber(friendPhone().value_or(""));
}

bool KTRVALocation::isPhone() const {
    return friendPhone().has_value() && !friendEmail().has_value();
}

std::string KTRVALocation::formatPhoneNumber(const std::string& phoneNumber) const {
    if (phoneNumber.empty()) {
        return phoneNumber;
    }
    const auto library = Platform::installed()->phoneNumbers;
    const std::string home = Common::defaultCountryCode();
    const auto parsed = library->parse(phoneNumber, home);
    const auto display =
        parsed ? library->displayText(*parsed, platform::PhoneNumberLibrary::kDisplayStyle, home) : std::nullopt;
    return display && !display->empty() ? *display : phoneNumber;
}

std::string KTRVALocation::unformatPhoneNumber(const std::string& phoneNumber) const {
    std::string kept;
    for (std::size_t at = 0; at < phoneNumber.size();) {
        const auto step = platform::decodeUtf8(phoneNumber, at);
        if (step.codePoint == U'+' || isDecimalDigit(step.codePoint)) {
            kept.append(phoneNumber, at, step.length);
        }
        at += step.length;
    }
    return kept;
}

bool KTRVALocation::hasCoordinate() const {
    return velaLocation_ && velaLocation_->latitude && velaLocation_->longitude;
}

std::string KTRVALocation::friendLocation(bool refreshFinished) const {
    if (velaLocation_) {
        const auto& city = velaLocation_->city;
        const auto& state = velaLocation_->stateCode;
        if (velaLocation_->label) {
            return *velaLocation_->label;
        }
        if (city && state && *city != *state) {
            static const std::string kCityAndState = "CITY_STATE_LABEL";
            return platform::filled(AssistantLocalizedString(kCityAndState), {*city, *state});
        }
        if (city || state) {
            return city ? *city : *state;
        }
    }
    return AssistantLocalizedString(refreshFinished ? "NO_LOCATION" : "LOCATING");
}

std::optional<std::string> KTRVALocation::distanceFromLocation(
    const std::shared_ptr<PlatformLocation>& location) const {
    if (!location) {
        return std::nullopt;
    }
    const auto place = KTRVAUtils::geoLocationForVALocation(velaLocation_);
    if (!place) {
        return std::nullopt;
    }
    const auto calculator = distanceCalculator();
    auto text = calculator->localizedDistance(*location, *place);
    if (isLineWanted(platform::LogLevel::Debug)) {
        LogCategory_Unspecified()->write(platform::LogLevel::Debug, "Distance calculated: %@ for friend: %@ (Unit:%li)",
                                         text, friendName(), calculator->measurementSystem());
    }
    return text;
}

std::shared_ptr<platform::DistanceCalculator> KTRVALocation::distanceCalculator() {
    return platform::shared<SharedDistanceCalculator>()->calculator;
}

std::shared_ptr<Image> KTRVALocation::friendImage() const {
    return friendImageForPersonAttribute(velaLocation_ ? velaLocation_->friend_ : nullptr);
}

std::shared_ptr<Image> KTRVALocation::friendImageForPersonAttribute(
    const std::shared_ptr<VAPersonAttribute>& attribute) {
    if (!attribute || !attribute->object) {
        return nullptr;
    }
    const auto contact = ContactsUtilities::contactForAssistantId(attribute->object->identifier);
    if (auto image = ContactsUtilities::imageForContact(contact)) {
        return image;
    }
    return friendImageForVAPerson(attribute->object);
}

std::shared_ptr<Image> KTRVALocation::friendImageForVAPerson(const std::shared_ptr<AssistantObject>& object) {
    const auto person = std::dynamic_pointer_cast<VAPerson>(object);
    if (!person) {
        return nullptr;
    }
    for (const auto& email : person->emails) {
        const auto contact = email ? ContactsUtilities::contactForEmail(email->emailAddress) : nullptr;
        if (auto image = ContactsUtilities::imageForContact(contact)) {
            return image;
        }
    }
    for (const auto& phone : person->phones) {
        const auto contact = phone ? ContactsUtilities::contactForPhone(phone->number) : nullptr;
        if (auto image = ContactsUtilities::imageForContact(contact)) {
            return image;
        }
    }
    return nullptr;
}

std::shared_ptr<platform::Bundle> KTRVALocation::bundle() {
    return PluginBundle::bundle();
}

}  // namespace ktr
