#include "linux/contacts/VCardText.h"

#include <algorithm>
#include <array>

#include "platform/base/Utf8.h"

namespace ktr::linux_ {

namespace {

struct Line {
    std::string_view text;  ///< without its end
    std::size_t end = 0;    ///< where the next one begins
};

Line lineAt(std::string_view text, std::size_t begin) {
    const auto end = text.find_first_of("\r\n", begin);
    if (end == std::string_view::npos) {
        return {text.substr(begin), text.size()};
    }
    const bool both = text[end] == '\r' && end + 1 < text.size() && text[end + 1] == '\n';
    return {text.substr(begin, end - begin), end + (both ? 2 : 1)};
}

bool isBlank(char c) {
    return c == ' ' || c == '\t';
}

std::string_view trimmed(std::string_view text) {
    const auto begin = text.find_first_not_of(" \t");
    return begin == std::string_view::npos ? std::string_view()
                                           : text.substr(begin, text.find_last_not_of(" \t") - begin + 1);
}

/// Whether a line is this one, whatever the case. A folded line (which begins with a blank) never is.
bool isLine(std::string_view line, std::string_view wanted) {
    constexpr std::size_t kLongest = 64;
    return !line.empty() && !isBlank(line.front()) && line.size() <= kLongest &&
           platform::asciiLowercased(trimmed(line)) == wanted;
}

/// "item1.TEL;TYPE=CELL:..." gives "tel".
std::string nameOf(std::string_view property) {
    constexpr std::size_t kLongest = 256;
    const std::string_view head = property.substr(0, std::min(property.find_first_of(":;"), kLongest));
    const auto group = head.find('.');
    return platform::asciiLowercased(trimmed(group == std::string_view::npos ? head : head.substr(group + 1)));
}

bool isWanted(const std::string& name) {
    static constexpr auto kNames = std::to_array<std::string_view>(
        {"begin", "email", "end", "fn", "n", "nickname", "org", "photo", "tel", "title", "uid", "version", "x-ablabel",
         "x-maidenname", "x-phonetic-first-name", "x-phonetic-last-name", "x-phonetic-middle-name"});
    return std::find(kNames.begin(), kNames.end(), name) != kNames.end();
}

/// The end of the property that begins here: it goes on in lines that begin with a blank (RFC 6350, 3.2), and in
/// quoted-printable after a line that ends in "=".
std::size_t endOfProperty(std::string_view card, std::size_t begin) {
    Line line = lineAt(card, begin);
    const std::string_view head = line.text.substr(0, line.text.find(':'));
    const bool isQuoted = platform::asciiLowercased(head).find("quoted-printable") != std::string::npos;
    while (line.end < card.size() && (isBlank(card[line.end]) || (isQuoted && line.text.ends_with('=')))) {
        line = lineAt(card, line.end);
    }
    return line.end;
}

/// A NUL ends the text for whoever reads it as C does, in the middle of a property: their readers of quoted-printable
/// look two letters further.
bool isText(std::string_view property) {
    return property.find('\0') == std::string_view::npos;
}

bool isWithinCaps(std::string_view property, bool isPicture) {
    const auto parts = std::count_if(property.begin(), property.end(), [](char c) { return c == ';' || c == ','; });
    return static_cast<std::size_t>(parts) <= VCardText::kMostParts &&
           (isPicture || property.size() <= VCardText::kLongestProperty);
}

}  // namespace

VCardText VCardText::of(std::string_view text) {
    VCardText found;
    const auto problem = [&](std::size_t line, const char* message) {
        if (found.problems.size() < kMostProblems) {
            found.problems.push_back({line, message});
        }
    };
    constexpr std::string_view kByteOrderMark = "\xef\xbb\xbf";
    std::size_t number = 0;    // of the line under way
    std::size_t cardLine = 0;  // 0: outside a card
    std::size_t cardBegin = 0;
    bool strayTold = false;
    for (std::size_t at = text.starts_with(kByteOrderMark) ? kByteOrderMark.size() : 0; at < text.size();) {
        const Line line = lineAt(text, at);
        ++number;
        if (isLine(line.text, "begin:vcard")) {
            if (cardLine != 0) {
                problem(cardLine, "the card has no END:VCARD");
            }
            if (found.cards.size() == kMostCards) {
                problem(number, "there are more than 100000 cards");
                return found;
            }
            cardLine = number;
            cardBegin = at;
        } else if (cardLine == 0 && !trimmed(line.text).empty() && !strayTold) {
            strayTold = true;
            problem(number, "text outside a card");
        } else if (cardLine != 0 && isLine(line.text, "end:vcard")) {
            if (line.end - cardBegin > kLargestCard) {
                problem(cardLine, "the card is larger than 16 MiB");
            } else {
                found.cards.push_back({text.substr(cardBegin, line.end - cardBegin), cardLine});
            }
            cardLine = 0;
            strayTold = false;
        }
        at = line.end;
    }
    if (cardLine != 0) {
        problem(cardLine, "the card has no END:VCARD");
    }
    return found;
}

std::string VCardText::essential(std::string_view card) {
    std::string kept;
    std::size_t properties = 0;
    for (std::size_t at = 0; at < card.size();) {
        const std::size_t end = endOfProperty(card, at);
        const std::string_view property = card.substr(at, end - at);
        at = end;
        const std::string name = nameOf(property);
        const bool isFrame = name == "begin" || name == "end";
        if (isWanted(name) && isText(property) && isWithinCaps(property, name == "photo") &&
            (isFrame || ++properties <= kMostProperties)) {
            kept += property;
        }
    }
    return kept;
}

}  // namespace ktr::linux_
