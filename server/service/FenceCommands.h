#pragma once

#include <cstdint>
#include <functional>
#include <string>

#include "platform/base/Value.h"
#include "server/http/HttpReply.h"
#include "server/outbox/EventStreams.h"
#include "server/store/Store.h"

namespace ktr::server {

/// The commands about fences and what they tell: set one, list them, end one, hear of what happens, say what was heard
/// (docs/service-protocol.md). Any thread.
class FenceCommands {
  public:
    struct Setup {
        Store& store;
        std::function<std::int64_t()> now;
        /// Answers as to a get-locations command.
        std::function<void(const Device&, const platform::Dictionary& body, const HttpReply&)> locations;
    };

    explicit FenceCommands(Setup setup) : setup_(std::move(setup)) {}

    /// False: this is no command about fences.
    bool answer(const std::string& command, const Device& device, const platform::Dictionary& body,
                const HttpReply& reply) const;

  private:
    void set(const Device& device, const platform::Dictionary& body, const HttpReply& reply) const;
    void list(const Device& device, const HttpReply& reply) const;
    void end(const Device& device, const platform::Dictionary& body, const HttpReply& reply) const;
    void acknowledge(const Device& device, const platform::Dictionary& body, const HttpReply& reply) const;

    const Setup setup_;
};

}  // namespace ktr::server
