#pragma once

#include <memory>
#include <string>

#include "model/KTRVALocation.h"
#include "platform/assistant/VAKtrGeoFence.h"
#include "platform/location/PlatformLocation.h"

namespace ktr {

/// A map in words, for those who hear it: who or what is where, how sure that is, and how far and in which direction
/// from the user. Localized in whole sentences; what is not known is left out. Main thread.
class MapSentences {
  public:
    /// `user` may be none.
    static std::string ofFriend(const KTRVALocation& record, const std::shared_ptr<platform::PlatformLocation>& user);
    /// The place by its label, the circle by its radius.
    static std::string ofFence(const platform::VAKtrGeoFence& fence,
                               const std::shared_ptr<platform::PlatformLocation>& user);
    /// None: where the user is is not known.
    static std::string ofUser(const std::shared_ptr<platform::PlatformLocation>& user);
};

}  // namespace ktr
