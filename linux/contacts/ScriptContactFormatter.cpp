#include "linux/contacts/ScriptContactFormatter.h"

#include <initializer_list>

#include <unicode/uchar.h>
#include <unicode/uscript.h>

#include "platform/base/Utf8.h"

namespace ktr::linux_ {

namespace {

/// Whether the text has letters, all of them of a script whose names begin with the family.
bool isFamilyFirst(const std::string& text) {
    bool any = false;
    for (std::size_t at = 0; at < text.size();) {
        const auto step = platform::decodeUtf8(text, at);
        at += step.length;
        UErrorCode status = U_ZERO_ERROR;
        switch (uscript_getScript(static_cast<UChar32>(step.codePoint), &status)) {
            case USCRIPT_HAN:
            case USCRIPT_HIRAGANA:
            case USCRIPT_KATAKANA:
            case USCRIPT_HANGUL:
            case USCRIPT_BOPOMOFO:
                any = true;
                break;
            case USCRIPT_COMMON:
            case USCRIPT_INHERITED:
                break;
            default:
                return false;
        }
    }
    return any;
}

std::string joined(std::initializer_list<const std::string*> parts, const char* between) {
    std::string out;
    for (const std::string* part : parts) {
        if (!part->empty()) {
            out += out.empty() ? "" : between;
            out += *part;
        }
    }
    return out;
}

}  // namespace

std::optional<std::string> ScriptContactFormatter::stringFromContact(const platform::Contact& contact,
                                                                     platform::ContactFormatterStyle) const {
    std::string name = contact.storedFullName;
    if (name.empty()) {
        name = isFamilyFirst(contact.familyName + contact.middleName + contact.givenName)
                   ? joined({&contact.familyName, &contact.middleName, &contact.givenName}, "")
                   : joined({&contact.namePrefix, &contact.givenName, &contact.middleName, &contact.familyName,
                             &contact.nameSuffix},
                            " ");
    }
    if (name.empty()) {
        name = contact.nickname.empty() ? contact.organizationName : contact.nickname;
    }
    return name.empty() ? std::nullopt : std::optional(name);
}

std::string ScriptContactFormatter::descriptorForRequiredKeys(platform::ContactFormatterStyle) const {
    return "contactFormatter.fullName";
}

}  // namespace ktr::linux_
