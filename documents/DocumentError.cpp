#include "documents/DocumentError.h"

namespace ktr::documents {

std::string DocumentError::text() const {
    std::string text = file + ":";
    if (position) {
        text += std::to_string(position->line) + ":" + std::to_string(position->column) + ":";
        text += path.empty() ? "" : " " + path + ":";
    }
    return text + " " + message;
}

}  // namespace ktr::documents
