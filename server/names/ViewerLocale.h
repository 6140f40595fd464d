#pragma once

#include <string>
#include <tuple>

#include "platform/base/Value.h"

namespace ktr::server {

/// In what words somebody wants to read. A value.
struct ViewerLocale {
    std::string language;  ///< BCP 47; empty: English
    std::string region;    ///< two letters, whose units distances are in; empty: that of the language

    /// Of a command's "clientContext"; members that are no such thing read as empty.
    static ViewerLocale of(const platform::Dictionary& context);

    bool operator==(const ViewerLocale&) const = default;
    bool operator<(const ViewerLocale& other) const {
        return std::tie(language, region) < std::tie(other.language, other.region);
    }
};

}  // namespace ktr::server
