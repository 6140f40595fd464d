#pragma once

#include <map>
#include <memory>
#include <optional>
#include <string>
#include <utility>
#include <vector>

#include "platform/base/DeviceInformation.h"
#include "platform/base/Preferences.h"
#include "platform/client/DeviceOwnerAccount.h"
#include "platform/client/FriendLocationRestrictions.h"
#include "platform/client/HttpTransport.h"

// The service's side of the platform in memory, for tests: each double answers from public members that a test sets.

namespace ktr::test {

struct FakeAccount : platform::DeviceOwnerAccount {
    std::optional<std::string> person = "person-1";
    std::optional<std::string> user = "ann@example.org";
    std::optional<std::string> token = "token-1";
    std::optional<std::string> host = "service.example.org";

    std::optional<std::string> personIdentifier() const override { return person; }
    std::optional<std::string> userName() const override { return user; }
    std::optional<std::string> tokenOfType(int type) const override {
        return type == platform::kFriendLocationService ? token : std::nullopt;
    }
    std::optional<std::string> hostNameOfType(int type) const override {
        return type == platform::kFriendLocationService ? host : std::nullopt;
    }
};

struct FakeAccounts : platform::AccountStore {
    std::shared_ptr<FakeAccount> account = std::make_shared<FakeAccount>();
    mutable int asked = 0;

    std::shared_ptr<platform::DeviceOwnerAccount> deviceOwnerAccount() const override {
        ++asked;
        return account;
    }
};

struct FakeDeviceInformation : platform::DeviceInformation {
    std::optional<std::string> identifier = "device-1";
    std::optional<std::string> product = "Model 7";
    std::optional<std::string> version = "12.5.1";
    std::optional<std::string> build = "6.1.0-18";

    std::optional<std::string> uniqueDeviceIdentifier() const override { return identifier; }
    std::optional<std::string> productType() const override { return product; }
    std::optional<std::string> operatingSystemVersion() const override { return version; }
    std::optional<std::string> operatingSystemBuild() const override { return build; }
};

struct FakeDeviceLock : platform::DeviceLock {
    int state = kUnlocked;
    int lockState() const override { return state; }
};

struct FakeRestrictions : platform::FriendLocationRestrictions {
    bool restricted = false;
    bool allowed = true;
    bool isFriendLocationRestricted() const override { return restricted; }
    bool isFriendLocationAllowed() const override { return allowed; }
};

struct FakeGeographicSettings : platform::GeographicSettings {
    std::optional<std::string> country = "CH";
    std::optional<std::string> countryCode() const override { return country; }
};

struct FakePreferences : platform::Preferences {
    /// By domain and key.
    std::map<std::pair<std::string, std::string>, std::string> values;
    std::vector<std::string> synchronized;

    std::optional<std::string> value(const std::string& key, const std::string& domain) const override {
        const auto found = values.find({domain, key});
        return found != values.end() ? std::optional(found->second) : std::nullopt;
    }
    void setValue(const std::string& key, const std::optional<std::string>& value, const std::string& domain) override {
        if (value) {
            values[{domain, key}] = *value;
        } else {
            values.erase({domain, key});
        }
    }
    void synchronize(const std::string& domain) override { synchronized.push_back(domain); }
};

/// Keeps what is sent, and answers when a test says so, on the test's own thread.
struct FakeHttpTransport : platform::HttpTransport {
    struct Exchange {
        platform::HttpRequest request;
        Completion completion;
    };
    std::vector<platform::HttpRequest> requests;
    std::vector<Exchange> waiting;

    ~FakeHttpTransport() override;
    void send(const platform::HttpRequest& request, Completion completion) override;
    /// Answers the request that has waited longest.
    void answer(platform::HttpAnswer answer);
    /// The same with a body and status 200.
    void answer(const platform::Dictionary& body) { this->answer({platform::HttpFailure::None, 200, body, {}}); }
    void fail(platform::HttpFailure failure) { answer({failure, 0, {}, {}}); }
};

}  // namespace ktr::test
