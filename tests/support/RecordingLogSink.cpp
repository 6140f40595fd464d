#include "tests/support/RecordingLogSink.h"

#include <algorithm>

namespace ktr::test {

void RecordingLogSink::write(const platform::LogLine& line) {
    const std::lock_guard lock(mutex_);
    lines_.push_back(
        {line.level, line.subsystem, line.category, line.format, platform::formatted(line.format, line.arguments)});
}

std::vector<RecordingLogSink::Line> RecordingLogSink::lines() const {
    const std::lock_guard lock(mutex_);
    return lines_;
}

std::vector<std::string> RecordingLogSink::texts() const {
    std::vector<std::string> out;
    for (const Line& line : lines()) {
        out.push_back(line.text);
    }
    return out;
}

std::vector<std::string> RecordingLogSink::texts(platform::LogLevel level) const {
    std::vector<std::string> out;
    for (const Line& line : lines()) {
        if (line.level == level) {
            out.push_back(line.text);
        }
    }
    return out;
}

bool RecordingLogSink::has(platform::LogLevel level, const std::string& text) const {
    const auto all = lines();
    return std::any_of(all.begin(), all.end(),
                       [&](const Line& line) { return line.level == level && line.text == text; });
}

void RecordingLogSink::clear() {
    const std::lock_guard lock(mutex_);
    lines_.clear();
}

}  // namespace ktr::test
