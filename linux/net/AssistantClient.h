#pragma once

#include <functional>
#include <memory>
#include <optional>
#include <string>
#include <vector>

#include "linux/net/HttpsClient.h"
#include "linux/net/TroubleLine.h"
#include "platform/client/HttpTransport.h"

namespace ktr::linux_ {

/// Asks the assistant's server a question (docs/service-protocol.md) as HttpsExchange does. A question may be a wish,
/// such as to hide: it is one POST with the account's credentials. Redirects are not followed. Why a question has no
/// answer is said in a line of the log.
class AssistantClient {
  public:
    struct Settings {
        /// A host, with ":port" when the port is not 443; empty: no question is sent.
        std::optional<std::string> host;
        /// The value of the field "Authorization"; empty: no question is sent.
        std::optional<std::string> authorization;
        /// Files of certificates (PEM) that are trusted besides the system's.
        std::vector<std::string> certificateFiles;
        std::string language;  ///< BCP 47: the answer's, if the assistant speaks it
        bool operator==(const Settings&) const = default;
    };

    struct Answer {
        platform::HttpFailure failure = platform::HttpFailure::None;
        int status = 0;    ///< of HTTP; 0 without an answer
        std::string body;  ///< of an answer of status 200 to 299
        /// Of an answer without a body: what is wrong, in words for a log line, without anything private.
        std::string reason = {};
        bool hasBody() const { return failure == platform::HttpFailure::None && status >= 200 && status < 300; }
    };
    using Completion = std::function<void(Answer)>;

    /// Seconds for a question and its answer together.
    static constexpr double kDeadline = 20.0;
    /// Bytes of an answer; a longer one fails.
    static constexpr std::size_t kMaximumBytes = std::size_t{4} * 1024 * 1024;

    /// `settings` is asked on the main thread at each question. Without a thread it has one of its own.
    explicit AssistantClient(std::function<Settings()> settings, std::shared_ptr<NetworkThread> thread = nullptr);
    /// Questions under way end with `Cancelled`.
    ~AssistantClient();
    AssistantClient(const AssistantClient&) = delete;
    AssistantClient& operator=(const AssistantClient&) = delete;

    /// Never calls the completion inside the call, and calls it exactly once, on any thread. Main thread.
    void ask(const std::string& question, Completion completion);

  private:
    std::function<Settings()> settings_;
    /// Used on the network thread.
    TroubleLine trouble_{platform::LogArea::Net, "The assistant at %@ cannot be asked: %@"};
    /// Goes first: what it ends still says why.
    HttpsClient client_;
};

}  // namespace ktr::linux_
