#include <libebook-contacts/libebook-contacts.h>

#include <exception>
#include <memory>
#include <string>
#include <string_view>
#include <unordered_map>
#include <vector>

#include "linux/contacts/VCardModule.h"
#include "platform/base/Utf8.h"

namespace ktr::linux_ {

namespace {

struct Unref {
    void operator()(EVCard* card) const { g_object_unref(card); }
};

/// The parser warns of bad lines on standard error; the reader says what was passed over in its own words.
void ignoreWarnings() {
    static const guint handler = g_log_set_handler(
        "libebook-contacts", static_cast<GLogLevelFlags>(G_LOG_LEVEL_WARNING | G_LOG_LEVEL_MESSAGE),
        [](const gchar*, GLogLevelFlags, const gchar*, gpointer) {}, nullptr);
    static_cast<void>(handler);
}

std::string trimmed(const std::string& text) {
    const auto begin = text.find_first_not_of(" \t\r\n");
    return begin == std::string::npos ? std::string()
                                      : text.substr(begin, text.find_last_not_of(" \t\r\n") - begin + 1);
}

std::string lowerName(EVCardAttribute* attribute) {
    const char* name = e_vcard_attribute_get_name(attribute);
    return platform::asciiLowercased(name ? name : "");
}

/// The value's components, decoded; a property such as N has several.
std::vector<std::string> valuesOf(EVCardAttribute* attribute) {
    std::vector<std::string> out;
    for (GList* node = e_vcard_attribute_get_values_decoded(attribute); node; node = node->next) {
        const auto* value = static_cast<const GString*>(node->data);
        out.emplace_back(value && value->str ? std::string(value->str, value->len) : std::string());
    }
    return out;
}

/// As text: what was encoded may have held any bytes.
std::string component(const std::vector<std::string>& values, std::size_t index) {
    if (index >= values.size()) {
        return {};
    }
    std::string text = platform::sanitizedUtf8(values[index]);
    std::erase(text, '\0');
    return trimmed(text);
}

std::string withoutScheme(const std::string& value, std::string_view scheme) {
    if (platform::asciiLowercased(value.substr(0, scheme.size())) != scheme) {
        return value;
    }
    return value.substr(scheme.size(), value.find_first_of(";?", scheme.size()) - scheme.size());
}

std::string groupOf(EVCardAttribute* attribute) {
    const char* group = e_vcard_attribute_get_group(attribute);
    return platform::asciiLowercased(group ? group : "");
}

/// The owner's own words for grouped properties ("item1.X-ABLABEL"), by group.
using Labels = std::unordered_map<std::string, std::string>;

Labels labelsOf(EVCard* card) {
    Labels labels;
    for (GList* node = e_vcard_get_attributes(card); node; node = node->next) {
        auto* attribute = static_cast<EVCardAttribute*>(node->data);
        if (lowerName(attribute) == "x-ablabel") {
            labels.emplace(groupOf(attribute), component(valuesOf(attribute), 0));
        }
    }
    labels.erase("");
    return labels;
}

/// The owner's own word for a property, else the built-in label of its type, else nothing.
std::string labelOf(const Labels& labels, EVCardAttribute* attribute) {
    if (const auto own = labels.find(groupOf(attribute)); own != labels.end()) {
        return own->second;
    }
    if (e_vcard_attribute_has_type(attribute, "HOME")) {
        return "_$!<home>!$_";
    }
    if (e_vcard_attribute_has_type(attribute, "WORK")) {
        return "_$!<work>!$_";
    }
    return e_vcard_attribute_has_type(attribute, "CELL") ? "_$!<mobile>!$_" : "";
}

platform::Bytes fromBase64(const std::string& text) {
    gsize length = 0;
    guchar* data = g_base64_decode(text.c_str(), &length);
    platform::Bytes out(data, data + length);
    g_free(data);
    return out;
}

/// The picture's bytes: base64 as in vCard 3.0, or a data: URI (RFC 2397) as in 4.0. A picture that is elsewhere is not
/// fetched.
std::optional<platform::Bytes> pictureOf(EVCardAttribute* attribute) {
    const auto values = valuesOf(attribute);
    if (values.empty()) {
        return std::nullopt;
    }
    // The parser takes the ";" of a URI for the end of a component.
    std::string whole = values.front();
    for (std::size_t i = 1; i < values.size(); ++i) {
        whole += ";" + values[i];
    }
    if (platform::asciiLowercased(whole.substr(0, 5)) == "data:") {
        const auto comma = whole.find(',');
        if (comma == std::string::npos ||
            platform::asciiLowercased(whole.substr(0, comma)).find(";base64") == std::string::npos) {
            return std::nullopt;
        }
        platform::Bytes bytes = fromBase64(whole.substr(comma + 1));
        return bytes.empty() ? std::nullopt : std::optional(std::move(bytes));
    }
    GList* encoding = e_vcard_attribute_get_param(attribute, "ENCODING");
    const bool encoded = encoding && encoding->data;
    if (!encoded || whole.empty()) {
        return std::nullopt;
    }
    return platform::Bytes(whole.begin(), whole.end());
}

void readName(const std::vector<std::string>& values, platform::Contact& contact) {
    contact.familyName = component(values, 0);
    contact.givenName = component(values, 1);
    contact.middleName = component(values, 2);
    contact.namePrefix = component(values, 3);
    contact.nameSuffix = component(values, 4);
}

void readProperty(const Labels& labels, EVCardAttribute* attribute, platform::Contact& contact) {
    const std::string name = lowerName(attribute);
    const auto setOnce = [&](std::string& field, std::size_t index) {
        if (field.empty()) {
            field = component(valuesOf(attribute), index);
        }
    };
    if (name == "n") {
        readName(valuesOf(attribute), contact);
    } else if (name == "fn") {
        setOnce(contact.storedFullName, 0);
    } else if (name == "nickname") {
        setOnce(contact.nickname, 0);
    } else if (name == "uid") {
        setOnce(contact.identifier, 0);
    } else if (name == "org") {
        setOnce(contact.organizationName, 0);
        setOnce(contact.departmentName, 1);
    } else if (name == "title") {
        setOnce(contact.jobTitle, 0);
    } else if (name == "x-maidenname") {
        setOnce(contact.previousFamilyName, 0);
    } else if (name == "x-phonetic-first-name") {
        setOnce(contact.phoneticGivenName, 0);
    } else if (name == "x-phonetic-middle-name") {
        setOnce(contact.phoneticMiddleName, 0);
    } else if (name == "x-phonetic-last-name") {
        setOnce(contact.phoneticFamilyName, 0);
    } else if (name == "email" || name == "tel") {
        const bool email = name == "email";
        const std::string value = trimmed(withoutScheme(component(valuesOf(attribute), 0), email ? "mailto:" : "tel:"));
        if (!value.empty()) {
            (email ? contact.emailAddresses : contact.phoneNumbers).push_back({labelOf(labels, attribute), value});
        }
    } else if (name == "photo" && !contact.imageData) {
        contact.imageData = pictureOf(attribute);
        contact.imageDataAvailable = contact.imageData.has_value();
    }
}

/// A card that says nothing by which anybody could be found or named is no contact.
bool saysSomething(const platform::Contact& contact) {
    return !contact.storedFullName.empty() || !contact.givenName.empty() || !contact.familyName.empty() ||
           !contact.nickname.empty() || !contact.organizationName.empty() || !contact.emailAddresses.empty() ||
           !contact.phoneNumbers.empty();
}

bool readCard(const std::string& text, platform::Contact& contact) {
    ignoreWarnings();
    const std::unique_ptr<EVCard, Unref> card(e_vcard_new_from_string(text.c_str()));
    if (!card) {
        return false;
    }
    const Labels labels = labelsOf(card.get());
    for (GList* node = e_vcard_get_attributes(card.get()); node; node = node->next) {
        readProperty(labels, static_cast<EVCardAttribute*>(node->data), contact);
    }
    return saysSomething(contact);
}

}  // namespace

}  // namespace ktr::linux_

extern "C" __attribute__((visibility("default"))) bool ktrReadVCard(const std::string& card,
                                                                    ktr::platform::Contact& contact) {
    try {
        return ktr::linux_::readCard(card, contact);
    } catch (const std::exception&) {
        return false;
    }
}
