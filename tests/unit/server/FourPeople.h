#pragma once

#include <gtest/gtest.h>

#include <atomic>
#include <cstdint>
#include <map>
#include <memory>
#include <string>

#include "server/http/BasicCredentials.h"
#include "server/service/Service.h"
#include "tests/support/RawClient.h"

namespace ktr::test {

using server::BasicCredentials;
using server::DeviceKind;
using server::Grant;
using server::Precision;
using server::Service;
using server::Store;

/// A service over plain HTTP on this machine, that holds answers: ann, otto, mara and eve each have a phone ("ann's")
/// and a reader ("ann's ktr"), and nobody sees anybody yet.
class FourPeople : public ::testing::Test {
  protected:
    static constexpr std::int64_t kNow = 1763760000;

    void SetUp() override {
        std::string complaint;
        store_ = Store::open(server::StoreAddress::inMemory(), true, complaint);
        ASSERT_TRUE(store_) << complaint;
        for (const char* name : {"ann", "otto", "mara", "eve"}) {
            ASSERT_TRUE(store_->addPerson(name, {std::string(name) + "@x.example"}, kNow));
            ids_[name] = store_->personNamed(name)->id;
            ASSERT_TRUE(store_->addDevice(ids_[name], DeviceKind::Phone, std::string(name) + "'s", "", kNow));
            ASSERT_TRUE(store_->addDevice(ids_[name], DeviceKind::Reader, std::string(name) + "'s ktr", "", kNow));
        }
    }
    void TearDown() override {
        if (service_) {
            service_->stop();
        }
    }
    void begin() {
        Service::Setup setup;
        setup.store = store_;
        setup.now = [this] { return now_.load(); };
        setup.holdsAnswers = true;
        service_ = std::make_unique<Service>(std::move(setup));
        ASSERT_EQ(service_->start(), "");
    }
    static std::string authorization(const std::string& who, const std::string& secret) {
        return "Authorization: " + BasicCredentials{who, secret}.header() + "\r\n";
    }
    /// What goes with each of somebody's commands.
    static std::string commandHeaders(const std::string& who) {
        return authorization(who, who + "'s ktr") + "X-Orcha-Seek-API-Ver: 4.0\r\nX-Orcha-AuthScheme: Forever\r\n";
    }

    std::atomic<std::int64_t> now_ = kNow;
    std::map<std::string, std::int64_t> ids_;
    std::shared_ptr<Store> store_;
    std::unique_ptr<Service> service_;
};

}  // namespace ktr::test
