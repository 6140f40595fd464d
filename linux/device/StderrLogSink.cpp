#include "linux/device/StderrLogSink.h"

#include <array>
#include <cstdlib>
#include <string>
#include <string_view>

namespace ktr::linux_ {

namespace {

std::string_view nameOf(platform::LogLevel level) {
    switch (level) {
        case platform::LogLevel::Debug:
            return "debug";
        case platform::LogLevel::Info:
            return "info";
        case platform::LogLevel::Default:
            return "default";
        case platform::LogLevel::Error:
            return "error";
    }
    return "error";
}

void appendEscaped(std::string& out, std::string_view text) {
    for (std::size_t at = 0; at < text.size(); ++at) {
        const char c = text[at];
        const auto byte = static_cast<unsigned char>(c);
        if (c == '\n') {
            out += "\\n";
        } else if (c == '\r') {
            out += "\\r";
        } else if (c == '\t') {
            out += "\\t";
        } else if (byte < 0x20 || byte == 0x7f) {
            constexpr std::string_view digits = "0123456789abcdef";
            out += "\\x";
            out += digits[byte >> 4];
            out += digits[byte & 0xf];
        } else if (byte == 0xc2 && at + 1 < text.size() && static_cast<unsigned char>(text[at + 1]) < 0xa0) {
            // A C1 control character: terminals act on some of them.
            out += "\\u00";
            constexpr std::string_view digits = "0123456789abcdef";
            const auto low = static_cast<unsigned char>(text[++at]);
            out += digits[low >> 4];
            out += digits[low & 0xf];
        } else if (text.substr(at, 3) == "\u2028" || text.substr(at, 3) == "\u2029") {
            out += text.substr(at, 3) == "\u2028" ? "\\u2028" : "\\u2029";
            at += 2;
        } else {
            out += c;
        }
    }
}

}  // namespace

bool StderrLogSink::wants(platform::LogLevel) const {
    return true;
}

bool StderrLogSink::environmentShowsPrivate() {
    const char* value = std::getenv("KTR_LOG_PRIVATE");
    return value && std::string_view(value) == "show";
}

void StderrLogSink::write(const platform::LogLine& line) {
    std::string record(nameOf(line.level));
    record += ' ';
    appendEscaped(record, line.subsystem);
    record += ' ';
    appendEscaped(record, line.category);
    record += ": ";
    appendEscaped(record, platform::formatted(line.format, line.arguments, !showPrivate_));
    record += '\n';
    const std::lock_guard lock(mutex_);
    // One write a record, so that lines of other writers to the same stream do not cut in.
    std::fwrite(record.data(), 1, record.size(), stream_);
    std::fflush(stream_);
}

}  // namespace ktr::linux_
