#pragma once

#include <string_view>

namespace ktr::server {

/// How the people's page looks: sizes and colours of the window's own cards, light, dark and in high contrast by the
/// reader's setting. Any thread.
class PageStyle {
  public:
    static std::string_view sheet();
    /// The only things that a browser may do with the page (Content Security Policy 3): show it with exactly this
    /// style, and send its forms back to where it came from.
    static std::string_view policy();
};

}  // namespace ktr::server
