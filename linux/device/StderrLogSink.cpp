#include "linux/device/StderrLogSink.h"

#include <cstdlib>
#include <string>
#include <string_view>

#include "documents/Words.h"

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

}  // namespace

bool StderrLogSink::wants(platform::LogLevel) const {
    return true;
}

bool StderrLogSink::environmentShowsPrivate() {
    const char* value = std::getenv("KTR_LOG_PRIVATE");
    return value && std::string_view(value) == "show";
}

void StderrLogSink::write(const platform::LogLine& line) {
    std::string text = line.subsystem + " " + line.category + ": ";
    text += platform::formatted(line.format, line.arguments, !showPrivate_);
    const std::string record =
        std::string(nameOf(line.level)) + " " + documents::forLine(secrets_->without(std::move(text))) + "\n";
    const std::lock_guard lock(mutex_);
    // One write a record, so that lines of other writers to the same stream do not cut in.
    std::fwrite(record.data(), 1, record.size(), stream_);
    std::fflush(stream_);
}

}  // namespace ktr::linux_
