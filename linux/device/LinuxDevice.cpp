#include "linux/device/LinuxDevice.h"

#include <array>
#include <cmath>
#include <cstddef>
#include <string>

#include "platform/base/Utf8.h"

namespace ktr::linux_ {

using platform::ContentSizeCategory;
using platform::UserInterfaceIdiom;

namespace {

constexpr std::array<std::string_view, 12> kCategories = {"XS",   "S",   "M",   "L",   "XL",  "XXL",
                                                          "XXXL", "AX1", "AX2", "AX3", "AX4", "AX5"};
/// The text scale up to which each category reaches, itself not included; the last has no end.
constexpr std::array kEnds = {0.85, 0.92, 0.98, 1.07, 1.19, 1.32, 1.5, 1.85, 2.2, 2.6, 2.95};
constexpr std::array<std::string_view, 4> kIdioms = {"phone", "tablet", "desktop", "display"};

template <std::size_t N>
std::optional<std::size_t> indexOf(const std::array<std::string_view, N>& names, std::string_view name) {
    for (std::size_t i = 0; i < N; ++i) {
        if (platform::asciiLowercased(names[i]) == platform::asciiLowercased(name)) {
            return i;
        }
    }
    return std::nullopt;
}

}  // namespace

void LinuxDevice::setMainScreenScale(double scale) {
    if (std::isfinite(scale) && scale > 0.0) {
        scale_ = scale;
    }
}

ContentSizeCategory LinuxDevice::categoryForTextScale(double scale) {
    if (std::isnan(scale)) {
        return ContentSizeCategory::L;
    }
    std::size_t index = 0;
    while (index < kEnds.size() && scale >= kEnds[index]) {
        ++index;
    }
    return static_cast<ContentSizeCategory>(index);
}

std::optional<ContentSizeCategory> LinuxDevice::categoryNamed(std::string_view name) {
    const auto index = indexOf(kCategories, name);
    return index ? std::optional(static_cast<ContentSizeCategory>(*index)) : std::nullopt;
}

std::string_view LinuxDevice::nameOf(ContentSizeCategory category) {
    return kCategories[static_cast<std::size_t>(category)];
}

std::optional<UserInterfaceIdiom> LinuxDevice::idiomNamed(std::string_view name) {
    const auto index = indexOf(kIdioms, name);
    return index ? std::optional(static_cast<UserInterfaceIdiom>(*index)) : std::nullopt;
}

std::string_view LinuxDevice::nameOf(UserInterfaceIdiom idiom) {
    return kIdioms[static_cast<std::size_t>(idiom)];
}

}  // namespace ktr::linux_
