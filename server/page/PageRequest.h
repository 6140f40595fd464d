#pragma once

#include <string>
#include <string_view>
#include <vector>

#include "server/http/HttpRequest.h"
#include "server/http/UrlQuery.h"

namespace ktr::server {

/// A request for one of the people's pages, taken apart. A value.
struct PageRequest {
    static constexpr std::size_t kMostForm = 16384;  ///< bytes of a form

    bool posts = false;
    std::vector<std::string> parts;  ///< of the path, after "/me"
    UrlQuery query;
    UrlQuery form;         ///< of a post; empty for one that is no form or too long
    std::string document;  ///< of a program's post: what it sends as JSON; empty otherwise
    std::string host;      ///< with its port, as the browser wrote it
    std::string session;   ///< the secret in its cookie; empty: none
    std::string language;  ///< chosen on the settings page; empty: none
    std::string accepted;  ///< Accept-Language
    std::string peer;
    /// A post that the browser says came from one of our own pages. Pages are shown without a referrer, so that
    /// browsers write no origin into their forms ("null"): where they say Sec-Fetch-Site, that counts, else Origin.
    bool isOwn = false;

    static bool isFor(const HttpRequest& request);
    static PageRequest read(const HttpRequest& request);
    /// A field of the form; empty when there is none.
    std::string field(std::string_view name) const { return form.find(name).value_or(""); }
    /// The path is "/me" with these parts; "*" is any one.
    bool is(std::initializer_list<std::string_view> wanted) const;
    /// A number in the path; 0 when it is none.
    std::int64_t number(std::size_t part) const;
};

/// The value of a cookie (RFC 6265, 4.2.1); empty when there is none.
std::string cookieOf(std::string_view header, std::string_view name);

}  // namespace ktr::server
