#include "linux/net/EventStreamParser.h"

#include <utility>

namespace ktr::linux_ {

std::vector<StreamEvent> EventStreamParser::feed(std::string_view bytes) {
    std::vector<StreamEvent> events;
    for (const char byte : bytes) {
        if (isBroken_) {
            break;
        }
        const bool isRest = std::exchange(afterReturn_, byte == '\r') && byte == '\n';
        if (isRest) {
            continue;
        }
        if (byte == '\n' || byte == '\r') {
            takeLine(std::exchange(line_, {}), events);
        } else {
            line_ += byte;
            isBroken_ = line_.size() + data_.size() > kLargest;
        }
    }
    return events;
}

void EventStreamParser::takeLine(std::string_view line, std::vector<StreamEvent>& events) {
    if (line.empty()) {
        if (hasData_) {
            events.push_back({id_, type_.empty() ? "message" : type_, data_});
        }
        type_.clear();
        data_.clear();
        hasData_ = false;
        return;
    }
    const std::size_t colon = line.find(':');
    const std::string_view name = line.substr(0, colon);
    std::string_view value = colon == std::string_view::npos ? std::string_view() : line.substr(colon + 1);
    if (!value.empty() && value.front() == ' ') {
        value.remove_prefix(1);
    }
    if (name == "data") {
        data_ += (hasData_ ? "\n" : "") + std::string(value);
        hasData_ = true;
        isBroken_ = data_.size() > kLargest;
    } else if (name == "event") {
        type_ = value;
    } else if (name == "id" && value.find('\0') == std::string_view::npos) {
        id_ = value;
    }
}

}  // namespace ktr::linux_
