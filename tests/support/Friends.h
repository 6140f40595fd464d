#pragma once

#include <memory>
#include <optional>
#include <string>

#include "platform/assistant/VASnippet.h"
#include "platform/contacts/Contact.h"

// Assistant objects and contacts for tests, in a few words.

namespace ktr::test {

/// A friend known by an e-mail address (the service's handle too), without a place.
std::shared_ptr<platform::VAKtrLocation> friendByEmail(const std::string& name, const std::string& email);
/// A friend known by a phone number (the service's handle too), without a place.
std::shared_ptr<platform::VAKtrLocation> friendByPhone(const std::string& name, const std::string& number);
/// The same friend at a place.
std::shared_ptr<platform::VAKtrLocation> placed(std::shared_ptr<platform::VAKtrLocation> object, double latitude,
                                                double longitude, std::optional<std::string> city = std::nullopt,
                                                std::optional<double> locationDate = std::nullopt);
/// "ann@example.org" of "Ann", in Springfield at 51, -1.
std::shared_ptr<platform::VAKtrLocation> placedFriend(const std::string& name, const std::string& email);

std::shared_ptr<const platform::LocationList> listOf(platform::LocationList locations);
/// A location snippet; its proximity is "dinner".
std::shared_ptr<platform::VAKtrLocationSnippet> proximitySnippet(platform::LocationList locations,
                                                                 std::optional<std::string> context = std::nullopt);

/// A fence around 51, -1 of a radius of 100 metres.
std::shared_ptr<platform::VAKtrGeoFence> fenceOf(std::shared_ptr<platform::VAPersonAttribute> person,
                                                 std::optional<std::string> trigger,
                                                 std::optional<std::string> label = std::nullopt,
                                                 std::optional<std::string> street = std::nullopt);

std::shared_ptr<platform::Contact> contactWith(const std::string& identifier, const std::string& email,
                                               const std::string& phone);

}  // namespace ktr::test
