#include "linux/device/KnownSecrets.h"

#include <gtest/gtest.h>

#include "platform/base/Json.h"
#include "platform/base/Value.h"

namespace ktr::test {

using linux_::KnownSecrets;
using platform::Dictionary;
using platform::writeJson;

TEST(KnownSecretsTest, Value_IsHiddenWhateverCarriesIt) {
    KnownSecrets secrets;
    secrets.add("s3/cr\"et é");
    EXPECT_EQ(secrets.without("a s3/cr\"et é b s3/cr\"et é"), "a <hidden> b <hidden>");
    EXPECT_EQ(secrets.without(writeJson(Dictionary{{"echo", "s3/cr\"et é"}})), R"({"echo":"<hidden>"})");
    EXPECT_EQ(secrets.without("x://y?a=s3%2Fcr%22et%20%C3%A9&b"), "x://y?a=<hidden>&b");
    EXPECT_EQ(secrets.without("x://y?a=s3%2fcr%22et%20%c3%a9&b"), "x://y?a=<hidden>&b");
    EXPECT_EQ(secrets.without("s3"), "s3");
}

TEST(KnownSecretsTest, EarlierValues_StayHidden) {
    KnownSecrets secrets;
    secrets.add("first-token");
    secrets.add("second-token");
    EXPECT_EQ(secrets.without("first-token second-token"), "<hidden> <hidden>");
}

TEST(KnownSecretsTest, ValueWithinAnother_LeavesNothing) {
    KnownSecrets secrets;
    secrets.add("token");
    secrets.add("token-long");
    EXPECT_EQ(secrets.without("token-long token"), "<hidden> <hidden>");
    secrets.add("abc");
    EXPECT_EQ(secrets.without("abc"), "abc");
}

TEST(KnownSecretsTest, MemberNamedAuthToken_IsHiddenAtEveryDepth) {
    const KnownSecrets secrets;
    const Dictionary inner{{"authToken", "s3,c }ret"}, {"a", 1}};
    EXPECT_EQ(secrets.without("(" + writeJson(inner) + ")"), R"(({"authToken":"<hidden>","a":1}))");
    const std::string twice = writeJson(Dictionary{{"text", writeJson(inner)}});
    EXPECT_EQ(secrets.without(twice), R"({"text":"{\"authToken\":\"<hidden>\",\"a\":1}"})");
    EXPECT_EQ(secrets.without(R"({"authToken" : 12345, "b": 2})"), R"({"authToken" : <hidden>, "b": 2})");
    EXPECT_EQ(secrets.without("x://y?authToken=secret&b=1"), "x://y?authToken=<hidden>&b=1");
    EXPECT_EQ(secrets.without("x://y?a=%7B%22authToken%22%3A%22secret%22%7D&b=1"),
              "x://y?a=%7B%22authToken%22%3A%22<hidden>%22%7D&b=1");
    EXPECT_EQ(secrets.without(R"({"authToken":"a\\nb","c":1})").find("nb"), std::string::npos);
    EXPECT_EQ(secrets.without("no authToken here, authToken"), "no authToken here, authToken");
}

}  // namespace ktr::test
