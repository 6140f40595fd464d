#include "server/http/HttpResponse.h"

// Boost 1.74 forgets to include these.
#include <ostream>
#include <utility>
//
#include <boost/beast/http/status.hpp>

namespace ktr::server {

namespace {

std::string oneLine(std::string text) {
    for (char& letter : text) {
        if (static_cast<unsigned char>(letter) < 0x20 || letter == 0x7F) {
            letter = ' ';
        }
    }
    return text;
}

}  // namespace

HttpResponse HttpResponse::json(int status, std::string body) {
    HttpResponse response;
    response.status = status;
    response.headers.emplace_back("Content-Type", "application/json");
    response.body = std::move(body);
    return response;
}

std::string HttpResponse::head(bool keepsAlive) const {
    const auto reason =
        boost::beast::http::obsolete_reason(boost::beast::http::int_to_status(static_cast<unsigned>(status)));
    std::string text = "HTTP/1.1 " + std::to_string(status) + " " + std::string(reason.data(), reason.size()) + "\r\n";
    for (const auto& [name, value] : headers) {
        text += oneLine(name) + ": " + oneLine(value) + "\r\n";
    }
    // Neither has a body (RFC 9110, 15.3.5 and 15.4.5).
    if (delivery.endless || stream) {
        text += "Transfer-Encoding: chunked\r\n";
    } else if (status != 204 && status != 304) {
        text += "Content-Length: " + std::to_string(body.size()) + "\r\n";
    }
    return text + (keepsAlive ? "\r\n" : "Connection: close\r\n\r\n");
}

}  // namespace ktr::server
