#pragma once

#include <string>

#include "server/page/PageData.h"

namespace ktr::server {

/// Language, time zone and how long things are kept; and the page that asks before everything goes. Any thread.
class SettingsPage {
  public:
    struct Data {
        std::int64_t fixesKept = 0;  ///< seconds
        std::int64_t looksKept = 0;  ///< seconds
        std::string told = {};
    };

    static std::string html(const PageContext& context, const Data& data);
    static std::string deleteHtml(const PageContext& context);
};

}  // namespace ktr::server
