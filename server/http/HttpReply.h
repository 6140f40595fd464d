#pragma once

#include <functional>
#include <memory>
#include <optional>

#include "server/http/HttpResponse.h"

namespace ktr::server {

/// The right to answer one request, once, now or later, from any thread. When the last copy goes without an answer,
/// the connection is closed: its client knows then that nothing was done, or nothing it may rely on.
class HttpReply {
  public:
    /// Called once: with the answer, or with none when there will be none.
    using Done = std::function<void(std::optional<HttpResponse>)>;

    explicit HttpReply(Done done);
    /// Answers; a second answer is dropped.
    void send(HttpResponse response) const;

  private:
    class Promise;
    std::shared_ptr<Promise> promise_;
};

}  // namespace ktr::server
