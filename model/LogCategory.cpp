#include "model/LogCategory.h"

#include "model/PluginBundle.h"
#include "platform/base/CurrentPlatform.h"
#include "platform/base/Platform.h"

namespace ktr {

namespace {

class LogCategory : public platform::Log {
  public:
    LogCategory() : platform::Log(platform::kSnippetsBundle, "_") {}
    static std::shared_ptr<LogCategory> makeShared() { return std::make_shared<LogCategory>(); }
};

}  // namespace

std::shared_ptr<const platform::Log> LogCategory_Unspecified() {
    auto handle = platform::shared<LogCategory>();
    return handle ? handle : LogCategory::makeShared();
}

bool isLineWanted(platform::LogLevel level) {
    const platform::Platform* installed = platform::currentPlatform();
    return installed != nullptr && installed->logSink && installed->logSink->wants(level);
}

}  // namespace ktr
