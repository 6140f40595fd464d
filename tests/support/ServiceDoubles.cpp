#include "tests/support/ServiceDoubles.h"

#include <gtest/gtest.h>

namespace ktr::test {

FakeHttpTransport::~FakeHttpTransport() {
    while (!waiting.empty()) {
        fail(platform::HttpFailure::Cancelled);
    }
}

void FakeHttpTransport::send(const platform::HttpRequest& request, Completion completion) {
    requests.push_back(request);
    waiting.push_back({request, std::move(completion)});
}

void FakeHttpTransport::answer(platform::HttpAnswer answer) {
    ASSERT_FALSE(waiting.empty()) << "no request is waiting for an answer";
    const Exchange exchange = std::move(waiting.front());
    waiting.erase(waiting.begin());
    exchange.completion(std::move(answer));
}

}  // namespace ktr::test
