#include <cstddef>
#include <cstdint>
#include <string>
#include <string_view>
#include <vector>

#include "server/http/BasicCredentials.h"
#include "server/http/ClientAddress.h"
#include "server/http/RequestReader.h"
#include "server/http/UrlQuery.h"
#include "tests/fuzz/Require.h"

// Any bytes from the network: however they are cut, the same requests are read and the same refusal is given, within
// the bounds.

namespace {

using ktr::fuzz::require;
using ktr::server::BasicCredentials;
using ktr::server::ClientAddress;
using ktr::server::HttpLimits;
using ktr::server::HttpRequest;
using ktr::server::RequestReader;
using ktr::server::UrlQuery;
using State = RequestReader::State;

struct Outcome {
    std::vector<std::string> requests;
    State state = State::Header;
    int status = 0;
};

HttpLimits limits() {
    HttpLimits limits;
    limits.headerBytes = 2000;
    limits.headerFields = 20;
    limits.bodyBytes = 500;
    return limits;
}

Outcome read(std::string_view bytes, std::size_t step) {
    RequestReader reader(limits());
    Outcome outcome;
    for (std::size_t at = 0; at < bytes.size() && reader.state() != State::Refused; at += step) {
        State state = reader.feed(bytes.substr(at, step));
        while (state == State::Done) {
            const HttpRequest request = reader.take();
            require(request.body.size() <= limits().bodyBytes, "a body within its bound");
            require(request.headers.size() <= limits().headerFields, "few enough fields");
            require(!request.path.empty() && request.path.front() == '/', "a path");
            UrlQuery::read(request.query);
            BasicCredentials::read(request.headerText("Authorization"));
            const std::string client = ClientAddress::forwardedFor(request);
            require(!client.empty() && client.size() < 46, "an address, or that there is none");
            outcome.requests.push_back(request.method + " " + request.path + " " + request.body);
            state = reader.next();
        }
    }
    outcome.state = reader.state();
    outcome.status = reader.status();
    require((outcome.state == State::Refused) == (outcome.status >= 400), "a refusal has a status");
    return outcome;
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    const std::string_view bytes(reinterpret_cast<const char*>(data), size);
    const Outcome dripped = read(bytes, 1);
    const Outcome pieces = read(bytes, 7);
    // A bound is met within a piece or between two, and a broken chunk is noticed with its fifth byte or a later one:
    // what is refused may be refused later, but what is read is the same.
    if (dripped.status != 413 && dripped.status != 431 && pieces.status != 413 && pieces.status != 431) {
        require(dripped.requests == pieces.requests, "the same requests");
    }
    return 0;
}
