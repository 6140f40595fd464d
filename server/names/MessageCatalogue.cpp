#include "server/names/MessageCatalogue.h"

#include <cstring>
#include <utility>
#include <variant>

#include "documents/FileReader.h"

namespace ktr::server {

namespace {

// The format: https://www.gnu.org/software/gettext/manual/html_node/MO-Files.html
constexpr std::uint32_t kMagic = 0x950412de;
constexpr std::uint32_t kTurnedMagic = 0xde120495;
constexpr std::size_t kHeader = 28;
constexpr std::size_t kRow = 8;  ///< of a table: a length and a place
constexpr char kContextEnd = '\x04';

}  // namespace

std::shared_ptr<const MessageCatalogue> MessageCatalogue::read(const std::string& file) {
    auto bytes = documents::FileReader::read(file, {kMostBytes, {}});
    auto* text = std::get_if<std::string>(&bytes);
    return text == nullptr ? nullptr : parse(std::move(*text));
}

std::shared_ptr<const MessageCatalogue> MessageCatalogue::parse(std::string bytes) {
    if (bytes.size() < kHeader) {
        return nullptr;
    }
    auto made = std::make_shared<MessageCatalogue>();
    made->bytes_ = std::move(bytes);
    const std::uint32_t magic = made->number(0);
    made->isTurned_ = magic == kTurnedMagic;
    made->count_ = made->number(8);
    made->originals_ = made->number(12);
    made->translations_ = made->number(16);
    const auto isInside = [&](std::size_t table) {
        return table <= made->bytes_.size() && made->count_ <= (made->bytes_.size() - table) / kRow;
    };
    const bool isSound = (magic == kMagic || magic == kTurnedMagic) && made->number(4) >> 16U == 0 &&
                         isInside(made->originals_) && isInside(made->translations_);
    return isSound ? made : nullptr;
}

std::uint32_t MessageCatalogue::number(std::size_t at) const {
    std::uint32_t value = 0;
    std::memcpy(&value, bytes_.data() + at, sizeof value);
    return isTurned_ ? __builtin_bswap32(value) : value;
}

std::string_view MessageCatalogue::string(std::size_t table, std::uint32_t index) const {
    const std::size_t row = table + std::size_t{index} * kRow;
    const std::size_t length = number(row);
    const std::size_t at = number(row + 4);
    return at > bytes_.size() || length > bytes_.size() - at ? std::string_view()
                                                             : std::string_view(bytes_.data() + at, length);
}

std::string_view MessageCatalogue::find(std::string_view context, std::string_view text) const {
    std::string key(context);
    key += context.empty() ? "" : std::string(1, kContextEnd);
    key += text;
    std::uint32_t begin = 0;
    for (std::uint32_t end = count_; begin < end;) {
        const std::uint32_t middle = begin + (end - begin) / 2;
        const std::string_view original = string(originals_, middle);
        if (original == key) {
            return string(translations_, middle);
        }
        (original < key ? begin : end) = original < key ? middle + 1 : middle;
    }
    return {};
}

}  // namespace ktr::server
