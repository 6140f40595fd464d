#include "documents/NearestName.h"

#include <algorithm>

#include "documents/Words.h"
#include "platform/base/Utf8.h"

namespace ktr::documents {

namespace {

/// Nobody means a short name with a longer word; it also bounds the work.
constexpr std::size_t kLongestWord = 64;

/// Optimal string alignment distance.
std::size_t slipsBetween(const std::string& a, const std::string& b) {
    std::vector<std::size_t> twoAbove(b.size() + 1);
    std::vector<std::size_t> above(b.size() + 1);
    std::vector<std::size_t> row(b.size() + 1);
    for (std::size_t j = 0; j <= b.size(); ++j) {
        above[j] = j;
    }
    for (std::size_t i = 1; i <= a.size(); ++i) {
        row[0] = i;
        for (std::size_t j = 1; j <= b.size(); ++j) {
            const std::size_t change = a[i - 1] == b[j - 1] ? 0 : 1;
            row[j] = std::min({above[j] + 1, row[j - 1] + 1, above[j - 1] + change});
            if (i > 1 && j > 1 && a[i - 1] == b[j - 2] && a[i - 2] == b[j - 1]) {
                row[j] = std::min(row[j], twoAbove[j - 2] + 1);
            }
        }
        std::swap(twoAbove, above);
        std::swap(above, row);
    }
    return above[b.size()];
}

}  // namespace

std::optional<std::string> nearestName(std::string_view word, const std::vector<std::string>& names) {
    if (word.empty() || word.size() > kLongestWord) {
        return std::nullopt;
    }
    const std::string asked = platform::asciiLowercased(word);
    std::optional<std::string> nearest;
    std::size_t fewest = 0;
    for (const std::string& name : names) {
        const std::size_t allowed = std::max<std::size_t>(1, std::min(word.size(), name.size()) / 3);
        const std::size_t slips = slipsBetween(asked, platform::asciiLowercased(name));
        if (slips <= allowed && (!nearest || slips < fewest)) {
            nearest = name;
            fewest = slips;
        }
    }
    return nearest;
}

std::string didYouMean(std::string_view word, const std::vector<std::string>& names) {
    const auto nearest = nearestName(word, names);
    return nearest ? "; did you mean " + inQuotes(*nearest) + "?" : "";
}

}  // namespace ktr::documents
