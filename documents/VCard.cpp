#include "documents/VCard.h"

namespace ktr::documents {

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

std::string VCard::text() const {
    std::string card;
    const auto line = [&](const std::string& name, const std::string& value) { card += name + ":" + value + "\r\n"; };
    line("BEGIN", "VCARD");
    line("VERSION", "3.0");
    line("FN", masked(whole));
    line("N", masked(last) + ";" + masked(first) + ";;;");
    for (const std::string& email : emails) {
        line("EMAIL;TYPE=INTERNET", masked(email));
    }
    for (const std::string& phone : phones) {
        line("TEL;TYPE=CELL", masked(phone));
    }
    line("END", "VCARD");
    return card;
}

}  // namespace ktr::documents
