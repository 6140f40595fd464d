#include "serve/FaultScript.h"

#include <charconv>
#include <cmath>
#include <utility>

#include "documents/DocumentReader.h"
#include "documents/NearestName.h"
#include "documents/Words.h"

namespace ktr::serve {

namespace {

using platform::Dictionary;
using platform::Value;

constexpr std::pair<const char*, Fault::Cut> kCuts[] = {
    {"before", Fault::Cut::BeforeAnswer}, {"headers", Fault::Cut::AfterHeaders}, {"body", Fault::Cut::InBody}};
constexpr std::pair<const char*, Fault::Body> kBodies[] = {
    {"not-json", Fault::Body::NotJson}, {"array", Fault::Body::Array}, {"deep", Fault::Body::Deep},
    {"endless", Fault::Body::Endless},  {"empty", Fault::Body::Empty}, {"truncated", Fault::Body::Truncated}};

template <class Word, std::size_t Count>
Word readWord(documents::FieldReader& fields, const std::string& name,
              const std::pair<const char*, Word> (&words)[Count], Word otherwise) {
    const auto text = fields.string(name);
    if (!text) {
        return otherwise;
    }
    std::string expected;
    for (const auto& [word, value] : words) {
        if (*text == word) {
            return value;
        }
        expected += (expected.empty() ? "" : ", ") + std::string(word);
    }
    fields.complain(name, "expected one of " + expected + ", found " + documents::inQuotes(*text));
    return otherwise;
}

constexpr double kMostAmount = 1.0e9;

Fault readFault(documents::FieldReader& fields) {
    constexpr int kMost = 1000000000;
    Fault fault;
    fault.at = fields.whole("at", 1, kMost).value_or(1);
    fault.count = fields.whole("count", 0, kMost).value_or(0);
    fault.delaySeconds = fields.number("delay", 0.0, kMostAmount).value_or(0.0);
    fault.cut = readWord(fields, "cut", kCuts, Fault::Cut::None);
    fault.status = fields.whole("status", 200, 599).value_or(0);
    fault.redirect = fields.string("redirect").value_or("");
    fault.redirectStatus = fields.whole("redirectStatus", 300, 399).value_or(307);
    fault.body = readWord(fields, "body", kBodies, Fault::Body::Ordinary);
    if (const auto text = fields.string("text")) {
        fault.body = Fault::Body::Text;
        fault.text = *text;
    }
    fault.bytesPerSecond = fields.number("bytesPerSecond", 0.0, kMostAmount).value_or(0.0);
    fault.statusCode = fields.whole("statusCode", -kMost, kMost);
    fault.entryStatus = fields.whole("entryStatus", -kMost, kMost);
    fault.entry = fields.string("entry").value_or("");
    // In milliseconds it has to be a number still.
    fault.intervalSeconds = fields.number("interval", -kMostAmount, kMostAmount);
    // A misspelt fault would test nothing.
    for (const std::string& name : fields.unasked()) {
        fields.complain(name, "there is no such fault" + documents::didYouMean(name, fields.asked()));
    }
    return fault;
}

/// The text as a number when it reads as one.
Value valueOf(const std::string& text) {
    double number = 0.0;
    const char* end = text.data() + text.size();
    const auto [stop, error] = std::from_chars(text.data(), end, number);
    return error == std::errc() && stop == end && std::isfinite(number) ? Value(number) : Value(text);
}

}  // namespace

std::variant<FaultScript, documents::DocumentError> FaultScript::readText(std::string_view text,
                                                                          const std::string& file,
                                                                          documents::DocumentWarnings* warnings) {
    FaultScript script;
    const auto read = [&](documents::FieldReader& fields) {
        if (!fields.objects("faults", [&](documents::FieldReader& fault) { script.add(readFault(fault)); })) {
            fields.complain("", "expected a member \"faults\"");
        }
    };
    if (auto error = documents::DocumentReader::readText(text, file, read, warnings)) {
        return *error;
    }
    return script;
}

std::variant<FaultScript, documents::DocumentError> FaultScript::readFile(const std::string& file,
                                                                          documents::DocumentWarnings* warnings) {
    const auto text = documents::DocumentReader::textOf(file, {documents::kLargestJson, {}});
    if (const auto* error = std::get_if<documents::DocumentError>(&text)) {
        return *error;
    }
    return readText(std::get<std::string>(text), file, warnings);
}

std::optional<Fault> FaultScript::readWords(const std::string& words, std::string& complaint) {
    std::vector<std::string> pairs(1);
    for (std::size_t i = 0; i < words.size(); ++i) {
        if (words[i] != ',') {
            pairs.back() += words[i];
        } else if (i + 1 < words.size() && words[i + 1] == ',') {
            pairs.back() += words[i++];
        } else {
            pairs.emplace_back();
        }
    }
    Dictionary members;
    for (const std::string& pair : pairs) {
        const std::size_t equals = pair.find('=');
        if (equals == 0 || equals == std::string::npos) {
            complaint = "expected words such as status=503,at=2, found " + documents::inQuotes(pair);
            return std::nullopt;
        }
        const std::string name = pair.substr(0, equals);
        const std::string text = pair.substr(equals + 1);
        members.set(name, name == "text" || name == "entry" ? Value(text) : valueOf(text));
    }
    documents::Complaints complaints;
    documents::FieldReader fields(members, {}, complaints);
    Fault fault = readFault(fields);
    if (complaints) {
        complaint = complaints->path.text() + ": " + complaints->message;
        return std::nullopt;
    }
    return fault;
}

Fault FaultScript::faultFor(int request) const {
    for (const Fault& fault : faults_) {
        if (fault.concerns(request)) {
            return fault;
        }
    }
    return {};
}

}  // namespace ktr::serve
