#include <chrono>
#include <memory>
#include <string>
#include <thread>

#include "tests/unit/server/FourPeople.h"

namespace ktr::test {

/// Ann lets otto be told when she comes and goes; mara she lets see where she is, and no more.
class FenceServiceTest : public FourPeople {
  protected:
    static constexpr double kDegree = 111230.0;

    void SetUp() override {
        ASSERT_NO_FATAL_FAILURE(FourPeople::SetUp());
        Grant grant{Precision::Exact, kNow - 1000, std::nullopt};
        ASSERT_TRUE(store_->grant(ids_["ann"], ids_["mara"], grant));
        grant.fences = true;
        ASSERT_TRUE(store_->grant(ids_["ann"], ids_["otto"], grant));
        begin();
    }
    static std::string command(const std::string& who, const std::string& path, const std::string& body) {
        return "POST /qloxservice/friends/va/" + path + " HTTP/1.1\r\nHost: localhost\r\n" + commandHeaders(who) +
               "Content-Type: application/json\r\nContent-Length: " + std::to_string(body.size()) + "\r\n\r\n" + body;
    }
    std::string ask(const std::string& who, const std::string& path, const std::string& body) {
        const RawClient client(service_->port());
        client.send(command(who, path, body));
        const std::string answer = client.read("}\n", std::chrono::milliseconds(300));
        const std::size_t begin = answer.find("\r\n\r\n");
        const std::size_t end = answer.rfind('}');
        return begin == std::string::npos || end == std::string::npos ? answer
                                                                      : answer.substr(begin + 4, end + 1 - begin - 4);
    }
    std::string setFence(const std::string& who, const std::string& handle, const std::string& more = "") {
        return ask(
            who, "setFence",
            R"({"clientContext":{},"handle":")" + handle +
                R"(","trigger":"OnArrival","once":false,"place":{"latitude":50.2,"longitude":-3.1,"radius":150})" +
                more + "}");
    }
    /// Ann's phone posts that it is so many metres north of the place.
    void post(double metres) {
        now_ += 60;
        const std::string body = R"({"_type":"location","tid":"an","acc":10,"lat":)" +
                                 std::to_string(50.2 + metres / kDegree) + R"(,"lon":-3.1,"tst":)" +
                                 std::to_string(now_.load()) + "}";
        const RawClient client(service_->port());
        client.send("POST /pub HTTP/1.1\r\nHost: localhost\r\n" + authorization("ann", "ann's") +
                    "Content-Type: application/json\r\nContent-Length: " + std::to_string(body.size()) + "\r\n\r\n" +
                    body);
        ASSERT_NE(client.read("]").find("200 OK"), std::string::npos);
    }
    /// A stream, with what has come of it.
    struct Listening {
        RawClient client;
        std::string text = {};
        /// Everything until `end` has come, or nothing does any more.
        std::string read(const std::string& end, std::chrono::milliseconds time = std::chrono::milliseconds(5000)) {
            return text.find(end) != std::string::npos ? text : text += client.read(end, time);
        }
    };
    std::unique_ptr<Listening> listen(const std::string& who, const std::string& last = "") {
        std::unique_ptr<Listening> stream(new Listening{RawClient(service_->port())});
        stream->client.send("GET /qloxservice/friends/va/events HTTP/1.1\r\nHost: localhost\r\n" +
                            authorization(who, who + "'s ktr") +
                            (last.empty() ? "" : "Last-Event-ID: " + last + "\r\n") + "\r\n");
        EXPECT_NE(stream->read("retry: 2000\n\n").find("text/event-stream"), std::string::npos);
        return stream;
    }
    static std::string locationsOf(const std::string& handle) {
        return R"({"clientContext":{},"handles":[")" + handle + R"("]})";
    }
    /// Asked twice, in turn: the second one is held.
    std::unique_ptr<RawClient> held(const std::string& who, const std::string& handle) {
        auto client = std::make_unique<RawClient>(service_->port());
        client->send(command(who, "getlocations", locationsOf(handle)));
        first_ = client->read("\"emails\":[\"" + handle + "\"]}");
        std::this_thread::sleep_for(std::chrono::milliseconds(1000));
        client->send(command(who, "getlocations", locationsOf(handle)));
        return client;
    }
    static constexpr std::chrono::milliseconds kShort{400};
    static constexpr const char* kNothing = "(nothing more in time)";

    std::string first_;
};

