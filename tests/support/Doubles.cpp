#include "tests/support/Doubles.h"

#include <charconv>
#include <cmath>

#include "platform/base/Json.h"
#include "platform/base/Utf8.h"

namespace ktr::test {

using namespace platform;

namespace {

std::string digitsOf(const std::string& text) {
    std::string digits;
    for (const char c : text) {
        if ((c >= '0' && c <= '9') || (c == '+' && digits.empty())) {
            digits.push_back(c);
        }
    }
    return digits;
}

bool samePhone(const std::string& a, const std::string& b) {
    const std::string left = digitsOf(a);
    const std::string right = digitsOf(b);
    if (left.starts_with('+') && right.starts_with('+')) {
        return left == right;
    }
    constexpr std::size_t kTail = 8;
    return left.size() >= kTail && right.size() >= kTail &&
           left.substr(left.size() - kTail) == right.substr(right.size() - kTail);
}

class FakeParsedNumber : public ParsedPhoneNumber {
  public:
    std::string country;   ///< calling code digits
    std::string national;  ///< digits without a leading zero
};

std::string callingCode(const std::string& country) {
    return asciiLowercased(country) == "gb" ? "44" : asciiLowercased(country) == "us" ? "1" : "";
}

class FakeDistanceCalculator : public DistanceCalculator {
  public:
    explicit FakeDistanceCalculator(int& asked) : asked_(asked) {}
    std::optional<std::string> localizedDistance(const PlatformLocation& from, const PlatformLocation& to) override {
        ++asked_;
        const double metres = from.distanceFromLocation(to);
        if (!std::isfinite(metres)) {
            return std::nullopt;
        }
        if (metres < 999.5) {
            return std::to_string(std::llround(metres)) + " m";
        }
        const auto tenths = std::llround(metres / 100.0);
        return std::to_string(tenths / 10) + "." + std::to_string(tenths % 10) + " km";
    }
    long measurementSystem() const override { return 0; }

  private:
    int& asked_;
};

class FakeMonogramMaker : public MonogramMaker {
  public:
    explicit FakeMonogramMaker(std::shared_ptr<FakeMonogramMakers::Call> call) : call_(std::move(call)) {}
    void setFont(const Font& font) override { call_->font = font; }
    std::shared_ptr<MonogramMaker> makerTintedWith(const std::optional<Color>& color) override {
        call_->tintsAsked.push_back(color);
        auto tinted = std::make_shared<FakeMonogramMakers::Call>(*call_);
        tinted->tint = color;
        return std::make_shared<FakeMonogramMaker>(tinted);
    }
    std::shared_ptr<Image> monogramForContact(const Contact& contact) override {
        auto image = std::make_shared<FakeImage>();
        image->name = (call_->tint ? "tinted monogram " : "monogram ") + contact.identifier;
        image->points = {call_->diameter, call_->diameter};
        return image;
    }

