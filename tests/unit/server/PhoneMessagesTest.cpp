#include "server/ingest/PhoneMessages.h"

#include <gtest/gtest.h>

#include <limits>

#include "server/ingest/FixRules.h"
#include "server/ingest/SealedText.h"

namespace ktr::test {

using server::FixRules;
using server::PhoneMessages;
using server::RawFix;
using server::Report;
using server::SealedText;
using Kind = Report::Kind;

class PhoneMessagesTest : public ::testing::Test {
  protected:
    static constexpr const char* kLocation =
        R"({"_type":"location","lat":50.2,"lon":-3.1,"tst":1763760000,"acc":12,"alt":3,"vel":4,"batt":80,"t":"u","tid":"an",
            "SSID":"home","BSSID":"aa:bb","inregions":["Home"],"motionactivities":["walking"],"topic":"owntracks/x/y"})";

    static RawFix only(const Report& report) {
        EXPECT_EQ(report.kind, Kind::Position);
        EXPECT_EQ(report.fixes.size(), 1U);
        return report.fixes.empty() ? RawFix() : report.fixes.front();
    }
};

TEST_F(PhoneMessagesTest, OwnTracksLocation_IsAPosition_AndNothingElseOfIt) {
    EXPECT_EQ(only(PhoneMessages::ownTracks(kLocation)), (RawFix{1763760000.0, 50.2, -3.1, 12.0}));
    EXPECT_EQ(only(PhoneMessages::ownTracks(R"({"_type":"location","lat":50.2,"lon":-3.1,"tst":1763760000})")),
              (RawFix{1763760000.0, 50.2, -3.1, std::nullopt}))
        << "an accuracy that is missing is unknown";
}

TEST_F(PhoneMessagesTest, OwnTracksPing_IsNotAFix) {
    EXPECT_EQ(PhoneMessages::ownTracks(R"({"_type":"location","lat":50.2,"lon":-3.1,"tst":1763760000,"t":"p"})"),
              Report::alive());
}

TEST_F(PhoneMessagesTest, OwnTracksOtherTypes_SayThatThePhoneLives) {
    for (const char* type : {"transition", "card", "status", "lwt", "steps", "beacon", "request", "cmd",
                             "configuration", "dump", "one from the future"}) {
        EXPECT_EQ(
            PhoneMessages::ownTracks(std::string(R"({"_type":")") + type + R"(","lat":1,"lon":2,"tst":3,"acc":4})"),
            Report::alive())
            << type;
    }
    EXPECT_EQ(PhoneMessages::ownTracks(""), Report::alive()) << "a friend was deleted in the app";
}

TEST_F(PhoneMessagesTest, OwnTracksWaypoints_AreNamedPlacesAndNoFixes) {
    const std::string work = R"({"_type":"waypoint","desc":"Work","lat":50.2,"lon":-3.1,"rad":120,"tst":1763760000})";
    Report expected = Report::alive();
    expected.places = {{"Work", 50.2, -3.1, 120.0}};
    EXPECT_EQ(PhoneMessages::ownTracks(work), expected);
    expected.places.push_back({"Pool", 50.3, -3.2, std::nullopt});
    EXPECT_EQ(PhoneMessages::ownTracks(R"({"_type":"waypoints","_creator":"phone","waypoints":[)" + work +
                                       R"(,{"_type":"waypoint","desc":"Pool","lat":50.3,"lon":-3.2},7,null,{}]})"),
              expected);
    for (const char* odd :
         {R"({"_type":"waypoint","lat":50.2,"lon":-3.1})", R"({"_type":"waypoint","desc":"Work","lat":50.2})",
          R"({"_type":"waypoint","desc":"+follow","lat":50.2,"lon":-3.1,"rad":50})",
          R"({"_type":"waypoint","desc":"Keys","lat":50.2,"lon":-3.1,"uuid":"0000","major":1})",
          R"({"_type":"waypoint","desc":7,"lat":50.2,"lon":-3.1})", R"({"_type":"waypoints","waypoints":7})"}) {
        EXPECT_EQ(PhoneMessages::ownTracks(odd), Report::alive()) << odd;
    }
}

TEST_F(PhoneMessagesTest, OwnTracksCard_BringsAFaceAndNoName) {
    const Report report =
        PhoneMessages::ownTracks(R"({"_type":"card","tid":"an","name":"Somebody else","face":"QUJD"})");
    EXPECT_EQ(report.kind, Kind::Alive);
    EXPECT_EQ(report.face, "ABC");
    for (const char* face : {"null", "7", R"("QUJ")", R"("QU JD")"}) {
        EXPECT_EQ(PhoneMessages::ownTracks(std::string(R"({"_type":"card","face":)") + face + "}"), Report::alive());
    }
    EXPECT_EQ(PhoneMessages::ownTracks(R"({"_type":"location","lat":1,"lon":2,"tst":3,"face":"QUJD"})").face,
              std::nullopt);
}

TEST_F(PhoneMessagesTest, WhatIsNoMessage_IsJunk) {
    for (const char* body : {"[]", "null", "{", "{}", R"({"_type":7})", R"({"_type":"location"})",
                             R"({"_type":"location","lat":"50","lon":1,"tst":2})", "\xFF", R"({"_type":"encrypted"})",
                             R"({"_type":"encrypted","data":"AAAA"})"}) {
        EXPECT_EQ(PhoneMessages::ownTracks(body, "key"), Report()) << body;
    }
}

TEST_F(PhoneMessagesTest, SealedMessage_IsOpenedWithItsKeyAlone) {
    const auto sealed = SealedText::seal(kLocation, "a shared key");
    ASSERT_TRUE(sealed);
    const std::string body = R"({"_type":"encrypted","data":")" + *sealed + "\"}";
    const Report report = PhoneMessages::ownTracks(body, "a shared key");
    EXPECT_EQ(only(report).latitude, 50.2);
    EXPECT_TRUE(report.sealed);
    EXPECT_EQ(PhoneMessages::ownTracks(body, "another key"), Report());
    EXPECT_EQ(PhoneMessages::ownTracks(body), Report());
    const auto twice = SealedText::seal(body, "a shared key");
    EXPECT_EQ(PhoneMessages::ownTracks(R"({"_type":"encrypted","data":")" + *twice + "\"}", "a shared key").kind,
              Kind::Junk);
}

