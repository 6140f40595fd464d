#include "ask/FoldedText.h"

#include <array>
#include <string>
#include <utility>

#include <unicode/normalizer2.h>
#include <unicode/uchar.h>
#include <unicode/unistr.h>
#include <unicode/uscript.h>

namespace ktr::ask {

namespace {

struct Form {
    char32_t from;
    const char32_t* to;
};

/// What no decomposition takes apart, and what is typed in several ways.
constexpr std::array<Form, 17> kForms{{{U'ł', U"l"},
                                       {U'ø', U"o"},
                                       {U'đ', U"d"},
                                       {U'ð', U"d"},
                                       {U'þ', U"th"},
                                       {U'æ', U"ae"},
                                       {U'œ', U"oe"},
                                       {U'ı', U"i"},
                                       {U'ى', U"ي"},
                                       {U'ی', U"ي"},
                                       {U'ک', U"ك"},
                                       {U'ة', U"ه"},
                                       {U'ٱ', U"ا"},
                                       {U'ʼ', U"'"},
                                       {U'’', U"'"},
                                       {U'‘', U"'"},
                                       {U'´', U"'"}}};

/// Marks that change no word: accents, Arabic and Hebrew vowels. Those of other scripts are letters of their own.
bool isPassedOver(char32_t c) {
    return (c >= 0x300 && c <= 0x36F) || (c >= 0x64B && c <= 0x65F) || c == 0x670 || c == 0x640 ||
           (c >= 0x591 && c <= 0x5C7 && u_charType(static_cast<UChar32>(c)) == U_NON_SPACING_MARK) ||
           u_charType(static_cast<UChar32>(c)) == U_FORMAT_CHAR;
}

bool isPartOfWord(char32_t c) {
    const auto code = static_cast<UChar32>(c);
    const int type = u_charType(code);
    // The mark in the place of what cannot be read stays: it makes no name of another.
    return u_isalnum(code) || type == U_NON_SPACING_MARK || type == U_COMBINING_SPACING_MARK || c == U'\'' ||
           c == U'@' || c == U'+' || c == U'_' || c == 0xFFFD;
}

/// A sign that belongs to a word between two letters or digits: in addresses, numbers, double names, times of day.
bool joins(char32_t c) {
    return c == U'.' || c == U'-' || c == U':';
}

bool isHebrew(char32_t c) {
    return c >= 0x590 && c <= 0x5FF;
}

/// The hyphen with which Hebrew joins a preposition to a name in other letters says nothing.
bool isPrepositionsHyphen(char32_t c, char32_t before, char32_t after) {
    return (c == U'-' || c == 0x5BE) && isHebrew(before) && !isHebrew(after);
}

/// The joiner inside Persian words stands where others write a blank.
bool isBlankInside(char32_t c, char32_t before) {
    return c == 0x200C && before >= 0x600 && before <= 0x6FF;
}

std::u32string decomposed(char32_t c, const icu::Normalizer2& compatibility) {
    UErrorCode status = U_ZERO_ERROR;
    const icu::UnicodeString folded = compatibility.normalize(icu::UnicodeString(static_cast<UChar32>(c)), status);
    std::u32string letters;
    for (int i = 0; U_SUCCESS(status) && i < folded.length(); i = folded.moveIndex32(i, 1)) {
        letters.push_back(static_cast<char32_t>(folded.char32At(i)));
    }
    return letters;
}

/// Accents of one script's letters taken off: "é" to "e", "й" to "и"; sounds of others stay with their letters.
std::u32string bare(char32_t c, const icu::Normalizer2& canonical) {
    icu::UnicodeString parts;
    const UScriptCode script = [&] {
        UErrorCode status = U_ZERO_ERROR;
        return uscript_getScript(static_cast<UChar32>(c), &status);
    }();
    const bool takesOff = script == USCRIPT_LATIN || script == USCRIPT_GREEK || script == USCRIPT_CYRILLIC ||
                          script == USCRIPT_ARABIC || script == USCRIPT_HEBREW;
    if (!takesOff || !canonical.getDecomposition(static_cast<UChar32>(c), parts)) {
        return {c};
    }
    std::u32string letters;
    for (int i = 0; i < parts.length(); i = parts.moveIndex32(i, 1)) {
        const auto part = static_cast<char32_t>(parts.char32At(i));
        if (!isPassedOver(part)) {
            letters.push_back(part);
        }
    }
    return letters;
}

std::u32string foldedLetter(char32_t c) {
    if (c < 0x80) {
        return {c >= U'A' && c <= U'Z' ? c + (U'a' - U'A') : c};
    }
    UErrorCode status = U_ZERO_ERROR;
    static const icu::Normalizer2* const compatibility = icu::Normalizer2::getNFKCCasefoldInstance(status);
    static const icu::Normalizer2* const canonical = icu::Normalizer2::getNFDInstance(status);
    if (compatibility == nullptr || canonical == nullptr) {
        return {c};
    }
    std::u32string letters;
    for (const char32_t one : decomposed(c, *compatibility)) {
        for (const char32_t part : bare(one, *canonical)) {
            std::u32string form(1, part);
            for (const Form& known : kForms) {
                form = known.from == part ? known.to : form;
            }
            if (!isPassedOver(part)) {
                letters += form;
            }
        }
    }
    return letters;
}

/// The letter at a byte, and where the next one begins.
std::pair<char32_t, std::size_t> letterAt(const std::string& text, std::size_t at) {
    const auto* const bytes = reinterpret_cast<const std::uint8_t*>(text.data());  // NOLINT
    auto next = static_cast<std::int32_t>(at);
    UChar32 letter = 0;
    U8_NEXT_OR_FFFD(bytes, next, static_cast<std::int32_t>(text.size()), letter);
    return {static_cast<char32_t>(letter), static_cast<std::size_t>(next)};
}

}  // namespace

bool FoldedText::isWithoutBlanks(char32_t letter) {
    if (letter < 0x1100) {
        return false;
    }
    UErrorCode status = U_ZERO_ERROR;
    switch (uscript_getScript(static_cast<UChar32>(letter), &status)) {
        case USCRIPT_HAN:
        case USCRIPT_HIRAGANA:
        case USCRIPT_KATAKANA:
        case USCRIPT_HANGUL:
            return true;
        default:
            // The sign that makes a kana long belongs to none of them alone.
            return letter == 0x30FC;
    }
}

FoldedText::FoldedText(std::string_view text) : text_(text) {
    for (std::size_t at = 0; at < text_.size();) {
        const auto [letter, next] = letterAt(text_, at);
        const char32_t before = letters_.empty() ? U' ' : letters_.back();
        if (next < text_.size() && isPrepositionsHyphen(letter, before, letterAt(text_, next).first)) {
            at = next;
            continue;
        }
        if (isBlankInside(letter, before)) {
            append(U' ', at);
        }
        const bool joining = joins(letter) && !letters_.empty() && letters_.back() != U' ' && next < text_.size() &&
                             u_isalnum(static_cast<UChar32>(letters_.back())) &&
                             u_isalnum(static_cast<UChar32>(letterAt(text_, next).first));
        const std::u32string folded = foldedLetter(letter);
        for (const char32_t one : folded) {
            append(isPartOfWord(one) || joining ? one : U' ', at);
        }
        at = next;
    }
    if (!letters_.empty() && letters_.back() == U' ') {
        letters_.pop_back();
        places_.pop_back();
    }
}

void FoldedText::append(char32_t letter, std::size_t at) {
    if (letter == U' ' && (letters_.empty() || letters_.back() == U' ' || isWithoutBlanks(letters_.back()))) {
        return;
    }
    if (!letters_.empty() && letters_.back() == U' ' && isWithoutBlanks(letter)) {
        letters_.pop_back();
        places_.pop_back();
    }
    letters_.push_back(letter);
    places_.push_back(at);
}

std::string FoldedText::original(std::size_t begin, std::size_t end) const {
    while (begin < end && letters_[begin] == U' ') {
        ++begin;
    }
    while (end > begin && letters_[end - 1] == U' ') {
        --end;
    }
    if (begin >= end || end > letters_.size()) {
        return {};
    }
    // Accents that follow the last letter belong to it; blanks and punctuation do not.
    std::size_t last = letterAt(text_, places_[end - 1]).second;
    for (std::size_t next = last; next < text_.size(); last = next) {
        const auto [letter, after] = letterAt(text_, next);
        if (!isPassedOver(letter) || (end < places_.size() && next >= places_[end])) {
            break;
        }
        next = after;
    }
    return text_.substr(places_[begin], last - places_[begin]);
}

}  // namespace ktr::ask