  private:
    std::shared_ptr<FakeMonogramMakers::Call> call_;
};

constexpr double kDay = 86400.0;

}  // namespace

std::string FakeLocalization::text(const std::string& key, const std::string& bundle,
                                   const std::optional<std::string>& table,
                                   const std::optional<std::string>& defaultValue) const {
    asked.push_back(key);
    const std::string rest = "/" + bundle + "/" + table.value_or(kDefaultTable) + "/" + key;
    for (const std::string& in : {language, std::string("en")}) {
        const auto found = texts.find(in + rest);
        if (found != texts.end()) {
            return found->second;
        }
    }
    return defaultValue.value_or(key);
}

std::optional<double> FakeNumbers::numberFromString(const std::string& text) const {
    double number = 0.0;
    const auto result = std::from_chars(text.data(), text.data() + text.size(), number, std::chars_format::fixed);
    if (text.empty() || result.ec != std::errc() || result.ptr != text.data() + text.size() || !std::isfinite(number)) {
        return std::nullopt;
    }
    return number;
}

std::shared_ptr<Image> FakeImages::imageNamed(const std::string& name, const std::string& bundle) {
    ++lookups;
    const auto found = named.find(bundle + "/" + name);
    return found != named.end() ? found->second : nullptr;
}

std::shared_ptr<Image> FakeImages::imageFromData(const Bytes& data) {
    const std::string text(data.begin(), data.end());
    if (!text.starts_with("image")) {
        return nullptr;
    }
    auto image = std::make_shared<FakeImage>();
    image->name = text;
    image->points = {54.0, 54.0};
    return image;
}

std::shared_ptr<Image> FakeAvatars::avatarForContact(const std::shared_ptr<Contact>& contact, double diameter) {
    auto& image = made[contact.get()];
    if (!image) {
        auto fresh = std::make_shared<FakeImage>();
        fresh->name = contact && !contact->isEmpty() ? "avatar " + contact->identifier : "blank";
        fresh->points = {diameter, diameter};
        image = fresh;
    }
    return image;
}

std::shared_ptr<MonogramMaker> FakeMonogramMakers::makeMonogramMaker(int style, double diameter) {
    auto call = std::make_shared<Call>();
    call->style = style;
    call->diameter = diameter;
    calls.push_back(call);
    return std::make_shared<FakeMonogramMaker>(call);
}

ContactFetch<ContactStore::Contacts> FakeContacts::unifiedContactsMatchingEmailAddress(const std::string& address,
                                                                                       const ContactKeys& keys) {
    ++fetches;
    lastKeys = keys;
    if (error) {
        return {{}, error};
    }
    Contacts found;
    for (const auto& contact : contacts) {
        for (const auto& mail : contact->emailAddresses) {
            if (asciiLowercased(mail.value) == asciiLowercased(address)) {
                found.push_back(contact);
                break;
            }
        }
    }
    return {found, std::nullopt};
}

ContactFetch<ContactStore::Contacts> FakeContacts::unifiedContactsMatchingPhoneNumber(const std::string& number,
                                                                                      const ContactKeys& keys) {
    ++fetches;
    lastKeys = keys;
    if (error) {
        return {{}, error};
    }
    Contacts found;
    for (const auto& contact : contacts) {
        for (const auto& phone : contact->phoneNumbers) {
            if (samePhone(phone.value, number)) {
                found.push_back(contact);
                break;
            }
        }
    }
    return {found, std::nullopt};
}

ContactFetch<std::shared_ptr<Contact>> FakeContacts::unifiedContactWithIdentifier(const std::string& identifier,
                                                                                  const ContactKeys& keys) {
    ++fetches;
    lastKeys = keys;
    if (error) {
        return {nullptr, error};
    }
    for (const auto& contact : contacts) {
        if (contact->identifier == identifier) {
            return {contact, std::nullopt};
        }
    }
    return {nullptr, "no contact with this identifier"};
}

std::optional<std::string> FakeContactFormatter::stringFromContact(const Contact& contact,
                                                                   ContactFormatterStyle /*style*/) const {
    if (!contact.storedFullName.empty()) {
        return contact.storedFullName;
    }
    std::string name = contact.givenName;
    if (!name.empty() && !contact.familyName.empty()) {
        name += " ";
    }
    name += contact.familyName;
    return name.empty() ? std::nullopt : std::optional<std::string>(name);
}

std::optional<std::string> FakeAssistantContacts::contactIdentifierForAssistantIdentifier(
    const std::string& identifier) const {
    constexpr std::string_view kPrefix = "assistant:";
    if (!identifier.starts_with(kPrefix) || identifier.size() == kPrefix.size()) {
        return std::nullopt;
    }
    return identifier.substr(kPrefix.size());
}

std::optional<std::string> FakeAssistantContacts::assistantIdentifierForContact(const Contact& contact) const {
    return contact.identifier.empty() ? std::nullopt : std::optional<std::string>("assistant:" + contact.identifier);
}

std::shared_ptr<ParsedPhoneNumber> FakePhoneNumbers::parse(const std::string& text,
                                                           const std::string& countryCode) const {
    ++parses;
    std::string digits = digitsOf(text);
    auto number = std::make_shared<FakeParsedNumber>();
    if (digits.starts_with('+')) {
        digits.erase(0, 1);
        for (const char* known : {"44", "1"}) {
            if (digits.starts_with(known)) {
                number->country = known;
                digits.erase(0, std::string(known).size());
                break;
            }
        }
    } else {
        number->country = callingCode(countryCode);
    }
    if (number->country.empty() || digits.size() < 7) {
        return nullptr;
    }
    number->national = digits.starts_with('0') ? digits.substr(1) : digits;
    return number;
}

std::optional<std::string> FakePhoneNumbers::displayText(const ParsedPhoneNumber& number, int style,
                                                         const std::string& homeCountryCode) const {
    const auto& parsed = dynamic_cast<const FakeParsedNumber&>(number);
    if (style != kDisplayStyle) {
        return std::nullopt;
    }
    if (callingCode(homeCountryCode) == parsed.country) {
        return (parsed.country == "44" ? "0" : "") + parsed.national;
    }
    return "+" + parsed.country + " " + parsed.national;
}

std::optional<std::string> FakePhoneNumbers::text(const ParsedPhoneNumber& number, int format) const {
    const auto& parsed = dynamic_cast<const FakeParsedNumber&>(number);
    return format == kFormatE164 ? std::optional<std::string>("+" + parsed.country + parsed.national) : std::nullopt;
}

double SphereGeodesy::distance(const Coordinate& from, const Coordinate& to) const {
    if (!isValid(from) || !isValid(to)) {
        return std::nan("");
    }
    constexpr double kRadius = 6371008.8;
    constexpr double kRadians = 3.14159265358979323846 / 180.0;
    const double dLat = (to.latitude - from.latitude) * kRadians;
    const double dLon = (to.longitude - from.longitude) * kRadians;
    const double h = std::pow(std::sin(dLat / 2.0), 2.0) + std::cos(from.latitude * kRadians) *
                                                               std::cos(to.latitude * kRadians) *
                                                               std::pow(std::sin(dLon / 2.0), 2.0);
    return 2.0 * kRadius * std::asin(std::min(1.0, std::sqrt(h)));
}

std::string FakeLengths::text(double amount, platform::LengthUnit unit, platform::LengthWidth width) const {
    static const char* const kShort[] = {"m", "km", "ft", "yd", "mi"};
    static const char* const kSpoken[] = {"metres", "kilometres", "feet", "yards", "miles"};
    const auto index = static_cast<std::size_t>(unit);
    return platform::writeJsonNumber(amount) + " " +
           (width == platform::LengthWidth::Short ? kShort[index] : kSpoken[index]);
}

double SphereGeodesy::azimuth(const Coordinate& from, const Coordinate& to) const {
    if (!isValid(from) || !isValid(to) || from == to) {
        return std::nan("");
    }
    constexpr double kRadians = 3.14159265358979323846 / 180.0;
    const double a = from.latitude * kRadians;
    const double b = to.latitude * kRadians;
    const double dLon = (to.longitude - from.longitude) * kRadians;
    const double y = std::sin(dLon) * std::cos(b);
    const double x = std::cos(a) * std::sin(b) - std::sin(a) * std::cos(b) * std::cos(dLon);
    const double degrees = std::atan2(y, x) / kRadians;
    const double positive = degrees < 0.0 ? degrees + 360.0 : degrees;
    return positive < 360.0 ? positive : 0.0;
}

Coordinate SphereGeodesy::destination(const Coordinate& from, double azimuthDegrees, double metres) const {
    if (!isValid(from) || !std::isfinite(azimuthDegrees) || !std::isfinite(metres)) {
        return {std::nan(""), std::nan("")};
    }
    constexpr double kRadius = 6371008.8;
    constexpr double kRadians = 3.14159265358979323846 / 180.0;
    const double arc = metres / kRadius;
    const double a = from.latitude * kRadians;
    const double direction = azimuthDegrees * kRadians;
    const double sine = std::sin(a) * std::cos(arc) + std::cos(a) * std::sin(arc) * std::cos(direction);
    const double b = std::asin(std::max(-1.0, std::min(1.0, sine)));
    const double y = std::sin(direction) * std::sin(arc) * std::cos(a);
    const double x = std::cos(arc) - std::sin(a) * std::sin(b);
    const double longitude = from.longitude + std::atan2(y, x) / kRadians;
    return {b / kRadians, std::remainder(longitude, 360.0)};
}

std::shared_ptr<DistanceCalculator> FakeDistanceCalculators::makeDistanceCalculator(
    const DistanceCalculator::Settings& settings) {
    made.push_back(settings);
    return std::make_shared<FakeDistanceCalculator>(asked);
}

Calendar::TimeOfDay UtcCalendar::timeOfDay(Date date) const {
    const double day = std::floor(date.secondsSinceReferenceDate / kDay) * kDay;
    const int seconds = static_cast<int>(std::floor(date.secondsSinceReferenceDate - day));
    return {seconds / 3600, seconds / 60 % 60, seconds % 60};
}

Date UtcCalendar::adding(TimeOfDay amounts, Date date) const {
    return {date.secondsSinceReferenceDate + amounts.hour * 3600.0 + amounts.minute * 60.0 + amounts.second};
}

void FakeLocationManager::deliver(const std::shared_ptr<PlatformLocation>& position) {
    cached = position;
    if (!updating || (delivered_ && delivered_->distanceFromLocation(*position) < distanceFilter)) {
        return;
    }
    delivered_ = position;
    if (const auto listener = delegate()) {
        listener->didUpdateLocations(*this, {position});
    }
}

std::shared_ptr<PlatformLocationManager> FakeLocationManagers::makeManager(const std::shared_ptr<Bundle>& bundle) {
    auto manager = std::make_shared<FakeLocationManager>();
    manager->bundle = bundle;
    manager->cached = cached;
    made.push_back(manager);
    return manager;
}

}  // namespace ktr::test
