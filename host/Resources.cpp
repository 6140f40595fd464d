#include "host/Resources.h"

#include <cstdlib>

namespace ktr::host {

std::filesystem::path resourceFolder() {
    if (const char* other = std::getenv("KTR_RESOURCES"); other != nullptr && *other != '\0') {
        return other;
    }
    std::error_code failure;
    const auto program = std::filesystem::read_symlink("/proc/self/exe", failure);
    return program.parent_path().parent_path() / "share" / "ktr";
}

}  // namespace ktr::host
