#include <cstddef>
#include <cstdint>
#include <limits>
#include <string>

#include "platform/base/Utf8.h"
#include "service/ContextValues.h"
#include "service/KTRVAUtils.h"
#include "tests/fuzz/Require.h"

// Any bytes as a context URL, also right behind its prefix: what decodes is integers of 32 bits and UTF-8, it encodes
// without the secret, and that decodes as the same.

namespace {

using ktr::ContextValues;
using ktr::KTRVAUtils;
using ktr::fuzz::require;
using ktr::platform::Dictionary;
using ktr::platform::Url;

constexpr const char* kSecret = "authToken";

void check(const Url& url) {
    Dictionary context = KTRVAUtils::contextDictionaryForURL(url);
    for (const auto& [key, value] : context) {
        require(ktr::platform::isValidUtf8(key), "a key is UTF-8");
        if (const auto number = value.integer()) {
            require(*number >= std::numeric_limits<std::int32_t>::min() &&
                        *number <= std::numeric_limits<std::int32_t>::max(),
                    "a number has 32 bits");
        } else {
            require(value.string() != nullptr && ktr::platform::isValidUtf8(*value.string()),
                    "what is no number is UTF-8");
        }
        const double number = ContextValues::number(context, key);
        require(number - number == 0.0, "a number is finite");
        ContextValues::boolean(context, key);
        ContextValues::text(context, key);
    }
    const auto encoded = KTRVAUtils::contextIdentifierURLForDictionary(context);
    require(encoded.has_value(), "a context encodes");
    context.remove(kSecret);
    require(encoded->text().find(std::string(kSecret) + "=") == std::string::npos || !context.empty(),
            "the secret is not encoded");
    require(KTRVAUtils::contextDictionaryForURL(*encoded) == context, "what was encoded decodes as the same");
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    const std::string text(reinterpret_cast<const char*>(data), size);
    check(Url(text));
    check(Url("ktrServerContext://serverContext?" + text));
    return 0;
}
