#pragma once

#include <functional>

#include "server/http/HttpReply.h"
#include "server/http/HttpRequest.h"

namespace ktr::server {

/// Answers a request, now or later. Called on the edge's threads, several at a time: it must not wait.
using HttpHandler = std::function<void(HttpRequest, HttpReply)>;

}  // namespace ktr::server
