#include "server/ingest/SealedText.h"

#include <sodium.h>

#include <algorithm>
#include <array>
#include <vector>

#include "server/ingest/Base64.h"

namespace ktr::server {

namespace {

using Key = std::array<unsigned char, crypto_secretbox_KEYBYTES>;

std::optional<Key> keyOf(std::string_view text) {
    Key key{};
    if (text.empty() || text.size() > key.size() || ::sodium_init() < 0) {
        return std::nullopt;
    }
    std::copy(text.begin(), text.end(), key.begin());
    return key;
}

}  // namespace

std::optional<std::string> SealedText::open(std::string_view sealed, std::string_view key) {
    const auto secret = keyOf(key);
    const auto decoded = Base64::decode(sealed);
    if (!secret || !decoded || decoded->size() < crypto_secretbox_NONCEBYTES + crypto_secretbox_MACBYTES) {
        return std::nullopt;
    }
    const auto* bytes = reinterpret_cast<const unsigned char*>(decoded->data());
    std::string plain(decoded->size() - crypto_secretbox_NONCEBYTES - crypto_secretbox_MACBYTES, '\0');
    if (::crypto_secretbox_open_easy(reinterpret_cast<unsigned char*>(plain.data()),
                                     bytes + crypto_secretbox_NONCEBYTES, decoded->size() - crypto_secretbox_NONCEBYTES,
                                     bytes, secret->data()) != 0) {
        return std::nullopt;
    }
    return plain;
}

std::optional<std::string> SealedText::seal(std::string_view plain, std::string_view key) {
    const auto secret = keyOf(key);
    if (!secret) {
        return std::nullopt;
    }
    std::vector<unsigned char> bytes(crypto_secretbox_NONCEBYTES + crypto_secretbox_MACBYTES + plain.size());
    ::randombytes_buf(bytes.data(), crypto_secretbox_NONCEBYTES);
    if (::crypto_secretbox_easy(bytes.data() + crypto_secretbox_NONCEBYTES,
                                reinterpret_cast<const unsigned char*>(plain.data()), plain.size(), bytes.data(),
                                secret->data()) != 0) {
        return std::nullopt;
    }
    return Base64::encode({reinterpret_cast<const char*>(bytes.data()), bytes.size()});
}

}  // namespace ktr::server
