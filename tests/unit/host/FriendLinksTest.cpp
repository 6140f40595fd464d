#include "host/links/FriendLinks.h"

#include <gtest/gtest.h>

#include "host/links/LinkPolicy.h"

namespace ktr::host {

namespace {

TEST(FriendLinksTest, NumbersAreDialledAsDigits) {
    EXPECT_EQ(FriendLinks::call("+44 (0)1632 960-018"), "tel:+4401632960018");
    EXPECT_EQ(FriendLinks::call("٠١٦٣٢"), "tel:01632");
    EXPECT_EQ(FriendLinks::call("960018;ext=1?x&y"), "tel:9600181");
    EXPECT_EQ(FriendLinks::call("call me"), std::nullopt);
    EXPECT_EQ(FriendLinks::call("+"), std::nullopt);
    EXPECT_EQ(FriendLinks::call(""), std::nullopt);
}

TEST(FriendLinksTest, AnAddressBringsNothingElseWithIt) {
    EXPECT_EQ(FriendLinks::write("ann@harbour.example"), "mailto:ann@harbour.example");
    EXPECT_EQ(FriendLinks::write("ann@harbour.example?bcc=eve@brin.example&body=x"),
              "mailto:ann@harbour.example%3Fbcc%3Deve@brin.example%26body%3Dx");
    EXPECT_EQ(FriendLinks::write("a,b@harbour.example"), "mailto:a%2Cb@harbour.example");
    EXPECT_EQ(FriendLinks::write("nobody"), std::nullopt);
    EXPECT_EQ(FriendLinks::write("@"), std::nullopt);
    EXPECT_EQ(FriendLinks::write("ann@"), std::nullopt);
}

TEST(FriendLinksTest, WhatThePageMakesMayBeOpenedByIt) {
    const std::string place = FriendLinks::place({50.2155, -3.1111}, "Ann & (Otto)");
    EXPECT_EQ(place, "geo:50.2155,-3.1111?q=50.2155,-3.1111(Ann%20%26%20%28Otto%29)");
    for (const std::string& url : {place, *FriendLinks::call("+441632960018"),
                                   *FriendLinks::write("l\xC3\xA9"
                                                       "a@mail.example")}) {
        EXPECT_EQ(LinkPolicy::decide(url, LinkPolicy::From::FriendPage),
                  LinkPolicy::Target(LinkPolicy::Elsewhere{url}));
        EXPECT_EQ(LinkPolicy::decide(url, LinkPolicy::From::Conversation), LinkPolicy::Target(LinkPolicy::Refused{}));
    }
    EXPECT_EQ(FriendLinks::placeText({50.2155, -3.1111}), "50.21550, -3.11110");
}

}  // namespace

}  // namespace ktr::host
