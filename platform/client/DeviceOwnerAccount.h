#pragma once

#include <memory>
#include <optional>
#include <string>

#include "platform/base/Api.h"

namespace ktr::platform {

/// The kind of token, and of host, that the friend-location service uses.
inline constexpr int kFriendLocationService = 0;

/// The account of the person who owns this device. A snapshot: it does not change once it is handed out. Any thread.
class KTR_API DeviceOwnerAccount {
  public:
    virtual ~DeviceOwnerAccount();
    /// Names the person to the service; none for an account that is not complete.
    virtual std::optional<std::string> personIdentifier() const = 0;
    virtual std::optional<std::string> userName() const = 0;
    /// A secret: it is neither logged nor stored. None when there is none, or when it cannot be read now.
    virtual std::optional<std::string> tokenOfType(int type) const = 0;
    /// The host of the service, with ":port" when the port is not the scheme's own; none when the account names none.
    virtual std::optional<std::string> hostNameOfType(int type) const = 0;
};

class KTR_API AccountStore {
  public:
    virtual ~AccountStore();
    /// Null when not signed in. Main thread; answers from memory.
    virtual std::shared_ptr<DeviceOwnerAccount> deviceOwnerAccount() const = 0;
};

}  // namespace ktr::platform
