#pragma once

#include <optional>
#include <string>

#include "platform/contacts/ContactStore.h"

namespace ktr::linux_ {

/// Full names: the one that the store holds, else made of the parts, family name first and without blanks for names in
/// Han, kana or hangul; else the nickname; else the organization. Main thread.
class ScriptContactFormatter : public platform::ContactFormatter {
  public:
    std::optional<std::string> stringFromContact(const platform::Contact& contact,
                                                 platform::ContactFormatterStyle style) const override;
    std::string descriptorForRequiredKeys(platform::ContactFormatterStyle style) const override;
};

}  // namespace ktr::linux_
