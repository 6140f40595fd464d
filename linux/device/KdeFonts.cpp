#include "linux/device/KdeFonts.h"

#include <algorithm>
#include <charconv>
#include <cmath>
#include <string_view>
#include <utility>
#include <variant>

#include "documents/FileReader.h"

namespace ktr::linux_ {

namespace {

constexpr std::size_t kLargestFile = std::size_t{1} << 20;
constexpr double kUsualPoints = 10.0;
constexpr double kUsualResolution = 96.0;
/// Beyond these, somebody has made a mistake.
constexpr double kLeast = 0.25;
constexpr double kMost = 8.0;

/// The value of a key of the group [General]; empty without one.
std::string_view generalValue(std::string_view text, std::string_view key) {
    bool isGeneral = false;
    while (!text.empty()) {
        const std::string_view line = text.substr(0, text.find('\n'));
        text.remove_prefix(std::min(line.size() + 1, text.size()));
        if (line.starts_with('[')) {
            isGeneral = line.starts_with("[General]");
        } else if (isGeneral && line.starts_with(key) && line.substr(key.size()).starts_with('=')) {
            return line.substr(key.size() + 1);
        }
    }
    return {};
}

std::optional<double> positiveNumber(std::string_view text) {
    double number = 0.0;
    const auto [stop, error] = std::from_chars(text.data(), text.data() + text.size(), number);
    return error == std::errc() && std::isfinite(number) && number > 0.0 ? std::optional(number) : std::nullopt;
}

/// A file that is not there says nothing, and neither does what is no plain file, or too large.
std::string contentOf(const std::filesystem::path& file) {
    auto read = documents::FileReader::read(file, {kLargestFile, {}});
    auto* text = std::get_if<std::string>(&read);
    return text == nullptr ? "" : std::move(*text);
}

}  // namespace

std::optional<double> KdeFonts::textScale(const std::filesystem::path& folder) {
    return textScale(contentOf(folder / kFiles[0]), contentOf(folder / kFiles[1]));
}

std::optional<double> KdeFonts::textScale(const std::string& globals, const std::string& fonts) {
    // "Noto Sans,12,-1,5,50,...": family and points, which are negative for a size in pixels.
    const std::string_view font = generalValue(globals, "font");
    const std::size_t comma = font.find(',');
    const auto points = comma == std::string_view::npos ? std::nullopt : positiveNumber(font.substr(comma + 1));
    const auto resolution = positiveNumber(generalValue(fonts, "forceFontDPI"));
    if (!points && !resolution) {
        return std::nullopt;
    }
    const double scale =
        points.value_or(kUsualPoints) / kUsualPoints * resolution.value_or(kUsualResolution) / kUsualResolution;
    return scale >= kLeast && scale <= kMost ? std::optional(scale) : std::nullopt;
}

}  // namespace ktr::linux_
