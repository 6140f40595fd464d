#include "linux/configuration/ConfigurationFile.h"

#include <algorithm>
#include <system_error>

#include "documents/AtomicFile.h"
#include "documents/DocumentReader.h"
#include "documents/FileLock.h"
#include "documents/FileSteps.h"
#include "documents/FileTrust.h"
#include "documents/JsonReader.h"
#include "documents/NearestName.h"
#include "documents/Words.h"
#include "linux/configuration/ConfigurationReader.h"
#include "platform/base/Json.h"

namespace ktr::linux_ {

namespace {

using platform::Dictionary;
using platform::Value;

constexpr std::size_t kLargestFile = std::size_t{1} << 20;

/// As people write it: a member a line, lists of texts on one.
void writeReadably(const Value& value, int depth, std::string& text) {
    const auto indent = [&](int by) { text.append("\n").append(static_cast<std::size_t>(by) * 2, ' '); };
    if (const Dictionary* members = value.dictionary(); members != nullptr && !members->empty()) {
        text += "{";
        const char* between = "";
        for (const auto& [name, member] : *members) {
            text += between;
            indent(depth + 1);
            text += platform::writeJsonString(name) + ": ";
            writeReadably(member, depth + 1, text);
            between = ",";
        }
        indent(depth);
        text += "}";
    } else {
        text += platform::writeJson(value);
    }
}

std::string unknownName(const std::string& name) {
    return "there is no setting " + documents::inQuotes(name) + documents::didYouMean(name, ConfigurationFile::names());
}

bool isName(const std::string& name) {
    const auto& names = ConfigurationFile::names();
    return std::find(names.begin(), names.end(), name) != names.end();
}

/// Null where nothing stands.
Value found(const Dictionary& members, const std::string& name) {
    const std::size_t dot = name.find('.');
    const Value* member = members.find(name.substr(0, dot));
    if (member == nullptr || dot == std::string::npos) {
        return member == nullptr ? Value() : *member;
    }
    const Dictionary* inner = member->dictionary();
    return inner == nullptr ? Value() : found(*inner, name.substr(dot + 1));
}

void apply(Dictionary& members, const std::string& name, const std::optional<Value>& value) {
    const std::size_t dot = name.find('.');
    const std::string first = name.substr(0, dot);
    if (dot == std::string::npos) {
        if (value) {
            members.set(first, *value);
        } else {
            members.remove(first);
        }
        return;
    }
    const Value* member = members.find(first);
    Dictionary inner = member != nullptr && member->dictionary() != nullptr ? *member->dictionary() : Dictionary();
    apply(inner, name.substr(dot + 1), value);
    if (inner.empty()) {
        members.remove(first);
    } else {
        members.set(first, std::move(inner));
    }
}

}  // namespace

ConfigurationFile::ConfigurationFile(const std::filesystem::path& file) : file_(documents::FileSteps::absolute(file)) {}

const std::vector<std::string>& ConfigurationFile::names() {
    static const std::vector<std::string> kNames = {"account.personId",
                                                    "account.userName",
                                                    "account.host",
                                                    "account.domains",
                                                    "account.tokenFile",
                                                    "account.assistant",
                                                    "certificates",
                                                    "contacts",
                                                    "addressBooks",
                                                    "language",
                                                    "textSize",
                                                    "colors",
                                                    "distances",
                                                    "geographicCountry",
                                                    "restrictions.friendLocationRestricted",
                                                    "restrictions.friendLocationAllowed",
                                                    "positions.source",
                                                    "positions.file",
                                                    "positions.host",
                                                    "positions.port",
                                                    "maps.sources",
                                                    "maps.datum",
                                                    "maps.cacheMegabytes"};
    return kNames;
}

std::variant<Dictionary, std::string> ConfigurationFile::read() const {
    const auto refusal = [this](const struct stat& facts) { return documents::FileTrust::problemOf(file_, facts); };
    const auto text = documents::DocumentReader::textOf(file_, {kLargestFile, refusal});
    if (const auto* error = std::get_if<documents::DocumentError>(&text)) {
        return error->isMissing ? std::variant<Dictionary, std::string>(Dictionary()) : error->text();
    }
    const auto& content = std::get<std::string>(text);
    const auto value = documents::JsonReader::read(documents::DocumentReader::withoutMark(content));
    const auto* members = std::holds_alternative<Value>(value) ? std::get<Value>(value).dictionary() : nullptr;
    if (members != nullptr) {
        return *members;
    }
    // The reader of the configuration says it with file, line and column.
    const auto broken = ConfigurationReader::readText(content, file_);
    const auto* error = std::get_if<ConfigurationReader::Error>(&broken);
    return error != nullptr ? error->text : file_.string() + ": expected an object";
}

std::variant<Value, std::string> ConfigurationFile::get(const std::string& name) const {
    using Got = std::variant<Value, std::string>;
    // A text is a value too: which of the two is meant has to be said.
    if (!isName(name)) {
        return Got(std::in_place_index<1>, unknownName(name));
    }
    const auto members = read();
    const auto* problem = std::get_if<std::string>(&members);
    return problem != nullptr ? Got(std::in_place_index<1>, *problem)
                              : Got(std::in_place_index<0>, found(std::get<Dictionary>(members), name));
}

std::variant<std::vector<std::pair<std::string, Value>>, std::string> ConfigurationFile::list() const {
    const auto members = read();
    if (const auto* problem = std::get_if<std::string>(&members)) {
        return *problem;
    }
    std::vector<std::pair<std::string, Value>> all;
    for (const std::string& name : names()) {
        if (Value value = found(std::get<Dictionary>(members), name); !value.isNull()) {
            all.emplace_back(name, std::move(value));
        }
    }
    return all;
}

std::string ConfigurationFile::change(const std::vector<Change>& changes) const {
    for (const Change& wanted : changes) {
        if (!isName(wanted.name) && wanted.name != "account") {
            return unknownName(wanted.name);
        }
    }
    if (std::string problem = documents::AtomicFile::makeFolder(file_.parent_path()); !problem.empty()) {
        return problem;
    }
    const documents::FileLock lock(file_.string() + ".lock");
    if (!lock.isHeld()) {
        return file_.string() + ": it cannot be locked: " + lock.problem();
    }
    auto members = read();
    if (const auto* problem = std::get_if<std::string>(&members)) {
        return *problem;
    }
    auto& dictionary = std::get<Dictionary>(members);
    for (const Change& wanted : changes) {
        apply(dictionary, wanted.name, wanted.value);
    }
    std::string text;
    writeReadably(dictionary, 0, text);
    text += "\n";
    const auto tried = ConfigurationReader::readText(text, file_);
    if (const auto* error = std::get_if<ConfigurationReader::Error>(&tried)) {
        // What was wrong before has a place in the file; what would be written has none.
        const auto standing = ConfigurationReader::readFile(file_);
        const auto* before = std::get_if<ConfigurationReader::Error>(&standing);
        return before != nullptr && before->ofMember == error->ofMember ? before->text : error->ofMember;
    }
    // What a link leads to is changed; the link stays.
    std::error_code isNone;
    const auto place = std::filesystem::canonical(file_, isNone);
    return documents::AtomicFile::write(isNone ? file_ : place, text);
}

std::string ConfigurationFile::set(const std::string& name, const std::string& typed) const {
    static const std::vector<std::string> kLists = {"account.domains", "certificates", "contacts"};
    // In a list of one, since a document is an object or a list.
    const auto read = documents::JsonReader::read("[" + typed + "]");
    const auto* list = std::holds_alternative<Value>(read) ? std::get<Value>(read).array() : nullptr;
    const Value* json = list != nullptr && list->size() == 1 ? &list->front() : nullptr;
    // What looks like a number, a truth value or a list is meant so where that is wanted; a person may be "1000".
    const bool isText = name.starts_with("account.") && name != "account.domains";
    Value value = json != nullptr && (!isText || json->string() != nullptr) ? *json : Value(typed);
    if (value.string() != nullptr && std::find(kLists.begin(), kLists.end(), name) != kLists.end()) {
        value = Value(Value::Array{value});
    }
    return change({{name, value}});
}

}  // namespace ktr::linux_
