#include "linux/configuration/ConfigurationReader.h"

#include <QByteArray>
#include <QJsonArray>
#include <QJsonDocument>
#include <QJsonObject>
#include <QUrl>
#include <algorithm>
#include <cerrno>
#include <cmath>
#include <cstring>
#include <fstream>
#include <functional>
#include <sstream>

namespace ktr::linux_ {

namespace {

constexpr std::size_t kLargestFile = std::size_t{1} << 20;

std::string nameOfType(const QJsonValue& value) {
    switch (value.type()) {
        case QJsonValue::Null:
            return "null";
        case QJsonValue::Bool:
            return "true or false";
        case QJsonValue::Double:
            return "a number";
        case QJsonValue::String:
            return "a text";
        case QJsonValue::Array:
            return "a list";
        case QJsonValue::Object:
            return "an object";
        case QJsonValue::Undefined:
            break;
    }
    return "nothing";
}

/// The members of one object. The first complaint is kept; reading goes on with defaults.
class Members {
  public:
    Members(QJsonObject object, std::string path, std::string& complaint)
        : object_(std::move(object)), path_(std::move(path)), complaint_(complaint) {}

    std::optional<std::string> text(const char* name) {
        const QJsonValue value = find(name);
        if (value.isUndefined()) {
            return std::nullopt;
        }
        if (!value.isString()) {
            expected(name, "a text", value);
            return std::nullopt;
        }
        const std::string found = value.toString().toStdString();
        if (found.empty()) {
            complain(name, "expected a text that is not empty");
            return std::nullopt;
        }
        const bool control = std::any_of(found.begin(), found.end(),
                                         [](char c) { return static_cast<unsigned char>(c) < 0x20 || c == 0x7F; });
        if (control) {
            complain(name, "expected a text without control characters");
            return std::nullopt;
        }
        return found;
    }

    bool boolean(const char* name, bool otherwise) {
        const QJsonValue value = find(name);
        if (!value.isUndefined() && !value.isBool()) {
            expected(name, "true or false", value);
        }
        return value.toBool(otherwise);
    }

    int whole(const char* name, int otherwise, int least, int most) {
        const QJsonValue value = find(name);
        if (value.isUndefined()) {
            return otherwise;
        }
        const double number = value.toDouble(std::nan(""));
        if (!(number >= least && number <= most) || std::floor(number) != number) {
            complain(name, "expected a whole number from " + std::to_string(least) + " to " + std::to_string(most));
            return otherwise;
        }
        return static_cast<int>(number);
    }

    std::vector<std::string> texts(const char* name) {
        const QJsonValue value = find(name);
        std::vector<std::string> found;
        if (value.isUndefined()) {
            return found;
        }
        if (!value.isArray()) {
            expected(name, "a list of texts", value);
            return found;
        }
        const QJsonArray list = value.toArray();
        for (qsizetype i = 0; i < list.size(); ++i) {
            const std::string element = std::string(name) + "[" + std::to_string(i) + "]";
            if (!list[i].isString() || list[i].toString().isEmpty()) {
                complain(element.c_str(), "expected a text, found " + nameOfType(list[i]));
            } else {
                found.push_back(list[i].toString().toStdString());
            }
        }
        return found;
    }

    /// Reads each object of a list.
    void objects(const char* name, const std::function<void(Members&)>& read) {
        const QJsonValue value = find(name);
        if (value.isUndefined()) {
            return;
        }
        if (!value.isArray()) {
            expected(name, "a list of objects", value);
            return;
        }
        const QJsonArray list = value.toArray();
        for (qsizetype i = 0; i < list.size(); ++i) {
            const std::string element = std::string(name) + "[" + std::to_string(i) + "]";
            if (!list[i].isObject()) {
                expected(element.c_str(), "an object", list[i]);
                continue;
            }
            Members inner(list[i].toObject(), path_ + "." + element, complaint_);
            read(inner);
        }
    }

