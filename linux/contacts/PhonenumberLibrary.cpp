#include "linux/contacts/PhonenumberLibrary.h"

#include <utility>

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

PhonenumberLibrary::PhonenumberLibrary() = default;
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

std::shared_ptr<PhonenumberLibrary::Number> PhonenumberLibrary::number(const std::string& text,
                                                                       const std::string& countryCode) const {
    const std::string region = upperCased(countryCode);
    std::string key = region + '\n' + text;
    if (const auto found = index_.find(key); found != index_.end()) {
        answers_.splice(answers_.begin(), answers_, found->second);
        return found->second->number;
    }
    const PhoneModule* library = module();
    const bool worthParsing = library && text.size() <= kLongestText;
    auto made = std::make_shared<Number>(worthParsing ? library->parse(text, region) : std::nullopt);
    answers_.push_front({key, made});
    index_.emplace(std::move(key), answers_.begin());
    if (index_.size() > kKept) {
        index_.erase(answers_.back().key);
        answers_.pop_back();
    }
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
