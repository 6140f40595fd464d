#include "linux/contacts/PhonenumberLibrary.h"

#include <algorithm>
#include <utility>

#include "linux/contacts/PhoneText.h"
#include "linux/device/LoadableModule.h"
#include "platform/base/Log.h"

namespace ktr::linux_ {

namespace {

constexpr const char* kModuleFile = "libktr-phone.so";
// libphonenumber takes no longer texts for numbers, but needs a minute to say so of a very long one.
constexpr std::size_t kLongestText = 250;

std::string upperCased(std::string code) {
    for (char& c : code) {
        c = static_cast<char>(c >= 'a' && c <= 'z' ? c - 'a' + 'A' : c);
    }
    return code;
}

}  // namespace

class PhonenumberLibrary::Number : public platform::ParsedPhoneNumber {
  public:
    /// None for a text that was understood to be no number: that answer is kept as well.
    explicit Number(std::optional<PhoneNumberParts> parts) : parts_(std::move(parts)) {}
    const std::optional<PhoneNumberParts>& parts() const { return parts_; }

  private:
    std::optional<PhoneNumberParts> parts_;
};

PhonenumberLibrary::PhonenumberLibrary(std::size_t most) : most_(std::max<std::size_t>(most, 1)) {}
PhonenumberLibrary::~PhonenumberLibrary() = default;

const PhoneModule* PhonenumberLibrary::module() const {
    if (!moduleTried_) {
        moduleTried_ = true;
        std::string error;
        if (const auto make =
                reinterpret_cast<PhoneModuleEntry>(LoadableModule::entry(kModuleFile, kPhoneModuleEntry, error))) {
            module_.reset(make());
        }
        if (!module_) {
            const platform::Log log("org.ktr.linux", "phone");
            log.write(platform::LogLevel::Error, "Phone numbers cannot be read: %@",
                      platform::FormatArgument(error).shown());
        }
    }
    return module_.get();
}

std::optional<PhoneNumberParts> PhonenumberLibrary::understood(const std::string& text,
                                                               const std::string& region) const {
    const PhoneModule* library = module();
    if (!library || text.size() > kLongestText) {
        return std::nullopt;
    }
    auto whole = library->parse(text, region);
    const std::string_view number = PhoneText::withoutExtension(text);
    if (number.size() == text.size()) {
        return whole;
    }
    // Of a word for an extension that it does not know the library makes digits.
    auto plain = library->parse(std::string(number), region);
    const bool knowsTheWord = whole && plain && whole->nationalPart == plain->nationalPart;
    return plain && !knowsTheWord ? plain : whole;
}

std::size_t PhonenumberLibrary::place() const {
    if (answers_.size() < most_) {
        answers_.emplace_back();
        return answers_.size() - 1;
    }
    constexpr int kTries = 16;
    std::size_t found = 0;
    for (int i = 0; i < kTries; ++i) {
        found = chance_() % most_;
        if (!std::exchange(answers_[found].wasAsked, false)) {
            break;
        }
    }
    index_.erase(*answers_[found].key);
    return found;
}

std::shared_ptr<PhonenumberLibrary::Number> PhonenumberLibrary::number(const std::string& text,
                                                                       const std::string& countryCode) const {
    const std::string region = upperCased(countryCode);
    std::string key = region + '\n' + text;
    if (const auto found = index_.find(key); found != index_.end()) {
        Answer& answer = answers_[found->second];
        answer.wasAsked = true;
        return answer.number;
    }
    ++read_;
    auto made = std::make_shared<Number>(understood(text, region));
    if (key.size() > 2 * kLongestText) {
        return made;
    }
    const std::size_t at = place();
    const auto kept = index_.emplace(std::move(key), at).first;
    answers_[at] = {&kept->first, made, false};
    return made;
}

std::optional<PhoneNumberParts> PhonenumberLibrary::parts(const std::string& text,
                                                          const std::string& countryCode) const {
    return number(text, countryCode)->parts();
}

std::shared_ptr<platform::ParsedPhoneNumber> PhonenumberLibrary::parse(const std::string& text,
                                                                       const std::string& countryCode) const {
    auto parsed = number(text, countryCode);
    return parsed->parts() ? parsed : nullptr;
}

std::optional<std::string> PhonenumberLibrary::displayText(const platform::ParsedPhoneNumber& number, int style,
                                                           const std::string& homeCountryCode) const {
    const auto* ours = dynamic_cast<const Number*>(&number);
    if (!ours || !ours->parts() || style != kDisplayStyle) {
        return std::nullopt;
    }
    // Countries that share a calling code write each other's numbers nationally; by it alone can a number that is not
    // in use be placed.
    const PhoneModule* library = module();
    const bool home = library && library->callingCode(upperCased(homeCountryCode)) == ours->parts()->callingCode;
    return home ? ours->parts()->national : ours->parts()->international;
}

std::optional<std::string> PhonenumberLibrary::text(const platform::ParsedPhoneNumber& number, int format) const {
    const auto* ours = dynamic_cast<const Number*>(&number);
    if (!ours || !ours->parts() || format != kFormatE164) {
        return std::nullopt;
    }
    return ours->parts()->e164;
}

}  // namespace ktr::linux_