TEST_F(PhoneMessagesTest, SealedText_HasKeysOfOneTo32Bytes_AndNoticesAChange) {
    EXPECT_EQ(SealedText::open(SealedText::seal("hello", "k").value_or(""), "k"), "hello");
    const std::string full(32, 'x');
    EXPECT_TRUE(SealedText::seal("", full));
    EXPECT_EQ(SealedText::seal("a", full + "x"), std::nullopt);
    EXPECT_EQ(SealedText::seal("a", ""), std::nullopt);
    auto changed = *SealedText::seal("hello", "k");
    changed[changed.size() / 2] = changed[changed.size() / 2] == 'A' ? 'B' : 'A';
    EXPECT_EQ(SealedText::open(changed, "k"), std::nullopt);
}

TEST_F(PhoneMessagesTest, Parameters_InEveryForm) {
    const Report report = PhoneMessages::parameters(
        "id=secret&lat=50.2&lon=-3.1&timestamp=1763760000&speed=3&bearing=9&altitude=2&accuracy=12&batt=80&hdop=1");
    EXPECT_EQ(report.device, "secret");
    EXPECT_EQ(only(report), (RawFix{1763760000.0, 50.2, -3.1, 12.0}));
    EXPECT_EQ(only(PhoneMessages::parameters("lat=50.2&lon=-3.1&time=2025-11-21T21%3A20%3A00Z&acc=12")),
              (RawFix{1763760000.0, 50.2, -3.1, 12.0}));
    EXPECT_EQ(only(PhoneMessages::parameters("location=50.2,-3.1&deviceid=x")),
              (RawFix{std::nullopt, 50.2, -3.1, std::nullopt}));
    EXPECT_EQ(only(PhoneMessages::parameters("lat=50.2&lon=-3.1&hdop=2")).accuracy, std::nullopt)
        << "a dilution is no length";
    for (const char* form :
         {"", "id=a", "lat=50", "lat=north&lon=1", "lat=1e400&lon=1", "lat=nan&lon=1", "location=50"}) {
        EXPECT_EQ(PhoneMessages::parameters(form).kind, Kind::Junk) << form;
    }
}

TEST_F(PhoneMessagesTest, Times_InSecondsMillisecondsAndDates) {
    for (const char* text : {"1763760000", "1763760000000", "2025-11-21T21:20:00Z", "2025-11-21T22:20:00+01:00",
                             "2025-11-21 21:20:00", "2025-11-21T21:20:00.000Z"}) {
        EXPECT_EQ(PhoneMessages::timeOf(text), 1763760000.0) << text;
    }
    for (const char* text : {"", "now", "inf", "2025-13-01T00:00:00Z", "12x"}) {
        EXPECT_EQ(PhoneMessages::timeOf(text), std::nullopt) << text;
    }
}

