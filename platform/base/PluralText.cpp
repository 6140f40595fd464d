#include "platform/base/PluralText.h"

#include <algorithm>

#include "platform/base/PluralRules.h"

namespace ktr::platform {

namespace {

constexpr std::string_view kOther = "other";

std::string_view withoutBlanks(std::string_view text) {
    return text.substr(std::min(text.find_first_not_of(" \n"), text.size()));
}

}  // namespace

PluralRules::~PluralRules() = default;

std::optional<std::string_view> PluralText::branch(std::string_view text, std::string_view category) {
    if (!isPlural(text)) {
        return std::nullopt;
    }
    std::optional<std::string_view> chosen;
    std::optional<std::string_view> other;
    std::string_view rest = withoutBlanks(text.substr(kOpening.size()));
    while (!rest.starts_with('}')) {
        const auto opening = rest.find('{');
        const auto closing = rest.find_first_of("{}", opening == std::string_view::npos ? opening : opening + 1);
        if (closing == std::string_view::npos || rest[closing] != '}') {
            return std::nullopt;
        }
        const auto name = rest.substr(0, opening);
        const auto words = rest.substr(opening + 1, closing - opening - 1);
        if (name == category) {
            chosen = words;
        }
        if (name == kOther) {
            other = words;
        }
        rest = withoutBlanks(rest.substr(closing + 1));
    }
    if (rest.size() != 1 || !other) {
        return std::nullopt;
    }
    return chosen ? chosen : other;
}

}  // namespace ktr::platform
