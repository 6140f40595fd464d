#pragma once

#include <optional>
#include <string>

namespace ktr::serve {

/// What goes wrong with some requests of the development service, on purpose.
struct Fault {
    enum class Cut {
        None,
        BeforeAnswer,  ///< the connection is reset instead of an answer
        AfterHeaders,  ///< the headers promise a body that does not come
        InBody,        ///< half of the body comes
    };
    enum class Body {
        Ordinary,
        NotJson,    ///< a web page
        Array,      ///< JSON, but a list
        Deep,       ///< a million opening brackets
        Endless,    ///< never ends
        Empty,      ///< no byte
        Truncated,  ///< half of the JSON, and the headers promise no more
        Text,       ///< `text`
    };

    int at = 1;     ///< the first request it meets, counted from 1
    int count = 0;  ///< how many requests; 0: all from there on
    double delaySeconds = 0.0;
    Cut cut = Cut::None;
    int status = 0;  ///< the HTTP status; 0: the ordinary one
    /// Where a redirect leads; "{origin}", "{port}" and "{path}" stand for the service's own. Empty: no redirect.
    std::string redirect;
    int redirectStatus = 307;
    Body body = Body::Ordinary;
    std::string text;
    double bytesPerSecond = 0.0;    ///< 0: as fast as it goes
    std::optional<int> statusCode;  ///< the member "statusCode" of the answer
    std::optional<int> entryStatus;
    std::string entry;  ///< the handle that entryStatus is for; empty: all
    std::optional<double> intervalSeconds;

    bool concerns(int request) const { return request >= at && (count == 0 || request - at < count); }
    bool operator==(const Fault&) const = default;
};

}  // namespace ktr::serve
