#include "host/scenario/ScenarioReader.h"

#include <algorithm>
#include <filesystem>
#include <fstream>
#include <limits>

#include "documents/FieldReader.h"
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

double readNeeded(documents::FieldReader& fields, const std::string& name, double least, double most,
                  std::optional<double> otherwise) {
    const auto number = fields.number(name);
    if (!number) {
        if (!otherwise && fields.member(name) == nullptr) {
            fields.complain("", "expected a member \"" + name + "\"");
        }
        return otherwise.value_or(0.0);
    }
    if (!(*number >= least && *number <= most)) {
        fields.complain(name, most == std::numeric_limits<double>::infinity()
                                  ? "expected a number of 0 or more"
                                  : "expected a number from " + std::to_string(static_cast<int>(least)) + " to " +
                                        std::to_string(static_cast<int>(most)));
    }
    return *number;
}

std::vector<ScenarioPosition> readPositions(documents::FieldReader& fields) {
    constexpr double kNoLimit = std::numeric_limits<double>::infinity();
    std::vector<ScenarioPosition> positions;
    fields.objects("positions", [&](documents::FieldReader& entry) {
        ScenarioPosition position;
        position.at = readNeeded(entry, "at", 0.0, kNoLimit, 0.0);
        position.coordinate.latitude = readNeeded(entry, "latitude", -90.0, 90.0, std::nullopt);
        position.coordinate.longitude = readNeeded(entry, "longitude", -180.0, 180.0, std::nullopt);
        position.accuracy = readNeeded(entry, "accuracy", 0.0, kNoLimit, position.accuracy);
        if (!positions.empty() && position.at < positions.back().at) {
            entry.complain("at", "expected the positions in the order of their time");
        }
        positions.push_back(position);
    });
    return positions;
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
    scenario.positions = readPositions(fields);
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
                                                                          const std::string& file) const {
    // Some editors begin UTF-8 with a byte-order mark; RFC 8259 lets readers ignore it.
    if (text.starts_with("\xEF\xBB\xBF")) {
        text.remove_prefix(3);
    }
    auto read = documents::JsonReader::read(text);
    if (const auto* error = std::get_if<documents::JsonError>(&read)) {
        return documents::DocumentError{file, error->position, error->path.text(), error->message};
    }
    const Value& root = std::get<Value>(read);
    if (root.dictionary() == nullptr) {
        return documents::DocumentError{file, documents::JsonReader::locate(text, {}), "$",
                                        "expected an object, found " + documents::nameOfKind(root)};
    }
    documents::Complaints complaints;
    documents::FieldReader fields(*root.dictionary(), {}, complaints);
    Scenario scenario;
    scenario.file = file;
    readScenario(fields, now_, clock_ == Clock::OfTheScenario, scenario);
    if (complaints) {
        return documents::DocumentError{file, documents::JsonReader::locate(text, complaints->path),
                                        complaints->path.text(), complaints->message};
    }
    return scenario;
}

std::variant<Scenario, documents::DocumentError> ScenarioReader::readFile(const std::string& file) const {
    std::error_code failure;
    const fs::file_status status = fs::status(file, failure);
    if (status.type() == fs::file_type::not_found) {
        return documents::DocumentError{file, std::nullopt, "", "there is no such file"};
    }
    if (fs::is_directory(status)) {
        return documents::DocumentError{file, std::nullopt, "", "this is a folder, not a scenario file"};
    }
    std::ifstream stream(file, std::ios::binary);
    if (!stream) {
        return documents::DocumentError{file, std::nullopt, "", "the file cannot be opened"};
    }
    // One byte more than allowed tells too large from just fitting, also for a pipe whose size nobody knows.
    std::string text;
    std::string block(1u << 16, '\0');
    while (text.size() <= documents::kLargestJson &&
           (stream.read(block.data(), static_cast<std::streamsize>(block.size())) || stream.gcount() > 0)) {
        text.append(block.data(), static_cast<std::size_t>(stream.gcount()));
    }
    if (stream.bad()) {
        return documents::DocumentError{file, std::nullopt, "", "the file cannot be read"};
    }
    if (text.size() > documents::kLargestJson) {
        return documents::DocumentError{file, std::nullopt, "", "the file is larger than 64 MiB"};
    }
    return readText(text, file);
}

}  // namespace ktr::host
