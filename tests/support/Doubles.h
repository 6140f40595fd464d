#pragma once

#include <map>
#include <memory>
#include <optional>
#include <string>
#include <vector>

#include "platform/assistant/AssistantSettings.h"
#include "platform/assistant/Localization.h"
#include "platform/base/Clock.h"
#include "platform/base/LengthFormatter.h"
#include "platform/base/PluralRules.h"
#include "platform/base/Region.h"
#include "platform/client/DistanceCalculator.h"
#include "platform/contacts/ContactStore.h"
#include "platform/contacts/MonogramMaker.h"
#include "platform/contacts/PhoneNumberLibrary.h"
#include "platform/location/Geodesy.h"
#include "platform/location/PlatformLocationManager.h"
#include "platform/map/MapsApplication.h"
#include "platform/ui/Appearance.h"
#include "platform/ui/Device.h"
#include "platform/ui/Image.h"

// The platform in memory, for tests: each double answers from public members that a test sets.

namespace ktr::test {

struct FakeDevice : platform::Device {
    std::optional<platform::UserInterfaceIdiom> idiom = platform::UserInterfaceIdiom::Phone;
    double scale = 2.0;
    platform::ContentSizeCategory category = platform::ContentSizeCategory::L;

    std::optional<platform::UserInterfaceIdiom> userInterfaceIdiom() const override { return idiom; }
    double mainScreenScale() const override { return scale; }
    platform::ContentSizeCategory contentSizeCategory() const override { return category; }
};

struct FakeAssistant : platform::AssistantSettings {
    std::optional<std::string> language = "en-GB";
    bool rightToLeft = false;

    std::optional<std::string> languageCode() const override { return language; }
    bool languageIsRightToLeft() const override { return rightToLeft; }
};

struct FakeRegion : platform::RegionSettings {
    std::string locale = "en-GB";
    std::optional<std::string> country = "GB";

    std::string localeIdentifier() const override { return locale; }
    std::optional<std::string> countryCode() const override { return country; }
};

struct FakeAppearance : platform::AssistantAppearance {
    platform::Font lightFont(double size) const override {
        return {platform::FontFace::Light, platform::FontWeight::Regular, size};
    }
    platform::Font thinFont(double size) const override {
        return {platform::FontFace::Thin, platform::FontWeight::Regular, size};
    }
    platform::Color standardTextColor() const override {
        return platform::Color::ofRole(platform::ColorRole::StandardText);
    }
    platform::Color highlightColor() const override { return platform::Color::ofRole(platform::ColorRole::Highlight); }
    bool isDark() const override { return dark; }
    bool isHighContrast() const override { return highContrast; }
    bool reducesMotion() const override { return reducedMotion; }

    bool dark = false;
    bool highContrast = false;
    bool reducedMotion = false;
};

/// Texts by language, bundle, table and key; falls back as the interface says.
struct FakeLocalization : platform::Localization {
    static constexpr const char* kDefaultTable = "Localizable";
    std::string language = "en";
    std::string hostBundle = "org.ktr.host";
    /// language/bundle/table/key -> text
    std::map<std::string, std::string> texts;
    mutable std::vector<std::string> asked;

    void set(const std::string& bundle, const std::string& key, const std::string& text, const std::string& in = "en",
             const std::string& table = kDefaultTable) {
        texts[in + "/" + bundle + "/" + table + "/" + key] = text;
    }
    std::string text(const std::string& key, const std::string& bundle, const std::optional<std::string>& table,
                     const std::optional<std::string>& defaultValue) const override;
    std::string hostBundleIdentifier() const override { return hostBundle; }
    std::string languageOfTexts() const override { return language; }
};

/// English: "1" is one, what a test names is what it says, and all else is other.
struct FakePlurals : platform::PluralRules {
    std::map<std::string, std::string> categories = {{"1", "one"}};
    mutable std::vector<std::string> asked;

    std::string category(const std::string& number, const std::string& inLanguage) const override {
        asked.push_back(inLanguage);
        const auto found = categories.find(number);
        return found != categories.end() ? found->second : "other";
    }
};

/// Decimal numbers with "." and ASCII digits.
struct FakeNumbers : platform::NumberFormatter {
    std::optional<double> numberFromString(const std::string& text) const override;
    std::string plainStringFromInteger(std::int64_t number) const override { return std::to_string(number); }
};

struct FakeImage : platform::Image {
    std::string name;
    platform::Size points;
    platform::Size size() const override { return points; }
};

/// Images that a test named, and one for any data that begins with "image".
struct FakeImages : platform::ImageSource {
    std::map<std::string, std::shared_ptr<platform::Image>> named;
    int lookups = 0;

    std::shared_ptr<platform::Image> imageNamed(const std::string& name, const std::string& bundle) override;
    std::shared_ptr<platform::Image> imageFromData(const platform::Bytes& data) override;
};

struct FakeAvatars : platform::AvatarImages {
    std::shared_ptr<platform::Image> avatarForContact(const std::shared_ptr<platform::Contact>& contact,
                                                      double diameter) override;
    std::map<const platform::Contact*, std::shared_ptr<platform::Image>> made;
};

struct FakeMonogramMakers : platform::MonogramMakerFactory {
    struct Call {
        int style = 0;
        double diameter = 0.0;
        std::optional<platform::Font> font;
        std::optional<platform::Color> tint;
        /// The colours that tinted makers were asked for.
        std::vector<std::optional<platform::Color>> tintsAsked;
    };
    /// One entry a maker made.
    std::vector<std::shared_ptr<Call>> calls;
    std::shared_ptr<platform::MonogramMaker> makeMonogramMaker(int style, double diameter) override;
};

/// Contacts in the order given; matches e-mail addresses by ASCII case-insensitive equality and phone numbers by
/// digits, in full when both begin with "+", else by their last eight digits.
struct FakeContacts : platform::ContactStore {
    Contacts contacts;
    std::optional<std::string> error;
    int fetches = 0;
    platform::ContactKeys lastKeys;

