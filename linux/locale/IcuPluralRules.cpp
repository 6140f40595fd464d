#include "linux/locale/IcuPluralRules.h"

#include <utility>

#include <unicode/locid.h>
#include <unicode/plurrule.h>
#include <unicode/unistr.h>

#include "linux/locale/IcuNumberFormatter.h"

namespace ktr::linux_ {

namespace {

constexpr const char* kOther = "other";

}  // namespace

struct IcuPluralRules::Rules {
    explicit Rules(const std::string& language) : numbers(language) {
        UErrorCode status = U_ZERO_ERROR;
        const auto locale = icu::Locale::forLanguageTag(language, status);
        forms.reset(icu::PluralRules::forLocale(locale, status));
        if (U_FAILURE(status)) {
            forms.reset();
        }
    }

    IcuNumberFormatter numbers;
    std::unique_ptr<icu::PluralRules> forms;  ///< none: every number is an "other"
};

IcuPluralRules::IcuPluralRules() = default;
IcuPluralRules::~IcuPluralRules() = default;

const IcuPluralRules::Rules& IcuPluralRules::rulesOf(const std::string& language) const {
    auto& rules = known_[language];
    if (!rules) {
        rules = std::make_unique<Rules>(language);
    }
    return *rules;
}

std::string IcuPluralRules::category(const std::string& number, const std::string& language) const {
    const std::lock_guard lock(mutex_);
    const Rules& rules = rulesOf(language);
    const auto value = rules.numbers.numberFromString(number);
    if (!value || !rules.forms) {
        return kOther;
    }
    std::string form;
    rules.forms->select(*value).toUTF8String(form);
    return form;
}

}  // namespace ktr::linux_
