#include "documents/JsonPath.h"

#include <algorithm>
#include <cctype>

#include "documents/Words.h"

namespace ktr::documents {

namespace {

/// A message is one line that somebody reads: longer names do not help.
constexpr std::size_t kLongestName = 60;

bool isIdentifier(const std::string& name) {
    return !name.empty() && std::all_of(name.begin(), name.end(),
                                        [](unsigned char c) { return std::isalnum(c) != 0 || c == '_' || c == '-'; });
}

}  // namespace

JsonPath JsonPath::member(std::string name) const {
    JsonPath path = *this;
    path.push(std::move(name));
    return path;
}

JsonPath JsonPath::element(std::size_t index) const {
    JsonPath path = *this;
    path.push(index);
    return path;
}

std::string JsonPath::text() const {
    std::string text = "$";
    for (const Step& step : steps_) {
        if (const auto* index = std::get_if<std::size_t>(&step)) {
            text += "[" + std::to_string(*index) + "]";
            continue;
        }
        const auto& name = std::get<std::string>(step);
        if (isIdentifier(name) && name.size() <= kLongestName) {
            text += "." + name;
        } else {
            text += "[" + inQuotes(name, kLongestName) + "]";
        }
    }
    return text;
}

}  // namespace ktr::documents
