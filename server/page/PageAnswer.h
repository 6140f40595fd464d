#pragma once

#include <string>

#include "server/http/HttpResponse.h"

namespace ktr::server {

/// Answers of the people's page. Every one says that it is kept nowhere, shown in no frame, and tells nobody where its
/// reader came from. Any thread.
class PageAnswer {
  public:
    /// "__Host-": for this host alone, over HTTPS alone, for all its paths (RFC 6265bis, 4.1.3.2).
    static constexpr const char* kSession = "__Host-session";
    static constexpr const char* kLanguage = "__Host-language";

    static HttpResponse html(int status, std::string body);
    /// After a change: the browser asks for that page, and may ask again without changing anything.
    static HttpResponse seeOther(const std::string& path);
    static HttpResponse file(const std::string& name, const std::string& type, std::string body);
    /// `seconds`: for how long the browser keeps it; 0: it goes.
    static void setCookie(HttpResponse& response, const std::string& name, const std::string& value, long seconds);
};

}  // namespace ktr::server
