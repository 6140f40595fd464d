#include "server/http/HttpRequest.h"

#include <algorithm>

namespace ktr::server {

namespace {

char lower(char letter) {
    return letter >= 'A' && letter <= 'Z' ? static_cast<char>(letter - 'A' + 'a') : letter;
}

}  // namespace

bool equalIgnoringCase(std::string_view one, std::string_view other) {
    return std::equal(one.begin(), one.end(), other.begin(), other.end(),
                      [](char a, char b) { return lower(a) == lower(b); });
}

const std::string* HttpRequest::header(std::string_view name) const {
    const auto found = std::find_if(headers.begin(), headers.end(),
                                    [&](const auto& header) { return equalIgnoringCase(header.first, name); });
    return found == headers.end() ? nullptr : &found->second;
}

std::string HttpRequest::headerText(std::string_view name) const {
    const std::string* value = header(name);
    return value == nullptr ? std::string() : *value;
}

}  // namespace ktr::server
