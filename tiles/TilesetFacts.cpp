#include "tiles/TilesetFacts.h"

#include <algorithm>
#include <array>
#include <charconv>
#include <cmath>

#include "platform/base/Utf8.h"
#include "platform/map/Mercator.h"

namespace ktr::tiles {

namespace {

constexpr int kLongestText = 120;
constexpr std::size_t kLongestMarkup = 4096;

std::string valueOf(const std::map<std::string, std::string>& metadata, const std::string& name) {
    const auto found = metadata.find(name);
    return found == metadata.end() ? std::string() : found->second;
}

std::optional<int> levelOf(const std::string& text) {
    int level = -1;
    const auto [end, failure] = std::from_chars(text.data(), text.data() + text.size(), level);
    return failure == std::errc() && level >= 0 && level <= 30 ? std::optional(level) : std::nullopt;
}

/// On the square of side 1, within it.
platform::Point placeOf(double latitude, double longitude) {
    const platform::Point point = platform::mercatorPoint({latitude, longitude});
    return {std::clamp(point.x, 0.0, 1.0), std::clamp(point.y, 0.0, 1.0)};
}

/// "west,south,east,north" in degrees.
std::optional<TilesetFacts::Bounds> boundsOf(const std::string& text) {
    std::array<double, 4> degrees{};
    const char* at = text.data();
    const char* const end = text.data() + text.size();
    for (std::size_t index = 0; index < degrees.size(); ++index) {
        while (at != end && (*at == ' ' || *at == ',')) {
            ++at;
        }
        const auto [after, failure] = std::from_chars(at, end, degrees[index]);
        if (failure != std::errc() || !std::isfinite(degrees[index])) {
            return std::nullopt;
        }
        at = after;
    }
    const auto [west, south, east, north] = degrees;
    const platform::Point first = placeOf(north, west);
    const platform::Point last = placeOf(south, east);
    TilesetFacts::Bounds bounds{first.x, first.y, last.x, last.y};
    const bool makesSense = bounds.left < bounds.right && bounds.top < bounds.bottom;
    return makesSense ? std::optional(bounds) : std::nullopt;
}

}  // namespace

TilesetFacts TilesetFacts::of(const std::map<std::string, std::string>& metadata) {
    TilesetFacts facts;
    facts.format = platform::asciiLowercased(valueOf(metadata, "format"));
    facts.coarsest = levelOf(valueOf(metadata, "minzoom"));
    facts.finest = levelOf(valueOf(metadata, "maxzoom"));
    facts.bounds = boundsOf(valueOf(metadata, "bounds"));
    facts.name = plainText(valueOf(metadata, "name"));
    facts.attribution = plainText(valueOf(metadata, "attribution"));
    if (facts.attribution.empty()) {
        facts.attribution = facts.name;
    }
    if (facts.attribution.empty()) {
        facts.attribution = "Offline map";
    }
    return facts;
}

namespace {

std::u32string lettersOf(std::string_view text) {
    std::u32string letters;
    for (std::size_t at = 0; at < text.size();) {
        const platform::Utf8Step step = platform::decodeUtf8(text, at);
        letters += step.codePoint;
        at += step.length;
    }
    return letters;
}

/// Characters that are no text: controls, invisible marks and directions, what is no character.
bool isPrintable(char32_t letter) {
    const bool isControl = letter < 0x20 || (letter >= 0x7F && letter < 0xA0);
    const bool isMark = letter == 0xAD || letter == 0x61C || (letter >= 0x200B && letter <= 0x200F) ||
                        (letter >= 0x2028 && letter <= 0x202E) || (letter >= 0x2060 && letter <= 0x206F) ||
                        letter == 0xFEFF || (letter >= 0xFFF9 && letter <= 0xFFFB);
    const bool isPrivate = (letter >= 0xE000 && letter <= 0xF8FF) || letter >= 0xE0000;
    return !isControl && !isMark && !isPrivate && (letter & 0xFFFE) != 0xFFFE;
}

std::string withoutTags(std::string_view markup) {
    std::string text;
    bool isTag = false;
    for (const char32_t letter : lettersOf(markup.substr(0, kLongestMarkup))) {
        if (letter == U'<') {
            isTag = true;
        } else if (letter == U'>' && isTag) {
            isTag = false;
            text += ' ';
        } else if (!isTag) {
            platform::appendUtf8(text, isPrintable(letter) ? letter : U' ');
        }
    }
    return text;
}

void replaceAll(std::string& text, std::string_view from, std::string_view to) {
    for (std::size_t at = text.find(from); at != std::string::npos; at = text.find(from, at + to.size())) {
        text.replace(at, from.size(), to);
    }
}

/// One blank between words, none around them, cut after so many characters.
std::string simplified(const std::string& text) {
    std::string simple;
    int length = 0;
    bool blank = false;
    for (const char32_t letter : lettersOf(text)) {
        if (letter == U' ' || letter == 0xA0 || letter == 0x3000) {
            blank = !simple.empty();
            continue;
        }
        const int wanted = blank ? 2 : 1;
        if (length + wanted > kLongestText) {
            break;
        }
        simple += blank ? " " : "";
        platform::appendUtf8(simple, letter);
        length += wanted;
        blank = false;
    }
    return simple;
}

}  // namespace

std::string TilesetFacts::plainText(std::string_view markup) {
    std::string text = withoutTags(markup);
    static constexpr std::array<std::pair<std::string_view, std::string_view>, 8> kEntities = {{{"&copy;", "©"},
                                                                                                {"&#169;", "©"},
                                                                                                {"&nbsp;", " "},
                                                                                                {"&quot;", "\""},
                                                                                                {"&#39;", "'"},
                                                                                                {"&lt;", "<"},
                                                                                                {"&gt;", ">"},
                                                                                                {"&amp;", "&"}}};
    for (const auto& [entity, character] : kEntities) {
        replaceAll(text, entity, character);
    }
    return simplified(text);
}

}  // namespace ktr::tiles
