#include "server/ingest/Base64.h"

#include <sodium.h>

namespace ktr::server {

namespace {

constexpr int kPadded = sodium_base64_VARIANT_ORIGINAL;

}  // namespace

std::string Base64::encode(std::string_view bytes) {
    std::string text(sodium_base64_encoded_len(bytes.size(), kPadded), '\0');
    ::sodium_bin2base64(text.data(), text.size(), reinterpret_cast<const unsigned char*>(bytes.data()), bytes.size(),
                        kPadded);
    text.pop_back();  // the zero byte behind it
    return text;
}

std::optional<std::string> Base64::decode(std::string_view text) {
    // Three bytes of every four letters at most.
    std::string bytes(text.size() / 4 * 3, '\0');
    std::size_t size = 0;
    if (::sodium_base642bin(reinterpret_cast<unsigned char*>(bytes.data()), bytes.size(), text.data(), text.size(),
                            nullptr, &size, nullptr, kPadded) != 0) {
        return std::nullopt;
    }
    bytes.resize(size);
    return bytes;
}

}  // namespace ktr::server
