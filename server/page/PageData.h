#pragma once

#include <cstdint>
#include <optional>
#include <string>
#include <vector>

#include "server/page/PageLanguage.h"
#include "server/rules/Grant.h"
#include "server/rules/NamedPlace.h"
#include "server/rules/Visibility.h"

namespace ktr::server {

/// Whose page it is, and for whom it is written.
struct PageContext {
    const PageLanguage& language;
    std::string token;  ///< of the session, in every form
    std::int64_t now = 0;
    std::string name;    ///< the reader's own
    std::string handle;  ///< decides the colour of the reader's face
};

/// Somebody whom the reader lets see them.
struct PageRule {
    std::int64_t viewer = 0;
    std::string name;
    std::string handle;
    Grant grant = {};
    std::string arrival = {};  ///< the name of the place whose reaching ends it; empty: none
};

/// Somebody who asks to see the reader.
struct PageAsk {
    std::int64_t asker = 0;
    std::string name;
    std::string handle;
    std::int64_t time = 0;
};

struct PageLook {
    std::string viewer;
    std::int64_t time = 0;
    bool asked = true;  ///< not merely fetched by a phone
};

/// A phone or program, or a browser that is signed in.
struct PageDevice {
    enum class Kind { Phone, Reader, Browser };

    std::int64_t id = 0;
    Kind kind = Kind::Phone;
    std::int64_t made = 0;
    std::optional<std::int64_t> heard = std::nullopt;
    bool isThis = false;  ///< the browser that reads the page
};

}  // namespace ktr::server
