#include "server/http/UrlQuery.h"

#include <gtest/gtest.h>

#include "server/http/BasicCredentials.h"

namespace ktr::test {

using server::BasicCredentials;
using server::UrlQuery;

TEST(UrlQueryTest, Parameters_AreUnescaped_InTheirOrder) {
    const auto query = UrlQuery::read("q=Where+is%20Ann%3F&empty&a=b=c&&q=second&bad=%zz%4");
    EXPECT_EQ(query.find("q"), "Where is Ann?");
    EXPECT_EQ(query.find("empty"), "");
    EXPECT_EQ(query.find("a"), "b=c");
    EXPECT_EQ(query.find("bad"), "%zz%4");
    EXPECT_EQ(query.find("none"), std::nullopt);
    EXPECT_EQ(query.parameters().size(), 5U);
}

TEST(UrlQueryTest, ManyParameters_AreNotAllRead) {
    std::string text;
    for (int i = 0; i < 10000; ++i) {
        text += "a&";
    }
    EXPECT_EQ(UrlQuery::read(text).parameters().size(), 200U);
}

TEST(BasicCredentialsTest, UserAndPassword_ComeBack) {
    for (const BasicCredentials& one : {BasicCredentials{"1000", "secret"}, BasicCredentials{"", ""},
                                        BasicCredentials{"ann", "a:b:c"}, BasicCredentials{"\xC3\xA4", "x"}}) {
        EXPECT_EQ(BasicCredentials::read(one.header()), one);
    }
    EXPECT_EQ((BasicCredentials{"Aladdin", "open sesame"}).header(), "Basic QWxhZGRpbjpvcGVuIHNlc2FtZQ==");
}

TEST(BasicCredentialsTest, WhatIsNone_IsNone) {
    for (const char* header : {"", "Basic", "Basic ", "Bearer YTpi", "Basic YTpi=", "Basic Y=pi", "Basic  YTpi",
                               "Basic YTp", "Basic ====", "Basic YWI="}) {
        EXPECT_EQ(BasicCredentials::read(header), std::nullopt) << header;
    }
    EXPECT_EQ(BasicCredentials::read("Basic " + std::string(8000, 'A')), std::nullopt);
}

TEST(BasicCredentialsTest, Secrets_AreTheSameAsAWhole) {
    EXPECT_TRUE(server::sameSecret("abc", "abc"));
    EXPECT_FALSE(server::sameSecret("abc", "abd"));
    EXPECT_FALSE(server::sameSecret("abc", "ab"));
    EXPECT_FALSE(server::sameSecret("", "a"));
}

}  // namespace ktr::test
