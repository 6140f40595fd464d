#pragma once

#include <string>
#include <vector>

#include "server/page/PageData.h"

namespace ktr::server {

/// The places to which the reader gave names, the page that changes one, and the page that asks before a name goes. Any
/// thread.
class PlacesPage {
  public:
    struct Data {
        std::vector<NamedPlace> places;
        bool knowsWhere = false;  ///< the reader's phone has sent a place, which can be named
        std::string typed = {};
        std::string complaint = {};  ///< why what was typed was not taken
    };

    static std::string html(const PageContext& context, const Data& data);
    /// `complaint`: why what was typed was not taken; else empty.
    static std::string changeHtml(const PageContext& context, const NamedPlace& place, const std::string& complaint);
    static std::string removeHtml(const PageContext& context, const NamedPlace& place);
};

}  // namespace ktr::server
