#pragma once

#include <cstdint>
#include <functional>
#include <optional>
#include <string>
#include <vector>

#include "platform/base/Value.h"
#include "server/http/HttpReply.h"
#include "server/rules/Grant.h"
#include "server/store/Store.h"

namespace ktr::server {

/// The commands with which a person asks about, and changes, what they share, and hears of their own places and of who
/// lets them see where they are
/// (docs/service-protocol.md). Any thread.
class AskCommands {
  public:
    struct Setup {
        Store& store;
        std::function<std::int64_t()> now;
    };

    explicit AskCommands(Setup setup) : setup_(std::move(setup)) {}

    /// False: this is none of these commands.
    bool answer(const std::string& command, const Device& device, const platform::Dictionary& body,
                const HttpReply& reply) const;

  private:
    struct Wish {
        enum class Kind { Read, Hide, Share };
        Kind kind = Kind::Read;
        std::vector<std::string> with;  ///< handles; none: everybody whom a rule names
        std::optional<std::int64_t> until;
        std::optional<Precision> precision;
    };
    static std::optional<Wish> read(const platform::Dictionary& body, std::string& complaint);

    /// Asks those with these handles to share; answered alike whoever has them, and whether anybody does.
    void askToShare(const Device& device, const platform::Dictionary& body, const HttpReply& reply) const;
    void sharing(const Device& device, const Wish& wish, const HttpReply& reply) const;
    void tell(const Device& device, bool tellsViewers, const HttpReply& reply) const;
    void places(const Device& device, const HttpReply& reply) const;
    /// Those whom the person would see now; who hides, ended a rule or was never heard is no different from a stranger.
    void friends(const Device& device, const HttpReply& reply) const;

    const Setup setup_;
};

}  // namespace ktr::server
