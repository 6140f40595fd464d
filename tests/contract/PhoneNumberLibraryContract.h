#pragma once

#include <gtest/gtest.h>

#include <functional>
#include <memory>
#include <string>

#include "platform/contacts/PhoneNumberLibrary.h"

namespace ktr::test {

struct PhoneNumberLibraryCase {
    std::string name;
    std::function<std::shared_ptr<platform::PhoneNumberLibrary>()> make;
};

class PhoneNumberLibraryContract : public ::testing::TestWithParam<PhoneNumberLibraryCase> {
  protected:
    void SetUp() override { library = GetParam().make(); }
    std::optional<std::string> e164(const std::string& text, const std::string& country) {
        const auto number = library->parse(text, country);
        return number ? library->text(*number, platform::PhoneNumberLibrary::kFormatE164) : std::nullopt;
    }
    /// The display text with everything but digits and "+" taken out: how a number is grouped is the library's own.
    std::string displayedDigits(const std::string& text, const std::string& country) {
        const auto number = library->parse(text, country);
        std::string digits;
        const auto shown =
            number ? library->displayText(*number, platform::PhoneNumberLibrary::kDisplayStyle, country) : std::nullopt;
        for (const char c : shown.value_or("(none)")) {
            if ((c >= '0' && c <= '9') || c == '+') {
                digits += c;
            }
        }
        return digits;
    }
    std::shared_ptr<platform::PhoneNumberLibrary> library;
};

}  // namespace ktr::test
