#include "server/page/PeoplesPage.h"

#include <gtest/gtest.h>

#include <future>
#include <regex>

#include "server/page/PageStyle.h"
#include "tests/support/TemporaryFolder.h"

namespace ktr::test {

using server::DeviceKind;
using server::Grant;
using server::HttpReply;
using server::HttpRequest;
using server::HttpResponse;
using server::PeoplesPage;
using server::Precision;
using server::Store;

/// The pages as a browser of Mara's meets them, on a real store.
class PeoplesPageTest : public ::testing::Test {
  protected:
    void SetUp() override {
        std::string complaint;
        store_ = Store::open({(folder_.path() / "data").string()}, true, complaint);
        ASSERT_TRUE(store_) << complaint;
        for (const char* name : {"Mara", "Lea", "Ann"}) {
            ASSERT_TRUE(store_->addPerson(name, {std::string(name) + "@x.example"}, now_));
        }
        mara_ = store_->personNamed("Mara")->id;
        lea_ = store_->personNamed("Lea")->id;
        ASSERT_TRUE(store_->setZone(mara_, "Europe/Berlin"));
        ASSERT_TRUE(store_->addDevice(mara_, DeviceKind::Phone, "phone", "", now_));
        page_ =
            std::make_unique<PeoplesPage>(PeoplesPage::Setup{*store_, [this] { return now_; }, delays_,
                                                             [this](double seconds, const std::function<void()>& work) {
                                                                 delayed_ += seconds;
                                                                 work();
                                                             }});
    }

    HttpResponse send(HttpRequest request) {
        std::promise<std::optional<HttpResponse>> answered;
        page_->answer(request, HttpReply([&](std::optional<HttpResponse> response) { answered.set_value(response); }));
        return answered.get_future().get().value_or(HttpResponse{0, {}, "", {}});
    }
    HttpRequest request(const std::string& method, const std::string& target, const std::string& body = "") {
        HttpRequest out;
        out.method = method;
        out.path = target.substr(0, target.find('?'));
        out.query = target.find('?') == std::string::npos ? "" : target.substr(target.find('?') + 1);
        out.body = body;
        out.peer = "192.0.2.7";
        out.headers = {{"Host", "home.example:8443"}};
        if (!cookie_.empty()) {
            out.headers.emplace_back("Cookie", cookie_);
        }
        if (method == "POST") {
            out.headers.emplace_back("Content-Type", "application/x-www-form-urlencoded");
            out.headers.emplace_back("Origin", "null");
            out.headers.emplace_back("Sec-Fetch-Site", "same-origin");
        }
        return out;
    }
    HttpResponse get(const std::string& target) { return send(request("GET", target)); }
    HttpResponse post(const std::string& target, const std::string& fields = "") {
        return send(request("POST", target, "token=" + token_ + "&" + fields));
    }
    static std::string headerOf(const HttpResponse& response, const std::string& name) {
        std::string all;
        for (const auto& [key, value] : response.headers) {
            all += key == name ? value : "";
        }
        return all;
    }
    /// Signs Mara in, as a browser does.
    void signIn() {
        ASSERT_TRUE(store_->addSignIn(mara_, "link", now_));
        const HttpResponse response = send(request("POST", "/me/in", "link=link"));
        ASSERT_EQ(response.status, 303);
        const std::string set = headerOf(response, "Set-Cookie");
        cookie_ = set.substr(0, set.find(';'));
        std::smatch found;
        const std::string body = get("/me").body;
        ASSERT_TRUE(std::regex_search(body, found, std::regex("name=\"token\" value=\"([0-9a-f]{32})\"")));
        token_ = found[1];
    }
    std::string address(const char* what = "") { return "/me/sees/" + std::to_string(lea_) + what; }
    std::optional<Grant> leasGrant() { return store_->sharing(lea_, mara_)->grant; }
    static bool has(const HttpResponse& response, const std::string& text) {
        return response.body.find(text) != std::string::npos;
    }

