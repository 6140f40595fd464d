#include "platform/client/HttpTransport.h"

namespace ktr::platform {

HttpTransport::~HttpTransport() = default;

}  // namespace ktr::platform
