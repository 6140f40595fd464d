#include <algorithm>
#include <cstddef>
#include <cstdint>
#include <string_view>

#include "documents/JsonReader.h"
#include "platform/base/Json.h"
#include "platform/base/Utf8.h"
#include "tests/fuzz/Require.h"

// Any bytes as JSON: read or refused with a place inside the text, and what was read is written and read again as the
// same value.

namespace {

using ktr::documents::JsonError;
using ktr::documents::JsonPath;
using ktr::documents::JsonPosition;
using ktr::documents::JsonReader;
using ktr::fuzz::require;
using ktr::platform::Value;

std::size_t depthOf(const Value& value) {
    std::size_t deepest = 0;
    if (const auto* elements = value.array()) {
        for (const Value& element : *elements) {
            deepest = std::max(deepest, depthOf(element));
        }
        return deepest + 1;
    }
    if (const auto* members = value.dictionary()) {
        for (const auto& [name, member] : *members) {
            deepest = std::max(deepest, depthOf(member));
        }
        return deepest + 1;
    }
    return 0;
}

/// The path to the last value of the last container of all.
JsonPath lastPath(const Value& root) {
    JsonPath path;
    const Value* at = &root;
    while (true) {
        if (const auto* elements = at->array(); elements != nullptr && !elements->empty()) {
            path.push(elements->size() - 1);
            at = &elements->back();
        } else if (const auto* members = at->dictionary(); members != nullptr && !members->empty()) {
            const auto& last = *(members->end() - 1);
            path.push(last.first);
            at = &last.second;
        } else {
            return path;
        }
    }
}

/// Whole reals read back as integers, and the sign of a zero is lost.
bool alike(const Value& one, const Value& other) {
    if (one.kind() == Value::Kind::Real) {
        return one.number() == other.number();
    }
    if (const auto* elements = one.array()) {
        const auto* others = other.array();
        return others != nullptr &&
               std::equal(elements->begin(), elements->end(), others->begin(), others->end(), alike);
    }
    if (const auto* members = one.dictionary()) {
        const auto* others = other.dictionary();
        return others != nullptr && std::equal(members->begin(), members->end(), others->begin(), others->end(),
                                               [](const auto& left, const auto& right) {
                                                   return left.first == right.first && alike(left.second, right.second);
                                               });
    }
    return one == other;
}

void requireInside(const JsonPosition& position, std::string_view text) {
    const auto lines = 1 + static_cast<std::size_t>(std::count(text.begin(), text.end(), '\n'));
    require(position.line >= 1 && position.line <= lines, "an error's line is one of the text's");
    require(position.column >= 1 && position.column <= text.size() + 1, "an error's column is one of the text's");
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    const std::string_view text(reinterpret_cast<const char*>(data), size);
    const auto read = JsonReader::read(text);
    if (const auto* error = std::get_if<JsonError>(&read)) {
        require(!error->message.empty(), "an error has words");
        require(ktr::platform::isValidUtf8(error->path.text()), "an error's path is UTF-8");
        requireInside(error->position, text);
        return 0;
    }
    const auto& value = std::get<Value>(read);
    require(depthOf(value) <= ktr::documents::kDeepestJson, "nothing is nested deeper than the limit");
    requireInside(JsonReader::locate(text, lastPath(value)), text);
    const std::string written = ktr::platform::writeJson(value);
    const auto again = JsonReader::read(written);
    require(std::holds_alternative<Value>(again), "what is written can be read");
    require(alike(value, std::get<Value>(again)), "what is written reads as the same value");
    return 0;
}
