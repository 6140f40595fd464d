#pragma once

#include <cstdio>
#include <memory>
#include <mutex>

#include "linux/device/KnownSecrets.h"
#include "platform/base/Log.h"

namespace ktr::linux_ {

/// Writes each record as one line: level, subsystem, category, text. Control characters in the text are escaped
/// ("\n" for a line end), so that no record can pass for two. Private arguments read "<private>" unless they are asked
/// to be shown; a secret is not shown even then. Any thread.
class StderrLogSink : public platform::LogSink {
  public:
    /// `showPrivate` reveals positions, names, handles and URLs. The stream is not owned and stays open.
    explicit StderrLogSink(bool showPrivate, std::FILE* stream = stderr,
                           std::shared_ptr<const KnownSecrets> secrets = std::make_shared<KnownSecrets>())
        : showPrivate_(showPrivate), stream_(stream), secrets_(std::move(secrets)) {}
    void write(const platform::LogLine& line) override;
    bool wants(platform::LogLevel level) const override;

    /// What the environment asks: true when KTR_LOG_PRIVATE is "show".
    static bool environmentShowsPrivate();

  private:
    bool showPrivate_;
    std::FILE* stream_;
    std::shared_ptr<const KnownSecrets> secrets_;
    std::mutex mutex_;
};

}  // namespace ktr::linux_
