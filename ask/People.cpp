#include "ask/People.h"

#include <algorithm>
#include <cstdlib>
#include <optional>

#include <unicode/translit.h>
#include <unicode/uchar.h>

#include "ask/FoldedText.h"

namespace ktr::ask {

namespace {

/// A number that is shorter names nobody.
constexpr std::size_t kLeastDigits = 6;
/// Of the digits of two numbers so many at the end are compared: the country's code may be missing.
constexpr std::size_t kComparedDigits = 9;
/// Names that may have one slip, and that may have two.
constexpr std::size_t kOneSlip = 3;
constexpr std::size_t kTwoSlips = 6;

std::string digitsOf(const std::u32string& text) {
    std::string digits;
    for (const char32_t c : text) {
        const int value = u_charDigitValue(static_cast<UChar32>(c));
        if (value >= 0) {
            digits += static_cast<char>('0' + value);
        } else if (u_isalpha(static_cast<UChar32>(c)) || c == U'@') {
            return {};
        }
    }
    return digits;
}

std::string lastDigits(const std::string& digits) {
    return digits.size() > kComparedDigits ? digits.substr(digits.size() - kComparedDigits) : digits;
}

bool endsWith(const std::u32string& text, const std::u32string& end) {
    return text.size() > end.size() && text.compare(text.size() - end.size(), end.size(), end) == 0;
}

/// Slips between two words (a letter missing, added, wrong, or two swapped), counted up to `most` + 1.
std::size_t slips(const std::u32string& one, const std::u32string& other, std::size_t most) {
    const std::size_t apart = one.size() > other.size() ? one.size() - other.size() : other.size() - one.size();
    if (apart > most) {
        return most + 1;
    }
    std::vector<std::size_t> before(other.size() + 1);
    std::vector<std::size_t> above(other.size() + 1);
    std::vector<std::size_t> row(other.size() + 1);
    for (std::size_t j = 0; j <= other.size(); ++j) {
        above[j] = j;
    }
    for (std::size_t i = 1; i <= one.size(); ++i) {
        row[0] = i;
        std::size_t least = i;
        for (std::size_t j = 1; j <= other.size(); ++j) {
            row[j] = std::min({above[j] + 1, row[j - 1] + 1, above[j - 1] + (one[i - 1] == other[j - 1] ? 0U : 1U)});
            if (i > 1 && j > 1 && one[i - 1] == other[j - 2] && one[i - 2] == other[j - 1]) {
                row[j] = std::min(row[j], before[j - 2] + 1);
            }
            least = std::min(least, row[j]);
        }
        if (least > most) {
            return most + 1;
        }
        before.swap(above);
        above.swap(row);
    }
    return above[other.size()];
}

std::string lowerAscii(std::string text) {
    std::transform(text.begin(), text.end(), text.begin(), [](unsigned char c) {
        return c < 0x80 ? static_cast<char>(std::tolower(c)) : static_cast<char>(c);
    });
    return text;
}

bool isLatin(const std::u32string& text) {
    return std::all_of(text.begin(), text.end(), [](char32_t c) { return c < 0x250; });
}

}  // namespace

/// Names in Latin letters, made when the first name of another script is asked for.
struct People::Latin {
    explicit Latin(const People& people) {
        UErrorCode status = U_ZERO_ERROR;
        letters.reset(icu::Transliterator::createInstance("Any-Latin; Latin-ASCII; Lower", UTRANS_FORWARD, status));
        if (U_FAILURE(status)) {
            letters.reset();
        }
        for (const auto& [name, numbers] : people.byName_) {
            if (!isLatin(name)) {
                auto& known = names[of(name)];
                known.insert(known.end(), numbers.begin(), numbers.end());
            }
        }
    }
    std::u32string of(const std::u32string& name) const {
        auto text = icu::UnicodeString::fromUTF32(reinterpret_cast<const UChar32*>(name.data()),  // NOLINT
                                                  static_cast<std::int32_t>(name.size()));
        if (letters) {
            letters->transliterate(text);
        }
        std::string utf8;
        return FoldedText::of(text.toUTF8String(utf8));
    }

