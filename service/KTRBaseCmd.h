#pragma once

#include <cstdint>
#include <memory>
#include <optional>
#include <string>

#include "platform/base/Url.h"
#include "platform/client/KTJSONCommand.h"
#include "service/ServiceResult.h"

namespace ktr {

/// The service's base path; a command's path is this and its command word.
inline constexpr const char* KTRUrlBase = "/qloxservice/friends/va/";

/// What all commands to the service share: scheme, host, credentials, two headers, the "clientContext" of the body, and
/// how an answer sets the pace. Without an account, or without its token, a command has no credentials. Made and filled
/// on the main thread; one command is one request.
class KTRBaseCmd : public platform::KTJSONCommand {
  public:
    /// The host is the one that the service redirected to last, in this or an earlier process, else the account's.
    bool init() override;
    platform::HttpHeaders headers() const override;
    platform::Dictionary jsonBodyDictionary() override;
    /// Records `statusCode` at every call.
    std::optional<platform::Dictionary> jsonResponseDictionary() override;

    /// What the commands say of the device: "deviceUDID", "productType", "osVersion", "buildVersion", "locale",
    /// "countryCode", "regionCode"; what is not known is left out. Read once for each installed platform: a change of
    /// language or region while it is installed is not seen. Never none. Any thread once a command has been made, which
    /// makes this too; until then the main thread.
    static std::shared_ptr<const platform::Dictionary> staticClientContext();

    /// Seconds until the service wants to be asked again, from "minCallbackIntervalInMS" of the answer's
    /// "serverContext"; 0 when there is none, which ends polling.
    virtual double minCallbackInterval();
    /// None when there is nothing to hand on; the base has nothing.
    virtual std::optional<ServiceResult> result();

    /// The member "statusCode" of the last answer read, which is not the HTTP status; none before an answer, and when
    /// it is missing or null.
    std::optional<std::int64_t> statusCode() const { return statusCode_; }
    void setStatusCode(std::optional<std::int64_t> statusCode) { statusCode_ = statusCode; }
    /// The server's context of the last answer as a URL, set by subclasses while they compute their result; may be
    /// none.
    const std::optional<platform::Url>& contextIdentifierURL() const { return contextIdentifierURL_; }
    void setContextIdentifierURL(std::optional<platform::Url> url) { contextIdentifierURL_ = std::move(url); }

  private:
    std::optional<std::int64_t> statusCode_;
    std::optional<platform::Url> contextIdentifierURL_;
};

}  // namespace ktr
