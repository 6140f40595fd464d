#include "platform/base/Object.h"

#include <cxxabi.h>

#include <cstdlib>
#include <typeinfo>

namespace ktr::platform {

Object::~Object() = default;

std::string Object::description() const {
    int status = 0;
    std::unique_ptr<char, decltype(&std::free)> name(
        abi::__cxa_demangle(typeid(*this).name(), nullptr, nullptr, &status), &std::free);
    const std::string full = status == 0 && name ? name.get() : typeid(*this).name();
    const auto colon = full.rfind("::");
    return "<" + (colon == std::string::npos ? full : full.substr(colon + 2)) + ">";
}

}  // namespace ktr::platform
