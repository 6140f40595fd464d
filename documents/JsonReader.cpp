#include "documents/JsonReader.h"

#include <simdjson.h>

#include <algorithm>

#include "platform/base/Utf8.h"

namespace ktr::documents {

namespace {

namespace ondemand = simdjson::ondemand;
using platform::Dictionary;
using platform::Value;

const char* const kEndsEarly = "the text ends before its arrays and objects are closed";

JsonPosition positionAt(std::string_view text, std::size_t offset) {
    offset = std::min(offset, text.size());
    const std::string_view before = text.substr(0, offset);
    const std::size_t newline = before.rfind('\n');
    const std::size_t start = newline == std::string_view::npos ? 0 : newline + 1;
    JsonPosition position;
    position.line = 1 + static_cast<std::size_t>(std::count(before.begin(), before.end(), '\n'));
    position.column = 1 + platform::utf8Length(before.substr(start));
    return position;
}

/// What the first pass refuses concerns bytes and strings; it reports no place, so the place is searched here.
std::size_t offsetOfBadText(std::string_view text, simdjson::error_code error) {
    if (error == simdjson::UTF8_ERROR) {
        for (std::size_t at = 0; at < text.size();) {
            const platform::Utf8Step step = platform::decodeUtf8(text, at);
            if (!step.valid) {
                return at;
            }
            at += step.length;
        }
        return text.size();
    }
    std::optional<std::size_t> opened;
    for (std::size_t at = 0; at < text.size(); ++at) {
        const char c = text[at];
        if (c == '"') {
            opened = opened ? std::nullopt : std::optional(at);
        } else if (opened && c == '\\') {
            ++at;
        } else if (opened && static_cast<unsigned char>(c) < 0x20) {
            return error == simdjson::UNESCAPED_CHARS ? at : *opened;
        }
    }
    return opened.value_or(text.size());
}

std::string wordsFor(simdjson::error_code error) {
    switch (error) {
        case simdjson::UTF8_ERROR:
            return "the text is not UTF-8";
        case simdjson::UNESCAPED_CHARS:
            return "a control character inside a string";
        case simdjson::UNCLOSED_STRING:
            return "a string is not closed";
        case simdjson::EMPTY:
            return "expected a JSON object, found nothing";
        case simdjson::STRING_ERROR:
            return "a string with a broken escape";
        case simdjson::NUMBER_ERROR:
            return "not a number as JSON writes it";
        case simdjson::T_ATOM_ERROR:
        case simdjson::F_ATOM_ERROR:
        case simdjson::N_ATOM_ERROR:
            return "expected a value (true, false, null, a number, a string, an array or an object)";
        case simdjson::INCOMPLETE_ARRAY_OR_OBJECT:
            return "an array or an object is not closed";
        case simdjson::TRAILING_CONTENT:
            return "text after the end of the JSON value";
        default:
            return "broken JSON: a value, a comma, a colon or a closing bracket is missing or out of place";
    }
}

/// One pass over a document; stops at the first error.
class Pass {
  public:
    explicit Pass(std::string_view text) : text_(text), padded_(text) {}

    std::variant<Value, JsonError> run() {
        if (text_.size() > kLargestJson) {
            return JsonError{{}, {}, "the file is larger than 64 MiB"};
        }
        ondemand::parser parser;
        ondemand::document document;
        if (const auto error = parser.iterate(padded_).get(document)) {
            const bool inText = error == simdjson::UTF8_ERROR || error == simdjson::UNESCAPED_CHARS ||
                                error == simdjson::UNCLOSED_STRING;
            return JsonError{
                positionAt(text_, inText ? offsetOfBadText(text_, error) : text_.size()), {}, wordsFor(error)};
        }
        document_ = &document;
        Value root;
        const bool isRead = readRoot(document, root);
        document_ = nullptr;
        if (isRead) {
            return root;
        }
        return *error_;
    }

  private:
    bool readRoot(ondemand::document& document, Value& out) {
        ondemand::json_type type;
        if (const auto error = document.type().get(type)) {
            return fail(error);
        }
        ondemand::value root;
        if (type != ondemand::json_type::object && type != ondemand::json_type::array) {
            return failAt(0, "expected a JSON object");
        }
        if (const auto error = document.get_value().get(root)) {
            return fail(error);
        }
        if (!read(root, 1, out)) {
            return false;
        }
        const char* rest = nullptr;
        return document.current_location().get(rest) || failAt(offsetOf(rest), wordsFor(simdjson::TRAILING_CONTENT));
    }

    bool read(ondemand::value& value, std::size_t depth, Value& out) {
        start_ = offsetOf(value);
        ondemand::json_type type;
        if (const auto error = value.type().get(type)) {
            return failAt(start_, wordsFor(error));
        }
        switch (type) {
            case ondemand::json_type::array:
            case ondemand::json_type::object:
                if (depth > kDeepestJson) {
                    return failAt(start_, "nested more than 64 levels deep");
                }
                return type == ondemand::json_type::array ? readArray(value, depth, out)
                                                          : readObject(value, depth, out);
            case ondemand::json_type::string:
                return readString(value, out);
            case ondemand::json_type::number:
                return readNumber(value, out);
            case ondemand::json_type::boolean: {
                bool truth = false;
                if (value.get_bool().get(truth)) {
                    return failAt(start_, wordsFor(simdjson::T_ATOM_ERROR));
                }
                out = Value(truth);
                return true;
            }
            case ondemand::json_type::null: {
                bool isNull = false;
                if (value.is_null().get(isNull) != simdjson::SUCCESS || !isNull) {
                    return failAt(start_, wordsFor(simdjson::N_ATOM_ERROR));
                }
                out = Value();
                return true;
            }
        }
        return failAt(start_, wordsFor(simdjson::T_ATOM_ERROR));
    }

