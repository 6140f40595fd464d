#include "app/ScenarioError.h"

namespace ktr::app {

std::string ScenarioError::text() const {
    std::string text = file + ":";
    if (position) {
        text += std::to_string(position->line) + ":" + std::to_string(position->column) + ": " + path + ":";
    }
    return text + " " + message;
}

}  // namespace ktr::app
