#include "host/scenario/ScenarioReader.h"

#include <algorithm>
#include <filesystem>

#include "documents/DocumentReader.h"
#include "documents/Words.h"
#include "host/scenario/AssistantObjectReader.h"
#include "linux/device/LinuxDevice.h"

namespace ktr::host {

namespace {

namespace fs = std::filesystem;
using platform::Value;

LocalizedText readLocalizedText(documents::FieldReader& fields, const std::string& name) {
    const Value* value = fields.member(name);
    if (value == nullptr) {
        return {};
    }
    if (const std::string* text = value->string()) {
        return LocalizedText(*text);
    }
    LocalizedText texts;
    const platform::Dictionary* languages = value->dictionary();
    if (languages == nullptr) {
        fields.complain(
            name, "expected a string, or an object of one text a language, found " + documents::nameOfKind(*value));
        return texts;
    }
    for (const auto& [language, text] : *languages) {
        const documents::JsonPath path = fields.path().member(name).member(language);
        if (!isLanguageTag(language)) {
            fields.complainAt(path, "expected a language such as \"en\" or \"pt-BR\"");
        } else if (text.string() == nullptr) {
            fields.complainAt(path, "expected a string, found " + documents::nameOfKind(text));
        } else {
            texts.add(language, *text.string());
        }
    }
    return texts;
}

/// A word of a closed list; `parse` gives none for any other.
template <class Parse>
auto readWord(documents::FieldReader& fields, const std::string& name, const std::string& expected, Parse parse)
    -> decltype(parse(std::string())) {
    const auto text = fields.string(name);
    if (!text) {
        return std::nullopt;
    }
    auto word = parse(*text);
    if (!word) {
        fields.complain(name, "expected " + expected + ", found " + documents::inQuotes(*text));
    }
    return word;
}

std::optional<std::string> languageTag(const std::string& text) {
    return isLanguageTag(text) ? std::optional(text) : std::nullopt;
}

std::optional<std::string> countryCode(std::string text) {
    if (text.size() != 2) {
        return std::nullopt;
    }
    for (char& c : text) {
        if (c >= 'a' && c <= 'z') {
            c = static_cast<char>(c - 'a' + 'A');
        }
        if (c < 'A' || c > 'Z') {
            return std::nullopt;
        }
    }
    return text;
}

std::vector<std::string> resolved(std::vector<std::string> paths, const std::string& file) {
    const fs::path folder = fs::path(file).parent_path();
    std::transform(paths.begin(), paths.end(), paths.begin(),
                   [&](const std::string& path) { return (folder / fs::path(path)).lexically_normal().string(); });
    return paths;
}

void readScenario(documents::FieldReader& fields, platform::Date now, bool withClock, Scenario& scenario) {
    const auto clock =
        readWord(fields, "clock", "a date and time such as \"2026-05-16T17:42:00+02:00\"", documents::parseIsoTime);
    scenario.clock = withClock ? clock : std::nullopt;
    scenario.question = readLocalizedText(fields, "question");
    scenario.sentence = readLocalizedText(fields, "sentence");
    scenario.contacts = resolved(fields.stringOrStrings("contacts"), scenario.file);
    scenario.language = readWord(fields, "language", "a language such as \"en-GB\"", languageTag);
    scenario.region = readWord(fields, "region", "a locale such as \"en-GB\"", languageTag);
    scenario.country = readWord(fields, "country", "a country of two letters such as \"GB\"", countryCode);
    scenario.textSize = readWord(fields, "textSize", "one of XS, S, M, L, XL, XXL, XXXL, AX1, AX2, AX3, AX4, AX5",
                                 linux_::LinuxDevice::categoryNamed);
    scenario.idiom =
        readWord(fields, "idiom", "one of phone, tablet, desktop, display", linux_::LinuxDevice::idiomNamed);
    scenario.positions = linux_::readScenarioPositions(fields);
    scenario.dark = fields.boolean("dark");
    fields.object("account", [&](documents::FieldReader& account) { scenario.userName = account.string("userName"); });
    const AssistantObjectReader objects(scenario.clock ? scenario.clock->date : now);
    const bool present = fields.object("snippet", [&](documents::FieldReader& snippet) {
        scenario.snippet = objects.readSnippet(snippet, scenario.kind);
    });
    if (!present && scenario.sentence.empty()) {
        fields.complain("", "expected a member \"snippet\", the assistant's answer, or at least a \"sentence\"");
    }
}

}  // namespace

std::variant<Scenario, documents::DocumentError> ScenarioReader::readText(std::string_view text,
                                                                          const std::string& file,
                                                                          documents::DocumentWarnings* warnings) const {
    Scenario scenario;
    scenario.file = file;
    const auto read = [&](documents::FieldReader& fields) {
        readScenario(fields, now_, clock_ == Clock::OfTheScenario, scenario);
    };
    if (auto error = documents::DocumentReader::readText(text, file, read, warnings)) {
        return *std::move(error);
    }
    return scenario;
}

std::variant<Scenario, documents::DocumentError> ScenarioReader::readFile(const std::string& file,
                                                                          documents::DocumentWarnings* warnings) const {
    const auto text = documents::DocumentReader::textOf(file, {documents::kLargestJson, {}});
    if (const auto* error = std::get_if<documents::DocumentError>(&text)) {
        return *error;
    }
    return readText(std::get<std::string>(text), file, warnings);
}

}  // namespace ktr::host
