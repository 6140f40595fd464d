#pragma once

#include <cstdint>
#include <string>

namespace ktr::server {

/// What goes into a database and comes out of it. Also none has a type: a server that prepares a statement asks for it.
/// A value.
struct DatabaseValue {
    enum class Type { Integer, Real, Text, Bytes };

    Type type = Type::Integer;
    bool isNone = true;
    std::int64_t integer = 0;
    double real = 0.0;
    std::string text;  ///< the bytes as well

    static DatabaseValue of(std::int64_t value) { return {Type::Integer, false, value, 0.0, {}}; }
    static DatabaseValue of(double value) { return {Type::Real, false, 0, value, {}}; }
    static DatabaseValue of(Type type, std::string text) { return {type, false, 0, 0.0, std::move(text)}; }
    static DatabaseValue none(Type type) { return {type, true, 0, 0.0, {}}; }
};

}  // namespace ktr::server
