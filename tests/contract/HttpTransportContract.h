#pragma once

#include <gtest/gtest.h>

#include <functional>
#include <memory>
#include <string>

#include "platform/client/HttpTransport.h"

namespace ktr::test {

/// A transport, a command that it may send, and the other side.
struct HttpTransportUnderTest {
    std::shared_ptr<platform::HttpTransport> transport;
    platform::HttpRequest request;
    /// The other side answers commands, those that wait and those that come, with `{"a":1}`; or it breaks them off.
    std::function<void(bool breaksOff)> letEnd;
};

struct HttpTransportCase {
    std::string name;
    std::function<HttpTransportUnderTest()> make;
};

class HttpTransportContract : public ::testing::TestWithParam<HttpTransportCase> {
  protected:
    void SetUp() override { subject = GetParam().make(); }

    HttpTransportUnderTest subject;
};

}  // namespace ktr::test
