#include "documents/FieldReader.h"

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

const Value* FieldReader::member(const std::string& name) const {
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

void FieldReader::complain(const std::string& name, std::string message) {
    complainAt(name.empty() ? path_ : path_.member(name), std::move(message));
}

void FieldReader::complainAt(const JsonPath& path, std::string message) {
    if (!complaints_) {
        complaints_ = Complaint{path, std::move(message)};
    }
}

void FieldReader::complainAboutType(const JsonPath& path, const std::string& expected, const Value& found) {
    complainAt(path, "expected " + expected + ", found " + nameOfKind(found));
}

}  // namespace ktr::documents
