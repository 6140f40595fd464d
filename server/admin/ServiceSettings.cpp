#include "server/admin/ServiceSettings.h"

#include <arpa/inet.h>
#include <sys/stat.h>

#include <algorithm>
#include <array>

#include "documents/AtomicFile.h"
#include "documents/DocumentReader.h"
#include "documents/FileTrust.h"
#include "platform/base/Json.h"

namespace ktr::server {

namespace {

constexpr std::size_t kLargest = 65536;
/// Of HTTPS: nobody writes it.
constexpr int kStandardPort = 443;

bool isAddress(const std::string& host, int family) {
    std::array<unsigned char, 16> bytes{};
    return ::inet_pton(family, host.c_str(), bytes.data()) == 1;
}

bool isPath(const std::string& text) {
    return text.front() == '/';
}

std::string fileOf(const std::string& folder) {
    return folder + "/settings.json";
}

}  // namespace

bool ServiceSettings::isHost(const std::string& text) {
    if (isAddress(text, AF_INET) || isAddress(text, AF_INET6)) {
        return true;
    }
    return !text.empty() && text.size() <= 253 && text.front() != '-' && text.front() != '.' &&
           std::all_of(text.begin(), text.end(), [](char c) {
               return (c >= 'a' && c <= 'z') || (c >= 'A' && c <= 'Z') || (c >= '0' && c <= '9') || c == '-' ||
                      c == '.';
           });
}

std::optional<ServiceSettings> ServiceSettings::read(const std::string& folder, std::string& complaint) {
    ServiceSettings settings;
    const auto refusal = [&](const struct stat& facts) {
        return documents::FileTrust::problemOf(fileOf(folder), facts);
    };
    const auto read = [&](documents::FieldReader& fields) {
        settings.host = fields.text("host").value_or("");
        settings.port = fields.whole("port", 0, 65535).value_or(settings.port);
        if (!isHost(settings.host)) {
            fields.complain("host", "expected a host name or an address");
        }
        settings.maps = fields.texts("maps");
        if (std::any_of(settings.maps.begin(), settings.maps.end(),
                        [](const std::string& map) { return !isPath(map); })) {
            fields.complain("maps", "expected whole paths of files, such as /srv/maps/region.mbtiles");
        }
        settings.store = fields.text("store").value_or("");
        if (!settings.store.empty() && !StoreAddress::isServer(settings.store)) {
            fields.complain("store", "expected an address such as postgresql:///ktr");
        }
    };
    const auto error = documents::DocumentReader::readFile(fileOf(folder), {kLargest, refusal}, read, nullptr);
    if (error) {
        complaint = error->text();
        return std::nullopt;
    }
    return settings;
}

std::string ServiceSettings::write(const std::string& folder) const {
    platform::Dictionary fields{{"host", host}, {"port", port}};
    if (!store.empty()) {
        fields.set("store", store);
    }
    if (!maps.empty()) {
        fields.set("maps", platform::Value::Array(maps.begin(), maps.end()));
    }
    return documents::AtomicFile::write(fileOf(folder), platform::writeJson(fields) + "\n", 0600);
}

std::string ServiceSettings::stateOf(const std::string& folder) {
    struct stat facts {};
    if (::stat(fileOf(folder).c_str(), &facts) != 0) {
        return "";
    }
    return std::to_string(facts.st_ino) + " " + std::to_string(facts.st_size) + " " +
           std::to_string(facts.st_mtim.tv_sec) + " " + std::to_string(facts.st_mtim.tv_nsec);
}

PlaceNames::Setup ServiceSettings::names() const {
    return {maps, {}, {}};
}

StoreAddress ServiceSettings::storeAddress(const std::string& folder) const {
    return {store.empty() ? folder : store};
}

std::string ServiceSettings::origin() const {
    const std::string name = isAddress(host, AF_INET6) ? "[" + host + "]" : host;
    return "https://" + name + (port == kStandardPort ? std::string() : ":" + std::to_string(port));
}

std::string ServiceSettings::alternativeName() const {
    return (isAddress(host, AF_INET) || isAddress(host, AF_INET6) ? "IP:" : "DNS:") + host;
}

std::string ServiceSettings::constraint() const {
    if (isAddress(host, AF_INET)) {
        return "critical,permitted;IP:" + host + "/255.255.255.255";
    }
    if (isAddress(host, AF_INET6)) {
        return "critical,permitted;IP:" + host + "/FFFF:FFFF:FFFF:FFFF:FFFF:FFFF:FFFF:FFFF";
    }
    return "critical,permitted;DNS:" + host;
}

}  // namespace ktr::server
