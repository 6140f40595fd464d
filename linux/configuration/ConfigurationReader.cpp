#include "linux/configuration/ConfigurationReader.h"

#include <algorithm>
#include <cctype>
#include <string_view>

#include "documents/DocumentReader.h"
#include "documents/FileSteps.h"
#include "documents/FileTrust.h"
#include "documents/Words.h"
#include "linux/configuration/XdgFolders.h"
#include "linux/device/LinuxDevice.h"

namespace ktr::linux_ {

namespace {

using documents::FieldReader;

constexpr std::size_t kLargestFile = std::size_t{1} << 20;

std::string resolved(const std::string& path, const std::filesystem::path& file) {
    // As people write it, and a shell does not replace it within quotes.
    if (path == "~") {
        return XdgFolders::home().string();
    }
    if (path.starts_with("~/")) {
        return (XdgFolders::home() / path.substr(2)).lexically_normal().string();
    }
    const std::filesystem::path folder = documents::FileSteps::absolute(file).parent_path();
    return (folder / path).lexically_normal().string();
}

/// A name or an address (IPv6 in brackets) with an optional port, and nothing of a URL around it.
bool isHost(const std::string& host) {
    if (host.find_first_of("/@?# \\") != std::string::npos) {
        return false;
    }
    const std::size_t close = host.rfind(']');
    const std::size_t colon = host.find(':', close == std::string::npos ? 0 : close);
    if (close != std::string::npos && host.front() != '[') {
        return false;
    }
    if (colon == std::string::npos) {
        return true;
    }
    const std::string port = host.substr(colon + 1);
    return colon > 0 && !port.empty() && port.size() <= 5 &&
           port.find_first_not_of("0123456789") == std::string::npos && std::stoi(port) >= 1 &&
           std::stoi(port) <= 65535;
}

void readAccount(FieldReader& members, const std::filesystem::path& file, Configuration& configuration) {
    Configuration::Account account;
    if (auto person = members.text("personId")) {
        account.personId = *person;
        // The user name of the service's credentials ends at the first colon.
        if (person->find(':') != std::string::npos) {
            members.complain("personId", "expected a text without \":\"");
        }
    } else {
        members.complain("personId", "expected the person identifier that the service knows, found nothing");
    }
    account.userName = members.text("userName");
    account.host = members.text("host");
    account.assistant = members.text("assistant");
    for (const auto& [name, host] : {std::pair("host", account.host), std::pair("assistant", account.assistant)}) {
        if (host && !isHost(*host)) {
            members.complain(name, "expected a host such as \"friends.example\" or \"localhost:8443\", found " +
                                       documents::inQuotes(*host));
        }
    }
    if (const auto* listed = members.member("domains"); listed != nullptr && !listed->isNull()) {
        account.domains = members.texts("domains");
    }
    if (auto token = members.text("tokenFile")) {
        account.tokenFile = resolved(*token, file);
    }
    configuration.account = std::move(account);
}

void readPositions(FieldReader& members, const std::filesystem::path& file, Configuration::Positions& positions) {
    using Source = Configuration::Positions::Source;
    const std::string source = members.text("source").value_or("geoclue");
    if (source == "none") {
        positions.source = Source::None;
    } else if (source == "geoclue") {
        positions.source = Source::GeoClue;
    } else if (source == "gpsd") {
        positions.source = Source::Gpsd;
    } else if (source == "track") {
        positions.source = Source::Track;
    } else {
        members.complain("source", "expected one of \"geoclue\", \"gpsd\", \"track\", \"none\", found " +
                                       documents::inQuotes(source));
    }
    if (auto track = members.text("file")) {
        positions.file = resolved(*track, file);
    } else if (positions.source == Source::Track) {
        members.complain("file", "expected a GPX file or a scenario for the source \"track\", found nothing");
    }
    positions.gpsdHost = members.text("host").value_or(positions.gpsdHost);
    positions.gpsdPort = members.whole("port", 1, 65535).value_or(positions.gpsdPort);
}

/// Characters that a URL may have (RFC 3986), and letters of any script, which are escaped when it is asked for.
bool isOfUrlCharacters(const std::string& text) {
    for (std::size_t i = 0; i < text.size(); ++i) {
        const auto byte = static_cast<unsigned char>(text[i]);
        const auto isHex = [&](std::size_t at) {
            return at < text.size() && std::isxdigit(static_cast<unsigned char>(text[at])) != 0;
        };
        if (byte <= 0x20 || byte == 0x7F || std::string_view("\"<>\\^`{|}#").find(text[i]) != std::string_view::npos ||
            (byte == '%' && !(isHex(i + 1) && isHex(i + 2)))) {
            return false;
        }
    }
    return true;
}

/// Where tiles come from: https, a host without a name or password, and a place for each of a tile's numbers.
bool isTileUrl(const std::string& text) {
    constexpr std::string_view kScheme = "https://";
    const std::size_t path = text.find('/', kScheme.size());
    if (!text.starts_with(kScheme) || path == std::string::npos || path == kScheme.size()) {
        return false;
    }
    std::string rest = text.substr(path);
    for (const std::string number : {"{z}", "{x}", "{y}"}) {
        const std::size_t at = rest.find(number);
        if (at == std::string::npos) {
            return false;
        }
        rest.replace(at, number.size(), "0");
    }
    // The host is not what the numbers may choose; a number twice leaves braces behind.
    const std::string host = text.substr(kScheme.size(), path - kScheme.size());
    return isHost(host) && isOfUrlCharacters(host) && isOfUrlCharacters(rest);
}

void readMapSource(FieldReader& members, const std::filesystem::path& file, Configuration::Maps& maps) {
    Configuration::Maps::Source source;
    if (auto path = members.text("file")) {
        source.file = resolved(*path, file);
    }
    source.url = members.text("url").value_or("");
    if (source.file.empty() == source.url.empty()) {
        members.complain("file", "expected either a file or a url");
    }
    if (!source.url.empty() && !isTileUrl(source.url)) {
        members.complain("url", "expected an https address with {z}, {x} and {y} in its path, found " +
                                    documents::inQuotes(source.url, 200));
    }
    source.attribution = members.text("attribution");
    if (!source.url.empty() && !source.attribution) {
        members.complain("attribution", "expected what the owner of the tiles wants to be shown, found nothing");
    }
    source.coarsest = members.whole("coarsest", 0, 24).value_or(source.coarsest);
    source.finest = members.whole("finest", source.coarsest, 24).value_or(source.finest);
    maps.sources.push_back(std::move(source));
}

void readMaps(FieldReader& members, const std::filesystem::path& file, Configuration::Maps& maps) {
    members.objects("sources", [&](FieldReader& source) { readMapSource(source, file, maps); });
    const std::string datum = members.text("datum").value_or("wgs84");
    if (datum == "gcj02") {
        maps.datum = Configuration::Maps::Datum::Gcj02;
    } else if (datum != "wgs84") {
        members.complain("datum", "expected one of \"wgs84\", \"gcj02\", found " + documents::inQuotes(datum));
    }
    maps.cacheMegabytes = members.whole("cacheMegabytes", 1, 100000).value_or(maps.cacheMegabytes);
}

void readLook(FieldReader& members, Configuration& configuration) {
    using Colors = Configuration::Colors;
    using Distances = Configuration::Distances;
    const std::string colors = members.text("colors").value_or("system");
    if (colors == "light") {
        configuration.colors = Colors::Light;
    } else if (colors == "dark") {
        configuration.colors = Colors::Dark;
    } else if (colors == "high-contrast") {
        configuration.colors = Colors::HighContrast;
    } else if (colors != "system") {
        members.complain("colors", R"(expected one of "system", "light", "dark", "high-contrast", found )" +
                                       documents::inQuotes(colors));
    }
    const std::string distances = members.text("distances").value_or("system");
    if (distances == "kilometres") {
        configuration.distances = Distances::Kilometres;
    } else if (distances == "miles") {
        configuration.distances = Distances::Miles;
    } else if (distances != "system") {
        members.complain("distances",
                         R"(expected one of "system", "kilometres", "miles", found )" + documents::inQuotes(distances));
    }
}

void readAll(FieldReader& members, const std::filesystem::path& file, Configuration& configuration) {
    members.object("account", [&](FieldReader& account) { readAccount(account, file, configuration); });
    for (const std::string& certificate : members.texts("certificates")) {
        configuration.certificates.push_back(resolved(certificate, file));
    }
    for (const std::string& contacts : members.texts("contacts")) {
        configuration.contacts.push_back(resolved(contacts, file));
    }
    configuration.addressBooks = members.boolean("addressBooks").value_or(true);
    configuration.language = members.text("language");
    if (const auto size = members.text("textSize")) {
        configuration.textSize = LinuxDevice::categoryNamed(*size);
        if (!configuration.textSize) {
            members.complain("textSize",
                             "expected XS, S, M, L, XL, XXL, XXXL or AX1 to AX5, found " + documents::inQuotes(*size));
        }
    }
    readLook(members, configuration);
    configuration.geographicCountry = members.text("geographicCountry");
    if (configuration.geographicCountry) {
        const std::string& country = *configuration.geographicCountry;
        const bool letters = std::all_of(country.begin(), country.end(), [](char c) { return c >= 'A' && c <= 'Z'; });
        if (country.size() != 2 || !letters) {
            members.complain("geographicCountry",
                             "expected two letters in upper case, found " + documents::inQuotes(country));
        }
    }
    members.object("restrictions", [&](FieldReader& restrictions) {
        configuration.friendLocationRestricted = restrictions.boolean("friendLocationRestricted").value_or(false);
        configuration.friendLocationAllowed = restrictions.boolean("friendLocationAllowed").value_or(true);
    });
    members.object("positions",
                   [&](FieldReader& positions) { readPositions(positions, file, configuration.positions); });
    members.object("maps", [&](FieldReader& maps) { readMaps(maps, file, configuration.maps); });
}

using Read = std::variant<Configuration, ConfigurationReader::Error>;

ConfigurationReader::Error errorOf(const documents::DocumentError& error) {
    constexpr std::string_view kRoot = "$.";
    const std::string member = error.path.starts_with(kRoot) ? error.path.substr(kRoot.size()) : "";
    return {error.text(), (member.empty() ? "" : member + ": ") + error.message};
}

Read readOrError(const std::variant<std::string, documents::DocumentError>& text, const std::filesystem::path& file,
                 documents::DocumentWarnings* warnings) {
    if (const auto* error = std::get_if<documents::DocumentError>(&text)) {
        return error->isMissing ? Read(Configuration{}) : Read(errorOf(*error));
    }
    Configuration configuration;
    const auto error = documents::DocumentReader::readText(
        std::get<std::string>(text), file.string(),
        [&](FieldReader& members) { readAll(members, file, configuration); }, warnings);
    return error ? Read(errorOf(*error)) : Read(std::move(configuration));
}

}  // namespace

Read ConfigurationReader::readFile(const std::filesystem::path& file, documents::DocumentWarnings* warnings) {
    // It says where the app token goes.
    const auto refusal = [&](const struct stat& facts) { return documents::FileTrust::problemOf(file, facts); };
    return readOrError(documents::DocumentReader::textOf(file, {kLargestFile, refusal}), file, warnings);
}

Read ConfigurationReader::readText(const std::string& text, const std::filesystem::path& file,
                                   documents::DocumentWarnings* warnings) {
    return readOrError(text, file, warnings);
}

}  // namespace ktr::linux_
