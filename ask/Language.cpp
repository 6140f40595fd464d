#include "ask/Language.h"

#include <algorithm>
#include <array>

#include "ask/FoldedText.h"
#include "documents/DocumentReader.h"

namespace ktr::ask {

using documents::FieldReader;

namespace {

/// A language's file is a page or two.
constexpr std::size_t kLargestFile = std::size_t{1} << 20;
constexpr std::array<const char*, Language::kTimes> kTimeNames{"at",      "pm",    "noon",     "tonight", "tomorrow",
                                                               "minutes", "hours", "halfHour", "oneHour"};
constexpr std::array<const char*, 4> kPrecisionNames{"exact", "1km", "town", "places"};
constexpr std::array<const char*, 4> kKinds{"home", "work", "school", "gym"};
/// The group of what stands for the asker's own place.
constexpr std::uint32_t kMe = 0;
constexpr const char* kMyPlace = "me";

/// Blanks at the ends are kept: they part words.
std::u32string foldedWithBlanks(const std::string& text) {
    std::u32string folded = FoldedText::of(text);
    if (!text.empty() && text.front() == ' ') {
        folded.insert(folded.begin(), U' ');
    }
    if (!text.empty() && text.back() == ' ') {
        folded.push_back(U' ');
    }
    return folded;
}

/// Reads templates, and complains where they stand.
class Templates {
  public:
    explicit Templates(FieldReader& fields) : fields_(fields) {}

    Template::Part read(const std::string& member, const std::string& text) {
        auto read = Template::read(text);
        if (const auto* error = std::get_if<Template::Error>(&read)) {
            fields_.complain(member, "column " + std::to_string(error->column) + ": " + error->message);
            return {};
        }
        return std::get<Template::Part>(std::move(read));
    }
    /// All members of an object, each one template.
    Grammar::Rules rules() {
        Grammar::Rules rules;
        for (const auto& [name, value] : fields_.dictionary()) {
            rules[name] = read(name, fields_.string(name).value_or(""));
        }
        return rules;
    }
    void add(Grammar& grammar, std::uint32_t group, const std::string& member) {
        for (const std::string& text : fields_.stringOrStrings(member)) {
            const std::string complaint = grammar.add(group, read(member, text));
            if (!complaint.empty()) {
                fields_.complain(member, complaint);
            }
        }
    }

