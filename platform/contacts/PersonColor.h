#pragma once

#include <cstddef>
#include <cstdint>
#include <string_view>

#include "platform/base/Api.h"

namespace ktr::platform {

/// The twelve colours that stand for people, the same on every device without being stored anywhere. Any thread.
class KTR_API PersonColor {
  public:
    static constexpr std::size_t kCount = 12;

    /// 32-bit FNV-1a of the bytes (draft-eastlake-fnv: offset basis 811c9dc5, prime 01000193).
    static std::uint32_t hash(std::string_view bytes);
    /// The number of a handle's colour: both halves of its hash folded together, modulo twelve.
    static std::size_t number(std::string_view handle);
    /// 0xRRGGBB. All twelve are equally light: white letters read on them, and they are seen on a light and a dark card
    /// alike.
    static std::uint32_t rgb(std::size_t number);
};

}  // namespace ktr::platform
