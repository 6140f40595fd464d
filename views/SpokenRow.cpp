#include "views/SpokenRow.h"

#include "model/PluginBundle.h"
#include "platform/base/Format.h"

namespace ktr {

std::string SpokenRow::line(const std::vector<std::string>& parts) {
    std::string line;
    for (const std::string& part : parts) {
        if (!part.empty()) {
            line = line.empty()
                       ? part
                       : platform::formatted(AssistantLocalizedString("ACCESSIBILITY_ROW_PARTS"), {line, part});
        }
    }
    return line;
}

}  // namespace ktr