TEST_F(FenceServiceTest, Refusal_IsTheSameForEverybodyWhoDoesNotLetTell) {
    const std::string refused =
        R"({"statusCode":403,"message":"nobody with this handle lets you be told when they come and go"})";
    EXPECT_EQ(setFence("otto", "nobody@x.example"), refused);
    EXPECT_EQ(setFence("otto", "eve@x.example"), refused);
    EXPECT_EQ(setFence("mara", "ann@x.example"), refused) << "she sees exactly, but has no leave";
    EXPECT_NE(setFence("otto", "ann@x.example").find(R"("statusCode":200,"fence":{"id":")"), std::string::npos);
    ASSERT_TRUE(store_->setHidden(ids_["ann"], true, kNow));
    EXPECT_EQ(setFence("otto", "ann@x.example"), refused);
}

TEST_F(FenceServiceTest, SmallCircle_IsMadeAsLargeAsAPhoneCanTell_AndSaidToBe) {
    const std::string answer = ask(
        "otto", "setFence",
        R"({"clientContext":{},"handle":"ann@x.example","trigger":"OnDeparture","place":{"latitude":50.2,"longitude":-3.1,"radius":20}})");
    EXPECT_NE(answer.find(R"("once":true,"place":{"latitude":50.2,"longitude":-3.1,"radius":100})"), std::string::npos)
        << answer;
    EXPECT_NE(answer.find("100 m wide around that place: below that a phone cannot tell in from out"),
              std::string::npos);
}

TEST_F(FenceServiceTest, WhatIsNoWish_SaysWhy) {
    const auto said = [&](const std::string& body) { return ask("otto", "setFence", body); };
    EXPECT_NE(said("{}").find("$.clientContext"), std::string::npos);
    EXPECT_NE(said(R"({"clientContext":{}})").find("$.handle: expected the handle of a friend"), std::string::npos);
    EXPECT_NE(said(R"({"clientContext":{},"handle":"a@b","trigger":"x"})").find("OnDeparture"), std::string::npos);
    EXPECT_NE(said(R"({"clientContext":{},"handle":"a@b","trigger":"OnArrival","place":{"latitude":99,"longitude":0}})")
                  .find("$.place"),
              std::string::npos);
    EXPECT_NE(
        said(
            R"({"clientContext":{},"handle":"a@b","trigger":"OnArrival","place":{"latitude":9,"longitude":0,"radius":-1}})")
            .find("$.place"),
        std::string::npos);
}

TEST_F(FenceServiceTest, Immediate_IsOneOrdinaryRead) {
    post(10.0);
    EXPECT_EQ(ask("otto", "setFence", R"({"clientContext":{},"handle":"ann@x.example","trigger":"Immediate"})"),
              ask("otto", "getlocations", locationsOf("ann@x.example")));
}

TEST_F(FenceServiceTest, Fences_AreListedForBoth_AndEndedByEither) {
    setFence("otto", "ann@x.example");
    const std::string list = ask("otto", "fences", "{}");
    EXPECT_NE(list.find(R"("name":"ann","handle":"ann@x.example"}],"aboutMe":[]})"), std::string::npos) << list;
    EXPECT_NE(ask("ann", "fences", "{}").find(R"({"statusCode":200,"fences":[],"aboutMe":[{)"), std::string::npos);
    const std::string id = std::to_string(store_->fencesBy(ids_["otto"])->front().fence.id);
    const std::string end = R"({"clientContext":{},"id":")" + id + "\"}";
    EXPECT_EQ(ask("mara", "endFence", end), R"({"statusCode":200})") << "tells a stranger nothing";
    EXPECT_EQ(store_->fencesBy(ids_["otto"])->size(), 1U);
    EXPECT_EQ(ask("ann", "endFence", end), R"({"statusCode":200})");
    EXPECT_TRUE(store_->fencesBy(ids_["otto"])->empty());
    EXPECT_NE(ask("ann", "endFence", R"({"clientContext":{},"id":"9223372036854775808"})").find("expected digits"),
              std::string::npos);
}

