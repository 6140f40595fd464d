#pragma once

#include <optional>
#include <string>

#include "server/page/PageData.h"

namespace ktr::server {

/// The pages on which a phone is set up. Any thread.
class PhonePage {
  public:
    struct Data {
        std::string address;       ///< where trackers post
        std::string addressAlone;  ///< for those that take nothing but an address; empty unless there is a password
        std::string password;      ///< shown this once; empty: it was shown before
        std::string link;          ///< opens the reader's page once; empty: no code is shown
        std::int64_t device = 0;
        std::int64_t made = 0;
        std::optional<std::int64_t> heard = std::nullopt;
        std::optional<double> accuracy = std::nullopt;  ///< of the reader's newest place, metres
    };

    /// Before anything is made.
    static std::string beginHtml(const PageContext& context);
    static std::string html(const PageContext& context, const Data& data);
};

}  // namespace ktr::server