TEST_F(PhoneMessagesTest, TraccarJson_IsAPosition) {
    const Report report = PhoneMessages::traccar(
        R"({"location":{"timestamp":"2025-11-21T21:20:00.000Z","coords":{"latitude":50.2,"longitude":-3.1,"accuracy":12,
            "speed":-1,"heading":-1,"altitude":5},"is_moving":false,"odometer":7,"event":"motionchange",
            "battery":{"level":-1,"is_charging":false},"activity":{"type":"still"},"extras":{},"_":"&id=x"},"device_id":"secret"})");
    EXPECT_EQ(report.device, "secret");
    EXPECT_EQ(only(report), (RawFix{1763760000.0, 50.2, -3.1, 12.0}));
    for (const char* body : {"", "[]", "{}", R"({"location":[]})", R"({"location":{"coords":{"latitude":1}}})"}) {
        EXPECT_EQ(PhoneMessages::traccar(body).kind, Kind::Junk) << body;
    }
}

class FixRulesTest : public ::testing::Test {
  protected:
    static constexpr std::int64_t kNow = 1763760000;
    static FixRules::Outcome admit(std::optional<double> time, double latitude = 50.2, double longitude = -3.1,
                                   std::optional<double> accuracy = 12.0) {
        return FixRules::admit({time, latitude, longitude, accuracy}, kNow);
    }
};

TEST_F(FixRulesTest, Fix_HasTwoTimes) {
    const auto fix = admit(kNow - 3600.5).fix;
    ASSERT_TRUE(fix);
    EXPECT_EQ(fix->time, kNow - 3601);
    EXPECT_EQ(fix->heard, kNow);
}

TEST_F(FixRulesTest, ClockAhead_IsBelievedForFiveMinutes) {
    EXPECT_EQ(admit(kNow + 300).fix->time, kNow + 300);
    EXPECT_EQ(admit(kNow + 301).fix->time, kNow);
    EXPECT_EQ(admit(1.0e11).fix->time, kNow);
}

TEST_F(FixRulesTest, TooOld_IsDropped) {
    EXPECT_TRUE(admit(kNow - FixRules::kRetention).fix);
    EXPECT_EQ(admit(kNow - FixRules::kRetention - 1).loss, FixRules::Loss::TooOld);
    for (const double time : {0.0, -5.0, 1.0e300, std::numeric_limits<double>::quiet_NaN()}) {
        EXPECT_EQ(admit(time).loss, FixRules::Loss::NoTime) << time;
    }
    EXPECT_EQ(admit(std::nullopt).loss, FixRules::Loss::NoTime);
}

TEST_F(FixRulesTest, Accuracy_ThatIsNoLength_IsUnknown) {
    for (const double accuracy :
         {0.0, -1.0, 1.0e300, std::numeric_limits<double>::infinity(), std::numeric_limits<double>::quiet_NaN()}) {
        EXPECT_EQ(admit(kNow, 50.2, -3.1, accuracy).fix->accuracy, std::nullopt) << accuracy;
    }
    EXPECT_EQ(admit(kNow).fix->accuracy, 12.0);
}

TEST_F(FixRulesTest, NoPlaceOnEarth_IsDropped) {
    const double nan = std::numeric_limits<double>::quiet_NaN();
    EXPECT_EQ(admit(kNow, 90.1, 0.0).loss, FixRules::Loss::NoPlace);
    EXPECT_EQ(admit(kNow, 0.0, -180.1).loss, FixRules::Loss::NoPlace);
    EXPECT_EQ(admit(kNow, nan, 0.0).loss, FixRules::Loss::NoPlace);
    EXPECT_EQ(admit(kNow, 0.0, nan).loss, FixRules::Loss::NoPlace);
    EXPECT_EQ(admit(kNow, 0.0, 0.0, std::nullopt).loss, FixRules::Loss::NoPlace);
    EXPECT_EQ(admit(kNow, 0.0, 0.0, 0.0).loss, FixRules::Loss::NoPlace);
    EXPECT_TRUE(admit(kNow, 0.0, 0.0, 12.0).fix) << "somebody may be there";
    EXPECT_TRUE(admit(kNow, 0.0, 5.0, std::nullopt).fix) << "on the equator";
}

}  // namespace ktr::test
