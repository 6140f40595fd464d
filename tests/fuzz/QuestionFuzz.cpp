// Any bytes as a sentence template, and as a question in each language: nothing may crash or hang, and whoever is said
// to be meant was named.
#include <cstdint>
#include <cstdlib>
#include <filesystem>
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
        const std::u32string folded = ktr::ask::FoldedText::of(text);
        for (const auto* person : understood->people) {
            // In one of its forms: the first letters are the name's own.
            if (folded.find(ktr::ask::FoldedText::of(person->fullName).substr(0, 5)) == std::u32string::npos) {
                std::abort();
            }
        }
    }
    return 0;
}
