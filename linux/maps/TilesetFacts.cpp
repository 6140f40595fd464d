#include "linux/maps/TilesetFacts.h"

#include <algorithm>
#include <array>
#include <charconv>
#include <cmath>
#include <numbers>

#include <QString>

#include "platform/base/Utf8.h"

namespace ktr::linux_ {

namespace {

constexpr int kLongestText = 120;

std::string valueOf(const std::map<std::string, std::string>& metadata, const std::string& name) {
    const auto found = metadata.find(name);
    return found == metadata.end() ? std::string() : found->second;
}

std::optional<int> levelOf(const std::string& text) {
    int level = -1;
    const auto [end, failure] = std::from_chars(text.data(), text.data() + text.size(), level);
    return failure == std::errc() && level >= 0 && level <= 30 ? std::optional(level) : std::nullopt;
}

double rowOf(double latitude) {
    const double radians = std::clamp(latitude, -85.05112877980659, 85.05112877980659) * std::numbers::pi / 180.0;
    return std::clamp(0.5 - std::asinh(std::tan(radians)) / (2.0 * std::numbers::pi), 0.0, 1.0);
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
    TilesetFacts::Bounds bounds{std::clamp(west / 360.0 + 0.5, 0.0, 1.0), rowOf(north),
                                std::clamp(east / 360.0 + 0.5, 0.0, 1.0), rowOf(south)};
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
    facts.attribution = plainText(valueOf(metadata, "attribution"));
    if (facts.attribution.empty()) {
        facts.attribution = plainText(valueOf(metadata, "name"));
    }
    if (facts.attribution.empty()) {
        facts.attribution = "Offline map";
    }
    return facts;
}

std::string TilesetFacts::plainText(std::string_view markup) {
    QString text;
    bool isTag = false;
    for (const QChar letter :
         QString::fromUtf8(markup.data(), static_cast<qsizetype>(std::min<std::size_t>(markup.size(), 4096)))) {
        if (letter == u'<') {
            isTag = true;
        } else if (letter == u'>' && isTag) {
            isTag = false;
            text += u' ';
        } else if (!isTag) {
            text += letter.isPrint() ? letter : QChar(u' ');
        }
    }
    static constexpr std::array<std::pair<const char16_t*, const char16_t*>, 8> kEntities = {{{u"&copy;", u"©"},
                                                                                              {u"&#169;", u"©"},
                                                                                              {u"&nbsp;", u" "},
                                                                                              {u"&quot;", u"\""},
                                                                                              {u"&#39;", u"'"},
                                                                                              {u"&lt;", u"<"},
                                                                                              {u"&gt;", u">"},
                                                                                              {u"&amp;", u"&"}}};
    for (const auto& [entity, character] : kEntities) {
        text.replace(QString::fromUtf16(entity), QString::fromUtf16(character));
    }
    return text.simplified().left(kLongestText).toStdString();
}

}  // namespace ktr::linux_
