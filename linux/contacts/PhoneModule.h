#pragma once

#include <memory>
#include <optional>
#include <string>

namespace ktr::linux_ {

/// A number that the phone-number library has understood. Texts in UTF-8.
struct PhoneNumberParts {
    std::string e164;           ///< such as "+441632960018"
    std::string national;       ///< as written inside the number's own country, such as "01632 960018"
    std::string international;  ///< such as "+44 1632 960018"
    std::string nationalPart;   ///< the national significant number: digits alone, without trunk prefix
    std::string callingCode;    ///< digits, such as "44"
    bool complete = false;      ///< written with its country code, not completed from the home country
};

/// What libktr-phone.so offers: the phone-number library behind an interface of our own, in a module that is loaded on
/// demand, since the library with all its metadata costs more than the rest of a process start. Nothing thrown leaves
/// it. Main thread.
class PhoneModule {
  public:
    virtual ~PhoneModule() = default;
    /// None for what is no number. The region is two letters in upper case; of an unknown one only complete numbers are
    /// understood.
    virtual std::optional<PhoneNumberParts> parse(const std::string& text, const std::string& region) const = 0;
    /// The digits of a region's calling code; empty for an unknown region.
    virtual std::string callingCode(const std::string& region) const = 0;
};

/// The module's only symbol, of type `PhoneModuleEntry`: makes the module's object; null when it cannot be made.
inline constexpr const char* kPhoneModuleEntry = "ktrMakePhoneModule";
using PhoneModuleEntry = PhoneModule* (*)();

}  // namespace ktr::linux_
