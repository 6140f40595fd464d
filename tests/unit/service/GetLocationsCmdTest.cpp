#include "service/GetLocationsCmd.h"

#include "platform/base/Json.h"
#include "platform/client/KTServerInteractionController.h"
#include "tests/support/PlatformTest.h"

namespace ktr::test {
namespace {

using platform::Dictionary;
using platform::Value;
using platform::VAPerson;

class GetLocationsCmdTest : public PlatformTest {
  protected:
    static std::shared_ptr<VAPerson> person(const std::string& name, const std::vector<std::string>& emails,
                                            const std::vector<std::string>& phones = {}) {
        auto made = std::make_shared<VAPerson>();
        made->fullName = name;
        for (const std::string& address : emails) {
            made->emails.push_back(std::make_shared<platform::VAEmail>());
            made->emails.back()->emailAddress = address;
        }
        for (const std::string& number : phones) {
            made->phones.push_back(std::make_shared<platform::VAPhone>());
            made->phones.back()->number = number;
        }
        return made;
    }

    /// Sends the command and answers it.
    void answer(const Dictionary& body) {
        platform::KTServerInteractionController().sendCommand(command, nullptr);
        transport->answer(body);
        time->runPosted();
    }
    std::string body() { return platform::writeJson(command->jsonBodyDictionary()); }
    /// The handles of what was found, in order.
    std::vector<std::string> found() {
        std::vector<std::string> handles;
        const ServiceResult items = command->result().value();
        for (const ResultItem& item : items) {
            const auto location = std::get<std::shared_ptr<platform::VAKtrLocation>>(item);
            handles.push_back(location->friend_->data.value_or("none"));
        }
        return handles;
    }
    std::string contextUrl() const {
        return command->contextIdentifierURL() ? command->contextIdentifierURL()->text() : "none";
    }

    static constexpr const char* kContext =
        R"("clientContext":{"deviceUDID":"device-1","productType":"Model 7","osVersion":"12.5",)"
        R"("buildVersion":"6.1.0-18","locale":"en-GB","countryCode":"CH","regionCode":"GB"})";
    static constexpr const char* kNowhere = R"({"latitude":0,"longitude":0,"source":"assistant"})";

