#pragma once

#include <memory>
#include <optional>
#include <string_view>

#include "platform/base/Log.h"

namespace ktr::linux_ {

/// Passes on the lines of a level and above. Any thread.
class FilteredLogSink : public platform::LogSink {
  public:
    /// The lowest level that is passed on; none: nothing is.
    FilteredLogSink(std::shared_ptr<platform::LogSink> target, std::optional<platform::LogLevel> lowest)
        : target_(std::move(target)), lowest_(lowest) {}
    void write(const platform::LogLine& line) override;
    bool wants(platform::LogLevel level) const override;

    /// A level by its name: "debug", "info", "default", "error"; "off" gives none in the inner optional. Any other word
    /// gives none in the outer one.
    static std::optional<std::optional<platform::LogLevel>> levelNamed(std::string_view name);
    /// The level that KTR_LOG names; `Error` when it is unset or holds another word.
    static std::optional<platform::LogLevel> environmentLevel();

  private:
    std::shared_ptr<platform::LogSink> target_;
    std::optional<platform::LogLevel> lowest_;
};

}  // namespace ktr::linux_
