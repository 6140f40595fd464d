#include "server/answers/PhoneSetUp.h"

#include <openssl/evp.h>

#include <vector>

#include "platform/base/Json.h"

namespace ktr::server {

namespace {

/// OwnTracks' number for HTTP.
constexpr int kModeHttp = 3;

}  // namespace

PhoneSetUp PhoneSetUp::of(const std::string& origin, const std::string& user, const std::string& password) {
    PhoneSetUp setUp;
    setUp.url = origin + "/pub";
    setUp.user = user;
    setUp.password = password;
    setUp.origin_ = origin;
    return setUp;
}

std::string PhoneSetUp::link() const {
    const platform::Dictionary configuration{
        {"_type", "configuration"}, {"mode", kModeHttp},   {"url", url}, {"auth", true},
        {"username", user},         {"password", password}};
    return "owntracks:///config?inline=" + escapedBase64(platform::writeJson(configuration));
}

std::string PhoneSetUp::address() const {
    return origin_ + "/?id=" + password;
}

std::string escapedBase64(std::string_view bytes) {
    std::vector<unsigned char> coded((bytes.size() + 2) / 3 * 4 + 1);
    const int count = EVP_EncodeBlock(coded.data(), reinterpret_cast<const unsigned char*>(bytes.data()),
                                      static_cast<int>(bytes.size()));
    std::string text;
    for (int i = 0; i < count; ++i) {
        const char letter = static_cast<char>(coded[static_cast<std::size_t>(i)]);
        text += letter == '+' ? "%2B" : letter == '/' ? "%2F" : letter == '=' ? "%3D" : std::string(1, letter);
    }
    return text;
}

}  // namespace ktr::server
