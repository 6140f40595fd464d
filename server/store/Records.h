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
    std::string zone = {};  ///< where their day ends, as for `WallClock`
};

/// How long something is kept of a person. A value.
struct Retention {
    static constexpr std::int64_t kLongestFixes = std::int64_t{48} * 3600;
    static constexpr std::int64_t kLongestLooks = std::int64_t{30} * 86400;

    std::int64_t fixes = kLongestFixes;  ///< seconds
    std::int64_t looks = kLongestLooks;  ///< seconds; full hours count

    bool operator==(const Retention&) const = default;
};

/// Who is behind a secret. A value.
struct Device {
    std::int64_t id = 0;
    DeviceKind kind = DeviceKind::Phone;
    std::int64_t person = 0;
    std::string name;  ///< of the person
    bool hidden = false;
    std::int64_t retention = 0;  ///< how long the person's fixes are kept, seconds
    std::string key;             ///< with which the phone seals its messages; empty: it does not
    bool shared = false;         ///< it is a child's, or several people's: it says itself by whom they are seen
    bool holdsEvents = false;    ///< a phone: its app shows who came and went
};

/// What a handle stands for, to somebody who asks for it. A value.
struct Asked {
    std::int64_t person = 0;  ///< 0: nobody has this handle
    Sharing sharing;          ///< without a grant when nobody has it
};

/// A phone or a reader, as its person sees it. Times are seconds since 1970. A value.
struct DeviceFacts {
    std::int64_t id = 0;
    DeviceKind kind = DeviceKind::Phone;
    bool shared = false;
    std::int64_t made = 0;
    std::optional<std::int64_t> heard;    ///< last; none: never
    std::optional<std::int64_t> revoked;  ///< none: it is in use
};

/// Somebody saw somebody. A value.
struct Look {
    std::string viewer;
    std::int64_t hour = 0;  ///< when that hour began, seconds since 1970
    bool asked = false;     ///< else carried along with what a phone is told
};

/// What somebody wishes for those who are named: that a rule ends, or begins or goes on as it is said here. A value.
struct RuleWish {
    bool ends = false;
    std::optional<std::int64_t> until;   ///< seconds since 1970; none: without an end
    std::optional<Precision> precision;  ///< none: as before, exact for a new rule
};

/// What became of the answer to "is this grant still meant?".
enum class Confirmation {
    Kept,
    HasAnEnd,    ///< nobody asks about such a grant
    IsNotThere,  ///< or it is over
    Failed,      ///< the store could not be written
};

/// A browser that is signed in to somebody's own page. A value.
struct Browser {
    std::int64_t id = 0;
    std::int64_t person = 0;
    std::int64_t made = 0;
    std::int64_t until = 0;  ///< when it has to sign in again
};

/// Somebody would like to see where somebody is. A value.
struct AskedBy {
    std::int64_t asker = 0;
    std::string name;
    std::string handle;     ///< the first; empty: there is none
    std::int64_t time = 0;  ///< seconds since 1970
};

/// What became of asking somebody to share.
enum class AskOutcome {
    Asked,    ///< or asked before on that day, or nobody is there: it is said to nobody which
    TooMany,  ///< of whomever, on one day
    Failed,   ///< the store could not be written
};

/// What became of a link that signs in.
enum class SignIn {
    Done,
    Spent,   ///< it was used before, has ended, or never was
    Failed,  ///< the store could not be written
};

/// What a phone was last told of who somebody is. A value.
struct SentCard {
    std::string hash;       ///< of what the card said; empty: there was none
    std::int64_t time = 0;  ///< seconds since 1970
    std::int64_t post = 0;  ///< the time of the fix that it answered; 0: none

    bool operator==(const SentCard&) const = default;
};

/// Somebody's card, as one phone has it. A value.
struct CardState {
    std::string faceHash;  ///< of the face there is now; empty: there is none
    SentCard sent;

    bool operator==(const CardState&) const = default;
};

/// Somebody whom a viewer may see, with what decides it. A value.
struct Friend {
    std::int64_t person = 0;
    std::string name;
    Sharing sharing;
};

}  // namespace ktr::server
