#pragma once

#include <string>
#include <vector>

#include "server/fences/Fence.h"
#include "server/page/PageData.h"

namespace ktr::server {

/// Who is told when the reader comes and goes: each with the place and since when, and a way to end it. Any thread.
class FencesPage {
  public:
    static std::string html(const PageContext& context, const std::vector<FenceFacts>& fences);
};

}  // namespace ktr::server