    bool readArray(ondemand::value& value, std::size_t depth, Value& out) {
        ondemand::array array;
        if (const auto error = value.get_array().get(array)) {
            return fail(error);
        }
        Value::Array elements;
        for (auto element : array) {
            path_.push(elements.size());
            ondemand::value item;
            if (const auto error = std::move(element).get(item)) {
                return fail(error);
            }
            if (!read(item, depth + 1, elements.emplace_back())) {
                return false;
            }
            path_.pop();
        }
        out = Value(std::move(elements));
        return true;
    }

    bool readObject(ondemand::value& value, std::size_t depth, Value& out) {
        ondemand::object object;
        if (const auto error = value.get_object().get(object)) {
            return fail(error);
        }
        Dictionary members;
        for (auto entry : object) {
            ondemand::field field;
            if (const auto error = std::move(entry).get(field)) {
                return fail(error);
            }
            std::string_view key;
            const char* keyStart = field.key().raw();
            if (const auto error = field.unescaped_key().get(key)) {
                return failAt(offsetOf(keyStart), wordsFor(error));
            }
            path_.push(std::string(key));
            if (members.contains(key)) {
                return failAt(offsetOf(keyStart) - 1, "this member is there already");
            }
            Value member;
            ondemand::value item = field.value();
            if (!read(item, depth + 1, member)) {
                return false;
            }
            members.set(std::get<std::string>(path_.steps().back()), std::move(member));
            path_.pop();
        }
        out = Value(std::move(members));
        return true;
    }

    bool readString(ondemand::value& value, Value& out) {
        std::string_view string;
        if (const auto error = value.get_string().get(string)) {
            return failAt(start_, wordsFor(error));
        }
        out = Value(std::string(string));
        return true;
    }

    bool readNumber(ondemand::value& value, Value& out) {
        ondemand::number number;
        if (value.get_number().get(number) == simdjson::SUCCESS) {
            if (number.is_int64()) {
                out = Value(number.get_int64());
            } else {
                out = Value(number.as_double());
            }
            return true;
        }
        if (text_.find_first_of(",]} \t\r\n", start_) == std::string_view::npos) {
            return failAt(text_.size(), kEndsEarly);
        }
        double real = 0.0;
        if (value.get_double().get(real)) {
            return failAt(start_, wordsFor(simdjson::NUMBER_ERROR));
        }
        out = Value(real);
        return true;
    }

    std::size_t offsetOf(ondemand::value& value) const { return offsetOf(value.raw_json_token().data()); }
    std::size_t offsetOf(const char* token) const { return static_cast<std::size_t>(token - padded_.data()); }

    bool fail(simdjson::error_code error) {
        const char* here = nullptr;
        const bool known = document_->current_location().get(here) == simdjson::SUCCESS;
        const std::size_t offset = known ? offsetOf(here) : text_.size();
        const bool ended = text_.find_first_not_of(" \t\r\n", offset) == std::string_view::npos;
        return failAt(offset, ended ? kEndsEarly : wordsFor(error));
    }
    bool failAt(std::size_t offset, std::string message) {
        error_ = JsonError{positionAt(text_, offset), path_, std::move(message)};
        return false;
    }

    std::string_view text_;
    simdjson::padded_string padded_;
    ondemand::document* document_ = nullptr;
    JsonPath path_;
    std::size_t start_ = 0;
    std::optional<JsonError> error_;
};

std::optional<ondemand::value> childOf(ondemand::value& value, const JsonPath::Step& step) {
    if (const auto* index = std::get_if<std::size_t>(&step)) {
        std::size_t at = 0;
        ondemand::array array;
        if (value.get_array().get(array)) {
            return std::nullopt;
        }
        for (auto element : array) {
            ondemand::value item;
            if (at++ == *index && !std::move(element).get(item)) {
                return item;
            }
        }
        return std::nullopt;
    }
    ondemand::object object;
    if (value.get_object().get(object)) {
        return std::nullopt;
    }
    for (auto entry : object) {
        ondemand::field field;
        std::string_view key;
        if (std::move(entry).get(field) || field.unescaped_key().get(key)) {
            return std::nullopt;
        }
        if (key == std::get<std::string>(step)) {
            return field.value();
        }
    }
    return std::nullopt;
}

}  // namespace

std::variant<Value, JsonError> JsonReader::read(std::string_view text) {
    return Pass(text).run();
}

JsonPosition JsonReader::locate(std::string_view text, const JsonPath& path) {
    const simdjson::padded_string padded(text);
    ondemand::parser parser;
    ondemand::document document;
    ondemand::value value;
    if (parser.iterate(padded).get(document) || document.get_value().get(value)) {
        return {};
    }
    for (const JsonPath::Step& step : path.steps()) {
        const auto child = childOf(value, step);
        if (!child) {
            return {};
        }
        value = *child;
    }
    return positionAt(text, static_cast<std::size_t>(value.raw_json_token().data() - padded.data()));
}

}  // namespace ktr::documents
