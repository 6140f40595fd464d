#include "linux/net/Origin.h"

#include <libpsl.h>

#include <QHostAddress>
#include <QString>
#include <QUrl>

namespace ktr::linux_ {

namespace {
constexpr int kHttpsPort = 443;
}

std::optional<Origin> Origin::fromText(const std::string& text) {
    QUrl url;
    url.setScheme(QStringLiteral("https"));
    url.setAuthority(QString::fromStdString(text), QUrl::StrictMode);
    return fromUrl(url);
}

std::optional<Origin> Origin::fromUrl(const QUrl& url) {
    if (!url.isValid() || url.scheme() != QLatin1String("https") || !url.userInfo().isEmpty() ||
        url.authority().contains(QLatin1Char('@'))) {
        return std::nullopt;
    }
    Origin origin;
    origin.host = url.host(QUrl::FullyEncoded).toLower().toStdString();
    origin.port = url.port(kHttpsPort);
    if (origin.host.ends_with('.')) {
        origin.host.pop_back();
    }
    if (origin.host.empty() || origin.port <= 0) {
        return std::nullopt;
    }
    return origin;
}

std::string Origin::text() const {
    const std::string shown = host.find(':') != std::string::npos ? "[" + host + "]" : host;
    return port == kHttpsPort ? shown : shown + ":" + std::to_string(port);
}

bool Origin::isAddress() const {
    return !QHostAddress(QString::fromStdString(host)).isNull();
}

std::optional<std::string> Origin::registrableDomain() const {
    const psl_ctx_t* list = psl_builtin();
    if (isAddress() || list == nullptr || host.find('.') == std::string::npos) {
        return std::nullopt;
    }
    const char* domain = psl_registrable_domain(list, host.c_str());
    return domain != nullptr ? std::optional<std::string>(domain) : std::nullopt;
}

bool Origin::isPublicSuffix() const {
    const psl_ctx_t* list = psl_builtin();
    // By the list's last rule any name of one label would be one, and so would a machine of the local network.
    return list != nullptr && !isAddress() &&
           psl_is_public_suffix2(list, host.c_str(), PSL_TYPE_ANY | PSL_TYPE_NO_STAR_RULE) != 0;
}

}  // namespace ktr::linux_
