// Any bytes as a sentence template, and as a question in each language: nothing may crash or hang, and whoever is said
// to be meant was named.
#include <unicode/translit.h>

#include <cstdint>
#include <cstdlib>
#include <filesystem>
#include <memory>
#include <string>
#include <vector>

#include "ask/FoldedText.h"
#include "ask/Languages.h"
#include "ask/Template.h"
#include "ask/Understanding.h"

namespace {

struct Asked {
    std::vector<std::shared_ptr<const ktr::ask::Language>> all;
    std::shared_ptr<const ktr::ask::Language> english;
    ktr::ask::People people;

    Asked() : people({named("Annabel", "annabel@x.example"), named("Ottokar", "ottokar@x.example")}) {
        ktr::ask::Languages languages(KTR_QUESTIONS);
        english = languages.language("en");
        for (const auto& file : std::filesystem::directory_iterator(KTR_QUESTIONS)) {
            all.push_back(languages.language(file.path().stem().string()));
        }
        if (!english || all.size() < 21) {
            std::abort();
        }
    }
    static ktr::ask::Person named(const char* name, const char* email) {
        ktr::ask::Person person;
        person.fullName = name;
        person.emails = {email};
        return person;
    }
};

/// What the letters of other scripts are in Latin ones: "ㅇ" before a consonant is silent.
std::u32string inLatin(const std::u32string& letters) {
    UErrorCode status = U_ZERO_ERROR;
    static const std::unique_ptr<icu::Transliterator> latin(
        icu::Transliterator::createInstance("Any-Latin; Latin-ASCII; Lower", UTRANS_FORWARD, status));
    auto text = icu::UnicodeString::fromUTF32(reinterpret_cast<const UChar32*>(letters.data()),  // NOLINT
                                              static_cast<std::int32_t>(letters.size()));
    latin->transliterate(text);
    std::string utf8;
    return ktr::ask::FoldedText::of(text.toUTF8String(utf8));
}

/// In one of its forms, in whatever script: the first letters are the name's own.
bool isNamedIn(const std::string& question, const std::string& name) {
    const std::u32string folded = ktr::ask::FoldedText::of(question);
    const std::u32string first = ktr::ask::FoldedText::of(name).substr(0, 5);
    return folded.find(first) != std::u32string::npos || inLatin(folded).find(first) != std::u32string::npos;
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    static const Asked asked;
    if (size == 0) {
        return 0;
    }
    const std::string text(reinterpret_cast<const char*>(data + 1), size - 1);  // NOLINT
    ktr::ask::Template::read(text);
    ktr::ask::Question question;
    question.text = text;
    const auto& language = *asked.all[data[0] % asked.all.size()];
    const auto result = ktr::ask::Understanding(language, *asked.english, asked.people).understand(question);
    if (const auto* understood = std::get_if<ktr::ask::Understood>(&result)) {
        for (const auto* person : understood->people) {
            if (!isNamedIn(text, person->fullName)) {
                std::abort();
            }
        }
    }
    return 0;
}
