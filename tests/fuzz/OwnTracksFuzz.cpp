#include <cstddef>
#include <cstdint>
#include <string>
#include <string_view>

#include "server/ingest/PhoneMessages.h"
#include "server/ingest/SealedText.h"
#include "tests/fuzz/ReportCheck.h"

// Any bytes as the body of an OwnTracks post, and as what such a post has sealed.

using ktr::fuzz::require;
using ktr::server::PhoneMessages;
using ktr::server::SealedText;

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    constexpr const char* kKey = "a key";
    const std::string_view text(reinterpret_cast<const char*>(data), size);
    const auto open = PhoneMessages::ownTracks(text);
    ktr::fuzz::checkReport(open);
    require(!open.sealed, "nothing opens without a key");
    ktr::fuzz::checkReport(PhoneMessages::ownTracks(text, kKey));
    const auto sealed = SealedText::seal(text, kKey);
    require(sealed.has_value() && SealedText::open(*sealed, kKey) == text, "what was sealed opens");
    auto inner = PhoneMessages::ownTracks(R"({"_type":"encrypted","data":")" + *sealed + "\"}", kKey);
    if (!text.empty() && inner.sealed) {
        inner.sealed = false;
        require(inner == open, "a message says the same whether it was sealed or not");
    }
    return 0;
}
