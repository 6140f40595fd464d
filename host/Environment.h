#pragma once

#include <memory>
#include <variant>

#include "host/Failure.h"
#include "host/HostSettings.h"
#include "host/live/LiveServices.h"
#include "linux/contacts/UserContacts.h"
#include "platform/base/Platform.h"
#include "platform/base/VirtualTime.h"

namespace ktr::host {

/// The platform of a conversation, put together from the Linux implementations. Main thread, while a QGuiApplication
/// exists.
struct Environment {
    using Contacts = linux_::UserContacts::Contacts;

    std::shared_ptr<platform::Platform> platform;
    /// The platform's clock and loop when time is virtual; else none.
    std::shared_ptr<platform::VirtualTime> virtualTime;

    /// What a live conversation asks; else none.
    std::unique_ptr<LiveServices> live;
    /// The contacts of what is live: a picture is of one moment. It goes before the platform's main loop does.
    std::unique_ptr<linux_::UserContacts> userContacts;

    /// Log and loop come first and are installed while the rest is made, so that what is found on the way is reported.
    /// The platform itself is not installed yet, and a failure leaves none behind. A failure for contacts that cannot
    /// be read and for missing resources. With a live configuration time is the present; without one nothing outside
    /// the conversation is asked.
    static std::variant<Environment, Failure> make(const HostSettings& settings, bool virtualTime);
    /// Makes another platform for settings that have changed, in the place of `platform`, which the caller has
    /// installed and uninstalls. Log, loop, clock, appearance, maps and what is live go on. With a failure everything
    /// stays as it was.
    /// `contacts`: what has been read again; none: those from before.
    std::optional<Failure> remake(const HostSettings& settings, const Contacts* contacts = nullptr);

  private:
    /// None, and why in `error`, where the files cannot be read.
    std::optional<Contacts> readContacts(const HostSettings& settings, bool isLive, std::string& error);
    std::optional<Failure> fill(platform::Platform& made, const HostSettings& settings, const Contacts& contacts,
                                const platform::Platform* earlier);
    bool isVirtual_ = false;
    Contacts contacts_;
};

}  // namespace ktr::host
