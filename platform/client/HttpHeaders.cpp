#include "platform/client/HttpHeaders.h"

#include <algorithm>

#include "platform/base/Utf8.h"

namespace ktr::platform {

namespace {

template <class Fields>
auto findField(Fields& fields, std::string_view name) {
    return std::find_if(fields.begin(), fields.end(), [lower = asciiLowercased(std::string(name))](const auto& field) {
        return asciiLowercased(field.first) == lower;
    });
}

}  // namespace

HttpHeaders::HttpHeaders(std::initializer_list<Field> fields) {
    for (const Field& field : fields) {
        set(field.first, field.second);
    }
}

void HttpHeaders::set(std::string name, std::string value) {
    Field field(std::move(name), std::move(value));
    if (const auto found = findField(fields_, field.first); found != fields_.end()) {
        *found = std::move(field);
    } else {
        fields_.push_back(std::move(field));
    }
}

std::optional<std::string> HttpHeaders::value(std::string_view name) const {
    const auto found = findField(fields_, name);
    return found != fields_.end() ? std::optional(found->second) : std::nullopt;
}

}  // namespace ktr::platform
