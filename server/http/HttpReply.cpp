#include "server/http/HttpReply.h"

#include <atomic>
#include <utility>

namespace ktr::server {

class HttpReply::Promise {
  public:
    explicit Promise(Done done) : done_(std::move(done)) {}
    ~Promise() { keep(std::nullopt); }
    Promise(const Promise&) = delete;
    Promise& operator=(const Promise&) = delete;

    void keep(std::optional<HttpResponse> response) {
        if (!kept_.exchange(true)) {
            done_(std::move(response));
        }
    }

  private:
    Done done_;
    std::atomic<bool> kept_ = false;
};

HttpReply::HttpReply(Done done) : promise_(std::make_shared<Promise>(std::move(done))) {}

void HttpReply::send(HttpResponse response) const {
    promise_->keep(std::move(response));
}

}  // namespace ktr::server
