#pragma once

#include <optional>
#include <string>
#include <vector>

#include "server/page/PageData.h"

namespace ktr::server {

/// The page about one rule: what that viewer sees now, how exactly, until when; and the page that asks before it ends.
/// Any thread.
class RulePage {
  public:
    struct Data {
        PageRule rule;
        bool isNew = false;              ///< not saved yet
        std::string typed = {};          ///< by what the viewer of a new rule was named
        std::optional<Seen> seen;        ///< what the viewer's own answer would hold
        std::vector<NamedPlace> places;  ///< the reader's
        std::string told = {};
        bool isComplaint = false;  ///< `told` says why it was not saved
    };

    static std::string html(const PageContext& context, const Data& data);
    static std::string stopHtml(const PageContext& context, const PageRule& rule);
};

}  // namespace ktr::server
