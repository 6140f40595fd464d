#include "tests/support/Friends.h"

#include <utility>

namespace ktr::test {

using namespace platform;

namespace {

std::shared_ptr<VAKtrLocation> friendNamed(const std::string& name, const std::string& handle) {
    auto object = std::make_shared<VAKtrLocation>();
    object->friend_ = std::make_shared<VAPersonAttribute>();
    object->friend_->data = handle;
    object->friend_->object = std::make_shared<VAPerson>();
    object->friend_->object->fullName = name;
    return object;
}

}  // namespace

std::shared_ptr<VAKtrLocation> friendByEmail(const std::string& name, const std::string& email) {
    auto object = friendNamed(name, email);
    auto address = std::make_shared<VAEmail>();
    address->emailAddress = email;
    object->friend_->object->emails = {address};
    return object;
}

std::shared_ptr<VAKtrLocation> friendByPhone(const std::string& name, const std::string& number) {
    auto object = friendNamed(name, number);
    auto phone = std::make_shared<VAPhone>();
    phone->number = number;
    object->friend_->object->phones = {phone};
    return object;
}

std::shared_ptr<VAKtrLocation> placed(std::shared_ptr<VAKtrLocation> object, double latitude, double longitude,
                                      std::optional<std::string> city, std::optional<double> locationDate) {
    object->latitude = latitude;
    object->longitude = longitude;
    object->accuracy = 10.0;
    object->city = std::move(city);
    object->locationDate = locationDate;
    return object;
}

std::shared_ptr<VAKtrLocation> placedFriend(const std::string& name, const std::string& email) {
    return placed(friendByEmail(name, email), 51.0, -1.0, "Springfield");
}

std::shared_ptr<const LocationList> listOf(LocationList locations) {
    return std::make_shared<const LocationList>(std::move(locations));
}

std::shared_ptr<VAKtrLocationSnippet> proximitySnippet(LocationList locations, std::optional<std::string> context) {
    auto snippet = std::make_shared<VAKtrLocationSnippet>();
    snippet->locations = listOf(std::move(locations));
    snippet->proximity = "dinner";
    if (context) {
        snippet->searchContext = Url("ktrServerContext://serverContext?" + *context);
    }
    return snippet;
}

std::shared_ptr<VAKtrGeoFence> fenceOf(std::shared_ptr<VAPersonAttribute> person, std::optional<std::string> trigger,
                                       std::optional<std::string> label, std::optional<std::string> street) {
    auto fence = std::make_shared<VAKtrGeoFence>();
    fence->friend_ = std::move(person);
    fence->geoFenceTrigger = std::move(trigger);
    fence->location = std::make_shared<VALocation>();
    fence->location->latitude = 51.0;
    fence->location->longitude = -1.0;
    fence->location->accuracy = 100.0;
    fence->location->label = std::move(label);
    fence->location->street = std::move(street);
    return fence;
}

std::shared_ptr<Contact> contactWith(const std::string& identifier, const std::string& email,
                                     const std::string& phone) {
    auto contact = std::make_shared<Contact>();
    contact->identifier = identifier;
    contact->givenName = identifier;
    if (!email.empty()) {
        contact->emailAddresses = {{"home", email}};
    }
    if (!phone.empty()) {
        contact->phoneNumbers = {{"home", phone}};
    }
    return contact;
}

}  // namespace ktr::test