    std::unique_ptr<icu::Transliterator> letters;
    std::map<std::u32string, Numbers> names;
};

People::~People() = default;

People::People(std::vector<Person> people) {
    std::map<std::string, std::size_t> known;  // by name and handle
    for (Person& person : people) {
        std::optional<std::size_t> same;
        std::vector<std::string> keys;
        for (const auto* handles : {&person.emails, &person.phones}) {
            for (const std::string& handle : *handles) {
                keys.push_back(lowerAscii(handle) + "\n" + person.shownName());
                if (const auto found = known.find(keys.back()); found != known.end()) {
                    same = found->second;
                }
            }
        }
        if (!same) {
            same = people_.size();
            people_.push_back(std::move(person));
        } else {
            Person& kept = people_[*same];
            for (auto [from, to] : {std::pair(&person.emails, &kept.emails), std::pair(&person.phones, &kept.phones)}) {
                for (const std::string& handle : *from) {
                    if (std::find(to->begin(), to->end(), handle) == to->end()) {
                        to->push_back(handle);
                    }
                }
            }
        }
        for (const std::string& key : keys) {
            known.emplace(key, *same);
        }
    }
    for (std::size_t i = 0; i < people_.size(); ++i) {
        addNames(i);
    }
}

void People::add(const std::u32string& name, std::size_t person) {
    if (name.empty()) {
        return;
    }
    Numbers& numbers = byName_[name];
    if (std::find(numbers.begin(), numbers.end(), person) == numbers.end()) {
        numbers.push_back(person);
    }
}

void People::addNames(std::size_t number) {
    const Person& person = people_[number];
    const std::u32string first = FoldedText::of(person.firstName);
    const std::u32string last = FoldedText::of(person.lastName);
    const std::u32string nickname = FoldedText::of(person.nickname);
    for (const std::u32string& name : {FoldedText::of(person.fullName), first, last, nickname}) {
        add(name, number);
    }
    for (const auto& [one, other] : {std::pair(first, last), std::pair(last, first), std::pair(nickname, last)}) {
        if (!one.empty() && !other.empty()) {
            const bool joined = FoldedText::isWithoutBlanks(one.back()) || FoldedText::isWithoutBlanks(other.front());
            add(std::u32string(one).append(joined ? U"" : U" ").append(other), number);
        }
    }
    for (const std::string& email : person.emails) {
        add(FoldedText::of(email), number);
    }
    for (const std::string& phone : person.phones) {
        const std::string digits = digitsOf(FoldedText::of(phone));
        if (digits.size() >= kLeastDigits) {
            const auto [at, isNew] = byDigits_.emplace(lastDigits(digits), number);
            // A number of two people names neither of them.
            at->second = isNew || at->second == number ? number : people_.size();
        }
    }
}

People::Numbers People::inItsOwnForm(const std::u32string& name) const {
    const auto found = byName_.find(name);
    return found == byName_.end() ? Numbers() : found->second;
}

People::Numbers People::byNumber(const std::u32string& name) const {
    const std::string digits = digitsOf(name);
    const auto found = digits.size() < kLeastDigits ? byDigits_.end() : byDigits_.find(lastDigits(digits));
    return found == byDigits_.end() || found->second == people_.size() ? Numbers() : Numbers{found->second};
}

People::Numbers People::relatives(const std::u32string& name, const Language& language) const {
    Numbers numbers;
    for (const auto& words : language.relations()) {
        if (std::find(words.begin(), words.end(), name) == words.end()) {
            continue;
        }
        for (const std::u32string& word : words) {
            for (const std::size_t number : inItsOwnForm(word)) {
                if (std::find(numbers.begin(), numbers.end(), number) == numbers.end()) {
                    numbers.push_back(number);
                }
            }
        }
    }
    return numbers;
}

People::Numbers People::transliterated(const std::u32string& name) const {
    std::call_once(latinOnce_, [this] { latin_ = std::make_unique<Latin>(*this); });
    const std::u32string latin = isLatin(name) ? name : latin_->of(name);
    if (!isLatin(name)) {
        return inItsOwnForm(latin);
    }
    const auto found = latin_->names.find(latin);
    Numbers numbers = found == latin_->names.end() ? Numbers() : found->second;
    std::sort(numbers.begin(), numbers.end());
    numbers.erase(std::unique(numbers.begin(), numbers.end()), numbers.end());
    return numbers;
}

People::Numbers People::called(const std::u32string& name, const Language& language) const {
    if (Numbers numbers = inItsOwnForm(name); !numbers.empty()) {
        return numbers;
    }
    if (Numbers numbers = byNumber(name); !numbers.empty()) {
        return numbers;
    }
    if (Numbers numbers = relatives(name, language); !numbers.empty()) {
        return numbers;
    }
    // Forms of a name that several names share fit all of them.
    Numbers declined;
    for (const auto& [ending, own] : language.endings()) {
        if (endsWith(name, ending)) {
            const std::u32string bare = name.substr(0, name.size() - ending.size()) + own;
            Numbers some = inItsOwnForm(bare);
            some = some.empty() ? relatives(bare, language) : some;
            declined.insert(declined.end(), some.begin(), some.end());
        }
    }
    std::sort(declined.begin(), declined.end());
    declined.erase(std::unique(declined.begin(), declined.end()), declined.end());
    return declined.empty() ? transliterated(name) : declined;
}

People::Numbers People::near(const std::u32string& name) const {
    const std::size_t most = name.size() >= kTwoSlips ? 2 : name.size() >= kOneSlip ? 1 : 0;
    std::vector<std::pair<std::size_t, std::size_t>> found;  // slips, person
    for (const auto& [known, numbers] : byName_) {
        if (most == 0 || known.find(U'@') != std::u32string::npos) {
            continue;
        }
        // "Anne Marsch": the first word alone may be what was meant.
        std::size_t count = slips(name, known, most);
        const std::size_t blank = name.find(U' ');
        if (count > most && blank != std::u32string::npos && blank >= kOneSlip) {
            count = 1 + slips(name.substr(0, blank), known, 1);
        }
        if (count <= most) {
            for (const std::size_t number : numbers) {
                found.emplace_back(count, number);
            }
        }
    }
    std::sort(found.begin(), found.end());
    Numbers numbers;
    for (const auto& [count, number] : found) {
        if (numbers.size() < kMostNear && std::find(numbers.begin(), numbers.end(), number) == numbers.end()) {
            numbers.push_back(number);
        }
    }
    return numbers;
}

bool People::findSome(const std::u32string& text, std::size_t begin, std::size_t end, const Language& language,
                      std::size_t left, std::vector<std::pair<std::size_t, std::size_t>>& pieces) const {
    if (!called(text.substr(begin, end - begin), language).empty()) {
        pieces.emplace_back(begin, end);
        return true;
    }
    if (left == 0) {
        return false;
    }
    // The first piece has to be a name; the rest follows from there.
    for (std::size_t at = begin + 1; at < end; ++at) {
        for (const std::u32string& word : language.conjunctions()) {
            const bool stands = at + word.size() < end && text.compare(at, word.size(), word) == 0;
            if (!stands || called(text.substr(begin, at - begin), language).empty()) {
                continue;
            }
            const std::size_t known = pieces.size();
            pieces.emplace_back(begin, at);
            if (findSome(text, at + word.size(), end, language, left - 1, pieces)) {
                return true;
            }
            pieces.resize(known);
        }
    }
    return false;
}

People::Unknown People::unknownIn(const FoldedText& folded, std::size_t begin, const Language& language) const {
    const std::u32string& text = folded.letters();
    // Of "Ann and Xyz" it is Xyz alone whom nobody knows, of "Xyz and Ann" as well.
    std::size_t end = text.size();
    for (bool again = true; again;) {
        again = false;
        for (std::size_t at = begin + 1; at < end && !again; ++at) {
            for (const std::u32string& word : language.conjunctions()) {
                std::vector<std::pair<std::size_t, std::size_t>> pieces;
                if (at + word.size() >= end || text.compare(at, word.size(), word) != 0) {
                    continue;
                }
                if (!called(text.substr(begin, at - begin), language).empty()) {
                    begin = at + word.size();
                    again = true;
                    break;
                }
                if (findSome(text, at + word.size(), end, language, kMostNamed, pieces)) {
                    end = at;
                    break;
                }
            }
        }
    }
    return {folded.original(begin, end), near(text.substr(begin, end - begin))};
}

People::Result People::find(const std::string& text, const Language& language, const std::string& chosen) const {
    // Commas part names in every language; folding makes blanks of them.
    std::vector<std::string> parts{""};
    for (std::size_t at = 0; at < text.size();) {
        std::size_t length = 0;
        for (const char* comma : {",", ";", "،", "、", "，"}) {
            length = text.compare(at, std::string(comma).size(), comma) == 0 ? std::string(comma).size() : length;
        }
        if (length > 0) {
            parts.emplace_back();
        } else {
            parts.back() += text[at];
        }
        at += std::max<std::size_t>(length, 1);
    }
    Found everybody;
    for (const std::string& part : parts) {
        FoldedText folded(part);
        std::size_t begin = 0;
        // "Ann, Otto, and Zofia": an "and" may stand behind a comma.
        for (const std::u32string& word : language.conjunctions()) {
            const std::u32string start = word.front() == U' ' ? word.substr(1) : word;
            if (parts.size() > 1 && begin == 0 && folded.letters().compare(0, start.size(), start) == 0 &&
                inItsOwnForm(folded.letters()).empty()) {
                begin = start.size();
            }
        }
        std::vector<std::pair<std::size_t, std::size_t>> pieces;
        if (folded.empty() && parts.size() > 1) {
            continue;
        }
        if (!findSome(folded.letters(), begin, folded.letters().size(), language, kMostNamed, pieces)) {
            return unknownIn(folded, begin, language);
        }
        for (const auto& [first, last] : pieces) {
            Numbers numbers = called(folded.letters().substr(first, last - first), language);
            const auto isChosen = [&](std::size_t number) {
                const Person& person = people_[number];
                return !chosen.empty() && lowerAscii(person.handle()) == lowerAscii(chosen);
            };
            if (const auto one = std::find_if(numbers.begin(), numbers.end(), isChosen); one != numbers.end()) {
                numbers = {*one};
            }
            if (numbers.size() > 1) {
                return Ambiguous{folded.original(first, last), numbers};
            }
            if (std::find(everybody.begin(), everybody.end(), numbers.front()) == everybody.end()) {
                everybody.push_back(numbers.front());
            }
        }
    }
    if (everybody.empty()) {
        return Unknown{text, {}};
    }
    return everybody;
}

}  // namespace ktr::ask