    platform::ContactFetch<Contacts> unifiedContactsMatchingEmailAddress(const std::string& address,
                                                                         const platform::ContactKeys& keys) override;
    platform::ContactFetch<Contacts> unifiedContactsMatchingPhoneNumber(const std::string& number,
                                                                        const platform::ContactKeys& keys) override;
    platform::ContactFetch<std::shared_ptr<platform::Contact>> unifiedContactWithIdentifier(
        const std::string& identifier, const platform::ContactKeys& keys) override;
};

struct FakeContactFormatter : platform::ContactFormatter {
    std::optional<std::string> stringFromContact(const platform::Contact& contact,
                                                 platform::ContactFormatterStyle style) const override;
    std::string descriptorForRequiredKeys(platform::ContactFormatterStyle) const override { return "fullNameKeys"; }
};

/// Assistant identifiers are "assistant:" and the contact's identifier.
struct FakeAssistantContacts : platform::AssistantContacts {
    std::optional<std::string> contactIdentifierForAssistantIdentifier(const std::string& identifier) const override;
    std::optional<std::string> assistantIdentifierForContact(const platform::Contact& contact) const override;
    platform::ContactKeys requiredKeys() const override { return {"conversionKey"}; }
};

/// "25 m" or "25 metres", and so on.
struct FakeLengths : platform::LengthFormatter {
    platform::LengthSystem units = platform::LengthSystem::Metric;
    platform::LengthSystem system() const override { return units; }
    std::string text(double amount, platform::LengthUnit unit, platform::LengthWidth width) const override;
};

/// Remembers what it was asked to open.
struct FakeMapsApplication : platform::MapsApplication {
    std::vector<platform::MapItem> opened;
    bool open(const platform::MapItem& item) override {
        opened.push_back(item);
        return true;
    }
};

/// Knows the countries us and gb; a number needs at least seven digits.
struct FakePhoneNumbers : platform::PhoneNumberLibrary {
    mutable int parses = 0;
    std::shared_ptr<platform::ParsedPhoneNumber> parse(const std::string& text,
                                                       const std::string& countryCode) const override;
    std::optional<std::string> displayText(const platform::ParsedPhoneNumber& number, int style,
                                           const std::string& homeCountryCode) const override;
    std::optional<std::string> text(const platform::ParsedPhoneNumber& number, int format) const override;
};

struct FakeTelephony : platform::Telephony {
    std::optional<std::string> country = "gb";
    std::optional<std::string> homeCountryCode() const override { return country; }
};

/// Great circles on a sphere of the WGS84 mean radius, 6,371,008.8 m: within 0.6 % of the ellipsoid.
struct SphereGeodesy : platform::Geodesy {
    double distance(const platform::Coordinate& from, const platform::Coordinate& to) const override;
    double azimuth(const platform::Coordinate& from, const platform::Coordinate& to) const override;
    platform::Coordinate destination(const platform::Coordinate& from, double azimuthDegrees,
                                     double metres) const override;
};

/// Whole metres below a kilometre, else kilometres with one digit.
struct FakeDistanceCalculators : platform::DistanceCalculatorFactory {
    std::vector<platform::DistanceCalculator::Settings> made;
    int asked = 0;
    std::shared_ptr<platform::DistanceCalculator> makeDistanceCalculator(
        const platform::DistanceCalculator::Settings& settings) override;
};

/// UTC without daylight saving.
struct UtcCalendar : platform::Calendar {
    TimeOfDay timeOfDay(platform::Date date) const override;
    platform::Date adding(TimeOfDay amounts, platform::Date date) const override;
};

/// Delivers what a test gives it while updates run.
struct FakeLocationManager : platform::PlatformLocationManager {
    std::shared_ptr<platform::Bundle> bundle;
    double desiredAccuracy = 0.0;
    double distanceFilter = 0.0;
    bool updating = false;
    int stops = 0;
    std::shared_ptr<platform::PlatformLocation> cached;

    void setDesiredAccuracy(double metres) override { desiredAccuracy = metres; }
    void setDistanceFilter(double metres) override { distanceFilter = metres; }
    void startUpdatingLocation() override { updating = true; }
    void stopUpdatingLocation() override {
        updating = false;
        ++stops;
    }
    std::shared_ptr<platform::PlatformLocation> location() const override { return cached; }
    /// Keeps the position and, while updates run and the filter lets it through, tells the delegate.
    void deliver(const std::shared_ptr<platform::PlatformLocation>& position);

  private:
    std::shared_ptr<platform::PlatformLocation> delivered_;
};

struct FakeLocationManagers : platform::LocationManagerFactory {
    /// What new managers start with as their cached position.
    std::shared_ptr<platform::PlatformLocation> cached;
    std::vector<std::shared_ptr<FakeLocationManager>> made;
    std::shared_ptr<platform::PlatformLocationManager> makeManager(
        const std::shared_ptr<platform::Bundle>& effectiveBundle) override;
};

}  // namespace ktr::test
