#pragma once

#include <functional>
#include <optional>
#include <string>

#include "platform/base/Object.h"
#include "platform/base/Value.h"
#include "platform/client/HttpTransport.h"

namespace ktr::platform {

/// One request to the service and what came of it: a POST with a JSON object as its body, answered by a JSON object. A
/// subclass adds its path, headers and body members. Made and filled on the main thread, sent once by a
/// KTServerInteractionController, read when it has finished.
class KTR_API KTJSONCommand : public Object {
  public:
    using CompletionBlock = std::function<void()>;

    virtual bool init();

    /// None and empty are the same for each: an empty host fails without a network, and without both a user name and a
    /// password the request has no credentials.
    const std::string& scheme() const { return scheme_; }
    void setScheme(std::string scheme) { scheme_ = std::move(scheme); }
    /// With ":port" when the port is not the scheme's own.
    const std::string& host() const { return host_; }
    void setHost(std::string host) { host_ = std::move(host); }
    const std::string& userName() const { return userName_; }
    void setUserName(std::string userName) { userName_ = std::move(userName); }
    const std::string& password() const { return password_; }
    void setPassword(std::string password) { password_ = std::move(password); }

    /// Begins with "/"; the base has none.
    virtual std::string path() const;
    /// The base says that the body is JSON and that JSON is wanted.
    virtual HttpHeaders headers() const;
    /// The base has an empty one.
    virtual Dictionary jsonBodyDictionary();
    /// The answer; none before it is there, and when it is no JSON object.
    virtual std::optional<Dictionary> jsonResponseDictionary();

    /// Whether an answer of HTTP status 200 to 299 came, and is a JSON object. Any thread once finished.
    bool wasSuccessful() const { return successful_; }
    /// Whether redirects led to the host that answered.
    bool wasRedirected() const { return redirectedHost_.has_value(); }
    /// The host that the command was first sent to; empty before it is sent.
    const std::string& originalHost() const { return originalHost_; }
    /// The host that answered in its stead; empty when the command was not redirected.
    std::string redirectedHost() const { return redirectedHost_.value_or(""); }

    /// Runs once when the command has finished. It is moved out before it is run, so that it may clear itself; none
    /// clears it.
    void setCompletionBlock(CompletionBlock block) { completionBlock_ = std::move(block); }
    bool hasCompletionBlock() const { return completionBlock_ != nullptr; }

  private:
    friend class KTServerInteractionController;
    HttpRequest makeRequest();
    void finish(HttpAnswer answer);
    CompletionBlock takeCompletionBlock();
    std::optional<Dictionary> takeAnswer();
    /// Whether giving back the answer's memory takes as long as filling some rows: hundreds of entries.
    bool hasLargeAnswer() const;

    std::string scheme_;
    std::string host_;
    std::string userName_;
    std::string password_;
    std::string originalHost_;
    std::optional<std::string> redirectedHost_;
    std::optional<Dictionary> response_;
    bool successful_ = false;
    CompletionBlock completionBlock_;
};

/// The value of an "Authorization" header for a user name and a password: the Basic scheme (RFC 7617) with UTF-8. None
/// when either is empty, or when the scheme cannot carry them (a colon in the user name, a control character).
KTR_API std::optional<std::string> basicAuthorization(const std::string& userName, const std::string& password);

}  // namespace ktr::platform
