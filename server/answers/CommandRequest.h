#pragma once

#include <optional>
#include <string>
#include <vector>

#include "platform/base/Value.h"
#include "server/http/HttpRequest.h"
#include "server/http/HttpResponse.h"
#include "server/names/ViewerLocale.h"

namespace ktr::server {

/// A place in a command.
struct CommandPlace {
    double latitude = 0.0;  ///< degrees
    double longitude = 0.0;
    std::optional<double> accuracy;  ///< metres
};

/// What a get-locations command asks (docs/service-protocol.md).
struct LocationsRequest {
    std::vector<std::string> handles;     ///< as they were sent
    std::optional<CommandPlace> mine;     ///< where the user is; 0/0 reads as none
    std::optional<CommandPlace> wanted;   ///< whether friends are there
    std::optional<std::string> clientId;  ///< comes back
    ViewerLocale viewer;                  ///< in what words places are named
    bool wantsNewer = false;              ///< a newer fix than there is, if a phone can be asked for one

    /// None, with the reason in `complaint`, for a request that is not one.
    static std::optional<LocationsRequest> read(const platform::Dictionary& body, std::string& complaint);
};

/// What a command that shows or hides the user asks.
struct SharingRequest {
    bool hides = false;
    std::optional<CommandPlace> place;
    ViewerLocale viewer;

    static std::optional<SharingRequest> read(const platform::Dictionary& body, std::string& complaint);
};

/// What is wrong with the headers of a command beside its credentials; none when nothing is.
std::optional<HttpResponse> refusalOfCommand(const HttpRequest& request);
/// The part of it that concerns the type of the body.
std::optional<HttpResponse> refusalOfType(const HttpRequest& request);
/// A status with a sentence, as the protocol words it.
HttpResponse refusal(int status, const std::string& message);

}  // namespace ktr::server
