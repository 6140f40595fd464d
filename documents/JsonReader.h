#pragma once

#include <cstddef>
#include <optional>
#include <string>
#include <string_view>
#include <variant>

#include "documents/JsonPath.h"
#include "platform/base/Value.h"

namespace ktr::documents {

/// Largest text that is read, bytes.
inline constexpr std::size_t kLargestJson = 64u << 20;
/// Deepest nesting of arrays and objects that is read.
inline constexpr std::size_t kDeepestJson = 64;

/// Line and column, both from 1; the column counts characters (code points), tabs as one.
struct JsonPosition {
    std::size_t line = 1;
    std::size_t column = 1;
    bool operator==(const JsonPosition&) const = default;
};

struct JsonError {
    JsonPosition position;
    JsonPath path;
    std::string message;
};

/// Strict JSON (RFC 8259) with UTF-8 checked, read into values. A member that occurs twice in one object is an error:
/// in a file that people write it is a slip. Whole numbers beyond 64 bits become reals. Any thread.
class JsonReader {
  public:
    static std::variant<platform::Value, JsonError> read(std::string_view text);
    /// Where the value at a path begins, in a text that `read` accepted; the text's start for a path that leads
    /// nowhere.
    static JsonPosition locate(std::string_view text, const JsonPath& path);
};

}  // namespace ktr::documents
