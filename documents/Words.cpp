#include "documents/Words.h"

#include "platform/base/Json.h"
#include "platform/base/Utf8.h"

namespace ktr::documents {

std::string inQuotes(std::string_view text, std::size_t longest) {
    if (text.size() <= longest) {
        return platform::writeJsonString(text);
    }
    std::size_t end = 0;
    while (end < longest) {
        end += platform::decodeUtf8(text, end).length;
    }
    return platform::writeJsonString(std::string(text.substr(0, end)) + "…");
}

}  // namespace ktr::documents
