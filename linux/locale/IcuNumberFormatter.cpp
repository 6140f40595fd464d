#include "linux/locale/IcuNumberFormatter.h"

#include <array>
#include <cmath>

#include <unicode/decimfmt.h>
#include <unicode/numberformatter.h>
#include <unicode/numfmt.h>
#include <unicode/parsepos.h>
#include <unicode/unistr.h>

namespace ktr::linux_ {

struct IcuNumberFormatter::Formats {
    std::unique_ptr<icu::NumberFormat> decimal;  ///< none when ICU has no data at all
    icu::number::LocalizedNumberFormatter plain;
    /// The locale's digits; empty where a number is not written digit by digit.
    std::array<std::string, 10> digits;
};

namespace {

std::string written(const icu::number::LocalizedNumberFormatter& format, std::int64_t number) {
    UErrorCode status = U_ZERO_ERROR;
    std::string out;
    format.formatInt(number, status).toString(status).toUTF8String(out);
    return U_SUCCESS(status) ? out : std::to_string(number);
}

/// A number that is not negative, digit by digit.
std::string joined(const std::array<std::string, 10>& digits, std::int64_t number) {
    std::string out;
    for (const char digit : std::to_string(number)) {
        out += digits[static_cast<std::size_t>(digit - '0')];
    }
    return out;
}

/// Some numerals are no digits in places (Roman ones): a number with all ten in it tells.
std::array<std::string, 10> digitsOf(const icu::number::LocalizedNumberFormatter& format) {
    std::array<std::string, 10> digits;
    for (std::size_t digit = 0; digit < digits.size(); ++digit) {
        digits[digit] = written(format, static_cast<std::int64_t>(digit));
    }
    constexpr std::int64_t kAllDigits = 10'234'567'898;
    return joined(digits, kAllDigits) == written(format, kAllDigits) ? digits : std::array<std::string, 10>();
}

}  // namespace

IcuNumberFormatter::IcuNumberFormatter(const std::string& localeIdentifier) : formats_(std::make_unique<Formats>()) {
    UErrorCode status = U_ZERO_ERROR;
    auto locale = icu::Locale::forLanguageTag(localeIdentifier, status);
    if (U_FAILURE(status) || locale.isBogus()) {
        locale = icu::Locale::getEnglish();
    }
    status = U_ZERO_ERROR;
    formats_->decimal.reset(icu::NumberFormat::createInstance(locale, UNUM_DECIMAL, status));
    if (U_FAILURE(status)) {
        formats_->decimal = nullptr;
    } else {
        formats_->decimal->setLenient(false);
    }
    formats_->plain = icu::number::NumberFormatter::withLocale(locale)
                          .grouping(UNUM_GROUPING_OFF)
                          .precision(icu::number::Precision::integer());
    formats_->digits = digitsOf(formats_->plain);
}

IcuNumberFormatter::~IcuNumberFormatter() = default;

std::optional<double> IcuNumberFormatter::numberFromString(const std::string& text) const {
    if (text.empty() || !formats_->decimal) {
        return std::nullopt;
    }
    const auto wide = icu::UnicodeString::fromUTF8(text);
    icu::ParsePosition position(0);
    icu::Formattable result;
    formats_->decimal->parse(wide, result, position);
    if (position.getErrorIndex() >= 0 || position.getIndex() != wide.length()) {
        return std::nullopt;
    }
    UErrorCode status = U_ZERO_ERROR;
    const double number = result.getDouble(status);
    if (U_FAILURE(status) || !std::isfinite(number)) {
        return std::nullopt;
    }
    return number;
}

std::string IcuNumberFormatter::plainStringFromInteger(std::int64_t number) const {
    return number < 0 || formats_->digits[0].empty() ? written(formats_->plain, number)
                                                     : joined(formats_->digits, number);
}

}  // namespace ktr::linux_
