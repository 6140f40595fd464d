#pragma once

#include <memory>
#include <optional>
#include <string>

#include "model/KTRVABaseModel.h"
#include "platform/assistant/VALocation.h"
#include "platform/base/Bundle.h"
#include "platform/base/Region.h"
#include "platform/base/Value.h"
#include "platform/client/DistanceCalculator.h"
#include "platform/location/PlatformLocation.h"
#include "platform/ui/Image.h"

namespace ktr {

/// A friend as rows and maps see them: who they are, where, since when and how far away. It wraps one assistant object,
/// which holds everything. Filled once, then only read. Missing data reads as none; nothing is reported. Main thread.
class KTRVALocation : public KTRVABaseModel {
  public:
    /// Adopts the object as it stands.
    virtual bool initWithVelaLocation(const std::shared_ptr<platform::VAKtrLocation>& velaLocation);
    /// Fills a new object with `decodeHandle`.
    virtual bool initWithHandle(const std::optional<std::string>& handle,
                                const std::shared_ptr<platform::VAPerson>& vaPerson,
                                const std::optional<platform::Dictionary>& dictionary);
    static std::shared_ptr<KTRVALocation> locationWithVelaLocation(
        const std::shared_ptr<platform::VAKtrLocation>& velaLocation);
    static std::shared_ptr<KTRVALocation> locationWithHandle(const std::optional<std::string>& handle,
                                                             const std::shared_ptr<platform::VAPerson>& vaPerson,
                                                             const std::optional<platform::Dictionary>& dictionary);
    /// As `locationWithHandle`, of an entry that stays where it is: of a thousand none is copied.
    static std::shared_ptr<KTRVALocation> locationWithEntry(const std::string& handle,
                                                            const std::shared_ptr<platform::VAPerson>& vaPerson,
                                                            const platform::Dictionary* entry);

    /// Replaces the wrapped object by a new one made of the handle, the person (none: looked up in the contacts by the
    /// handle) and one entry of the service's answer. The entry:
    ///   "distanceInMeters": a decimal number as a string, metres
    ///   "location": { "latitude", "longitude": degrees; "horizontalAccuracy": metres; "timestamp": milliseconds since
    ///     1970; "streetAddress"; "labels": [{"label"}], the first that has one counts;
    ///     "address": { "locality"; "stateCode", or "administrativeArea" when "stateCode" is absent altogether } }
    /// A null or wrongly typed value counts as absent, except "stateCode": null or wrongly typed it is none, without
    /// the fallback.
    virtual void decodeHandle(const std::optional<std::string>& handle,
                              const std::shared_ptr<platform::VAPerson>& vaPerson,
                              const std::optional<platform::Dictionary>& dictionary);
    /// A person with this one handle, and the name and identifier of the contact that has it, if there is one. Never
    /// none.
    std::shared_ptr<platform::VAPerson> personForEmailFromContacts(const std::optional<std::string>& email) const;
    std::shared_ptr<platform::VAPerson> personForPhoneFromContacts(const std::optional<std::string>& phone) const;
    /// The user's decimal style.
    static std::shared_ptr<platform::NumberFormatter> numberFormatter();

    const std::shared_ptr<platform::VAKtrLocation>& velaLocation() const { return velaLocation_; }
    void setVelaLocation(std::shared_ptr<platform::VAKtrLocation> location) { velaLocation_ = std::move(location); }
    /// A slot for a view to keep the friend's picture in; the record never fills it.
    const std::shared_ptr<platform::Image>& cachedFriendImage() const { return cachedFriendImage_; }
    void setCachedFriendImage(std::shared_ptr<platform::Image> image) { cachedFriendImage_ = std::move(image); }

    /// The full name, else the handle for reading; empty when there is neither.
    std::string friendName() const;
    /// The last of the person's e-mail addresses, or of their numbers, where it stands. A present empty one counts.
    const std::optional<std::string>& friendEmail() const;
    const std::optional<std::string>& friendPhone() const;
    /// The e-mail address, else the number.
    const std::optional<std::string>& friendHandle() const;
    /// The e-mail address, else the number for reading; empty without either.
    std::string friendHandlePretty() const;
    /// The e-mail address, else the number's digits and "+"; empty without either.
    std::string unformattedHandle() const;
    /// Whether there is a number and no e-mail address.
    bool isPhone() const;
    /// In the display style of the home country; unchanged when it is no number.
    std::string formatPhoneNumber(const std::string& phoneNumber) const;
    /// The decimal digits (of any script) and "+" alone.
    std::string unformatPhoneNumber(const std::string& phoneNumber) const;

    /// Whether latitude and longitude are known; 0 is known.
    bool hasCoordinate() const;
    /// The place in a line: the label as it stands, else city and state, else "no location" when the refresh has
    /// finished and "locating" while it has not.
    virtual std::string friendLocation(bool refreshFinished) const;
    /// The distance from the user's position to the friend, in the user's words; none when either is unknown.
    std::optional<std::string> distanceFromLocation(const std::shared_ptr<platform::PlatformLocation>& location) const;
    /// One per installed platform, made on first use.
    static std::shared_ptr<platform::DistanceCalculator> distanceCalculator();

    /// The friend's picture from the contacts; none when no contact has one.
    std::shared_ptr<platform::Image> friendImage() const;
    /// By the person's assistant identifier first, then as `friendImageForVAPerson`.
    static std::shared_ptr<platform::Image> friendImageForPersonAttribute(
        const std::shared_ptr<platform::VAPersonAttribute>& attribute);
    /// By each e-mail address, then by each number, in their order. None for an object that is no person.
    static std::shared_ptr<platform::Image> friendImageForVAPerson(
        const std::shared_ptr<platform::AssistantObject>& object);
    /// The plugin's bundle, where the texts are looked up.
    static std::shared_ptr<platform::Bundle> bundle();

  private:
    const platform::VAPerson* person() const;
    void decodeEntry(const std::optional<std::string>& handle, const std::shared_ptr<platform::VAPerson>& vaPerson,
                     const platform::Dictionary* entry);
    void decodeAddress(const platform::Dictionary& address);
    void decodeFix(const platform::Dictionary& location);

    std::shared_ptr<platform::VAKtrLocation> velaLocation_;
    std::shared_ptr<platform::Image> cachedFriendImage_;
};

}  // namespace ktr
