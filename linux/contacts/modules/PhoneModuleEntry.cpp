#include <exception>
#include <memory>

#include <phonenumbers/logger.h>
#include <phonenumbers/phonenumberutil.h>

#include "linux/contacts/PhoneModule.h"

namespace ktr::linux_ {

namespace {

using i18n::phonenumbers::PhoneNumber;
using i18n::phonenumbers::PhoneNumberUtil;

class LibPhoneModule : public PhoneModule {
  public:
    LibPhoneModule() : util_(PhoneNumberUtil::GetInstance()) {
        // The library's own logger writes to standard output, which is ours.
        util_->SetLogger(new i18n::phonenumbers::NullLogger);
    }

    std::optional<PhoneNumberParts> parse(const std::string& text, const std::string& region) const override {
        try {
            PhoneNumber number;
            const auto known = util_->GetCountryCodeForRegion(region) != 0;
            if (util_->ParseAndKeepRawInput(text, known ? region : "ZZ", &number) !=
                PhoneNumberUtil::NO_PARSING_ERROR) {
                return std::nullopt;
            }
            PhoneNumberParts parts;
            util_->Format(number, PhoneNumberUtil::E164, &parts.e164);
            util_->Format(number, PhoneNumberUtil::NATIONAL, &parts.national);
            util_->Format(number, PhoneNumberUtil::INTERNATIONAL, &parts.international);
            util_->GetNationalSignificantNumber(number, &parts.nationalPart);
            parts.callingCode = std::to_string(number.country_code());
            parts.complete = number.country_code_source() != PhoneNumber::FROM_DEFAULT_COUNTRY;
            return parts;
        } catch (const std::exception&) {
            return std::nullopt;
        }
    }

    std::string callingCode(const std::string& region) const override {
        try {
            const int code = util_->GetCountryCodeForRegion(region);
            return code == 0 ? std::string() : std::to_string(code);
        } catch (const std::exception&) {
            return {};
        }
    }

  private:
    PhoneNumberUtil* util_;
};

}  // namespace

}  // namespace ktr::linux_

extern "C" __attribute__((visibility("default"))) ktr::linux_::PhoneModule* ktrMakePhoneModule() {
    try {
        return new ktr::linux_::LibPhoneModule;
    } catch (const std::exception&) {
        return nullptr;
    }
}
