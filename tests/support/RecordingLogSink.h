#pragma once

#include <mutex>
#include <string>
#include <vector>

#include "platform/base/Log.h"

namespace ktr::test {

/// Keeps every line, arguments shown.
class RecordingLogSink : public platform::LogSink {
  public:
    struct Line {
        platform::LogLevel level;
        std::string subsystem;
        std::string category;
        std::string format;
        std::string text;
        bool operator==(const Line&) const = default;
    };

    void write(const platform::LogLine& line) override;
    bool wants(platform::LogLevel) const override { return true; }

    std::vector<Line> lines() const;
    /// The texts of the lines of one level, or of all.
    std::vector<std::string> texts() const;
    std::vector<std::string> texts(platform::LogLevel level) const;
    bool has(platform::LogLevel level, const std::string& text) const;
    void clear();

  private:
    mutable std::mutex mutex_;
    std::vector<Line> lines_;
};

}  // namespace ktr::test