TEST_F(FenceServiceTest, Stream_TellsAsItHappens_AndGoesOnWhereItEnded) {
    post(900.0);
    post(900.0);
    setFence("otto", "ann@x.example");
    auto stream = listen("otto");
    post(0.0);
    const std::string told = stream->read("}\n\n");
    EXPECT_NE(told.find("id: 1\nevent: crossing\ndata: {\"id\":\"1\",\"name\":\"ann\",\"handle\":\"ann@x.example\","
                        "\"trigger\":\"OnArrival\""),
              std::string::npos)
        << told;
    stream.reset();
    post(900.0);
    post(900.0);
    post(0.0);
    EXPECT_NE(listen("otto", "1")->read("}\n\n").find("id: 2\n"), std::string::npos);
    EXPECT_NE(listen("otto")->read("id: 2\n").find("id: 1\n"), std::string::npos) << "nothing was said to be heard";
    EXPECT_EQ(ask("otto", "events", R"({"clientContext":{},"heard":"1"})"), R"({"statusCode":200})");
    const std::string rest = listen("otto")->read("}\n\n");
    EXPECT_EQ(rest.find("id: 1\n"), std::string::npos);
    EXPECT_NE(rest.find("id: 2\n"), std::string::npos);
}

TEST_F(FenceServiceTest, Stream_GoesOnAfterTheServiceStartsAgain) {
    post(900.0);
    post(900.0);
    setFence("otto", "ann@x.example");
    post(0.0);
    EXPECT_NE(listen("otto")->read("}\n\n").find("id: 1\n"), std::string::npos);
    service_->stop();
    begin();
    EXPECT_NE(listen("otto", "1")->read("id:", kShort).find(kNothing), std::string::npos);
    EXPECT_NE(listen("otto")->read("}\n\n").find("id: 1\n"), std::string::npos);
}

TEST_F(FenceServiceTest, OneStreamADevice_TheOlderOneIsTold) {
    auto first = listen("otto");
    auto second = listen("otto");
    EXPECT_NE(first->read("(end)").find("event: ended\ndata: {\"why\":\"another stream began\"}"), std::string::npos);
    post(900.0);
    post(900.0);
    setFence("otto", "ann@x.example");
    post(0.0);
    EXPECT_NE(second->read("}\n\n").find("id: 1\n"), std::string::npos);
}

TEST_F(FenceServiceTest, RevokedGrant_TakesBackWhatWasNotTold_AndRevokedSecretEndsTheStream) {
    post(900.0);
    post(900.0);
    setFence("otto", "ann@x.example");
    post(0.0);
    ASSERT_TRUE(store_->revokeGrant(ids_["ann"], ids_["otto"]));
    auto stream = listen("otto");
    EXPECT_NE(stream->read("id:", kShort).find(kNothing), std::string::npos);
    ASSERT_GT(store_->revokeDevices(ids_["otto"], now_), 0);
    EXPECT_NE(stream->read("(end)").find("the secret has ended"), std::string::npos);
}

TEST_F(FenceServiceTest, Stream_NeedsAReadersSecret_AndANumber) {
    const RawClient phone(service_->port());
    phone.send("GET /qloxservice/friends/va/events HTTP/1.1\r\nHost: localhost\r\n" + authorization("otto", "otto's") +
               "\r\n");
    EXPECT_NE(phone.read("}").find("401"), std::string::npos);
    const RawClient strange(service_->port());
    strange.send("GET /qloxservice/friends/va/events HTTP/1.1\r\nHost: localhost\r\n" +
                 authorization("otto", "otto's ktr") + "Last-Event-ID: -1\r\n\r\n");
    EXPECT_NE(strange.read("}").find("400"), std::string::npos);
}

TEST_F(FenceServiceTest, AnswerToTheSameQuestionInTurn_IsHeldUntilWhatIsSeenChanges) {
    post(10.0);
    const auto client = held("otto", "ann@x.example");
    EXPECT_NE(first_.find(R"("minCallbackIntervalInMS":1000)"), std::string::npos);
    EXPECT_NE(client->read("}", kShort).find(kNothing), std::string::npos);
    const auto began = std::chrono::steady_clock::now();
    post(500.0);
    const std::string second = client->read("\"emails\":[\"ann@x.example\"]}");
    EXPECT_NE(second.find("\"latitude\":50.204"), std::string::npos) << second;
    EXPECT_LT(std::chrono::steady_clock::now() - began, std::chrono::seconds(4));
}

TEST_F(FenceServiceTest, HeldAnswer_EndsWithARevocation_InTheBytesOfAStranger) {
    post(10.0);
    const auto client = held("otto", "ann@x.example");
    ASSERT_TRUE(store_->revokeGrant(ids_["ann"], ids_["otto"]));
    const std::string end = "\"emails\":[\"ann@x.example\"]}";
    const auto body = [](const std::string& answer) { return answer.substr(answer.find("\r\n\r\n")); };
    const std::string now = client->read(end);
    const RawClient other(service_->port());
    other.send(command("eve", "getlocations", locationsOf("ann@x.example")));
    EXPECT_EQ(body(now), body(other.read(end)));
}

