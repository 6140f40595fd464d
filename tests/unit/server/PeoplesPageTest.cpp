#include "server/page/PeoplesPage.h"

#include <future>
#include <regex>

#include "tests/unit/server/PageFixture.h"

namespace ktr::test {

using server::HttpReply;
using server::HttpRequest;
using server::HttpResponse;
using server::PeoplesPage;
using server::Precision;
using server::Store;

class PeoplesPageTest : public PageFixture {};

TEST_F(PeoplesPageTest, Link_ShowsAButtonAndChangesNothing_UntilItIsPressed) {
    ASSERT_TRUE(store_->addSignIn(mara_, "link", now_));
    for (int i = 0; i < 3; ++i) {
        const HttpResponse shown = get("/me/in?link=link");
        EXPECT_EQ(shown.status, 200);
        EXPECT_TRUE(has(shown, "<input type=\"hidden\" name=\"link\" value=\"link\">"));
        EXPECT_EQ(headerOf(shown, "Set-Cookie"), "");
    }
    const HttpResponse pressed = send(request("POST", "/me/in", "link=link"));
    EXPECT_EQ(pressed.status, 303);
    EXPECT_EQ(headerOf(pressed, "Location"), "/me");
    EXPECT_TRUE(std::regex_match(headerOf(pressed, "Set-Cookie"),
                                 std::regex("__Host-session=[a-z0-9]{26}; Max-Age=2592000; Path=/; Secure; HttpOnly; "
                                            "SameSite=Strict")))
        << headerOf(pressed, "Set-Cookie");
    EXPECT_EQ(delayed_, 0.0);
    const HttpResponse again = send(request("POST", "/me/in", "link=link"));
    EXPECT_EQ(again.status, 403);
    EXPECT_EQ(headerOf(again, "Set-Cookie"), "");
    EXPECT_TRUE(has(again, "This link has been used"));
    EXPECT_GT(delayed_, 0.0) << "whoever guesses waits";
}

TEST_F(PeoplesPageTest, Link_IsNotSpentByAFormOfAnotherPage) {
    ASSERT_TRUE(store_->addSignIn(mara_, "link", now_));
    HttpRequest foreign = request("POST", "/me/in", "link=link");
    foreign.headers.back().second = "cross-site";
    EXPECT_EQ(send(foreign).status, 403);
    EXPECT_EQ(send(request("POST", "/me/in", "link=link")).status, 303);
}

TEST_F(PeoplesPageTest, Program_GetsAReadersSecretForALink_Once) {
    ASSERT_TRUE(store_->addSignIn(mara_, "link", now_));
    const auto program = [this](const std::string& body) {
        HttpRequest out = request("POST", "/me/in", body);
        out.headers = {{"Host", "home.example:8443"}, {"Content-Type", "application/json"}};
        return send(out);
    };
    EXPECT_EQ(program("{}").status, 400);
    EXPECT_EQ(program("[1]").status, 400);
    EXPECT_EQ(program(R"({"link":"phone"})").status, 403) << "a phone's secret is no link";
    EXPECT_GT(delayed_, 0.0) << "whoever guesses waits";
    const HttpResponse given = program(R"({"link":"link"})");
    EXPECT_EQ(given.status, 200);
    EXPECT_EQ(headerOf(given, "Cache-Control"), "no-store");
    EXPECT_EQ(headerOf(given, "Set-Cookie"), "");
    std::smatch found;
    ASSERT_TRUE(std::regex_search(
        given.body, found, std::regex("^\\{\"statusCode\":200,\"person\":\"Mara\",\"secret\":\"([a-z0-9]{26})\"\\}$")))
        << given.body;
    bool failed = false;
    const auto device = store_->deviceOf(found[1].str(), failed);
    ASSERT_TRUE(device);
    EXPECT_EQ(device->kind, server::DeviceKind::Reader);
    EXPECT_EQ(device->person, mara_);
    const HttpResponse again = program(R"({"link":"link"})");
    EXPECT_EQ(again.status, 403);
    EXPECT_FALSE(has(again, "secret\""));
    EXPECT_EQ(send(request("POST", "/me/in", "link=link")).status, 403) << "it does not open the page afterwards";
}

TEST_F(PeoplesPageTest, LinkForAComputer_IsMadeByAPressOnOnesOwnPageAlone) {
    EXPECT_EQ(post("/me/devices/link").status, 403) << "nobody is signed in";
    signIn();
    EXPECT_TRUE(has(get("/me/devices"), "Sign in on a computer"));
    const HttpResponse made = post("/me/devices/link");
    EXPECT_EQ(made.status, 200);
    std::smatch found;
    ASSERT_TRUE(
        std::regex_search(made.body, found, std::regex("https://home.example:8443/me/in\\?link=([a-z0-9]{26})")))
        << made.body;
    EXPECT_EQ(get("/me/devices/link").status, 404) << "a look makes none";
    std::string person;
    EXPECT_EQ(store_->signProgramIn(found[1].str(), "secret", now_, person), server::SignIn::Done);
    EXPECT_EQ(person, "Mara");
}

TEST_F(PeoplesPageTest, PhonesSecret_NeverSignsIn) {
    EXPECT_EQ(send(request("POST", "/me/in", "link=phone")).status, 403);
    cookie_ = "__Host-session=phone";
    EXPECT_EQ(get("/me").status, 403);
    cookie_.clear();
    HttpRequest basic = request("GET", "/me");
    basic.headers.emplace_back("Authorization", "Basic TWFyYTpwaG9uZQ==");
    EXPECT_EQ(send(basic).status, 403);
}

TEST_F(PeoplesPageTest, EveryAnswer_IsKeptNowhere_FramedNowhere_AndRunsNothing) {
    signIn();
    for (const char* target : {"/me", "/me/in?link=x", "/me/nothing", "/me/copy", "/me/settings"}) {
        const HttpResponse response = get(target);
        EXPECT_EQ(headerOf(response, "Cache-Control"), "no-store") << target;
        EXPECT_EQ(headerOf(response, "Referrer-Policy"), "no-referrer") << target;
        EXPECT_EQ(headerOf(response, "X-Content-Type-Options"), "nosniff") << target;
        EXPECT_EQ(headerOf(response, "Access-Control-Allow-Origin"), "") << target;
        const std::string policy = headerOf(response, "Content-Security-Policy");
        EXPECT_TRUE(policy.starts_with("default-src 'none'; style-src 'sha256-")) << policy;
        EXPECT_NE(policy.find("frame-ancestors 'none'"), std::string::npos) << policy;
        EXPECT_EQ(policy.find("unsafe"), std::string::npos) << policy;
        EXPECT_FALSE(has(response, "<script")) << target;
        EXPECT_FALSE(has(response, " style=")) << target;
    }
}

TEST_F(PeoplesPageTest, EveryChange_NeedsTheTokenAndAnOwnPage) {
    signIn();
    ASSERT_TRUE(store_->grant(mara_, lea_, {Precision::Exact, now_, std::nullopt}));
    for (const std::string& target :
         {std::string("/me/visible"), std::string("/me/delete"), std::string("/me/phone"), std::string("/me/settings"),
          std::string("/me/share/with"), std::string("/me/out"), address("/stop"), address()}) {
        const std::string fields = "state=off&who=Ann&exactness=exact&until=changed";
        EXPECT_EQ(send(request("POST", target, fields)).status, 403) << target;
        EXPECT_EQ(send(request("POST", target, fields + "&token=" + std::string(32, '0'))).status, 403) << target;
        for (const auto& [name, value] :
             {std::pair("Sec-Fetch-Site", "cross-site"), std::pair("Sec-Fetch-Site", "same-site"),
              std::pair("Sec-Fetch-Site", "none"), std::pair("Origin", "https://evil.example"),
              std::pair("Origin", "null"), std::pair("X-Nothing", "")}) {
            HttpRequest foreign = request("POST", target, "token=" + token_ + "&" + fields);
            foreign.headers.resize(foreign.headers.size() - 2);
            foreign.headers.emplace_back(name, value);
            EXPECT_EQ(send(foreign).status, 403) << target << " " << name << ": " << value;
        }
    }
    EXPECT_FALSE(store_->person(mara_)->hidden);
    EXPECT_TRUE(leasGrant());
    HttpRequest old = request("POST", "/me/visible", "state=off&token=" + token_);
    old.headers.back() = {"Origin", "https://home.example:8443"};
    old.headers.erase(old.headers.end() - 2);
    EXPECT_EQ(send(old).status, 303) << "a browser that knows no Sec-Fetch-Site";
}

TEST_F(PeoplesPageTest, OneSessionsToken_IsNotAnothers) {
    signIn();
    const std::string first = token_;
    signIn();
    ASSERT_NE(first, token_);
    EXPECT_EQ(send(request("POST", "/me/visible", "state=off&token=" + first)).status, 403);
}

TEST_F(PeoplesPageTest, Get_ChangesNothing) {
    signIn();
    ASSERT_TRUE(store_->grant(mara_, lea_, {Precision::Exact, now_, std::nullopt}));
    for (const std::string& target :
         {std::string("/me/visible?state=off"), std::string("/me/out"), std::string("/me/delete"), address("/stop"),
          address("/keep"), std::string("/me/phone"), std::string("/me/share/with?who=Ann")}) {
        get(target + (target.find('?') == std::string::npos ? "?" : "&") + "token=" + token_);
    }
    EXPECT_FALSE(store_->person(mara_)->hidden);
    EXPECT_TRUE(leasGrant());
    EXPECT_EQ(store_->devicesOf(mara_).size(), 1U);
    EXPECT_EQ(get("/me").status, 200);
}

TEST_F(PeoplesPageTest, OthersNames_AreOnlyText) {
    const std::string name = "<b>&\"'\u202E";
    ASSERT_TRUE(store_->addPerson(name + std::string(10000, 'a'), {}, now_));
    const auto odd = store_->personNamed(name + std::string(10000, 'a'));
    ASSERT_TRUE(store_->grant(mara_, odd->id, {Precision::Exact, now_, std::nullopt}));
    signIn();
    for (const std::string& target :
         {std::string("/me"), "/me/sees/" + std::to_string(odd->id), "/me/sees/" + std::to_string(odd->id) + "/stop"}) {
        const HttpResponse response = get(target);
        EXPECT_EQ(response.status, 200);
        EXPECT_TRUE(has(response, "&lt;b&gt;&amp;&quot;&#39;aaaa")) << target;
        EXPECT_FALSE(has(response, "<b>")) << target;
        EXPECT_FALSE(has(response, "\u202E")) << target;
        EXPECT_FALSE(has(response, std::string(61, 'a'))) << target;
    }
    EXPECT_FALSE(has(post("/me/share", "who=%22%3E%3Cscript%3E"), "<script"));
}

TEST_F(PeoplesPageTest, SigningOut_EndsTheSession_NotOnlyTheCookie) {
    signIn();
    EXPECT_EQ(post("/me/out").status, 303);
    EXPECT_EQ(get("/me").status, 403);
}

TEST_F(PeoplesPageTest, Session_EndsByItself_AndWithAllSecrets) {
    signIn();
    now_ += Store::kBrowserLasts;
    EXPECT_EQ(get("/me").status, 403);
    signIn();
    store_->revokeDevices(mara_, now_);
    EXPECT_EQ(get("/me").status, 403);
}

TEST_F(PeoplesPageTest, EveryPage_InEveryLanguage_HasNoKeyForAText) {
    ASSERT_TRUE(store_->grant(mara_, lea_, {Precision::Town, now_, now_ + 600}));
    signIn();
    const std::regex key(">[A-Z][A-Z0-9]*_[A-Z0-9_]+<");
    for (const char* language : {"en", "de", "fr", "es", "pt", "it", "nl",      "sv",      "pl", "uk", "ru",
                                 "tr", "el", "ar", "he", "fa", "hi", "zh-Hans", "zh-Hant", "ja", "ko"}) {
        for (const std::string& target :
             {std::string("/me"), std::string("/me/share"), std::string("/me/looks"), std::string("/me/phone"),
              std::string("/me/devices"), std::string("/me/settings"), std::string("/me/delete"), address(),
              address("/stop"), std::string("/me/in"), std::string("/me/none")}) {
            HttpRequest asked = request("GET", target);
            asked.headers.emplace_back("Accept-Language", language);
            const HttpResponse response = send(asked);
            EXPECT_FALSE(std::regex_search(response.body, key)) << language << " " << target;
            EXPECT_TRUE(has(response, std::string("<html lang=\"") + language + "\"")) << language;
            EXPECT_FALSE(has(response, "%@")) << language << " " << target;
        }
    }
}

TEST_F(PeoplesPageTest, ManyAtOnce_AreAnsweredOrRefused_NeverLost) {
    signIn();
    std::vector<std::future<std::optional<HttpResponse>>> answers;
    for (int i = 0; i < 500; ++i) {
        auto promise = std::make_shared<std::promise<std::optional<HttpResponse>>>();
        answers.push_back(promise->get_future());
        page_->answer(request("GET", "/me"), HttpReply([promise](const std::optional<HttpResponse>& response) {
                          promise->set_value(response);
                      }));
    }
    for (auto& answer : answers) {
        const auto response = answer.get();
        ASSERT_TRUE(response);
        EXPECT_TRUE(response->status == 200 || response->status == 503) << response->status;
    }
}

}  // namespace ktr::test