    TemporaryFolder folder_;
    std::unique_ptr<Store> store_;
    server::FailureDelays delays_;
    double delayed_ = 0.0;
    std::int64_t now_ = 1763760000;  // Friday 2025-11-21, 22:20 in Berlin
    std::int64_t mara_ = 0;
    std::int64_t lea_ = 0;
    std::string cookie_;
    std::string token_;
    std::unique_ptr<PeoplesPage> page_;
};

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

TEST_F(PeoplesPageTest, Hiding_HoldsBeforeItsAnswer_AndShowingAgain) {
    signIn();
    ASSERT_TRUE(store_->grant(mara_, lea_, {Precision::Exact, now_, std::nullopt}));
    EXPECT_TRUE(has(get("/me"), "One person can see where you are."));
    EXPECT_TRUE(has(get("/me"), ">\u2068Visible to friends\u2069, on<"));
    EXPECT_EQ(post("/me/visible", "state=off").status, 303);
    EXPECT_TRUE(store_->person(mara_)->hidden);
    EXPECT_TRUE(has(get("/me"), "Nobody can see where you are."));
    EXPECT_EQ(post("/me/visible", "state=off").status, 303) << "twice";
    EXPECT_TRUE(store_->person(mara_)->hidden);
    EXPECT_EQ(post("/me/visible", "state=maybe").status, 400);
    EXPECT_EQ(post("/me/visible", "state=on").status, 303);
    EXPECT_FALSE(store_->person(mara_)->hidden);
}

TEST_F(PeoplesPageTest, Sharing_BeginsByNameOrHandle_AndIsSaved) {
    signIn();
    EXPECT_EQ(post("/me/share", "who=Nobody").status, 400);
    EXPECT_TRUE(has(post("/me/share", "who=Mara"), "Nobody shares with themselves."));
    EXPECT_TRUE(has(post("/me/share", "who=LEA%40x.example"), "What \u2068Lea\u2069 sees"));
    EXPECT_FALSE(leasGrant()) << "nothing is saved yet";
    EXPECT_EQ(get(address()).status, 404);
    const HttpResponse saved = post("/me/share/with", "who=Lea&exactness=town&until=midnight&aloud=yes");
    EXPECT_EQ(saved.status, 303);
    EXPECT_EQ(headerOf(saved, "Location"), address("?saved"));
    ASSERT_TRUE(leasGrant());
    EXPECT_EQ(leasGrant()->precision, Precision::Town);
    EXPECT_EQ(leasGrant()->until, 1763766000) << "midnight in Berlin";
    EXPECT_TRUE(leasGrant()->aloud);
    EXPECT_TRUE(has(get("/me"), "\u2068The town\u2069, until midnight"));
    EXPECT_TRUE(has(get(address("?saved")), "Saved."));
}

TEST_F(PeoplesPageTest, Rule_IsChanged_AndEnded) {
    signIn();
    ASSERT_TRUE(store_->grant(mara_, lea_, {Precision::Exact, now_ - 100, std::nullopt}));
    EXPECT_EQ(post(address(), "exactness=1km&until=time&time=23%3A30").status, 303);
    EXPECT_EQ(leasGrant()->precision, Precision::Kilometre);
    EXPECT_EQ(leasGrant()->until, now_ + 70 * 60);
    EXPECT_EQ(post(address(), "exactness=1km&until=changed").status, 303);
    EXPECT_EQ(leasGrant()->until, std::nullopt);
    EXPECT_EQ(get(address("/stop")).status, 200);
    EXPECT_EQ(post(address("/stop")).status, 303);
    EXPECT_FALSE(leasGrant());
    EXPECT_EQ(post(address("/stop")).status, 303) << "twice";
    EXPECT_EQ(get(address()).status, 404);
}

TEST_F(PeoplesPageTest, EndThatWasNotTouched_StaysOnItsDay) {
    signIn();
    const std::int64_t end = now_ + 5 * 86400;
    ASSERT_TRUE(store_->grant(mara_, lea_, {Precision::Exact, now_, end}));
    EXPECT_EQ(post(address(), "exactness=town&until=time&time=22%3A20").status, 303);
    EXPECT_EQ(leasGrant()->until, end);
    EXPECT_EQ(leasGrant()->precision, Precision::Town);
}

TEST_F(PeoplesPageTest, Rule_EndsOnArrivalAtAPlaceOfTheReadersOwn_AndNoOther) {
    signIn();
    ASSERT_TRUE(store_->setPlace(mara_, {0, "Home", "home", 50.0, 8.0, 150.0, true}));
    ASSERT_TRUE(store_->setPlace(lea_, {0, "Lea's", "home", 51.0, 8.0, 150.0, true}));
    const auto home = store_->placesOf(mara_).front().id;
    EXPECT_EQ(post("/me/share/with",
                   "who=Lea&exactness=exact&until=arrival&place=" + std::to_string(store_->placesOf(lea_).front().id))
                  .status,
              400);
    EXPECT_FALSE(leasGrant());
    EXPECT_EQ(post("/me/share/with", "who=Lea&exactness=exact&until=arrival&place=" + std::to_string(home)).status,
              303);
    EXPECT_EQ(leasGrant()->arrival, home);
    EXPECT_TRUE(has(get("/me"), "until you are at \u2068Home\u2069"));
}

TEST_F(PeoplesPageTest, UnfinishedForm_ChangesNothing_AndSaysWhatIsMissing) {
    signIn();
    ASSERT_TRUE(store_->grant(mara_, lea_, {Precision::Exact, now_, std::nullopt}));
    for (const char* fields :
         {"", "exactness=exact", "exactness=all&until=changed", "exactness=town&until=soon",
          "exactness=town&until=arrival", "exactness=town&until=time", "exactness=town&until=time&time=25:99",
          "exactness=town&until=time&time=midnight", "exactness=town&until=time&time=%00%FF"}) {
        const HttpResponse response = post(address(), fields);
        EXPECT_EQ(response.status, 400) << fields;
        EXPECT_TRUE(has(response, "role=\"alert\"")) << fields;
    }
    EXPECT_EQ(leasGrant()->precision, Precision::Exact);
    HttpRequest upload = request("POST", address(), "token=" + token_ + "&exactness=town&until=changed");
    upload.headers[2].second = "text/plain";
    EXPECT_EQ(send(upload).status, 403) << "no form, no token";
    EXPECT_EQ(post(address(), "exactness=town&until=changed&x=" + std::string(20000, 'x')).status, 403) << "too long";
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

TEST_F(PeoplesPageTest, WhatLeaSees_IsHerOwnReading) {
    signIn();
    ASSERT_TRUE(store_->grant(mara_, lea_, {Precision::Exact, now_ - 1000, std::nullopt}));
    EXPECT_TRUE(has(get(address()), "sees no place of yours now."));
    std::promise<bool> kept;
    bool failed = false;
    const auto phone = store_->deviceOf("phone", failed);
    now_ += 300;
    store_->keep(phone->id, mara_, {{now_ - 240, now_ - 230, 50.2213, -3.1145, 12.0}}, now_,
                 [&](bool good) { kept.set_value(good); });
    ASSERT_TRUE(kept.get_future().get());
    const HttpResponse exact = get(address());
    EXPECT_TRUE(has(exact, "50.2213 / -3.1145")) << exact.body;
    EXPECT_TRUE(has(exact, "4 min. ago"));
    EXPECT_EQ(post(address(), "exactness=town&until=changed").status, 303);
    now_ += 3600;
    const HttpResponse town = get(address());
    EXPECT_FALSE(has(town, "50.2213")) << "less is seen, and the page shows that";
}

TEST_F(PeoplesPageTest, Phone_IsSetUp_ItsPasswordShownOnce) {
    signIn();
    EXPECT_EQ(get("/me/phone").status, 200);
    EXPECT_EQ(store_->devicesOf(mara_).size(), 1U) << "looking makes nothing";
    const HttpResponse made = post("/me/phone");
    ASSERT_EQ(made.status, 200);
    EXPECT_TRUE(has(made, "https://home.example:8443/pub"));
    std::smatch found;
    ASSERT_TRUE(std::regex_search(made.body, found, std::regex("\\?id=([a-z0-9]{26})<")));
    bool failed = false;
    const auto device = store_->deviceOf(found[1].str(), failed);
    ASSERT_TRUE(device);
    EXPECT_EQ(device->person, mara_);
    EXPECT_EQ(device->kind, DeviceKind::Phone);
    EXPECT_TRUE(has(made, "role=\"img\" aria-label=\"Code for a camera\""));
    const HttpResponse later = get("/me/phone/" + std::to_string(device->id));
    EXPECT_EQ(later.status, 200);
    EXPECT_FALSE(has(later, found[1].str()));
    EXPECT_TRUE(has(later, "Shown once: \u2068Today\u2069."));
    EXPECT_TRUE(has(later, "Nothing has come yet."));
}

TEST_F(PeoplesPageTest, Devices_AreListed_AndEndedOneByOne) {
    signIn();
    ASSERT_TRUE(store_->addDevice(mara_, DeviceKind::Reader, "reader", "", now_));
    bool failed = false;
    const auto phone = store_->deviceOf("phone", failed)->id;
    const HttpResponse list = get("/me/devices");
    EXPECT_TRUE(has(list, ">Phone<"));
    EXPECT_TRUE(has(list, ">Program that asks for friends<"));
    EXPECT_TRUE(has(list, ">This browser<"));
    const std::string target = "/me/devices/" + std::to_string(phone) + "/end";
    EXPECT_EQ(get(target).status, 200);
    EXPECT_TRUE(store_->deviceOf("phone", failed)) << "asking ends nothing";
    EXPECT_EQ(post(target).status, 303);
    EXPECT_FALSE(store_->deviceOf("phone", failed));
    EXPECT_TRUE(store_->deviceOf("reader", failed));
    EXPECT_EQ(post(target).status, 303) << "twice";
    EXPECT_FALSE(has(get("/me/devices"), ">Phone<"));
}

TEST_F(PeoplesPageTest, SomebodyElsesDevicesAndRules_AreNotThere) {
    ASSERT_TRUE(store_->addDevice(lea_, DeviceKind::Phone, "lea's", "", now_));
    ASSERT_TRUE(store_->grant(lea_, mara_, {Precision::Exact, now_, std::nullopt}));
    signIn();
    bool failed = false;
    const std::string leas = std::to_string(store_->deviceOf("lea's", failed)->id);
    EXPECT_EQ(get("/me/phone/" + leas).status, 404);
    EXPECT_EQ(get("/me/devices/" + leas + "/end").status, 404);
    post("/me/devices/" + leas + "/end");
    EXPECT_TRUE(store_->deviceOf("lea's", failed));
    EXPECT_EQ(get(address()).status, 404);
    EXPECT_EQ(post(address(), "exactness=exact&until=changed").status, 404);
    EXPECT_FALSE(leasGrant());
    for (const char* odd : {"/me/sees/0", "/me/sees/x", "/me/sees/", "/me/sees/99999999999999999999", "/me/../admin"}) {
        EXPECT_EQ(get(odd).status, 404) << odd;
    }
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

TEST_F(PeoplesPageTest, Settings_AreKept_AndTheLanguageFollows) {
    signIn();
    const HttpResponse saved = post("/me/settings", "language=ar&zone=Asia%2FTokyo&places=21600&looks=604800");
    EXPECT_EQ(saved.status, 303);
    EXPECT_EQ(store_->person(mara_)->zone, "Asia/Tokyo");
    EXPECT_EQ(store_->retention(mara_), (server::Retention{21600, 604800}));
    const std::string set = headerOf(saved, "Set-Cookie");
    cookie_ += "; " + set.substr(0, set.find(';'));
    EXPECT_TRUE(has(get("/me"), "<html lang=\"ar\" dir=\"rtl\">"));
    for (const char* fields :
         {"language=xx&zone=UTC&places=3600&looks=86400", "language=en&zone=Mars&places=3600&looks=86400",
          "language=en&zone=UTC&places=0&looks=86400", "language=en&zone=UTC&places=999999999&looks=86400",
          "language=en&zone=UTC&places=3600&looks=1e9"}) {
        EXPECT_EQ(post("/me/settings", fields).status, 400) << fields;
    }
    EXPECT_EQ(store_->person(mara_)->zone, "Asia/Tokyo");
}

TEST_F(PeoplesPageTest, AfterARestore_ShowingIsTheWordForWhichProgramsWait) {
    ASSERT_TRUE(store_->addDevice(mara_, DeviceKind::Reader, "reader", "", now_));
    const std::string backup = (folder_.path() / "backup.db").string();
    ASSERT_EQ(store_->backup(backup), "");
    signIn();
    ASSERT_EQ(store_->restore(backup, folder_.path().string(), now_), "");
    EXPECT_EQ(get("/me").status, 403) << "nobody is signed in by a backup";
    bool failed = false;
    EXPECT_FALSE(store_->deviceOf("reader", failed));
    signIn();
    EXPECT_TRUE(has(get("/me"), "Nobody can see where you are."));
    EXPECT_FALSE(store_->deviceOf("reader", failed)) << "signing in alone says nothing";
    EXPECT_EQ(post("/me/visible", "state=on").status, 303);
    EXPECT_TRUE(store_->deviceOf("reader", failed));
}

TEST_F(PeoplesPageTest, Copy_HasEverythingButSecrets) {
    signIn();
    const HttpResponse copy = get("/me/copy");
    EXPECT_EQ(copy.status, 200);
    EXPECT_EQ(headerOf(copy, "Content-Disposition"), "attachment; filename=\"ktr.json\"");
    EXPECT_TRUE(has(copy, "Mara@x.example"));
    EXPECT_FALSE(has(copy, "Lea@x.example"));
}

TEST_F(PeoplesPageTest, Deleting_AsksFirst_AndLeavesNobody) {
    signIn();
    EXPECT_TRUE(has(get("/me/delete"), "Delete everything"));
    ASSERT_TRUE(store_->person(mara_));
    const HttpResponse deleted = post("/me/delete");
    EXPECT_EQ(deleted.status, 200);
    EXPECT_TRUE(has(deleted, "Everything about you is deleted."));
    EXPECT_FALSE(store_->person(mara_));
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
        page_->answer(request("GET", "/me"),
                      HttpReply([promise](std::optional<HttpResponse> response) { promise->set_value(response); }));
    }
    for (auto& answer : answers) {
        const auto response = answer.get();
        ASSERT_TRUE(response);
        EXPECT_TRUE(response->status == 200 || response->status == 503) << response->status;
    }
}

}  // namespace ktr::test
