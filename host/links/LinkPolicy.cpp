#include "host/links/LinkPolicy.h"

#include <QUrl>
#include <algorithm>
#include <string_view>

namespace ktr::host {

namespace {

/// A plugin writes a handle that it does not have as every absent object is written.
constexpr std::string_view kAbsent = "(null)";

/// What follows the beginning; schemes and hosts have no case (RFC 3986, 3.1 and 3.2.2). Null when it begins otherwise.
const char* after(const std::string& url, std::string_view beginning) {
    const auto lower = [](char c) { return c >= 'A' && c <= 'Z' ? static_cast<char>(c - 'A' + 'a') : c; };
    const bool begins = url.size() >= beginning.size() &&
                        std::equal(beginning.begin(), beginning.end(), url.begin(),
                                   [lower](char wanted, char found) { return wanted == lower(found); });
    return begins ? url.c_str() + beginning.size() : nullptr;
}

bool isText(const std::string& url) {
    const bool hasControl = std::any_of(url.begin(), url.end(), [](char c) {
        const auto byte = static_cast<unsigned char>(c);
        return byte < 0x20 || byte == 0x7F;
    });
    return !hasControl && QString::fromStdString(url).toStdString() == url;
}

bool isSecurePage(const std::string& url) {
    const QUrl page(QString::fromStdString(url), QUrl::StrictMode);
    return page.isValid() && page.scheme() == QLatin1String("https") && !page.host().isEmpty() &&
           page.userInfo().isEmpty();
}

}  // namespace

LinkPolicy::Target LinkPolicy::decide(const std::string& url, From from) {
    if (url.size() > kLongest || !isText(url)) {
        return Refused{};
    }
    if (const char* handle = after(url, "wayloc://friend/")) {
        return *handle == '\0' || handle == kAbsent ? Target(Self{}) : Target(Friend{handle});
    }
    for (const char* list : {"wayloc://friends/", "wayloc://friends"}) {
        if (const char* rest = after(url, list); rest != nullptr && *rest == '\0') {
            return Friends{};
        }
    }
    if (isSecurePage(url)) {
        return Elsewhere{url};
    }
    const bool isOfThePage = after(url, "geo:") || after(url, "tel:") || after(url, "mailto:");
    return from == From::FriendPage && isOfThePage ? Target(Elsewhere{url}) : Target(Refused{});
}

}  // namespace ktr::host