TEST_F(FenceServiceTest, HeldAnswer_EndsWithItsSecret_AndSaysNothing) {
    post(10.0);
    const auto client = held("otto", "ann@x.example");
    ASSERT_GT(store_->revokeDevices(ids_["otto"], now_), 0);
    const std::string answer = client->read("}");
    EXPECT_NE(answer.find("401"), std::string::npos) << answer;
    EXPECT_EQ(answer.find("latitude"), std::string::npos) << answer;
}

TEST_F(FenceServiceTest, SomebodyHidden_IsHeldLikeNobody) {
    post(10.0);
    ASSERT_TRUE(store_->setHidden(ids_["ann"], true, now_));
    const auto hidden = held("otto", "ann@x.example");
    const auto nobody = held("otto", "nobody@x.example");
    post(500.0);
    post(900.0);
    EXPECT_NE(hidden->read("}", kShort).find(kNothing), std::string::npos);
    EXPECT_NE(nobody->read("}", kShort).find(kNothing), std::string::npos);
}

TEST_F(FenceServiceTest, OutOfTurn_OrBesideAHeldOne_IsAnsweredAtOnce) {
    post(10.0);
    const std::string end = "\"emails\":[\"ann@x.example\"]}";
    const RawClient client(service_->port());
    client.send(command("otto", "getlocations", locationsOf("ann@x.example")));
    client.read(end);
    client.send(command("otto", "getlocations", locationsOf("ann@x.example")));
    EXPECT_EQ(client.read(end, kShort).find(kNothing), std::string::npos) << "earlier than it was told to ask";
    const auto first = held("otto", "ann@x.example");
    EXPECT_NE(first->read("}", kShort).find(kNothing), std::string::npos);
    const RawClient second(service_->port());
    second.send(command("otto", "getlocations", locationsOf("ann@x.example")));
    EXPECT_EQ(second.read(end, kShort).find(kNothing), std::string::npos) << "another card";
}

TEST_F(FenceServiceTest, HeldAnswers_AreGivenWhenTheServiceEnds) {
    post(10.0);
    const auto client = held("otto", "ann@x.example");
    EXPECT_NE(client->read("}", kShort).find(kNothing), std::string::npos);
    service_->stop();
    EXPECT_NE(client->read("\"emails\":[\"ann@x.example\"]}").find("200 OK"), std::string::npos);
}

TEST_F(FenceServiceTest, PhoneWhoseAppShowsIt_IsToldInTheAnswer_OnceAndAgainToTheSamePost) {
    const auto postsAs = [&](const std::string& agent, int time) {
        const std::string body =
            R"({"_type":"location","tid":"ot","acc":10,"lat":51.2,"lon":-3.1,"tst":)" + std::to_string(time) + "}";
        const RawClient client(service_->port());
        client.send("POST /pub HTTP/1.1\r\nHost: localhost\r\nUser-Agent: " + agent + "\r\n" +
                    authorization("otto", "otto's") + "Content-Length: " + std::to_string(body.size()) + "\r\n\r\n" +
                    body);
        return client.read("]");
    };
    const std::string apple = "OwnTracks/18.5 CFNetwork/1494.0.7 Darwin/23.4.0";
    const std::string other = "Owntracks-Android/gms/420600001";
    post(900.0);
    post(900.0);
    setFence("otto", "ann@x.example");
    postsAs(apple, kNow + 1);
    store_->finish();
    post(0.0);
    const std::string told = postsAs(apple, kNow + 200);
    EXPECT_NE(told.find(R"({"_type":"transition","tid":"ann","event":"enter","desc":"50.20, -3.10","wtst":)"),
              std::string::npos)
        << told;
    store_->finish();
    EXPECT_NE(postsAs(apple, kNow + 200).find("transition"), std::string::npos) << "the answer was lost";
    store_->finish();
    EXPECT_EQ(postsAs(apple, kNow + 260).find("transition"), std::string::npos);
    post(900.0);
    post(900.0);
    postsAs(other, kNow + 300);
    store_->finish();
    post(0.0);
    EXPECT_EQ(postsAs(other, kNow + 360).find("transition"), std::string::npos)
        << "the other app would make a friend without a name of it";
}

}  // namespace ktr::test
