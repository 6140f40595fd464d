#include "server/page/PageAnswer.h"

#include "server/page/PageStyle.h"

namespace ktr::server {

namespace {

HttpResponse guarded(int status) {
    HttpResponse response;
    response.status = status;
    response.headers = {{"Cache-Control", "no-store"},
                        {"Content-Security-Policy", std::string(PageStyle::policy())},
                        {"Referrer-Policy", "no-referrer"},
                        {"X-Content-Type-Options", "nosniff"},
                        {"X-Frame-Options", "DENY"},
                        {"Cross-Origin-Opener-Policy", "same-origin"},
                        {"Cross-Origin-Resource-Policy", "same-origin"}};
    return response;
}

}  // namespace

HttpResponse PageAnswer::html(int status, std::string body) {
    HttpResponse response = guarded(status);
    response.headers.emplace_back("Content-Type", "text/html; charset=utf-8");
    response.body = std::move(body);
    return response;
}

HttpResponse PageAnswer::seeOther(const std::string& path) {
    HttpResponse response = guarded(303);
    response.headers.emplace_back("Location", path);
    return response;
}

HttpResponse PageAnswer::file(const std::string& name, const std::string& type, std::string body) {
    HttpResponse response = guarded(200);
    response.headers.emplace_back("Content-Type", type);
    response.headers.emplace_back("Content-Disposition", "attachment; filename=\"" + name + "\"");
    response.body = std::move(body);
    return response;
}

void PageAnswer::setCookie(HttpResponse& response, const std::string& name, const std::string& value, long seconds) {
    response.headers.emplace_back("Set-Cookie", name + "=" + value + "; Max-Age=" + std::to_string(seconds) +
                                                    "; Path=/; Secure; HttpOnly; SameSite=Strict");
}

}  // namespace ktr::server
