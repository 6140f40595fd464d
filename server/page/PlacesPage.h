#pragma once

#include <string>
#include <vector>

#include "server/page/PageData.h"

namespace ktr::server {

/// The places to which the reader gave names, and the page that asks before a name goes. Any thread.
class PlacesPage {
  public:
    struct Data {
        std::vector<NamedPlace> places;
        bool knowsWhere = false;  ///< the reader's phone has sent a place, which can be named
        std::string typed = {};
        std::string complaint = {};  ///< why what was typed was not taken
    };

    static std::string html(const PageContext& context, const Data& data);
    static std::string removeHtml(const PageContext& context, const NamedPlace& place);
};

}  // namespace ktr::server