    bool object(const char* name, const std::function<void(Members&)>& read) {
        const QJsonValue value = find(name);
        if (value.isUndefined()) {
            return false;
        }
        if (!value.isObject()) {
            expected(name, "an object", value);
            return false;
        }
        Members inner(value.toObject(), path_ + "." + name, complaint_);
        read(inner);
        return true;
    }

    void complain(const char* name, const std::string& message) {
        if (complaint_.empty()) {
            complaint_ = path_ + "." + name + ": " + message;
        }
    }

  private:
    /// A member that is null counts as absent.
    QJsonValue find(const char* name) const {
        const QJsonValue value = object_.value(QLatin1String(name));
        return value.isNull() ? QJsonValue(QJsonValue::Undefined) : value;
    }
    void expected(const char* name, const std::string& what, const QJsonValue& found) {
        complain(name, "expected " + what + ", found " + nameOfType(found));
    }

    QJsonObject object_;
    std::string path_;
    std::string& complaint_;
};

std::string resolved(const std::string& path, const std::filesystem::path& file) {
    const std::filesystem::path folder = std::filesystem::absolute(file).parent_path();
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

void readAccount(Members& members, const std::filesystem::path& file, Configuration& configuration) {
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
    if (account.host && !isHost(*account.host)) {
        members.complain("host", "expected a host such as \"friends.example\" or \"localhost:8443\", found \"" +
                                     *account.host + "\"");
    }
    account.domains = members.texts("domains");
    if (auto token = members.text("tokenFile")) {
        account.tokenFile = resolved(*token, file);
    }
    configuration.account = std::move(account);
}

void readPositions(Members& members, const std::filesystem::path& file, Configuration::Positions& positions) {
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
        members.complain("source",
                         "expected one of \"geoclue\", \"gpsd\", \"track\", \"none\", found \"" + source + "\"");
    }
    if (auto track = members.text("file")) {
        positions.file = resolved(*track, file);
    } else if (positions.source == Source::Track) {
        members.complain("file", "expected a GPX file or a scenario for the source \"track\", found nothing");
    }
    positions.gpsdHost = members.text("host").value_or(positions.gpsdHost);
    positions.gpsdPort = members.whole("port", positions.gpsdPort, 1, 65535);
}

/// Where tiles come from: https, a host without a name or password, and a place for each of a tile's numbers.
bool isTileUrl(const std::string& text) {
    QString address = QString::fromStdString(text);
    for (const char16_t* number : {u"{z}", u"{x}", u"{y}"}) {
        const QString part = QString::fromUtf16(number);
        if (address.count(part) != 1) {
            return false;
        }
        address.replace(part, QStringLiteral("0"));
    }
    const QUrl url(address, QUrl::StrictMode);
    // The host is not what the numbers may choose.
    return url.isValid() && url.scheme() == QLatin1String("https") && !url.host().isEmpty() &&
           url.userInfo().isEmpty() && !url.hasFragment() && text.find('{') > text.find('/', sizeof("https://"));
}

void readMapSource(Members& members, const std::filesystem::path& file, Configuration::Maps& maps) {
    Configuration::Maps::Source source;
    if (auto path = members.text("file")) {
        source.file = resolved(*path, file);
    }
    source.url = members.text("url").value_or("");
    if (source.file.empty() == source.url.empty()) {
        members.complain("file", "expected either a file or a url");
    }
    if (!source.url.empty() && !isTileUrl(source.url)) {
        members.complain("url",
                         "expected an https address with {z}, {x} and {y} in its path, found \"" + source.url + "\"");
    }
    source.attribution = members.text("attribution");
    if (!source.url.empty() && !source.attribution) {
        members.complain("attribution", "expected what the owner of the tiles wants to be shown, found nothing");
    }
    source.coarsest = members.whole("coarsest", source.coarsest, 0, 24);
    source.finest = members.whole("finest", source.finest, source.coarsest, 24);
    maps.sources.push_back(std::move(source));
}

void readMaps(Members& members, const std::filesystem::path& file, Configuration::Maps& maps) {
    members.objects("sources", [&](Members& source) { readMapSource(source, file, maps); });
    const std::string datum = members.text("datum").value_or("wgs84");
    if (datum == "gcj02") {
        maps.datum = Configuration::Maps::Datum::Gcj02;
    } else if (datum != "wgs84") {
        members.complain("datum", "expected one of \"wgs84\", \"gcj02\", found \"" + datum + "\"");
    }
    maps.cacheMegabytes = members.whole("cacheMegabytes", maps.cacheMegabytes, 1, 100000);
}

void readAll(Members& members, const std::filesystem::path& file, Configuration& configuration) {
    members.object("account", [&](Members& account) { readAccount(account, file, configuration); });
    for (const std::string& certificate : members.texts("certificates")) {
        configuration.certificates.push_back(resolved(certificate, file));
    }
    for (const std::string& contacts : members.texts("contacts")) {
        configuration.contacts.push_back(resolved(contacts, file));
    }
    configuration.language = members.text("language");
    configuration.geographicCountry = members.text("geographicCountry");
    if (configuration.geographicCountry) {
        const std::string& country = *configuration.geographicCountry;
        const bool letters = std::all_of(country.begin(), country.end(), [](char c) { return c >= 'A' && c <= 'Z'; });
        if (country.size() != 2 || !letters) {
            members.complain("geographicCountry", "expected two letters in upper case, found \"" + country + "\"");
        }
    }
    members.object("restrictions", [&](Members& restrictions) {
        configuration.friendLocationRestricted = restrictions.boolean("friendLocationRestricted", false);
        configuration.friendLocationAllowed = restrictions.boolean("friendLocationAllowed", true);
    });
    members.object("positions", [&](Members& positions) { readPositions(positions, file, configuration.positions); });
    members.object("maps", [&](Members& maps) { readMaps(maps, file, configuration.maps); });
}

std::string placeOf(const std::string& text, int offset) {
    const auto end = text.begin() + std::clamp<std::ptrdiff_t>(offset, 0, static_cast<std::ptrdiff_t>(text.size()));
    const auto line = std::count(text.begin(), end, '\n') + 1;
    const auto start = std::find(std::make_reverse_iterator(end), text.rend(), '\n').base();
    return std::to_string(line) + ":" + std::to_string(end - start + 1);
}

}  // namespace

std::variant<Configuration, ConfigurationReader::Error> ConfigurationReader::readFile(
    const std::filesystem::path& file) {
    std::error_code missing;
    if (std::filesystem::status(file, missing).type() == std::filesystem::file_type::not_found) {
        return Configuration{};
    }
    std::ifstream stream(file, std::ios::binary);
    std::string text(kLargestFile + 1, '\0');
    errno = 0;
    stream.read(text.data(), static_cast<std::streamsize>(text.size()));
    if (!stream.is_open() || stream.bad()) {
        const int reason = errno != 0 ? errno : EIO;
        return Error{file.string() + ": cannot be read: " + std::strerror(reason)};
    }
    text.resize(static_cast<std::size_t>(stream.gcount()));
    if (text.size() > kLargestFile) {
        return Error{file.string() + ": expected at most 1 MiB"};
    }
    return readText(text, file);
}

std::variant<Configuration, ConfigurationReader::Error> ConfigurationReader::readText(
    const std::string& text, const std::filesystem::path& file) {
    QJsonParseError parsing;
    const QJsonDocument document = QJsonDocument::fromJson(QByteArray::fromStdString(text), &parsing);
    if (parsing.error != QJsonParseError::NoError) {
        return Error{file.string() + ":" + placeOf(text, parsing.offset) + ": " + parsing.errorString().toStdString()};
    }
    if (!document.isObject()) {
        return Error{file.string() + ": $: expected an object, found a list"};
    }
    Configuration configuration;
    std::string complaint;
    Members members(document.object(), "$", complaint);
    readAll(members, file, configuration);
    if (!complaint.empty()) {
        return Error{file.string() + ": " + complaint};
    }
    return configuration;
}

}  // namespace ktr::linux_
