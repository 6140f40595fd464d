#pragma once

#include <memory>
#include <optional>
#include <string>

#include "model/KTRVALocation.h"

namespace ktr {

/// The user's own entry: a friend's record that also tells whether friends can see it. Main thread.
class KTRVAMyLocation : public KTRVALocation {
  public:
    /// The user's place as the assistant has it, adopted as it stands; without one, a record without a place, known by
    /// the given address, or without one by the account's user name, which may be a phone number. A given empty address
    /// counts as given.
    virtual bool initWithMyLocation(bool visible, const std::shared_ptr<platform::VAKtrLocation>& velaLocation,
                                    const std::optional<std::string>& preferredEmail);
    /// The user's place from an entry of the service's answer (as in `decodeHandle`); none leaves it empty. The handle
    /// is chosen in the same way.
    virtual bool initWithMyLocation(bool visible, const std::optional<platform::Dictionary>& dictionary,
                                    const std::optional<std::string>& preferredEmail);
    static std::shared_ptr<KTRVAMyLocation> myLocation(bool visible,
                                                       const std::shared_ptr<platform::VAKtrLocation>& velaLocation,
                                                       const std::optional<std::string>& preferredEmail);
    static std::shared_ptr<KTRVAMyLocation> myLocation(bool visible,
                                                       const std::optional<platform::Dictionary>& dictionary,
                                                       const std::optional<std::string>& preferredEmail);

    /// "Hidden" as long as the user is, whatever place is known; else a friend's line.
    std::string friendLocation(bool refreshFinished) const override;
    /// Always none: one's own place has no age in words.
    std::optional<std::string> prettyTimestamp() const { return std::nullopt; }
    /// The plugin's bundle.
    static std::shared_ptr<platform::Bundle> bundle();
    std::string description() const override;

    /// Friends can see where the user is.
    bool isVisible() const { return isVisible_; }
    void setIsVisible(bool visible) { isVisible_ = visible; }
    /// A slot for the account's user name; the record never fills it.
    const std::optional<std::string>& username() const { return username_; }
    void setUsername(std::optional<std::string> username) { username_ = std::move(username); }

  private:
    void decode(bool visible, const std::optional<platform::Dictionary>& dictionary,
                const std::optional<std::string>& preferredEmail);

    bool isVisible_ = false;
    std::optional<std::string> username_;
};

}  // namespace ktr
