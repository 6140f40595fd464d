#include "documents/FieldReader.h"

#include <algorithm>
#include <cmath>
#include <limits>

#include "documents/NearestName.h"
#include "platform/base/Json.h"

namespace ktr::documents {

using platform::Value;

std::string nameOfKind(const Value& value) {
    switch (value.kind()) {
        case Value::Kind::Null:
            return "null";
        case Value::Kind::Bool:
            return "a boolean";
        case Value::Kind::Integer:
        case Value::Kind::Real:
            return "a number";
        case Value::Kind::String:
            return "a string";
        case Value::Kind::Array:
            return "a list";
        case Value::Kind::Dictionary:
            return "an object";
    }
    return "something else";
}

const Value* FieldReader::member(const std::string& name) {
    asked_.push_back(name);
    const Value* value = dictionary_.find(name);
    return value == nullptr || value->isNull() ? nullptr : value;
}

std::optional<std::string> FieldReader::string(const std::string& name) {
    const Value* value = member(name);
    if (value == nullptr) {
        return std::nullopt;
    }
    if (const std::string* text = value->string()) {
        return *text;
    }
    complainAboutType(path_.member(name), "a string", *value);
    return std::nullopt;
}

bool FieldReader::isText(const JsonPath& path, const std::string& text) {
    const bool control =
        std::any_of(text.begin(), text.end(), [](char c) { return static_cast<unsigned char>(c) < 0x20 || c == 0x7F; });
    if (text.empty() || control) {
        complainAt(path,
                   control ? "expected a string without control characters" : "expected a string, found an empty one");
    }
    return !text.empty() && !control;
}

std::optional<std::string> FieldReader::text(const std::string& name) {
    auto found = string(name);
    return found && isText(path_.member(name), *found) ? std::move(found) : std::nullopt;
}

std::optional<double> FieldReader::number(const std::string& name) {
    const Value* value = member(name);
    if (value == nullptr) {
        return std::nullopt;
    }
    if (!value->isNumber()) {
        complainAboutType(path_.member(name), "a number", *value);
    }
    return value->number();
}

std::optional<double> FieldReader::number(const std::string& name, double least, double most) {
    const auto found = number(name);
    if (found && !(*found >= least && *found <= most)) {
        const std::string from = platform::writeJson(Value(least));
        complain(name, most == std::numeric_limits<double>::infinity()
                           ? "expected a number of " + from + " or more"
                           : "expected a number from " + from + " to " + platform::writeJson(Value(most)));
        return std::nullopt;
    }
    return found;
}

std::optional<int> FieldReader::whole(const std::string& name, int least, int most) {
    const Value* value = member(name);
    if (value == nullptr) {
        return std::nullopt;
    }
    const double found = value->number().value_or(std::nan(""));
    if (!(found >= least && found <= most) || std::floor(found) != found) {
        const std::string expected = "a whole number from " + std::to_string(least) + " to " + std::to_string(most);
        value->isNumber() ? complain(name, "expected " + expected)
                          : complainAboutType(path_.member(name), expected, *value);
        return std::nullopt;
    }
    return static_cast<int>(found);
}

std::optional<bool> FieldReader::boolean(const std::string& name) {
    const Value* value = member(name);
    if (value == nullptr) {
        return std::nullopt;
    }
    if (!value->boolean()) {
        complainAboutType(path_.member(name), "true or false", *value);
    }
    return value->boolean();
}

bool FieldReader::object(const std::string& name, const std::function<void(FieldReader&)>& read) {
    const Value* value = member(name);
    if (value == nullptr) {
        return false;
    }
    const platform::Dictionary* fields = value->dictionary();
    if (fields == nullptr) {
        complainAboutType(path_.member(name), "an object", *value);
        return true;
    }
    FieldReader inner(*fields, path_.member(name), complaints_);
    read(inner);
    inner.warnOfOthers();
    return true;
}

bool FieldReader::objects(const std::string& name, const std::function<void(FieldReader&)>& read) {
    const Value* value = member(name);
    if (value == nullptr) {
        return false;
    }
    const Value::Array* elements = value->array();
    if (elements == nullptr) {
        complainAboutType(path_.member(name), "a list", *value);
        return true;
    }
    const JsonPath list = path_.member(name);
    for (std::size_t i = 0; i < elements->size(); ++i) {
        const platform::Dictionary* fields = (*elements)[i].dictionary();
        if (fields == nullptr) {
            complainAboutType(list.element(i), "an object", (*elements)[i]);
            continue;
        }
        FieldReader inner(*fields, list.element(i), complaints_);
        read(inner);
        inner.warnOfOthers();
    }
    return true;
}

std::vector<std::string> FieldReader::stringOrStrings(const std::string& name) {
    const Value* value = member(name);
    std::vector<std::string> texts;
    if (value == nullptr) {
        return texts;
    }
    if (const std::string* text = value->string()) {
        texts.push_back(*text);
        return texts;
    }
    const Value::Array* elements = value->array();
    if (elements == nullptr) {
        complainAboutType(path_.member(name), "a string or a list of strings", *value);
        return texts;
    }
    for (std::size_t i = 0; i < elements->size(); ++i) {
        if (const std::string* text = (*elements)[i].string()) {
            texts.push_back(*text);
        } else {
            complainAboutType(path_.member(name).element(i), "a string", (*elements)[i]);
        }
    }
    return texts;
}

std::vector<std::string> FieldReader::texts(const std::string& name) {
    const Value* value = member(name);
    std::vector<std::string> found;
    if (value == nullptr) {
        return found;
    }
    const Value::Array* elements = value->array();
    if (elements == nullptr) {
        complainAboutType(path_.member(name), "a list of strings", *value);
        return found;
    }
    for (std::size_t i = 0; i < elements->size(); ++i) {
        const JsonPath path = path_.member(name).element(i);
        const std::string* text = (*elements)[i].string();
        if (text == nullptr) {
            complainAboutType(path, "a string", (*elements)[i]);
        } else if (isText(path, *text)) {
            found.push_back(*text);
        }
    }
    return found;
}

std::vector<std::string> FieldReader::unasked() const {
    std::vector<std::string> names;
    for (const auto& [name, value] : dictionary_) {
        if (name != "$schema" && std::find(asked_.begin(), asked_.end(), name) == asked_.end()) {
            names.push_back(name);
        }
    }
    return names;
}

void FieldReader::warnOfOthers() {
    if (leavesOthers_) {
        return;
    }
    for (const std::string& name : unasked()) {
        if (complaints_.unknown.size() == Complaints::kMostUnknown) {
            ++complaints_.moreUnknown;
            continue;
        }
        complaints_.unknown.push_back(
            {path_.member(name), "there is no such member, it is passed over" + didYouMean(name, asked_)});
    }
}

void FieldReader::complain(const std::string& name, std::string message) {
    complainAt(name.empty() ? path_ : path_.member(name), std::move(message));
}

void FieldReader::complainAt(const JsonPath& path, std::string message) {
    if (!complaints_) {
        complaints_.first = Complaint{path, std::move(message)};
    }
}

void FieldReader::complainAboutType(const JsonPath& path, const std::string& expected, const Value& found) {
    complainAt(path, "expected " + expected + ", found " + nameOfKind(found));
}

}  // namespace ktr::documents
