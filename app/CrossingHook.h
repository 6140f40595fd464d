#pragma once

#include <cstdint>
#include <functional>
#include <string>
#include <vector>

#include "app/CrossingWords.h"
#include "linux/net/HttpsClient.h"

namespace ktr::app {

/// Posts crossings to an address of the user's own over HTTPS, signed, so that whoever gets them knows whom they are
/// from: "Ktr-Signature: t=SECONDS,v1=HEX", where HEX is the HMAC-SHA256 (RFC 2104) of "SECONDS.BODY". A number of
/// attempts, no redirects. Main thread.
class CrossingHook {
  public:
    struct Setup {
        std::string url;
        std::string key;
        std::vector<std::string> certificateFiles;
        std::function<void(const std::string& line)> tell;
    };
    static constexpr int kAttempts = 3;

    /// What is wrong with an address: it is no HTTPS, or carries a name or password; empty: nothing.
    static std::string objection(const std::string& url);
    static std::string signature(const std::string& key, std::int64_t seconds, const std::string& body);
    static std::string body(const Crossing& crossing);

    explicit CrossingHook(Setup setup) : setup_(std::move(setup)) {}
    /// Calls `done` when somebody has taken it, or nobody will.
    void post(const Crossing& crossing, std::function<void()> done) { attempt(crossing, 1, std::move(done)); }

  private:
    void attempt(const Crossing& crossing, int number, std::function<void()> done);

    const Setup setup_;
    linux_::HttpsClient client_;
};

}  // namespace ktr::app
