#include <string>

#include "documents/JsonReader.h"
#include "platform/base/Json.h"
#include "server/ingest/SealedText.h"
#include "tests/unit/server/FourPeople.h"

namespace ktr::test {

/// "Where is Ann right now?": ann has a phone, otto sees her exactly, mara her town, eve nothing. What is looked at is
/// what is written to the phone, and what the one who asks gets to read.
class FreshFixTest : public FourPeople {
  protected:
    static constexpr const char* kAndroid = "Owntracks-Android/gms/420506000";
    static constexpr const char* kIphone = "OwnTracks/18.5 CFNetwork/1494.0.7 Darwin/23.4.0";
    static constexpr const char* kReport = R"({"_type":"cmd","action":"reportLocation"})";

    void SetUp() override {
        ASSERT_NO_FATAL_FAILURE(FourPeople::SetUp());
        ASSERT_TRUE(store_->grant(ids_["ann"], ids_["otto"], {Precision::Exact, kNow - 9000, std::nullopt}));
        ASSERT_TRUE(store_->grant(ids_["ann"], ids_["mara"], {Precision::Town, kNow - 9000, std::nullopt}));
        ASSERT_NO_FATAL_FAILURE(begin());
    }

    static std::string bodyOf(const std::string& answer) {
        const std::size_t begin = answer.find("\r\n\r\n");
        std::string body = begin == std::string::npos ? answer : answer.substr(begin + 4);
        // What the client notes of a connection that was closed.
        const std::size_t end = body.rfind("(end)");
        body.erase(end == std::string::npos ? body.size() : end);
        body.erase(body.find_last_not_of("\r\n") + 1);
        return body;
    }
    std::string send(const std::string& path, const std::string& headers, const std::string& body) const {
        const RawClient client(service_->port());
        client.send("POST " + path + " HTTP/1.1\r\nHost: localhost\r\nConnection: close\r\n" + headers +
                    "Content-Type: application/json\r\nContent-Length: " + std::to_string(body.size()) + "\r\n\r\n" +
                    body);
        return bodyOf(client.read(""));
    }
    std::string ask(const std::string& who, const std::string& handles, const char* fresh = R"(,"fresh":true)") const {
        return send("/qloxservice/friends/va/getlocations", commandHeaders(who),
                    R"({"clientContext":{},"handles":[)" + handles + "]" + fresh + "}");
    }
    /// What ann's phone is answered, that says where it was so many seconds ago.
    std::string post(std::int64_t age, const std::string& agent = kAndroid, const std::string& secret = "ann's") const {
        return postBody(R"({"_type":"location","tid":"an","acc":10,"lat":50.2,"lon":-3.1,"tst":)" +
                            std::to_string(now_ - age) + "}",
                        agent, secret);
    }
    std::string postBody(const std::string& body, const std::string& agent, const std::string& secret = "ann's") const {
        return send("/pub", authorization("ann", secret) + "User-Agent: " + agent + "\r\n", body);
    }
    static std::string since(std::int64_t time) { return std::to_string(time) + "000"; }
};

TEST_F(FreshFixTest, AndroidPhone_IsToldToReportOnce_WithTheAnswerToItsNextPost) {
    EXPECT_EQ(post(600), "[]");
    const std::string answer = ask("otto", R"("ann@x.example")");
    EXPECT_NE(answer.find(R"("asked":{"ann@x.example":)" + since(kNow) + "}"), std::string::npos) << answer;
    EXPECT_NE(answer.find(R"("latitude":50.2)"), std::string::npos) << answer;
    now_ += 30;
    EXPECT_EQ(post(120), std::string("[") + kReport + "]");
    now_ += 1;
    // The phone reports, perhaps with the same fix: that must not make it report again.
    EXPECT_EQ(post(121), "[]");
}

TEST_F(FreshFixTest, PingWithoutAPlace_IsAnsweredSoToo) {
    ask("otto", R"("ann@x.example")");
    const std::string ping =
        R"({"_type":"location","t":"p","tid":"an","lat":50.2,"lon":-3.1,"tst":)" + std::to_string(kNow + 1) + "}";
    EXPECT_EQ(postBody(ping, kAndroid), std::string("[") + kReport + "]");
}

TEST_F(FreshFixTest, PostThatIsNewerThanTheQuestion_IsTheAnswer) {
    ask("otto", R"("ann@x.example")");
    now_ += 60;
    EXPECT_EQ(post(10), "[]");
    EXPECT_EQ(post(3000), "[]");
}

TEST_F(FreshFixTest, OtherPhones_AreNeverTold) {
    for (const char* agent : {kIphone, "", "curl/7.88", "GPSLogger/132", "owntracks-android/gms/1"}) {
        ask("otto", R"("ann@x.example")");
        EXPECT_EQ(post(600, agent), "[]") << agent;
    }
}

TEST_F(FreshFixTest, WithoutTheWish_NobodyIsTold) {
    const std::string answer = ask("otto", R"("ann@x.example")", "");
    EXPECT_EQ(answer.find("asked"), std::string::npos) << answer;
    EXPECT_EQ(ask("otto", R"("ann@x.example")", R"(,"fresh":false)").find("asked"), std::string::npos);
    EXPECT_NE(ask("otto", R"("ann@x.example")", R"(,"fresh":1)").find(R"("statusCode":400)"), std::string::npos);
    EXPECT_EQ(post(600), "[]");
}

TEST_F(FreshFixTest, WhoDoesNotSeeExactly_MakesNoPhoneWork) {
    EXPECT_NE(ask("mara", R"("ann@x.example")").find("\"asked\""), std::string::npos);
    EXPECT_NE(ask("eve", R"("ann@x.example")").find("\"asked\""), std::string::npos);
    EXPECT_EQ(post(600), "[]");
}

TEST_F(FreshFixTest, WhoHides_IsToldNothing_AndReadsLikeNobody) {
    post(600);
    ASSERT_TRUE(store_->setHidden(ids_["ann"], true, kNow));
    std::string hidden = ask("otto", R"("ann@x.example")");
    const std::string nobody = ask("otto", R"("eva@x.example")");
    const std::size_t at = hidden.find("ann@");
    ASSERT_NE(at, std::string::npos);
    for (std::size_t i = at; i != std::string::npos; i = hidden.find("ann@")) {
        hidden.replace(i, 3, "eva");
    }
    EXPECT_EQ(hidden, nobody);
    EXPECT_NE(nobody.find(R"("asked":{"eva@x.example":)" + since(kNow) + "}"), std::string::npos) << nobody;
    EXPECT_EQ(post(300), "[]");
    ASSERT_TRUE(store_->setHidden(ids_["ann"], false, kNow + 1));
    EXPECT_EQ(post(300), "[]");
}

TEST_F(FreshFixTest, WhatThePhoneWasTold_ChangesNothingForWhoAsks) {
    post(600);
    const std::string before = ask("otto", R"("ann@x.example")");
    now_ += 5;
    EXPECT_EQ(post(606), std::string("[") + kReport + "]");
    EXPECT_EQ(ask("otto", R"("ann@x.example")"), before);
}

TEST_F(FreshFixTest, SealedPhone_IsToldUnderItsSeal) {
    ASSERT_TRUE(store_->addDevice(ids_["ann"], DeviceKind::Phone, "sealed", "key", kNow));
    ask("otto", R"("ann@x.example")");
    const std::string inner =
        R"({"_type":"location","tid":"an","lat":50.2,"lon":-3.1,"tst":)" + std::to_string(kNow - 60) + "}";
    const std::string answer =
        postBody(R"({"_type":"encrypted","data":")" + server::SealedText::seal(inner, "key").value() + "\"}", kAndroid,
                 "sealed");
    EXPECT_EQ(answer.find("reportLocation"), std::string::npos) << answer;
    const auto document = documents::JsonReader::read(answer);
    const auto* box = std::get_if<platform::Value>(&document);
    ASSERT_TRUE(box != nullptr && box->dictionary() != nullptr) << answer;
    EXPECT_EQ(server::SealedText::open(*box->dictionary()->find("data")->string(), "key").value_or(""),
              std::string("[") + kReport + "]");
}

}  // namespace ktr::test
