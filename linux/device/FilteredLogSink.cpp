#include "linux/device/FilteredLogSink.h"

#include <cstdlib>

namespace ktr::linux_ {

void FilteredLogSink::write(const platform::LogLine& line) {
    if (wants(line.level)) {
        target_->write(line);
    }
}

bool FilteredLogSink::wants(platform::LogLevel level) const {
    return lowest_ && level >= *lowest_ && target_->wants(level);
}

std::optional<std::optional<platform::LogLevel>> FilteredLogSink::levelNamed(std::string_view name) {
    using Level = std::optional<platform::LogLevel>;
    if (name == "debug") {
        return Level(platform::LogLevel::Debug);
    }
    if (name == "info") {
        return Level(platform::LogLevel::Info);
    }
    if (name == "default") {
        return Level(platform::LogLevel::Default);
    }
    if (name == "error") {
        return Level(platform::LogLevel::Error);
    }
    if (name == "off") {
        return Level(std::nullopt);
    }
    return std::nullopt;
}

std::optional<platform::LogLevel> FilteredLogSink::environmentLevel() {
    const char* value = std::getenv("KTR_LOG");
    return levelNamed(value ? value : "").value_or(platform::LogLevel::Error);
}

}  // namespace ktr::linux_
