#pragma once

#include <mutex>
#include <string>
#include <vector>

#include "platform/base/Log.h"

namespace ktr::test {

/// Keeps the error lines as they are shown to somebody who is shown nothing private.
class RedactedLogSink : public platform::LogSink {
  public:
    void write(const platform::LogLine& line) override {
        const std::lock_guard lock(mutex_);
        texts_.push_back(platform::formatted(line.format, line.arguments, true));
    }
    bool wants(platform::LogLevel level) const override { return level == platform::LogLevel::Error; }

    std::vector<std::string> texts() const {
        const std::lock_guard lock(mutex_);
        return texts_;
    }

  private:
    mutable std::mutex mutex_;
    std::vector<std::string> texts_;
};

}  // namespace ktr::test
