#include "server/http/BasicCredentials.h"

#include <openssl/crypto.h>
#include <openssl/evp.h>

#include <vector>

#include "server/http/HttpRequest.h"

namespace ktr::server {

namespace {

constexpr std::string_view kScheme = "Basic ";
constexpr std::size_t kLongest = 4096;

}  // namespace

std::optional<BasicCredentials> BasicCredentials::read(std::string_view header) {
    if (header.size() < kScheme.size() || header.size() > kLongest ||
        !equalIgnoringCase(header.substr(0, kScheme.size()), kScheme)) {
        return std::nullopt;
    }
    const std::string_view coded = header.substr(kScheme.size());
    const std::size_t padding = coded.ends_with("==") ? 2 : coded.ends_with("=") ? 1 : 0;
    // OpenSSL passes over blanks at either end and padding inside, which the standard does not allow.
    if (coded.empty() || coded.size() % 4 != 0 ||
        coded.substr(0, coded.size() - padding)
                .find_first_not_of("ABCDEFGHIJKLMNOPQRSTUVWXYZabcdefghijklmnopqrstuvwxyz0123456789+/") !=
            std::string_view::npos) {
        return std::nullopt;
    }
    std::string plain(coded.size() / 4 * 3, '\0');
    const int count =
        EVP_DecodeBlock(reinterpret_cast<unsigned char*>(plain.data()),
                        reinterpret_cast<const unsigned char*>(coded.data()), static_cast<int>(coded.size()));
    if (count < 0) {
        return std::nullopt;
    }
    // The length that it gives counts what the padding stands for.
    plain.resize(static_cast<std::size_t>(count) - padding);
    const std::size_t colon = plain.find(':');
    if (colon == std::string::npos) {
        return std::nullopt;
    }
    return BasicCredentials{plain.substr(0, colon), plain.substr(colon + 1)};
}

std::string BasicCredentials::header() const {
    const std::string plain = user + ":" + password;
    std::vector<unsigned char> coded((plain.size() + 2) / 3 * 4 + 1);
    const int count = EVP_EncodeBlock(coded.data(), reinterpret_cast<const unsigned char*>(plain.data()),
                                      static_cast<int>(plain.size()));
    return std::string(kScheme) + std::string(coded.begin(), coded.begin() + count);
}

bool sameSecret(std::string_view one, std::string_view other) {
    return one.size() == other.size() && CRYPTO_memcmp(one.data(), other.data(), one.size()) == 0;
}

}  // namespace ktr::server
