#pragma once

#include <functional>
#include <memory>
#include <optional>
#include <string>
#include <vector>

#include <QThread>

#include "platform/client/HttpTransport.h"

namespace ktr::linux_ {

/// Sends commands over HTTPS on a thread of its own, HTTP/1.1, each as one POST that is never repeated. TLS is 1.2 or
/// newer and the other side has to prove who it is; nothing switches that off. Redirects are followed as ServicePolicy
/// allows: 307 and 308, https, at most five. What a server sends is bounded in size, nesting and time.
///
/// HTTP/1.1 alone: that a POST is sent once rests on a body that cannot be read twice, which is proven for 1.1 only.
class QtHttpTransport : public platform::HttpTransport {
  public:
    struct Settings {
        /// The host that the account names; none without an account, and then nothing is sent.
        std::optional<std::string> serviceHost;
        /// As ServicePolicy takes them.
        std::vector<std::string> domains;
        /// Files of certificates (PEM) that are trusted besides the system's. One that cannot be read is an error line
        /// in the log.
        std::vector<std::string> certificateFiles;
        bool operator==(const Settings&) const = default;
    };

    /// `settings` is asked on the main thread at each command, so that a new account counts from then on.
    explicit QtHttpTransport(std::function<Settings()> settings);
    /// Commands under way end with `Cancelled`.
    ~QtHttpTransport() override;
    QtHttpTransport(const QtHttpTransport&) = delete;
    QtHttpTransport& operator=(const QtHttpTransport&) = delete;

    void send(const platform::HttpRequest& request, Completion completion) override;

  private:
    class Worker;

    std::function<Settings()> settings_;
    QThread thread_;
    /// Lives on the thread and is deleted there.
    Worker* worker_;
};

}  // namespace ktr::linux_
