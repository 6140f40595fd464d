#pragma once

#include <string>
#include <vector>

#include "server/page/PageData.h"

namespace ktr::server {

/// The reader's phones, programs and browsers, and the page that asks before one of them ends. Any thread.
class DevicesPage {
  public:
    static std::string html(const PageContext& context, const std::vector<PageDevice>& devices);
    /// Shows a link with which a program signs in, once.
    static std::string linkHtml(const PageContext& context, const std::string& link);
    static std::string endHtml(const PageContext& context, const PageDevice& device);
};

}  // namespace ktr::server
