#include "server/http/ClientAddress.h"

#include <arpa/inet.h>
#include <gtest/gtest.h>
#include <netinet/in.h>

#include <string>
#include <utility>
#include <vector>

namespace ktr::test {

using server::ClientAddress;
using server::HttpRequest;

namespace {

std::string forwarded(std::vector<std::pair<std::string, std::string>> headers) {
    HttpRequest request;
    request.headers = std::move(headers);
    return ClientAddress::forwardedFor(request);
}

sockaddr_storage six(const char* text) {
    sockaddr_storage bytes{};
    bytes.ss_family = AF_INET6;
    ::inet_pton(AF_INET6, text, &reinterpret_cast<sockaddr_in6*>(&bytes)->sin6_addr);
    return bytes;
}

}  // namespace

TEST(ClientAddressTest, LastHop_IsTheClient_WhatTheClientWroteIsNot) {
    EXPECT_EQ(forwarded({{"X-Forwarded-For", "192.0.2.1"}}), "192.0.2.1");
    EXPECT_EQ(forwarded({{"x-forwarded-for", "10.0.0.1, evil ,192.0.2.7"}}), "192.0.2.7");
    EXPECT_EQ(forwarded({{"X-Forwarded-For", "10.0.0.1"}, {"X-Forwarded-For", "192.0.2.8"}}), "192.0.2.8");
    EXPECT_EQ(forwarded({{"Forwarded", "for=10.0.0.1, for=192.0.2.9;proto=https;by=_x"}}), "192.0.2.9");
    EXPECT_EQ(forwarded({{"Forwarded", "proto=https; For=\"[2001:db8:1:2:3:4:5:6]:4711\""}}), "2001:db8:1:2::");
}

TEST(ClientAddressTest, AddressOfIPv6_IsItsNetwork_PortsAreLeftOut) {
    EXPECT_EQ(forwarded({{"X-Forwarded-For", "2001:db8::1"}}), "2001:db8::");
    EXPECT_EQ(forwarded({{"X-Forwarded-For", "[2001:db8::1]:80"}}), "2001:db8::");
    EXPECT_EQ(forwarded({{"X-Forwarded-For", "192.0.2.1:80"}}), "192.0.2.1");
    EXPECT_EQ(forwarded({{"X-Forwarded-For", "::ffff:192.0.2.1"}}), "192.0.2.1");
}

TEST(ClientAddressTest, WhatIsNoAddress_IsUnclear) {
    for (const char* text : {"", "unknown", "_hidden", "192.0.2.1, ", "192.0.2", "[192.0.2.1]", "[2001:db8::1",
                             "2001:db8::1%eth0", "unix:", "192.0.2.1 x"}) {
        EXPECT_EQ(forwarded({{"X-Forwarded-For", text}}), ClientAddress::kUnclear) << text;
    }
    EXPECT_EQ(forwarded({{"Forwarded", "by=192.0.2.1"}}), ClientAddress::kUnclear);
    EXPECT_EQ(forwarded({}), ClientAddress::kUnclear);
}

TEST(ClientAddressTest, TwoHeadersThatDisagree_AreUnclear_SinceOneIsTheClients) {
    EXPECT_EQ(forwarded({{"X-Forwarded-For", "192.0.2.1"}, {"Forwarded", "for=192.0.2.1"}}), "192.0.2.1");
    EXPECT_EQ(forwarded({{"X-Forwarded-For", "192.0.2.1"}, {"Forwarded", "for=10.0.0.1"}}), ClientAddress::kUnclear);
}

TEST(ClientAddressTest, Loopback_IsKnownInBothFamilies) {
    EXPECT_TRUE(ClientAddress::isLoopback(six("::1")));
    EXPECT_TRUE(ClientAddress::isLoopback(six("::ffff:127.0.0.1")));
    EXPECT_FALSE(ClientAddress::isLoopback(six("::2"))) << "of the same network";
    EXPECT_FALSE(ClientAddress::isLoopback(six("::ffff:192.0.2.1")));
    EXPECT_FALSE(ClientAddress::isLoopback(sockaddr_storage{}));
}

}  // namespace ktr::test
