#pragma once

#include <cstddef>
#include <functional>
#include <optional>
#include <string>

#include "platform/base/Api.h"
#include "platform/base/Value.h"
#include "platform/client/HttpHeaders.h"

namespace ktr::platform {

/// One POST over HTTPS with a JSON body. What does not stand here is not sent, but for "Host", "Content-Length",
/// "Accept-Encoding", "Accept-Language", "Connection" and "User-Agent", which say nothing of the user.
struct HttpRequest {
    /// "https"; every other scheme fails.
    std::string scheme;
    /// A name or an address (IPv6 in brackets), with ":port" when the port is not 443.
    std::string host;
    /// Sent the request in place of `host`, when that one may not be asked, cannot be reached, or cannot prove who it
    /// is, before a byte has left; in the same form. Empty: nobody.
    std::string fallbackHost = {};
    /// Begins with "/".
    std::string path;
    HttpHeaders headers;
    std::string body;
    /// Seconds for everything together, redirects included.
    double deadline = 30.0;
    /// Seconds without a byte in either direction.
    double inactivityLimit = 15.0;
    /// Bytes of the answer's body; a longer answer fails.
    std::size_t maximumBytes = std::size_t{8} * 1024 * 1024;
};

enum class HttpFailure {
    None,
    /// No host, no legal URL or header, a scheme other than https, or a host that the account does not allow: nothing
    /// was sent.
    BadRequest,
    /// No connection, or one that broke.
    Network,
    /// An answer that is no HTTP, or that ended before it was whole.
    BadAnswer,
    /// The other side could not prove to be the host.
    Tls,
    /// The deadline or the inactivity limit passed.
    Timeout,
    TooLarge,
    /// The answer was a redirect that is not followed; nothing was sent there.
    RedirectRefused,
    /// The transport was shut down.
    Cancelled,
};

/// What came back. With a failure, status and JSON say nothing.
struct HttpAnswer {
    HttpFailure failure = HttpFailure::None;
    /// The HTTP status of the last hop.
    int status = 0;
    /// The body of an answer of status 200 to 299, when it is strict JSON: UTF-8, no member twice in one object,
    /// nothing nested more than 64 levels deep.
    std::optional<Value> json;
    /// The host (with its port, if any) that was asked last, when redirects led to another than the first; also
    /// with a failure.
    std::optional<std::string> redirectedHost;
    /// Of a failure: what is wrong, in words for a log line, without anything private.
    std::string reason = {};
    /// The fallback host was asked; redirects are counted from there.
    bool fromFallback = false;
};

/// Sends requests, each exactly once: a request whose connection breaks fails rather than being sent again.
class KTR_API HttpTransport {
  public:
    using Completion = std::function<void(HttpAnswer)>;

    virtual ~HttpTransport();
    /// Never calls the completion inside the call, and calls it exactly once, on any thread; a transport that is
    /// destroyed calls those that still wait with `Cancelled`, in its destructor. Main thread.
    virtual void send(const HttpRequest& request, Completion completion) = 0;
};

}  // namespace ktr::platform
