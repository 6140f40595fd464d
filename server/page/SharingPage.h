#pragma once

#include <string>
#include <vector>

#include "server/page/PageData.h"

namespace ktr::server {

/// The page that opens first: who sees the reader, the one switch over all, who looked, and the way to all else; and
/// the page that asks with whom to share. Any thread.
class SharingPage {
  public:
    struct Data {
        bool hidden = false;
        std::vector<PageRule> rules;
        std::vector<PageAsk> asks;
        std::vector<PageLook> looks;  ///< the newest first
        std::int64_t looksKept = 30;  ///< days
        std::string told = {};        ///< what was just done; empty: nothing
    };

    static constexpr std::size_t kFewLooks = 3;

    static std::string html(const PageContext& context, const Data& data);
    /// `complaint`: why what was typed was not taken; empty at first.
    static std::string shareHtml(const PageContext& context, const std::string& typed, const std::string& complaint);
    /// All that is kept of who looked, over so many days.
    static std::string looksHtml(const PageContext& context, const std::vector<PageLook>& looks, std::int64_t days);
};

}  // namespace ktr::server
