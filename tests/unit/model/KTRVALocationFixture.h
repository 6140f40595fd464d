#pragma once

#include <memory>
#include <optional>
#include <string>
#include <vector>

#include "model/KTRVALocation.h"
#include "tests/support/PlatformTest.h"

namespace ktr::test {

/// Records, and contacts that they find.
class KTRVALocationTest : public PlatformTest {
  protected:
    KTRVALocationTest() { localization->set("org.ktr.snippets", "CITY_STATE_LABEL", "%1$@, %2$@"); }

    static std::shared_ptr<platform::VAPerson> person(const std::vector<std::optional<std::string>>& emails,
                                                      const std::vector<std::optional<std::string>>& phones,
                                                      const std::optional<std::string>& fullName = std::nullopt) {
        auto made = std::make_shared<platform::VAPerson>();
        made->fullName = fullName;
        for (const auto& address : emails) {
            made->emails.push_back(std::make_shared<platform::VAEmail>());
            made->emails.back()->emailAddress = address;
        }
        for (const auto& number : phones) {
            made->phones.push_back(std::make_shared<platform::VAPhone>());
            made->phones.back()->number = number;
        }
        return made;
    }
    static std::shared_ptr<KTRVALocation> record(const std::shared_ptr<platform::VAPerson>& of) {
        auto vela = std::make_shared<platform::VAKtrLocation>();
        vela->friend_ = std::make_shared<platform::VAPersonAttribute>();
        vela->friend_->object = of;
        return KTRVALocation::locationWithVelaLocation(vela);
    }
    static std::shared_ptr<KTRVALocation> nobody() { return record(nullptr); }
    /// A record made of an answer with this "location" member.
    static std::shared_ptr<KTRVALocation> decoded(const platform::Value& location) {
        return KTRVALocation::locationWithHandle("ann@example.com", nullptr,
                                                 platform::Dictionary{{"location", location}});
    }
    static std::shared_ptr<platform::VAKtrLocation> decodedAddress(const platform::Value& address) {
        return decoded(platform::Dictionary{{"address", address}})->velaLocation();
    }
    static std::optional<std::string> labelOf(const platform::Value& labels) {
        return decoded(platform::Dictionary{{"labels", labels}})->velaLocation()->label;
    }
    std::shared_ptr<platform::Contact> addContact(const std::string& identifier,
                                                  const std::optional<std::string>& email,
                                                  const std::optional<std::string>& phone,
                                                  const std::string& thumbnail = "") {
        auto contact = std::make_shared<platform::Contact>();
        contact->identifier = identifier;
        contact->givenName = "Ann";
        contact->familyName = "Nakamura";
        if (email) {
            contact->emailAddresses.push_back({"home", *email});
        }
        if (phone) {
            contact->phoneNumbers.push_back({"mobile", *phone});
        }
        if (!thumbnail.empty()) {
            contact->thumbnailImageData = platform::Bytes(thumbnail.begin(), thumbnail.end());
        }
        contacts->contacts.push_back(contact);
        return contact;
    }
    static std::string imageName(const std::shared_ptr<platform::Image>& image) {
        const auto fake = std::dynamic_pointer_cast<FakeImage>(image);
        return fake ? fake->name : "none";
    }
};

}  // namespace ktr::test
