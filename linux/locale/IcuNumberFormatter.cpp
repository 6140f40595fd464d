#include "linux/locale/IcuNumberFormatter.h"

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
};

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
    UErrorCode status = U_ZERO_ERROR;
    std::string out;
    formats_->plain.formatInt(number, status).toString(status).toUTF8String(out);
    return U_SUCCESS(status) ? out : std::to_string(number);
}

}  // namespace ktr::linux_
