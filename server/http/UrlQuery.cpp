#include "server/http/UrlQuery.h"

namespace ktr::server {

namespace {

constexpr std::size_t kMostParameters = 200;

int digit(char letter) {
    if (letter >= '0' && letter <= '9') {
        return letter - '0';
    }
    if (letter >= 'a' && letter <= 'f') {
        return letter - 'a' + 10;
    }
    return letter >= 'A' && letter <= 'F' ? letter - 'A' + 10 : -1;
}

}  // namespace

std::string UrlQuery::unescaped(std::string_view text) {
    std::string plain;
    for (std::size_t i = 0; i < text.size(); ++i) {
        const int high = text[i] == '%' && i + 2 < text.size() ? digit(text[i + 1]) : -1;
        const int low = high >= 0 ? digit(text[i + 2]) : -1;
        if (low >= 0) {
            plain += static_cast<char>(high * 16 + low);
            i += 2;
        } else {
            plain += text[i] == '+' ? ' ' : text[i];
        }
    }
    return plain;
}

UrlQuery UrlQuery::read(std::string_view text) {
    UrlQuery query;
    while (!text.empty() && query.parameters_.size() < kMostParameters) {
        const std::size_t end = text.find('&');
        const std::string_view pair = text.substr(0, end);
        const std::size_t equals = pair.find('=');
        if (!pair.empty()) {
            query.parameters_.emplace_back(unescaped(pair.substr(0, equals)), equals == std::string_view::npos
                                                                                  ? std::string()
                                                                                  : unescaped(pair.substr(equals + 1)));
        }
        text = end == std::string_view::npos ? std::string_view() : text.substr(end + 1);
    }
    return query;
}

std::optional<std::string> UrlQuery::find(std::string_view name) const {
    for (const auto& [key, value] : parameters_) {
        if (key == name) {
            return value;
        }
    }
    return std::nullopt;
}

}  // namespace ktr::server