    std::shared_ptr<GetLocationsCmd> command = platform::create<GetLocationsCmd>(&GetLocationsCmd::init);
};

TEST_F(GetLocationsCmdTest, PathAndHeaders) {
    EXPECT_EQ(command->path(), "/qloxservice/friends/va/getlocations");
    EXPECT_EQ(command->headers().size(), 4U);
}

TEST_F(GetLocationsCmdTest, Body_ByteForByte) {
    command->setFriends(GetLocationsCmd::Persons{person("Ann", {"ann@example.org"}),
                                                 person("Bob", {"Bob@Example.org"}, {"mobile 020 7946 0018"})});
    command->setCurrentLocation(position(51.5, -0.125, 12.5));
    command->setProximity("near");
    command->setClientId("client-1");
    EXPECT_EQ(body(), std::string("{") + kContext +
                          R"(,"handles":["ann@example.org","+442079460018","Bob@Example.org"],)"
                          R"("myLocation":{"latitude":51.5,"longitude":-0.125,"source":"assistant",)"
                          R"("horizontalAccuracy":12.5,"timestamp":1768478400000},"requestedLocation":)" +
                          kNowhere + R"(,"proximity":"near","serverContext":{"clientId":"client-1"}})");
}

TEST_F(GetLocationsCmdTest, Body_UnknownPositionsAreSentAsZero_IsKept) {
    EXPECT_EQ(body(), std::string("{") + kContext + R"(,"myLocation":)" + kNowhere + R"(,"requestedLocation":)" +
                          kNowhere + "}");
}

TEST_F(GetLocationsCmdTest, Body_RequestedPlaceAndItsLabel) {
    command->setRequestedLocation(position(1.5, 2.5, 0.0));
    command->setRequestedLocationLabel("office");
    command->setEmails({"not@sent"});
    EXPECT_EQ(body(), std::string("{") + kContext + R"(,"myLocation":)" + kNowhere +
                          R"(,"requestedLocation":{"latitude":1.5,"longitude":2.5,"source":"assistant",)"
                          R"("timestamp":1768478400000},"label":"office"})");
}

TEST_F(GetLocationsCmdTest, Body_InvalidPositionIsLeftOut) {
    command->setCurrentLocation(position(91.0, 0.5));
    EXPECT_EQ(body().find("myLocation"), std::string::npos);
}

TEST_F(GetLocationsCmdTest, Body_NoFriendsAreNotTheSameAsUnsetFriends) {
    EXPECT_EQ(command->allFriendsHandles(), std::nullopt);
    command->setFriends(GetLocationsCmd::Persons{});
    EXPECT_NE(body().find(R"("handles":[])"), std::string::npos);
}

TEST_F(GetLocationsCmdTest, Handles_KeepDuplicatesAndEveryPerson) {
    command->setFriends(
        GetLocationsCmd::Persons{person("A", {"a@b", "a@b"}), nullptr, person("Nobody", {}), person("B", {"a@b"})});
    EXPECT_EQ(command->allFriendsHandles(), (std::vector<std::string>{"a@b", "a@b", "a@b"}));
}

TEST_F(GetLocationsCmdTest, FriendForHandle_ComparesBytes) {
    const auto ann = person("Ann", {"ann@example.org"}, {"020 7946 0018"});
    const auto bob = person("Bob", {"bob@example.org"}, {"ann@example.org"});
    command->setFriends(GetLocationsCmd::Persons{bob, nullptr, ann});
    EXPECT_EQ(command->friendForHandle("020 7946 0018"), ann);
    EXPECT_EQ(command->friendForHandle("Ann@example.org"), nullptr);
    EXPECT_EQ(command->friendForHandle(""), nullptr);
    // The first person with it, be it as an address or as a number.
    EXPECT_EQ(command->friendForHandle("ann@example.org"), bob);
}

TEST_F(GetLocationsCmdTest, FriendForHandle_CompletedNumberFindsNobody_IsKept) {
    command->setFriends(GetLocationsCmd::Persons{person("Ann", {}, {"020 7946 0018"})});
    EXPECT_EQ(command->allFriendsHandles(), std::vector<std::string>{"+442079460018"});
    EXPECT_EQ(command->friendForHandle("+442079460018"), nullptr);
}

TEST_F(GetLocationsCmdTest, Result_NoneWithoutAnswer) {
    EXPECT_EQ(command->result(), std::nullopt);
    EXPECT_TRUE(log->has(platform::LogLevel::Default, "getlocations_resultDictionary_raw: (null)"));
    EXPECT_EQ(command->contextIdentifierURL(), std::nullopt);
}

TEST_F(GetLocationsCmdTest, Result_WithoutEmails_WalksTheLocationsInTheirOrder) {
    const Dictionary entry{{"location", Dictionary{{"latitude", 51.5}, {"longitude", -0.1}}}};
    answer({{"locations", Dictionary{{"c@x", entry}, {"a@x", entry}, {"b@x", entry}}}, {"emails", Value::Array{}}});
    EXPECT_EQ(found(), (std::vector<std::string>{"c@x", "a@x", "b@x"}));
}

TEST_F(GetLocationsCmdTest, Result_EmailsChooseAndOrder) {
    const Dictionary entry{{"location", Dictionary{{"latitude", 51.5}, {"longitude", -0.1}}}};
    answer({{"locations", Dictionary{{"a@x", entry}, {"b@x", entry}}}, {"emails", Value::Array{"b@x", 7, "nobody@x"}}});
    EXPECT_EQ(found(), (std::vector<std::string>{"b@x", "nobody@x"}));
}

TEST_F(GetLocationsCmdTest, Result_CarriesThePersonAndThePlace) {
    const auto ann = person("Ann Example", {"ann@example.org"});
    command->setFriends(GetLocationsCmd::Persons{ann});
    answer({{"locations", Dictionary{{"ann@example.org",
                                      Dictionary{{"location", Dictionary{{"latitude", 51.5}, {"longitude", -0.1}}},
                                                 {"distanceInMeters", "1200"}}}}}});
    const auto items = command->result().value();
    ASSERT_EQ(items.size(), 1U);
    const auto location = std::get<std::shared_ptr<platform::VAKtrLocation>>(items[0]);
    EXPECT_EQ(location->friend_->object, ann);
    EXPECT_EQ(location->latitude, 51.5);
    EXPECT_EQ(location->longitude, -0.1);
    EXPECT_EQ(location->distance, 1200.0);
}

TEST_F(GetLocationsCmdTest, Result_Status411IsLeftOutAndDoesNotTouchTheMatch) {
    answer({{"locations", Dictionary{{"a@x", Dictionary{{"match", true}}},
                                     {"b@x", Dictionary{{"status", 411}, {"match", false}}},
                                     {"c@x", Dictionary{{"status", "411"}}}}}});
    EXPECT_EQ(command->atRequestedLocation(), std::nullopt);
    EXPECT_EQ(found(), std::vector<std::string>{"a@x"});
    EXPECT_EQ(command->atRequestedLocation(), true);
}

TEST_F(GetLocationsCmdTest, Result_TheLastMatchStands) {
    answer({{"locations", Dictionary{{"a@x", Dictionary{{"match", 1}}}, {"b@x", Dictionary{{"status", 410}}}}}});
    EXPECT_EQ(found().size(), 2U);
    EXPECT_EQ(command->atRequestedLocation(), false);
}

TEST_F(GetLocationsCmdTest, Result_EntryThatIsNoObjectCountsAsAbsent) {
    answer({{"locations", Dictionary{{"a@x", nullptr}, {"b@x", 5}}}});
    EXPECT_EQ(found(), (std::vector<std::string>{"a@x", "b@x"}));
    EXPECT_EQ(command->atRequestedLocation(), false);
}

TEST_F(GetLocationsCmdTest, Result_NullLocationsGiveAnEmptyListAndAContext) {
    answer({{"locations", nullptr}, {"emails", Value::Array{}}, {"serverContext", Dictionary{{"clientId", "c"}}}});
    EXPECT_TRUE(found().empty());
    EXPECT_EQ(contextUrl(), "ktrServerContext://serverContext?clientId=c&");
}

TEST_F(GetLocationsCmdTest, Result_Status416MarksTheContext) {
    answer({{"statusCode", 416}, {"serverContext", Dictionary{{"clientId", "c"}, {"authToken", "secret"}}}});
    found();
    EXPECT_EQ(contextUrl(), "ktrServerContext://serverContext?clientId=c&incomplete=1&");
    EXPECT_TRUE(log->has(platform::LogLevel::Default, "location result: ()"));
}

TEST_F(GetLocationsCmdTest, Result_OtherStatusDoesNotMarkTheContext) {
    answer({{"statusCode", 200}, {"serverContext", Dictionary{{"clientId", "c"}}}});
    found();
    EXPECT_EQ(contextUrl(), "ktrServerContext://serverContext?clientId=c&");
}

TEST_F(GetLocationsCmdTest, Result_Status416WithoutContextChangesNothing) {
    for (const Dictionary& one :
         {Dictionary{{"statusCode", 416}}, Dictionary{{"statusCode", 416}, {"serverContext", 1}}}) {
        command = platform::create<GetLocationsCmd>(&GetLocationsCmd::init);
        answer(one);
        found();
        EXPECT_EQ(contextUrl(), "none");
        EXPECT_TRUE(log->has(platform::LogLevel::Default, "serverContextDictionary: (null)"));
    }
}

TEST_F(GetLocationsCmdTest, Result_IsMadeAnewAtEveryCall) {
    answer({{"locations", Dictionary{{"a@x", Dictionary{}}}}});
    const auto first = command->result().value();
    const auto second = command->result().value();
    EXPECT_NE(std::get<std::shared_ptr<platform::VAKtrLocation>>(first[0]),
              std::get<std::shared_ptr<platform::VAKtrLocation>>(second[0]));
}

TEST_F(GetLocationsCmdTest, Result_EachHandleHasItsOwnEntryInAnyOrder) {
    const auto inTown = [](const char* town) {
        return Dictionary{{"location", Dictionary{{"address", Dictionary{{"locality", town}}}}}};
    };
    const Dictionary locations{{"a@x", inTown("A")}, {"b@x", inTown("B")}, {"c@x", inTown("C")}};
    using Handles = platform::Value::Array;
    for (const Handles& order : {Handles{"a@x", "b@x", "c@x"}, Handles{"c@x", "b@x", "a@x"}, Handles{"a@x", "a@x"},
                                 Handles{"b@x", "none@x", "a@x", "b@x", "c@x"}}) {
        answer({{"emails", order}, {"locations", locations}});
        const auto result = command->result().value();
        ASSERT_EQ(result.size(), order.size());
        for (std::size_t i = 0; i < order.size(); ++i) {
            const auto object = std::get<std::shared_ptr<platform::VAKtrLocation>>(result[i]);
            const std::string& handle = *order[i].string();
            EXPECT_EQ(object->city, handle == "none@x"
                                        ? std::nullopt
                                        : std::optional(std::string(1, static_cast<char>(handle[0] - 32))));
        }
    }
}

}  // namespace
}  // namespace ktr::test
