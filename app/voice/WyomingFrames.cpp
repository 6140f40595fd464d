#include "app/voice/WyomingFrames.h"

#include <optional>
#include <utility>

#include "documents/JsonReader.h"
#include "platform/base/Json.h"

namespace ktr::app {

using platform::Dictionary;
using platform::Value;

namespace {

std::optional<Dictionary> objectOf(std::string_view text) {
    const auto read = documents::JsonReader::read(text);
    const auto* value = std::get_if<Value>(&read);
    return value == nullptr || value->dictionary() == nullptr ? std::nullopt : std::optional(*value->dictionary());
}

/// A length that a header names; 0 where it names none, none where that is no length up to the limit.
std::optional<std::size_t> lengthIn(const Dictionary& header, const char* name, std::size_t most) {
    const Value* value = header.find(name);
    if (value == nullptr || value->isNull()) {
        return 0;
    }
    const auto number = value->number();
    if (!number || !(*number >= 0.0 && *number <= static_cast<double>(most))) {
        return std::nullopt;
    }
    const auto length = static_cast<std::size_t>(*number);
    return static_cast<double>(length) == *number ? std::optional(length) : std::nullopt;
}

}  // namespace

bool WyomingFrames::readHeader(std::string_view text) {
    const auto header = objectOf(text);
    const Value* type = header ? header->find("type") : nullptr;
    if (type == nullptr || type->string() == nullptr) {
        return false;
    }
    const auto dataLength = lengthIn(*header, "data_length", kLongestPart);
    const auto payloadLength = lengthIn(*header, "payload_length", kLongestPayload);
    const Value* data = header->find("data");
    const bool isEmpty = data == nullptr || data->isNull();
    if (!dataLength || !payloadLength || (!isEmpty && data->dictionary() == nullptr)) {
        return false;
    }
    frame_ = {*type->string(), isEmpty ? Dictionary() : *data->dictionary()};
    dataLength_ = *dataLength;
    payloadLength_ = *payloadLength;
    return true;
}

WyomingFrames::Next WyomingFrames::finish() {
    if (dataLength_ > 0) {
        const auto data = objectOf(std::string_view(bytes_).substr(0, dataLength_));
        if (!data) {
            isBroken_ = true;
            return Broken();
        }
        for (const auto& [name, value] : *data) {
            frame_.data.set(name, value);
        }
    }
    bytes_.erase(0, dataLength_ + payloadLength_);
    hasHeader_ = false;
    return std::exchange(frame_, {});
}

WyomingFrames::Next WyomingFrames::next() {
    if (!isBroken_ && !hasHeader_) {
        const std::size_t end = bytes_.find('\n');
        const bool isLine = end != std::string::npos;
        if (!isLine && bytes_.size() <= kLongestPart) {
            return Waiting();
        }
        isBroken_ = !isLine || end > kLongestPart || !readHeader(std::string_view(bytes_).substr(0, end));
        hasHeader_ = !isBroken_;
        bytes_.erase(0, isLine ? end + 1 : bytes_.size());
    }
    if (isBroken_) {
        bytes_.clear();
        return Broken();
    }
    return bytes_.size() < dataLength_ + payloadLength_ ? Next(Waiting()) : finish();
}

std::string WyomingFrames::line(const std::string& type, const Dictionary& data) {
    return platform::writeJson(Dictionary{{"type", type}, {"data", data}}) + "\n";
}

}  // namespace ktr::app
