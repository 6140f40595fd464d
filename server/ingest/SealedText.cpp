#include "server/ingest/SealedText.h"

#include <sodium.h>

#include <algorithm>
#include <array>
#include <vector>

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

constexpr int kBase64 = sodium_base64_VARIANT_ORIGINAL;

}  // namespace

std::optional<std::string> SealedText::open(std::string_view sealed, std::string_view key) {
    const auto secret = keyOf(key);
    std::vector<unsigned char> bytes(sealed.size());
    std::size_t size = 0;
    if (!secret || ::sodium_base642bin(bytes.data(), bytes.size(), sealed.data(), sealed.size(), nullptr, &size,
                                       nullptr, kBase64) != 0) {
        return std::nullopt;
    }
    if (size < crypto_secretbox_NONCEBYTES + crypto_secretbox_MACBYTES) {
        return std::nullopt;
    }
    std::string plain(size - crypto_secretbox_NONCEBYTES - crypto_secretbox_MACBYTES, '\0');
    if (::crypto_secretbox_open_easy(reinterpret_cast<unsigned char*>(plain.data()),
                                     bytes.data() + crypto_secretbox_NONCEBYTES, size - crypto_secretbox_NONCEBYTES,
                                     bytes.data(), secret->data()) != 0) {
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
    std::string text(sodium_base64_encoded_len(bytes.size(), kBase64), '\0');
    ::sodium_bin2base64(text.data(), text.size(), bytes.data(), bytes.size(), kBase64);
    text.pop_back();  // the zero byte behind it
    return text;
}

}  // namespace ktr::server
