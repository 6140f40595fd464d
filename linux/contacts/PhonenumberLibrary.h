#pragma once

#include <memory>
#include <optional>
#include <random>
#include <string>
#include <unordered_map>
#include <vector>

#include "linux/contacts/PhoneModule.h"
#include "platform/contacts/PhoneNumberLibrary.h"

namespace ktr::linux_ {

/// Phone numbers by libphonenumber, loaded when the first number is asked for. Numbers that are possible but not in use
/// (such as those set aside for fiction) count as numbers, and so do those with an extension in words that the library
/// does not know. Answers are kept, since every refresh of a row asks again; of more than kKept, one that was not asked
/// for lately makes room, and which of them is left to chance: a list that is a little too long for it then loses a
/// little, where giving up the oldest would lose it all. Without the module no text is a number, and one error line
/// says so. Main thread.
class PhonenumberLibrary : public platform::PhoneNumberLibrary {
  public:
    /// Answers that are kept, unless it is made for fewer.
    static constexpr std::size_t kKept = 32768;

    explicit PhonenumberLibrary(std::size_t most = kKept);
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
    /// How many texts have been read: what was not answered from what is kept.
    std::size_t read() const { return read_; }

  private:
    class Number;
    struct Answer {
        const std::string* key = nullptr;  ///< the index's own
        std::shared_ptr<Number> number;
        bool wasAsked = false;  ///< again, since chance last passed it by
    };

    std::shared_ptr<Number> number(const std::string& text, const std::string& countryCode) const;
    const PhoneModule* module() const;
    std::optional<PhoneNumberParts> understood(const std::string& text, const std::string& region) const;
    /// Where a new answer stands.
    std::size_t place() const;

    std::size_t most_;
    mutable bool moduleTried_ = false;
    mutable std::unique_ptr<PhoneModule> module_;
    mutable std::vector<Answer> answers_;
    mutable std::unordered_map<std::string, std::size_t> index_;
    mutable std::minstd_rand chance_;
    mutable std::size_t read_ = 0;
};

}  // namespace ktr::linux_
