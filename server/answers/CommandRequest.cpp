#include "server/answers/CommandRequest.h"

#include <cmath>

#include "documents/FieldReader.h"
#include "platform/base/Json.h"

namespace ktr::server {

namespace {

using documents::Complaints;
using documents::FieldReader;
using platform::Dictionary;

std::optional<CommandPlace> readPlace(FieldReader& request, const std::string& name) {
    std::optional<CommandPlace> place;
    request.object(name, [&](FieldReader& fields) {
        fields.leaveOthers();
        const auto latitude = fields.number("latitude");
        const auto longitude = fields.number("longitude");
        if (!latitude || !longitude || std::abs(*latitude) > 90.0 || std::abs(*longitude) > 180.0) {
            fields.complain("", "expected a latitude and a longitude in degrees");
        } else if (*latitude != 0.0 || *longitude != 0.0) {
            place = CommandPlace{*latitude, *longitude, fields.number("horizontalAccuracy")};
        }
    });
    return place;
}

/// What a complaint says; empty without one.
std::string sentenceOf(const Complaints& complaints) {
    return complaints ? complaints->path.text() + ": " + complaints->message : std::string();
}

}  // namespace

std::optional<LocationsRequest> LocationsRequest::read(const Dictionary& body, std::string& complaint) {
    Complaints complaints;
    FieldReader fields(body, {}, complaints);
    LocationsRequest request;
    const bool hasContext = fields.object("clientContext", [&](FieldReader& context) {
        context.leaveOthers();
        request.viewer = ViewerLocale::of(context.dictionary());
    });
    if (!hasContext) {
        fields.complain("clientContext", "expected an object, found nothing");
    }
    request.handles = fields.stringOrStrings("handles");
    request.wantsNewer = fields.boolean("fresh").value_or(false);
    request.mine = readPlace(fields, "myLocation");
    request.wanted = readPlace(fields, "requestedLocation");
    fields.object("serverContext", [&](FieldReader& context) {
        context.leaveOthers();
        request.clientId = context.string("clientId");
    });
    complaint = sentenceOf(complaints);
    return complaint.empty() ? std::optional(std::move(request)) : std::nullopt;
}

std::optional<SharingRequest> SharingRequest::read(const Dictionary& body, std::string& complaint) {
    Complaints complaints;
    FieldReader fields(body, {}, complaints);
    SharingRequest request;
    const bool hasContext = fields.object("clientContext", [&](FieldReader& context) {
        context.leaveOthers();
        request.viewer = ViewerLocale::of(context.dictionary());
        request.place = readPlace(context, "location");
    });
    if (!hasContext) {
        fields.complain("clientContext", "expected an object, found nothing");
    }
    std::optional<std::string> hide;
    fields.object("prefs", [&](FieldReader& preferences) {
        preferences.leaveOthers();
        hide = preferences.string("hideLocation");
    });
    if (!complaints && hide != "Yes" && hide != "No") {
        fields.complain("prefs", R"(expected "hideLocation" to be "Yes" or "No")");
    }
    request.hides = hide == "Yes";
    complaint = sentenceOf(complaints);
    return complaint.empty() ? std::optional(request) : std::nullopt;
}

HttpResponse refusal(int status, const std::string& message) {
    return HttpResponse::json(status, platform::writeJson(Dictionary{{"statusCode", status}, {"message", message}}));
}

std::optional<HttpResponse> refusalOfCommand(const HttpRequest& request) {
    if (request.headerText("X-Orcha-Seek-API-Ver") != "4.0") {
        return refusal(400, "expected the header X-Orcha-Seek-API-Ver: 4.0");
    }
    if (request.headerText("X-Orcha-AuthScheme") != "Forever") {
        return refusal(400, "expected the header X-Orcha-AuthScheme: Forever");
    }
    return refusalOfType(request);
}

std::optional<HttpResponse> refusalOfType(const HttpRequest& request) {
    if (request.headerText("Content-Type").rfind("application/json", 0) == 0) {
        return std::nullopt;
    }
    return refusal(415, "expected the header Content-Type: application/json");
}

}  // namespace ktr::server
