#include "linux/net/ServicePolicy.h"

#include <gtest/gtest.h>

#include <QUrl>

namespace ktr::linux_ {
namespace {

TEST(OriginTest, FromText) {
    const std::pair<const char*, const char*> cases[] = {
        {"service.example.org", "service.example.org"},
        {"Service.EXAMPLE.org:8443", "service.example.org:8443"},
        {"service.example.org:443", "service.example.org"},
        {"service.example.org.", "service.example.org"},
        {"b\xC3\xBC"
         "cher.example",
         "xn--bcher-kva.example"},
        {"127.1:8443", "127.0.0.1:8443"},
        {"[::1]:8443", "[::1]:8443"},
        {"localhost", "localhost"},
        {"", "none"},
        {":8443", "none"},
        {"host:0", "none"},
        {"host:99999", "none"},
        {"user@host", "none"},
        {"@host", "none"},
        {"host/path", "none"},
        {"host?x", "none"},
        {"host#x", "none"},
        {"ex ample", "none"},
        {"https://host", "none"},
        {"a\\b", "none"},
    };
    for (const auto& [text, shown] : cases) {
        const auto origin = Origin::fromText(text);
        EXPECT_EQ(origin ? origin->text() : "none", shown) << text;
    }
}

TEST(OriginTest, FromUrl_WantsHttpsAndNobodysName) {
    EXPECT_TRUE(Origin::fromUrl(QUrl(QStringLiteral("https://host/path?x"))));
    EXPECT_FALSE(Origin::fromUrl(QUrl(QStringLiteral("http://host/"))));
    EXPECT_FALSE(Origin::fromUrl(QUrl(QStringLiteral("https://user@host/"))));
    EXPECT_FALSE(Origin::fromUrl(QUrl(QStringLiteral("https:///path"))));
    EXPECT_FALSE(Origin::fromUrl(QUrl()));
}

TEST(OriginTest, RegistrableDomain) {
    const std::pair<const char*, const char*> cases[] = {
        {"a.b.example.org", "example.org"},
        {"example.org", "example.org"},
        {"a.b.co.uk", "b.co.uk"},
        {"co.uk", "none"},
        {"org", "none"},
        {"localhost", "none"},
        {"127.0.0.1", "none"},
        {"[::1]", "none"},
        {"pages.github.io", "pages.github.io"},
        {"github.io", "none"},
    };
    for (const auto& [text, domain] : cases) {
        EXPECT_EQ(Origin::fromText(text)->registrableDomain().value_or("none"), domain) << text;
    }
}

bool allows(const ServicePolicy& policy, const char* host) {
    return policy.allows(Origin::fromText(host).value());
}

TEST(ServicePolicyTest, ServiceDomainAndItsSubdomainsAtItsPort) {
    const ServicePolicy policy("service.example.org:8443", std::nullopt);
    EXPECT_TRUE(allows(policy, "service.example.org:8443"));
    EXPECT_TRUE(allows(policy, "p12-service.example.org:8443"));
    EXPECT_TRUE(allows(policy, "deep.below.example.org:8443"));
    EXPECT_TRUE(allows(policy, "example.org:8443"));
    EXPECT_FALSE(allows(policy, "service.example.org"));
    EXPECT_FALSE(allows(policy, "service.example.org:8444"));
    EXPECT_FALSE(allows(policy, "notexample.org:8443"));
    EXPECT_FALSE(allows(policy, "example.org.evil.net:8443"));
    EXPECT_FALSE(allows(policy, "example.com:8443"));
    EXPECT_FALSE(allows(policy, "org:8443"));
}

TEST(ServicePolicyTest, NeighboursUnderAPublicSuffixAreForeign) {
    const ServicePolicy policy("mine.github.io", std::nullopt);
    EXPECT_TRUE(allows(policy, "mine.github.io"));
    EXPECT_TRUE(allows(policy, "a.mine.github.io"));
    EXPECT_FALSE(allows(policy, "theirs.github.io"));
    EXPECT_FALSE(allows(policy, "github.io"));
}

TEST(ServicePolicyTest, AddressesAndLocalNames_ExactlyThatOrigin) {
    const ServicePolicy address("127.0.0.1:8443", std::nullopt);
    EXPECT_TRUE(allows(address, "127.0.0.1:8443"));
    EXPECT_FALSE(allows(address, "127.0.0.1"));
    EXPECT_FALSE(allows(address, "1.127.0.0.1.example:8443"));
    EXPECT_FALSE(allows(address, "126.0.0.1:8443"));
    const ServicePolicy local("localhost:8443", std::nullopt);
    EXPECT_TRUE(allows(local, "localhost:8443"));
    EXPECT_FALSE(allows(local, "a.localhost:8443"));
    EXPECT_FALSE(allows(local, "127.0.0.1:8443"));
}

using Domains = std::vector<std::string>;

TEST(ServicePolicyTest, WithAList_TheHostAndTheListAlone) {
    const ServicePolicy policy("service.example.org:8443",
                               Domains{"example.net", "example.com:443", "127.0.0.1:9443", "nas"});
    EXPECT_TRUE(allows(policy, "service.example.org:8443"));
    EXPECT_FALSE(allows(policy, "example.org:8443"));
    EXPECT_FALSE(allows(policy, "a.example.org:8443"));
    EXPECT_FALSE(allows(policy, "a.service.example.org:8443"));
    EXPECT_FALSE(allows(policy, "service.example.org"));
    EXPECT_TRUE(allows(policy, "a.example.net:8443"));
    EXPECT_FALSE(allows(policy, "a.example.net"));
    EXPECT_TRUE(allows(policy, "a.example.com"));
    EXPECT_FALSE(allows(policy, "a.example.com:8443"));
    EXPECT_TRUE(allows(policy, "127.0.0.1:9443"));
    EXPECT_TRUE(allows(policy, "nas:8443"));
    EXPECT_FALSE(allows(policy, "a.nas:8443"));
    EXPECT_TRUE(policy.entriesForNobody().empty());
}

TEST(ServicePolicyTest, AnEmptyListIsTheHostAlone) {
    const ServicePolicy policy("service.example.org", Domains{});
    EXPECT_TRUE(allows(policy, "service.example.org"));
    EXPECT_FALSE(allows(policy, "other.example.org"));
    EXPECT_FALSE(allows(policy, "example.org"));
    EXPECT_TRUE(policy.entriesForNobody().empty());
}

TEST(ServicePolicyTest, WhatAllowsNobodyIsTold) {
    const Domains nobody = {"co.uk", "org", "com", "github.io", "not a domain", ""};
    const ServicePolicy policy("service.example.org", nobody);
    EXPECT_FALSE(allows(policy, "evil.co.uk"));
    EXPECT_FALSE(allows(policy, "evil.org"));
    EXPECT_FALSE(allows(policy, "org"));
    EXPECT_FALSE(allows(policy, "evil.com"));
    EXPECT_FALSE(allows(policy, "evil.github.io"));
    EXPECT_FALSE(allows(policy, "github.io"));
    EXPECT_TRUE(allows(policy, "service.example.org"));
    EXPECT_EQ(policy.entriesForNobody(), nobody);
}

TEST(ServicePolicyTest, WithoutAService_NobodyIsAllowed) {
    EXPECT_FALSE(allows(ServicePolicy("", {{"example.org"}}), "example.org"));
    EXPECT_FALSE(allows(ServicePolicy("user@example.org", std::nullopt), "example.org"));
}

}  // namespace
}  // namespace ktr::linux_
