#include "platform/contacts/PersonColor.h"

#include <array>

namespace ktr::platform {

namespace {

constexpr std::array<std::uint32_t, PersonColor::kCount> kColors = {
    0xB15966,  // rosewood
    0xAF5D4D,  // brick
    0x9D692E,  // bronze
    0x7D762C,  // olive
    0x597E40,  // moss
    0x34825A,  // fern
    0x13817E,  // lagoon
    0x247CA3,  // ocean
    0x4A75B4,  // denim
    0x706BBA,  // iris
    0x9560A6,  // plum
    0xAD5786,  // mulberry
};

}  // namespace

std::uint32_t PersonColor::hash(std::string_view bytes) {
    std::uint32_t h = 0x811c9dc5U;
    for (const char byte : bytes) {
        h ^= static_cast<unsigned char>(byte);
        h *= 0x01000193U;
    }
    return h;
}

std::size_t PersonColor::number(std::string_view handle) {
    const std::uint32_t h = hash(handle);
    return (h ^ (h >> 16U)) % kCount;
}

std::uint32_t PersonColor::rgb(std::size_t number) {
    return kColors[number % kCount];
}

}  // namespace ktr::platform