  private:
    FieldReader& fields_;
};

std::string textOf(const FoldedText& text, const Grammar::Span& span) {
    return span.isThere() ? text.original(span.begin, span.end) : std::string();
}

}  // namespace

std::optional<std::string> Language::fileFor(const std::string& tag, const std::set<std::string>& files) {
    if (tag.size() > kLongestTag) {
        return std::nullopt;
    }
    std::vector<std::string> names{tag};
    if (tag == "iw" || tag.rfind("iw-", 0) == 0) {
        names.emplace_back("he");
    }
    for (const char* place : {"TW", "HK", "MO"}) {
        if (tag.rfind("zh", 0) == 0 && tag.find(place) != std::string::npos) {
            names.emplace_back("zh-Hant");
        }
    }
    for (std::string shorter = tag; shorter.find('-') != std::string::npos;) {
        shorter.erase(shorter.rfind('-'));
        names.push_back(shorter);
    }
    if (tag.rfind("zh", 0) == 0) {
        names.emplace_back("zh-Hans");
    }
    const auto found =
        std::find_if(names.begin(), names.end(), [&](const std::string& name) { return files.count(name) == 1; });
    return found == names.end() ? std::nullopt : std::optional(*found);
}

std::variant<std::shared_ptr<const Language>, documents::DocumentError> Language::read(
    const std::filesystem::path& file, const std::string& tag) {
    const auto language = std::make_shared<File>();
    documents::FileReader::Terms terms;
    terms.most = kLargestFile;
    documents::DocumentWarnings unknown;
    auto error = documents::DocumentReader::readFile(
        file, terms, [&](FieldReader& fields) { language->readAll(fields); }, &unknown);
    if (!error && !unknown.empty()) {
        error = unknown.front();
    }
    if (error) {
        return *error;
    }
    return std::shared_ptr<const Language>(new Language(tag, language));
}

std::shared_ptr<const Language> Language::under(const std::string& tag) const {
    return std::shared_ptr<const Language>(new Language(tag, file_));
}

void Language::File::readAll(FieldReader& fields) {
    readQuestions(fields);
    readWords(fields);
    times = std::make_unique<Grammar>(Grammar::Rules(), Grammar::Lists());
    fields.object("times", [&](FieldReader& given) {
        for (std::size_t time = 0; time < kTimes; ++time) {
            Templates(given).add(*times, static_cast<std::uint32_t>(time), kTimeNames.at(time));
        }
    });
    fields.object("sentences", [&](FieldReader& given) {
        for (const auto& [key, value] : given.dictionary()) {
            sentences[key] = given.string(key).value_or("");
        }
    });
    suggestions = fields.texts("suggestions");
}

void Language::File::readQuestions(FieldReader& fields) {
    Grammar::Rules rules;
    fields.object("rules", [&](FieldReader& given) { rules = Templates(given).rules(); });
    Grammar::Lists lists;
    fields.object("precision", [&](FieldReader& given) {
        for (const char* name : kPrecisionNames) {
            lists.at(static_cast<std::size_t>(Grammar::List::Precision))
                .push_back(Templates(given).read(name, given.string(name).value_or("")));
        }
    });
    lists.at(static_cast<std::size_t>(Grammar::List::Every))
        .push_back(Templates(fields).read("every", fields.string("every").value_or("")));
    lists.at(static_cast<std::size_t>(Grammar::List::Now))
        .push_back(Templates(fields).read("now", fields.string("now").value_or("")));
    auto& spots = lists.at(static_cast<std::size_t>(Grammar::List::Spot));
    spots.push_back(Templates(fields).read(kMyPlace, fields.string(kMyPlace).value_or("")));
    fields.object("places", [&](FieldReader& given) {
        for (const char* label : kKinds) {
            given.object(label, [&](FieldReader& kind) {
                spots.push_back(Templates(kind).read("called", kind.string("called").value_or("")));
                kinds.push_back({label, kind.text("said").value_or("")});
            });
        }
    });
    places = std::make_unique<Grammar>(Grammar::Rules(), Grammar::Lists());
    for (std::size_t spot = 0; spot < spots.size(); ++spot) {
        places->add(static_cast<std::uint32_t>(spot), spots[spot]);
    }
    questions = std::make_unique<Grammar>(std::move(rules), std::move(lists));
    fields.object("questions", [&](FieldReader& given) {
        for (const auto& [name, value] : given.dictionary()) {
            if (const auto wish = wishNamed(name)) {
                Templates(given).add(*questions, static_cast<std::uint32_t>(*wish), name);
            }
        }
    });
}

void Language::File::readWords(FieldReader& fields) {
    for (const std::string& word : fields.texts("and")) {
        // A comma is folded away, and parts names in every language.
        if (const std::u32string folded = foldedWithBlanks(word); !folded.empty()) {
            conjunctions.push_back(folded);
        }
    }
    fields.object("relations", [&](FieldReader& given) {
        for (const auto& [name, value] : given.dictionary()) {
            relations.emplace_back();
            for (const std::string& word : given.texts(name)) {
                relations.back().push_back(FoldedText::of(word));
            }
        }
    });
    fields.object("endings", [&](FieldReader& given) {
        for (const auto& [ending, value] : given.dictionary()) {
            for (const std::string& own : given.stringOrStrings(ending)) {
                endings.emplace_back(FoldedText::of(ending), FoldedText::of(own));
            }
        }
    });
    int value = 0;
    for (const std::string& words : fields.texts("numbers")) {
        ++value;
        for (std::size_t at = 0; at <= words.size();) {
            const std::size_t end = std::min(words.find('|', at), words.size());
            numbers[FoldedText::of(words.substr(at, end - at))] = value;
            at = end + 1;
        }
    }
}

std::vector<Meaning> Language::meanings(const std::string& question) const {
    const FoldedText text(question);
    std::vector<Meaning> meanings;
    for (const Grammar::Reading& reading : file_->questions->read(text.letters())) {
        Meaning meaning;
        meaning.wish = static_cast<Wish>(reading.group);
        const auto slot = [&](Grammar::Slot which) {
            return textOf(text, reading.slots.at(static_cast<std::size_t>(which)));
        };
        meaning.people = slot(Grammar::Slot::Name);
        meaning.place = slot(Grammar::Slot::Place);
        meaning.until = slot(Grammar::Slot::Time);
        if (const auto value = reading.values.at(static_cast<std::size_t>(Grammar::List::Precision)); value >= 0) {
            meaning.precision = static_cast<Precision>(value);
        }
        if (const auto value = reading.values.at(static_cast<std::size_t>(Grammar::List::Spot)); value >= 0) {
            meaning.spot = spotOf(static_cast<std::size_t>(value));
        }
        meaning.everyTime = reading.values.at(static_cast<std::size_t>(Grammar::List::Every)) >= 0;
        meaning.thisMoment = reading.values.at(static_cast<std::size_t>(Grammar::List::Now)) >= 0;
        meaning.certainty = reading.letters;
        if (std::find(meanings.begin(), meanings.end(), meaning) == meanings.end()) {
            meanings.push_back(std::move(meaning));
        }
    }
    return meanings;
}

std::string Language::placeWord(const std::string& words) const {
    const auto readings = file_->places->read(FoldedText::of(words));
    if (readings.empty()) {
        return {};
    }
    return spotOf(readings.front().group);
}

std::string Language::spotOf(std::size_t number) const {
    return number == kMe ? kMyPlace : file_->kinds.at(number - 1).label;
}

const Language::PlaceKind* Language::kindOf(const std::string& label) const {
    const auto found = std::find_if(file_->kinds.begin(), file_->kinds.end(),
                                    [&](const PlaceKind& kind) { return kind.label == label; });
    return found == file_->kinds.end() ? nullptr : &*found;
}

const std::string& Language::sentence(const std::string& key) const {
    const auto found = file_->sentences.find(key);
    return found == file_->sentences.end() ? key : found->second;
}

}  // namespace ktr::ask
