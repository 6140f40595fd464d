#include "server/page/OwnPages.h"

#include <future>
#include <regex>
#include <tuple>

#include "tests/unit/server/PageFixture.h"

namespace ktr::test {

using server::DeviceKind;
using server::HttpRequest;
using server::HttpResponse;
using server::Precision;

class OwnPagesTest : public PageFixture {};

TEST_F(OwnPagesTest, Hiding_HoldsBeforeItsAnswer_AndShowingAgain) {
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

TEST_F(OwnPagesTest, Sharing_BeginsByNameOrHandle_AndIsSaved) {
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

TEST_F(OwnPagesTest, Rule_IsChanged_AndEnded) {
    signIn();
    ASSERT_TRUE(store_->grant(mara_, lea_, {Precision::Exact, now_ - 100, std::nullopt}));
    EXPECT_EQ(post(address(), "exactness=1km&until=time&time=23%3A30").status, 303);
    EXPECT_EQ(leasGrant()->precision, Precision::Kilometre);
    EXPECT_EQ(leasGrant()->until, now_ + 70L * 60);
    EXPECT_EQ(post(address(), "exactness=1km&until=changed").status, 303);
    EXPECT_EQ(leasGrant()->until, std::nullopt);
    EXPECT_EQ(get(address("/stop")).status, 200);
    EXPECT_EQ(post(address("/stop")).status, 303);
    EXPECT_FALSE(leasGrant());
    EXPECT_EQ(post(address("/stop")).status, 303) << "twice";
    EXPECT_EQ(get(address()).status, 404);
}

TEST_F(OwnPagesTest, WhoeverAsks_IsNamed_UntilTheyAreAnswered) {
    signIn();
    ASSERT_EQ(store_->askToSee(lea_, {"mara@x.example"}, now_), server::AskOutcome::Asked);
    const std::string asked = get("/me").body;
    const std::string no = "/me/asked/" + std::to_string(lea_) + "/no";
    EXPECT_NE(asked.find("Would like to see where you are"), std::string::npos) << asked;
    EXPECT_NE(asked.find(no), std::string::npos);
    EXPECT_NE(asked.find("name=\"who\" value=\"Lea\""), std::string::npos) << "which begins a rule";
    EXPECT_TRUE(store_->grantsOf(mara_).empty()) << "nothing is shared by being asked";
    EXPECT_EQ(get(no).status, 404) << "a link changes nothing";
    EXPECT_EQ(post(no).status, 303);
    EXPECT_EQ(get("/me").body.find("Would like to see"), std::string::npos);
}

TEST_F(OwnPagesTest, LeaveToBeTold_NeedsExact_AndEachFenceIsSeenAndEnded) {
    signIn();
    post("/me/share/with", "who=Lea&exactness=town&until=changed&fences=yes");
    EXPECT_FALSE(leasGrant()->fences) << "less than exact";
    post("/me/sees/" + std::to_string(lea_), "exactness=exact&until=changed&fences=yes");
    EXPECT_TRUE(leasGrant()->fences);
    EXPECT_NE(get("/me/fences").body.find("Nobody is told."), std::string::npos);
    ASSERT_TRUE(store_->setPlace(mara_, {0, "Office & Co", "work", 50.2, -3.1, 200.0, true}));
    now_ += 10;
    const auto set = [&](const server::FencePlace& place, bool arrives) {
        std::promise<server::FenceOutcome> outcome;
        store_->setFence({lea_, mara_, place, arrives, true}, now_,
                         [&](server::FenceOutcome what, const server::Fence&) { outcome.set_value(what); });
        return outcome.get_future().get();
    };
    ASSERT_EQ(set({"work", std::nullopt}, false), server::FenceOutcome::Set);
    ASSERT_EQ(set({"", server::FenceCircle{50.3, -3.2, 150.0}}, true), server::FenceOutcome::Set);
    const std::string page = get("/me/fences").body;
    EXPECT_NE(page.find("When I leave: \u2068Office &amp; Co\u2069"), std::string::npos) << page;
    EXPECT_NE(page.find("When I arrive: \u2068\u2068\u206850.3000\u2069°\u00a0north"), std::string::npos) << page;
    const auto fences = *store_->fencesAbout(mara_);
    for (const auto& one : fences) {
        EXPECT_EQ(post("/me/fences/" + std::to_string(one.fence.id) + "/end", "").status, 303);
    }
    EXPECT_TRUE(store_->fencesBy(lea_)->empty());
    EXPECT_EQ(post("/me/fences/1/end", "").status, 303) << "one that has ended is what was wanted";
}

TEST_F(OwnPagesTest, KeepSharing_IsAskedAfter90Days_AndAnswersForAnother90) {
    constexpr std::int64_t kDay = 86400;
    ASSERT_TRUE(store_->grant(mara_, lea_, {Precision::Exact, now_, std::nullopt}));
    signIn();
    EXPECT_FALSE(has(get(address()), "Keep sharing"));
    EXPECT_EQ(post("/me/sees/999/keep").status, 303);
    now_ += 91 * kDay;
    signIn();
    EXPECT_TRUE(has(get(address()), "Keep sharing"));
    EXPECT_EQ(headerOf(post(address("/keep")), "Location"), address("?saved"));
    EXPECT_EQ(leasGrant()->confirmed, now_);
    EXPECT_EQ(leasGrant()->end(), now_ + 97 * kDay);
    EXPECT_FALSE(has(get(address()), "Keep sharing")) << "it is answered";
    now_ += 98 * kDay;
    signIn();
    post(address("/keep"));
    EXPECT_LE(leasGrant()->end(), now_) << "nobody answered for seven days: it began again by nothing";
}

TEST_F(OwnPagesTest, EndThatWasNotTouched_StaysOnItsDay) {
    signIn();
    const std::int64_t end = now_ + 5L * 86400;
    ASSERT_TRUE(store_->grant(mara_, lea_, {Precision::Exact, now_, end}));
    EXPECT_EQ(post(address(), "exactness=town&until=time&time=22%3A20").status, 303);
    EXPECT_EQ(leasGrant()->until, end);
    EXPECT_EQ(leasGrant()->precision, Precision::Town);
}

TEST_F(OwnPagesTest, Rule_EndsOnArrivalAtAPlaceOfTheReadersOwn_AndNoOther) {
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

TEST_F(OwnPagesTest, UnfinishedForm_ChangesNothing_AndSaysWhatIsMissing) {
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

TEST_F(OwnPagesTest, WhatLeaSees_IsHerOwnReading) {
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
    EXPECT_TRUE(has(exact, "50.2213\u2069°\u00a0north")) << exact.body;
    EXPECT_TRUE(has(exact, "4 min. ago"));
    EXPECT_EQ(post(address(), "exactness=town&until=changed").status, 303);
    now_ += 3600;
    const HttpResponse town = get(address());
    EXPECT_FALSE(has(town, "50.2213")) << "less is seen, and the page shows that";
}

TEST_F(OwnPagesTest, Phone_IsSetUp_ItsPasswordShownOnce) {
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

TEST_F(OwnPagesTest, Devices_AreListed_AndEndedOneByOne) {
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

TEST_F(OwnPagesTest, SomebodyElsesDevicesAndRules_AreNotThere) {
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

TEST_F(OwnPagesTest, Settings_AreKept_AndTheLanguageFollows) {
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

TEST_F(OwnPagesTest, AfterARestore_ShowingIsTheWordForWhichProgramsWait) {
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

TEST_F(OwnPagesTest, Copy_HasEverythingButSecrets) {
    signIn();
    const HttpResponse copy = get("/me/copy");
    EXPECT_EQ(copy.status, 200);
    EXPECT_EQ(headerOf(copy, "Content-Disposition"), "attachment; filename=\"ktr.json\"");
    EXPECT_TRUE(has(copy, "Mara@x.example"));
    EXPECT_FALSE(has(copy, "Lea@x.example"));
}

TEST_F(OwnPagesTest, Deleting_AsksFirst_AndLeavesNobody) {
    signIn();
    EXPECT_TRUE(has(get("/me/delete"), "Delete everything"));
    ASSERT_TRUE(store_->person(mara_));
    const HttpResponse deleted = post("/me/delete");
    EXPECT_EQ(deleted.status, 200);
    EXPECT_TRUE(has(deleted, "Everything about you is deleted."));
    EXPECT_FALSE(store_->person(mara_));
    EXPECT_EQ(get("/me").status, 403);
}

TEST_F(OwnPagesTest, PlaceWhereThePhoneIs_IsNamed_AndItsNameTakenBack) {
    signIn();
    EXPECT_TRUE(has(get("/me/places"), "Your phone has sent no place yet."));
    EXPECT_EQ(post("/me/places", "name=Home").status, 400);
    bool failed = false;
    std::promise<bool> kept;
    store_->keep(store_->deviceOf("phone", failed)->id, mara_, {{now_, now_, 50.2213, -3.1145, 12.0}}, now_,
                 [&](bool good) { kept.set_value(good); });
    ASSERT_TRUE(kept.get_future().get());
    for (const char* name : {"", "%20", "a%0Ab", "%FF", "01234567890123456789012345678901234567890"}) {
        EXPECT_EQ(post("/me/places", std::string("name=") + name).status, 400) << name;
    }
    EXPECT_TRUE(store_->placesOf(mara_).empty());
    EXPECT_EQ(post("/me/places", "name=Home&said=yes").status, 303);
    ASSERT_EQ(store_->placesOf(mara_).size(), 1U);
    const server::NamedPlace home = store_->placesOf(mara_).front();
    EXPECT_EQ(std::tuple(home.name, home.latitude, home.longitude, home.radius, home.said),
              std::tuple("Home", 50.2213, -3.1145, 150.0, true));
    EXPECT_TRUE(has(get("/me/places"), "<bdi>Home</bdi>"));
    EXPECT_FALSE(has(get("/me/places"), "50.2213"));
    const std::string removal = "/me/places/" + std::to_string(home.id) + "/remove";
    EXPECT_EQ(get(removal).status, 200);
    EXPECT_EQ(store_->placesOf(mara_).size(), 1U) << "asking removes nothing";
    EXPECT_EQ(post(removal).status, 303);
    EXPECT_TRUE(store_->placesOf(mara_).empty());
    EXPECT_EQ(post(removal).status, 303) << "twice";
    EXPECT_EQ(get(removal).status, 404);
}

TEST_F(OwnPagesTest, Place_IsChanged_ByItsOwnerAlone) {
    signIn();
    ASSERT_TRUE(store_->setPlace(mara_, {0, "Pool", "", 50.0, 8.0, 250.0, false}));
    ASSERT_TRUE(store_->setPlace(mara_, {0, "Attic", "", 50.1, 8.0, 150.0, false}));
    ASSERT_TRUE(store_->setPlace(lea_, {0, "Lea's", "", 51.0, 8.0, 150.0, false}));
    const auto pool = [&] { return store_->placesOf(mara_).back(); };
    const std::string page = "/me/places/" + std::to_string(pool().id);
    EXPECT_TRUE(has(get("/me/places"), page));
    EXPECT_TRUE(has(get(page), "Change \u2068Pool\u2069"));
    EXPECT_FALSE(has(get(page), R"(value="yes" checked)"));
    EXPECT_EQ(post(page, "name=Swimming&kind=gym&said=yes").status, 303);
    EXPECT_EQ(pool(), (server::NamedPlace{pool().id, "Swimming", "gym", 50.0, 8.0, 250.0, true}));
    EXPECT_TRUE(has(get(page), R"(value="yes" checked)"));
    EXPECT_EQ(post(page, "name=Swimming&kind=").status, 303) << "without the box it is not said";
    EXPECT_EQ(pool(), (server::NamedPlace{pool().id, "Swimming", "", 50.0, 8.0, 250.0, false}));
    const server::NamedPlace before = pool();
    EXPECT_EQ(post(page, "name=&kind=gym").status, 400);
    EXPECT_EQ(post(page, "name=Swimming&kind=palace").status, 400);
    EXPECT_TRUE(has(post(page, "name=Attic&kind="), "Another place of yours has this name."));
    EXPECT_EQ(pool(), before);
    const std::string leas = "/me/places/" + std::to_string(store_->placesOf(lea_).front().id);
    EXPECT_EQ(get(leas).status, 404);
    EXPECT_EQ(post(leas, "name=Mine&kind=&said=yes").status, 404);
    EXPECT_EQ(store_->placesOf(lea_).front().name, "Lea's");
    EXPECT_FALSE(store_->placesOf(lea_).front().said);
}

TEST_F(OwnPagesTest, PhonesFirstPlace_ShowsUp) {
    signIn();
    bool failed = false;
    const auto phone = store_->deviceOf("phone", failed)->id;
    std::promise<bool> kept;
    store_->keep(phone, mara_, {{now_, now_, 50.2213, -3.1145, 19.5}}, now_, [&](bool good) { kept.set_value(good); });
    ASSERT_TRUE(kept.get_future().get());
    EXPECT_TRUE(has(get("/me/phone/" + std::to_string(phone)), "within about \u206820 m\u2069."));
}

}  // namespace ktr::test
