#include "platform/base/Log.h"

#include "platform/base/Platform.h"

namespace ktr::platform {

LogSink::~LogSink() = default;

bool Log::wants(LogLevel level) const {
    const auto platform = Platform::installed();
    return platform && platform->logSink && platform->logSink->wants(level);
}

void Log::put(LogLevel level, std::string_view format, FormatArguments arguments) const {
    if (const auto platform = Platform::installed()) {
        platform->logSink->write({level, subsystem_, category_, std::string(format), std::move(arguments)});
    }
}

const Log& platformLog() {
    static const Log log("org.ktr.platform", "layout");
    return log;
}

}  // namespace ktr::platform
