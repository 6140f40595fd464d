#pragma once

#include <list>
#include <memory>
#include <optional>
#include <string>
#include <unordered_map>

#include "linux/contacts/PhoneModule.h"
#include "platform/contacts/PhoneNumberLibrary.h"

namespace ktr::linux_ {

/// Phone numbers by libphonenumber, loaded when the first number is asked for. Numbers that are possible but not in use
/// (such as those set aside for fiction) count as numbers. Answers are kept, the least recently asked given up first:
/// every refresh of a row asks again. Without the module no text is a number, and one error line says so. Main thread.
class PhonenumberLibrary : public platform::PhoneNumberLibrary {
  public:
    /// Answers that are kept.
    static constexpr std::size_t kKept = 1024;

    PhonenumberLibrary();
    ~PhonenumberLibrary() override;

    std::shared_ptr<platform::ParsedPhoneNumber> parse(const std::string& text,
                                                       const std::string& countryCode) const override;
    std::optional<std::string> displayText(const platform::ParsedPhoneNumber& number, int style,
                                           const std::string& homeCountryCode) const override;
    std::optional<std::string> text(const platform::ParsedPhoneNumber& number, int format) const override;

    /// The parts of a number, for comparing numbers; none for what is no number.
    std::optional<PhoneNumberParts> parts(const std::string& text, const std::string& countryCode) const;
    /// How many answers are kept now.
    std::size_t kept() const { return index_.size(); }

  private:
    class Number;
    struct Answer {
        std::string key;
        std::shared_ptr<Number> number;
    };

    std::shared_ptr<Number> number(const std::string& text, const std::string& countryCode) const;
    const PhoneModule* module() const;

    mutable bool moduleTried_ = false;
    mutable std::unique_ptr<PhoneModule> module_;
    /// The most recently asked first.
    mutable std::list<Answer> answers_;
    mutable std::unordered_map<std::string, std::list<Answer>::iterator> index_;
};

}  // namespace ktr::linux_
