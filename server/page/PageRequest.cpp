#include "server/page/PageRequest.h"

#include <algorithm>
#include <charconv>

#include "server/page/PageAnswer.h"

namespace ktr::server {

namespace {

constexpr std::string_view kRoot = "/me";

bool isForm(const HttpRequest& request) {
    const std::string type = request.headerText("Content-Type");
    return equalIgnoringCase(type.substr(0, type.find(';')), "application/x-www-form-urlencoded");
}

bool isDocument(const HttpRequest& request) {
    const std::string type = request.headerText("Content-Type");
    return equalIgnoringCase(type.substr(0, type.find(';')), "application/json");
}

bool isOfOwnPage(const HttpRequest& request) {
    if (const std::string* site = request.header("Sec-Fetch-Site")) {
        return *site == "same-origin";
    }
    const std::string* origin = request.header("Origin");
    return origin != nullptr && equalIgnoringCase(*origin, "https://" + request.headerText("Host"));
}

}  // namespace

std::string cookieOf(std::string_view header, std::string_view name) {
    while (!header.empty()) {
        const std::size_t end = header.find(';');
        std::string_view pair = header.substr(0, end);
        header = end == std::string_view::npos ? std::string_view() : header.substr(end + 1);
        pair.remove_prefix(std::min(pair.find_first_not_of(' '), pair.size()));
        const std::size_t equals = pair.find('=');
        if (equals != std::string_view::npos && pair.substr(0, equals) == name) {
            return std::string(pair.substr(equals + 1));
        }
    }
    return "";
}

bool PageRequest::isFor(const HttpRequest& request) {
    return (request.path == kRoot || request.path.rfind("/me/", 0) == 0) &&
           (request.method == "GET" || request.method == "POST");
}

PageRequest PageRequest::read(const HttpRequest& request) {
    PageRequest out;
    out.posts = request.method == "POST";
    std::string_view path = std::string_view(request.path).substr(kRoot.size());
    while (!path.empty()) {
        const std::size_t end = path.find('/', 1);
        out.parts.emplace_back(path.substr(1, end == std::string_view::npos ? end : end - 1));
        path = end == std::string_view::npos ? std::string_view() : path.substr(end);
    }
    out.query = UrlQuery::read(request.query);
    if (out.posts && isForm(request) && request.body.size() <= kMostForm) {
        out.form = UrlQuery::read(request.body);
    }
    if (out.posts && isDocument(request) && request.body.size() <= kMostForm) {
        out.document = request.body;
    }
    out.host = request.headerText("Host");
    const std::string cookies = request.headerText("Cookie");
    out.session = cookieOf(cookies, PageAnswer::kSession);
    out.language = cookieOf(cookies, PageAnswer::kLanguage);
    out.accepted = request.headerText("Accept-Language");
    out.peer = request.peer;
    out.isOwn = out.posts && isOfOwnPage(request);
    return out;
}

bool PageRequest::is(std::initializer_list<std::string_view> wanted) const {
    return std::equal(parts.begin(), parts.end(), wanted.begin(), wanted.end(),
                      [](const std::string& part, std::string_view one) { return one == "*" || one == part; });
}

std::int64_t PageRequest::number(std::size_t part) const {
    std::int64_t value = 0;
    const std::string& text = parts[part];
    const auto [end, error] = std::from_chars(text.data(), text.data() + text.size(), value);
    return error == std::errc() && end == text.data() + text.size() ? value : 0;
}

}  // namespace ktr::server
