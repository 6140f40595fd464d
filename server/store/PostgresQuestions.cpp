#include "server/store/PostgresQuestions.h"

#include <array>
#include <charconv>
#include <cstddef>

namespace ktr::server {

using Type = DatabaseValue::Type;

namespace {

const char* nameOf(Type type) {
    return type == Type::Integer ? "BIGINT"
           : type == Type::Real  ? "DOUBLE PRECISION"
           : type == Type::Text  ? "TEXT"
                                 : "BYTEA";
}

bool isDigit(char letter) {
    return letter >= '0' && letter <= '9';
}

template <class Number>
std::string digitsOf(Number number) {
    std::array<char, 32> digits;
    return {digits.data(), std::to_chars(digits.data(), digits.data() + digits.size(), number).ptr};
}

/// In quotes, as an element of an array.
std::string quoted(std::string_view text) {
    std::string all = "\"";
    for (const char letter : text) {
        if (letter == '"' || letter == '\\') {
            all += '\\';
        }
        all += letter;
    }
    return all + '"';
}

std::string hexadecimal(std::string_view bytes) {
    constexpr std::string_view kDigits = "0123456789abcdef";
    std::string text = "\\x";
    for (const char byte : bytes) {
        const auto value = static_cast<unsigned char>(byte);
        text += kDigits[value / 16];
        text += kDigits[value % 16];
    }
    return text;
}

std::string elementOf(const DatabaseValue& value) {
    if (value.isNone) {
        return "NULL";
    }
    switch (value.type) {
        case Type::Integer:
            return digitsOf(value.integer);
        case Type::Real:
            return digitsOf(value.real);
        case Type::Text:
            return quoted(value.text);
        case Type::Bytes:
            break;
    }
    return quoted(hexadecimal(value.text));
}

/// With "$1" as "asked.v1", and so on.
std::string ofAsked(std::string_view sql) {
    std::string text;
    for (std::size_t at = 0; at < sql.size(); ++at) {
        text += sql[at] == '$' && at + 1 < sql.size() && isDigit(sql[at + 1]) ? "asked.v" : std::string(1, sql[at]);
    }
    return text;
}

}  // namespace

PostgresQuestions::PostgresQuestions(std::string_view sql, const std::vector<const std::vector<DatabaseValue>*>& runs) {
    std::string arrays;
    std::string names;
    for (std::size_t column = 0; column < runs.front()->size(); ++column) {
        const std::string number = digitsOf(column + 1);
        arrays += (column == 0 ? "$" : ", $") + number + "::" + nameOf((*runs.front())[column].type) + "[]";
        names += "v" + number + ", ";
        std::string elements;
        for (const auto* values : runs) {
            elements += (elements.empty() ? "{" : ",") + elementOf((*values)[column]);
        }
        values_.push_back(DatabaseValue::of(Type::Text, elements + "}"));
    }
    // A query that sorts by itself is run for each of those asked, and its rows come as it sorts them.
    sql_ = "SELECT asked.number, answer.* FROM unnest(" + arrays + ") WITH ORDINALITY AS asked (" + names +
           "number) CROSS JOIN LATERAL (" + ofAsked(sql) + ") AS answer";
}

}  // namespace ktr::server
