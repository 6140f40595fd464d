#pragma once

#include <initializer_list>
#include <string>
#include <string_view>

#include "platform/base/Api.h"

namespace ktr::platform {

/// What `formatted` gives for these texts as arguments, without arguments being made of them. Any thread.
KTR_API std::string filled(std::string_view format, std::initializer_list<std::string_view> texts);

}  // namespace ktr::platform
