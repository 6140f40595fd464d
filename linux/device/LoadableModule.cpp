#include "linux/device/LoadableModule.h"

#include <dlfcn.h>

#include <filesystem>
#include <system_error>

#include "platform/base/Log.h"

namespace ktr::linux_ {

namespace {

/// The folder of the platform library: the modules are installed relative to it.
std::filesystem::path libraryFolder() {
    Dl_info info{};
    const auto anchor = &platform::platformLog;
    if (::dladdr(reinterpret_cast<void*>(anchor), &info) == 0 || !info.dli_fname) {
        return {};
    }
    std::error_code failed;
    const auto file = std::filesystem::canonical(info.dli_fname, failed);
    return failed ? std::filesystem::path() : file.parent_path();
}

}  // namespace

void* LoadableModule::entry(const std::string& fileName, const char* symbol, std::string& error) {
    const auto folder = libraryFolder();
    std::filesystem::path file = folder / fileName;
    std::error_code ignored;
    if (!std::filesystem::exists(file, ignored)) {
        file = folder / "ktr" / fileName;
    }
    void* library = ::dlopen(file.c_str(), RTLD_NOW | RTLD_LOCAL | RTLD_NODELETE);
    void* found = library ? ::dlsym(library, symbol) : nullptr;
    if (!found) {
        const char* reason = ::dlerror();
        error = reason ? reason : fileName + " cannot be loaded";
    }
    return found;
}

}  // namespace ktr::linux_
