#include "app/CrossingWords.h"

#include <gtest/gtest.h>

#include "app/CrossingHook.h"

namespace ktr::test {

using app::Crossing;
using app::CrossingHook;
using app::CrossingWords;

namespace {

constexpr const char* kEvent =
    R"({"id":"17","name":"Ann","handle":"ann@x.example","trigger":"OnDeparture","place":{"latitude":50.2,"longitude":-3.1,"radius":150,"name":"Office","label":"_$!<work>!$_"},"timestamp":1763760000000})";

CrossingWords words(const Crossing& crossing, bool isLocked) {
    return CrossingWords::of(
        crossing, isLocked,
        [](const std::string& key) { return key.find("SOMEBODY") == std::string::npos ? key + " %@" : key; },
        [](std::int64_t) { return "17:42"; });
}

}  // namespace

TEST(CrossingWordsTest, Event_IsRead_AndWhatIsNoneIsNot) {
    EXPECT_EQ(Crossing::read(kEvent), (Crossing{17, "Ann", "ann@x.example", "Office", false, 1763760000}));
    for (const char* text : {"", "[]", "{}", R"({"id":"x","name":"Ann","trigger":"OnArrival","timestamp":1})",
                             R"({"id":"-1","name":"Ann","trigger":"OnArrival","timestamp":1})",
                             R"({"id":"1","trigger":"OnArrival","timestamp":1})",
                             R"({"id":"1","name":"Ann","trigger":"Immediate","timestamp":1})",
                             R"({"id":"1","name":"Ann","trigger":"OnArrival"})",
                             R"({"id":"1","name":"Ann","trigger":"OnArrival","timestamp":1e300})",
                             R"({"id":"1","name":"Ann","trigger":"OnArrival","timestamp":-9e15})"}) {
        EXPECT_FALSE(Crossing::read(text)) << text;
    }
}

TEST(CrossingWordsTest, Notification_SaysWhoAndWhere_ButNothingWhileTheScreenIsLocked) {
    Crossing crossing = *Crossing::read(kEvent);
    EXPECT_EQ(words(crossing, false), (CrossingWords{"Ann", "WATCH_DEPARTURE Office"}));
    EXPECT_EQ(words(crossing, true), (CrossingWords{"WATCH_SOMEBODY_LEFT", ""}));
    crossing.arrives = true;
    crossing.place.clear();
    EXPECT_EQ(words(crossing, false), (CrossingWords{"Ann", "WATCH_ARRIVAL 17:42"}));
    EXPECT_EQ(words(crossing, true), (CrossingWords{"WATCH_SOMEBODY_ARRIVED", ""}));
}

TEST(CrossingWordsTest, Click_AsksInTheLanguageOfTheTexts) {
    const auto german = [](const std::string& key) { return std::string(key == "FRIEND_WHERE" ? "Wo ist %@?" : key); };
    EXPECT_EQ(CrossingWords::question(*Crossing::read(kEvent), german), "Wo ist Ann?");
}

TEST(CrossingHookTest, Signature_IsTheHashOfTimeAndBody) {
    // printf '1763760000.{"a":1}' | openssl dgst -sha256 -hmac 0123456789abcdef
    EXPECT_EQ(CrossingHook::signature("0123456789abcdef", 1763760000, R"({"a":1})"),
              "t=1763760000,v1=baf658d515339ed880e7afdfbbc8ce1076f3722fd9e41539bc118685a46138a6");
    EXPECT_EQ(
        CrossingHook::body(*Crossing::read(kEvent)),
        R"({"id":"17","name":"Ann","handle":"ann@x.example","trigger":"OnDeparture","place":"Office","timestamp":1763760000000})");
}

TEST(CrossingHookTest, Address_IsHttpsWithoutCredentials) {
    EXPECT_EQ(CrossingHook::objection("https://hooks.example/ann?x=1"), "");
    EXPECT_NE(CrossingHook::objection("http://hooks.example/"), "");
    EXPECT_NE(CrossingHook::objection("https:///x"), "");
    EXPECT_NE(CrossingHook::objection("https://a:b@hooks.example/"), "");
    EXPECT_NE(CrossingHook::objection("file:///etc/passwd"), "");
}

}  // namespace ktr::test
