#pragma once

#include <cstdint>
#include <optional>
#include <string>
#include <vector>

#include "server/rules/Visibility.h"

namespace ktr::server {

/// What a secret is for.
enum class DeviceKind {
    Phone = 0,   ///< sends positions, and hears of friends in the answer
    Reader = 1,  ///< asks where friends are, hides its owner: ktr
};

/// Somebody whom the service knows. A value.
struct Person {
    std::int64_t id = 0;
    std::string name;                  ///< unique; what friends see
    std::vector<std::string> handles;  ///< e-mail addresses and phone numbers, the preferred one first
    bool hidden = false;
};

/// Who is behind a secret. A value.
struct Device {
    std::int64_t id = 0;
    DeviceKind kind = DeviceKind::Phone;
    std::int64_t person = 0;
    std::string name;  ///< of the person
    bool hidden = false;
    std::string key;        ///< with which the phone seals its messages; empty: it does not
    std::string cardsSent;  ///< the hash of what it was last told of its friends' names
};

/// A browser that is signed in to somebody's own page. A value.
struct Browser {
    std::int64_t id = 0;
    std::int64_t person = 0;
    std::int64_t made = 0;
    std::int64_t until = 0;  ///< when it has to sign in again
};

/// What became of a link that signs in.
enum class SignIn {
    Done,
    Spent,   ///< it was used before, has ended, or never was
    Failed,  ///< the store could not be written
};

/// Somebody whom a viewer may see, with what decides it. A value.
struct Friend {
    std::int64_t person = 0;
    std::string name;
    Sharing sharing;
};

}  // namespace ktr::server
