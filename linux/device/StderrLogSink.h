#pragma once

#include <cstdio>
#include <mutex>

#include "platform/base/Log.h"

namespace ktr::linux_ {

/// Writes each record as one line: level, subsystem, category, text. Control characters in the text are escaped
/// ("\n" for a line end), so that no record can pass for two. Private arguments read "<private>" unless they are asked
/// to be shown; a token is never among them, it is taken out when the line is made. Any thread.
class StderrLogSink : public platform::LogSink {
  public:
    /// `showPrivate` reveals positions, names, handles and URLs. The stream is not owned and stays open.
    explicit StderrLogSink(bool showPrivate, std::FILE* stream = stderr) : showPrivate_(showPrivate), stream_(stream) {}
    void write(const platform::LogLine& line) override;
    bool wants(platform::LogLevel level) const override;

    /// What the environment asks: true when KTR_LOG_PRIVATE is "show".
    static bool environmentShowsPrivate();

  private:
    bool showPrivate_;
    std::FILE* stream_;
    std::mutex mutex_;
};

}  // namespace ktr::linux_
