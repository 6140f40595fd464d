#include "serve/ServedContacts.h"

namespace ktr::serve {

namespace {

/// A text value (RFC 2426, 5): what would end it is masked, other control characters become blanks.
std::string masked(const std::string& text) {
    std::string out;
    for (const char c : text) {
        if (c == '\n') {
            out += "\\n";
        } else if (static_cast<unsigned char>(c) < 0x20 || c == 0x7F) {
            out += ' ';
        } else {
            if (c == '\\' || c == ',' || c == ';') {
                out += '\\';
            }
            out += c;
        }
    }
    return out;
}

}  // namespace

std::string ServedContacts::vCards(const std::vector<ServedFriend>& friends) {
    std::string cards;
    const auto line = [&](const std::string& name, const std::string& value) { cards += name + ":" + value + "\r\n"; };
    for (const ServedFriend& person : friends) {
        if (person.fullName.empty() && person.firstName.empty() && person.lastName.empty()) {
            continue;
        }
        const std::string whole = person.fullName.empty() ? person.firstName + " " + person.lastName : person.fullName;
        line("BEGIN", "VCARD");
        line("VERSION", "3.0");
        line("FN", masked(whole));
        line("N", masked(person.lastName) + ";" + masked(person.firstName) + ";;;");
        for (const std::string& email : person.emails) {
            line("EMAIL;TYPE=INTERNET", masked(email));
        }
        for (const std::string& phone : person.phones) {
            line("TEL;TYPE=CELL", masked(phone));
        }
        line("END", "VCARD");
    }
    return cards;
}

}  // namespace ktr::serve
