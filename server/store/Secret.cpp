#include "server/store/Secret.h"

#include <openssl/rand.h>
#include <openssl/sha.h>

#include <array>
#include <cstdint>

namespace ktr::server {

std::optional<std::string> Secret::make() {
    // Five bits a letter: 26 letters hold 130.
    constexpr std::string_view kLetters = "abcdefghijkmnpqrstuvwxyz23456789";
    static_assert(kLetters.size() == 32);
    std::array<std::uint8_t, 26> bytes{};
    if (RAND_bytes(bytes.data(), static_cast<int>(bytes.size())) != 1) {
        return std::nullopt;
    }
    std::string secret;
    for (const std::uint8_t byte : bytes) {
        secret += kLetters[byte % kLetters.size()];
    }
    return secret;
}

std::int64_t Secret::number() {
    std::uint64_t bits = 0;
    if (RAND_bytes(reinterpret_cast<unsigned char*>(&bits), static_cast<int>(sizeof bits)) != 1) {
        return 0;
    }
    return static_cast<std::int64_t>(bits >> 2) | 1;
}

std::string Secret::hash(std::string_view secret) {
    std::string hash(SHA256_DIGEST_LENGTH, '\0');
    SHA256(reinterpret_cast<const unsigned char*>(secret.data()), secret.size(),
           reinterpret_cast<unsigned char*>(hash.data()));
    return hash;
}

}  // namespace ktr::server
