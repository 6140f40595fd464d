#pragma once

#include <memory>
#include <mutex>
#include <string>
#include <string_view>

#include "platform/base/Api.h"
#include "platform/base/Format.h"

namespace ktr::platform {

enum class LogLevel { Debug, Info, Default, Error };

/// A line before it is written: the format and its arguments are kept apart, so that the sink can redact.
struct LogLine {
    LogLevel level = LogLevel::Default;
    std::string subsystem;
    std::string category;
    std::string format;
    FormatArguments arguments;
};

/// Where lines go. Any thread.
class KTR_API LogSink {
  public:
    virtual ~LogSink();
    virtual void write(const LogLine& line) = 0;
    /// Whether a line of this level would be kept: a line that nobody keeps is not built.
    virtual bool wants(LogLevel level) const = 0;
};

/// A subsystem's handle to the log of the installed platform. Any thread.
class KTR_API Log {
  public:
    Log(std::string subsystem, std::string category)
        : subsystem_(std::move(subsystem)), category_(std::move(category)) {}

    template <class... Arguments>
    void write(LogLevel level, std::string_view format, Arguments&&... arguments) const {
        if (wants(level)) {
            put(level, format, FormatArguments{FormatArgument(std::forward<Arguments>(arguments))...});
        }
    }
    template <class... Arguments>
    void line(std::string_view format, Arguments&&... arguments) const {
        write(LogLevel::Default, format, std::forward<Arguments>(arguments)...);
    }

    const std::string& subsystem() const { return subsystem_; }
    const std::string& category() const { return category_; }

  private:
    bool wants(LogLevel level) const;
    void put(LogLevel level, std::string_view format, FormatArguments arguments) const;

    std::string subsystem_;
    std::string category_;
};

/// The platform library's own log: subsystem "org.ktr.platform".
KTR_API const Log& platformLog();

}  // namespace ktr::platform
