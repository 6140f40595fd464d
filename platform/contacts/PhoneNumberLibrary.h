#pragma once

#include <memory>
#include <optional>
#include <string>

#include "platform/base/Object.h"

namespace ktr::platform {

/// A phone number that has been understood.
class KTR_API ParsedPhoneNumber : public Object {
  public:
    ~ParsedPhoneNumber() override;
};

/// Parses and prints phone numbers. Country codes are two letters, in either case (ISO 3166-1). Main thread.
class KTR_API PhoneNumberLibrary {
  public:
    /// Style 1, display: the national form for a number of the home country, else the international form.
    static constexpr int kDisplayStyle = 1;
    /// Format 2 is E.164, such as "+15555550100".
    static constexpr int kFormatE164 = 2;

    virtual ~PhoneNumberLibrary();
    /// None for what is no number.
    virtual std::shared_ptr<ParsedPhoneNumber> parse(const std::string& text, const std::string& countryCode) const = 0;
    /// None when the number cannot be printed so.
    virtual std::optional<std::string> displayText(const ParsedPhoneNumber& number, int style,
                                                   const std::string& homeCountryCode) const = 0;
    virtual std::optional<std::string> text(const ParsedPhoneNumber& number, int format) const = 0;
};

/// The telephony service. Main thread; answers from memory.
class KTR_API Telephony {
  public:
    virtual ~Telephony();
    /// Two letters; none without a SIM card or a setting.
    virtual std::optional<std::string> homeCountryCode() const = 0;
};

}  // namespace ktr::platform
