// What a record is made of, and who its friend is.
#include "model/KTRVALocation.h"

#include "tests/unit/model/KTRVALocationFixture.h"

namespace ktr::test {
namespace {

using platform::Dictionary;
using platform::VAKtrLocation;
using platform::Value;
using platform::VAPerson;

// Making a record.

TEST_F(KTRVALocationTest, AdoptsTheObjectAsItStands) {
    const auto vela = std::make_shared<VAKtrLocation>();
    const auto made = KTRVALocation::locationWithVelaLocation(vela);
    ASSERT_TRUE(made);
    EXPECT_EQ(made->velaLocation(), vela);
    EXPECT_EQ(made->cachedFriendImage(), nullptr);
}

TEST_F(KTRVALocationTest, Decoding_ReadsEveryField) {
    const Dictionary entry{
        {"distanceInMeters", "1234.5"},
        {"location", Dictionary{{"latitude", 48.25},
                                {"longitude", -11},
                                {"horizontalAccuracy", 65},
                                {"timestamp", 978307201500.0},
                                {"streetAddress", "1 Elm St"},
                                {"labels", Value::Array{Dictionary{{"label", "Work"}}}},
                                {"address", Dictionary{{"locality", "Springfield"}, {"stateCode", "IL"}}},
                                {"unknown", Value::Array{}}}}};
    const auto given = person({"ann@example.com"}, {});
    const auto vela = KTRVALocation::locationWithHandle("ann@example.com", given, entry)->velaLocation();
    ASSERT_TRUE(vela && vela->friend_);
    EXPECT_EQ(vela->friend_->object, given);
    EXPECT_EQ(vela->friend_->data, "ann@example.com");
    EXPECT_EQ(vela->distance, 1234.5);
    EXPECT_EQ(vela->latitude, 48.25);
    EXPECT_EQ(vela->longitude, -11.0);
    EXPECT_EQ(vela->accuracy, 65.0);
    EXPECT_EQ(vela->locationDate, 1.5);
    EXPECT_EQ(vela->street, "1 Elm St");
    EXPECT_EQ(vela->label, "Work");
    EXPECT_EQ(vela->city, "Springfield");
    EXPECT_EQ(vela->stateCode, "IL");
}

TEST_F(KTRVALocationTest, Decoding_DropsTheEarlierObject) {
    const auto made = decoded(Dictionary{{"latitude", 1.0}, {"longitude", 2.0}});
    const auto before = made->velaLocation();
    made->decodeHandle("bob@example.com", nullptr, std::nullopt);
    EXPECT_NE(made->velaLocation(), before);
    EXPECT_FALSE(made->hasCoordinate());
    EXPECT_EQ(made->friendHandle(), "bob@example.com");
}

TEST_F(KTRVALocationTest, Decoding_NullOrWronglyTypedLocationReadsAsAbsent) {
    for (const Value& location : {Value(nullptr), Value("x"), Value(1), Value(Value::Array{}), Value(Dictionary{})}) {
        const auto made = decoded(location);
        EXPECT_FALSE(made->hasCoordinate());
        EXPECT_EQ(made->velaLocation()->city, std::nullopt);
        EXPECT_EQ(made->velaLocation()->locationDate, std::nullopt);
        EXPECT_EQ(made->velaLocation()->label, std::nullopt);
        EXPECT_EQ(made->friendHandle(), "ann@example.com") << "who it is stays known";
    }
    EXPECT_FALSE(KTRVALocation::locationWithHandle("a@b", nullptr, std::nullopt)->hasCoordinate());
    EXPECT_FALSE(KTRVALocation::locationWithHandle("a@b", nullptr, Dictionary{})->hasCoordinate());
}

TEST_F(KTRVALocationTest, Decoding_NullOrWronglyTypedFieldsReadAsAbsent) {
    for (const Value& wrong : {Value(nullptr), Value(true), Value(Dictionary{}), Value(Value::Array{1})}) {
        const auto made =
            decoded(Dictionary{{"latitude", wrong},
                               {"longitude", wrong},
                               {"horizontalAccuracy", wrong},
                               {"timestamp", wrong},
                               {"streetAddress", wrong},
                               {"labels", wrong},
                               {"address", Dictionary{{"locality", wrong}, {"administrativeArea", wrong}}}});
        const VAKtrLocation& vela = *made->velaLocation();
        EXPECT_EQ(vela.latitude, std::nullopt);
        EXPECT_EQ(vela.longitude, std::nullopt);
        EXPECT_EQ(vela.accuracy, std::nullopt);
        EXPECT_EQ(vela.locationDate, std::nullopt);
        EXPECT_EQ(vela.street, std::nullopt);
        EXPECT_EQ(vela.label, std::nullopt);
        EXPECT_EQ(vela.city, std::nullopt);
        EXPECT_EQ(vela.stateCode, std::nullopt);
    }
    EXPECT_EQ(decoded(Dictionary{{"latitude", "48.1"}})->velaLocation()->latitude, std::nullopt);
}

TEST_F(KTRVALocationTest, Decoding_DistanceIsADecimalNumberInAString) {
    const auto distance = [](const Value& value) {
        return KTRVALocation::locationWithHandle("a@b", nullptr, Dictionary{{"distanceInMeters", value}})
            ->velaLocation()
            ->distance;
    };
    EXPECT_EQ(distance("310"), 310.0);
    EXPECT_EQ(distance("far"), std::nullopt);
    EXPECT_EQ(distance(""), std::nullopt);
    EXPECT_EQ(distance(310), std::nullopt) << "a number is not the string it is meant to be";
    EXPECT_EQ(distance(nullptr), std::nullopt);
}

TEST_F(KTRVALocationTest, StateCodeAbsent_FallsBackToAdministrativeArea) {
    EXPECT_EQ(decodedAddress(Dictionary{{"administrativeArea", "IL"}})->stateCode, "IL");
    EXPECT_EQ(decodedAddress(Dictionary{{"stateCode", "IL"}, {"administrativeArea", "Illinois"}})->stateCode, "IL");
    EXPECT_EQ(decodedAddress(Dictionary{})->stateCode, std::nullopt);
}

TEST_F(KTRVALocationTest, StateCodeNull_DoesNotFallBackToAdministrativeArea) {
    EXPECT_EQ(decodedAddress(Dictionary{{"stateCode", nullptr}})->stateCode, std::nullopt);
    EXPECT_EQ(decodedAddress(Dictionary{{"stateCode", nullptr}, {"administrativeArea", "IL"}})->stateCode,
              std::nullopt);
}

TEST_F(KTRVALocationTest, StateCodeWronglyTyped_DoesNotFallBackToAdministrativeArea) {
    EXPECT_EQ(decodedAddress(Dictionary{{"stateCode", 5}, {"administrativeArea", "IL"}})->stateCode, std::nullopt);
}

TEST_F(KTRVALocationTest, AddressNull_LeavesCityAndStateNone) {
    for (const Value& address : {Value(nullptr), Value("x"), Value(Dictionary{{"locality", nullptr}})}) {
        EXPECT_EQ(decodedAddress(address)->city, std::nullopt);
        EXPECT_EQ(decodedAddress(address)->stateCode, std::nullopt);
    }
}

TEST_F(KTRVALocationTest, Labels_TheFirstPresentOneCounts) {
    EXPECT_EQ(
        labelOf(Value::Array{Dictionary{{"other", 1}}, Dictionary{{"label", "Home"}}, Dictionary{{"label", "Work"}}}),
        "Home");
    EXPECT_EQ(labelOf(Value::Array{nullptr, "x", Dictionary{{"label", nullptr}}, Dictionary{{"label", 7}},
                                   Dictionary{{"label", "Gym"}}}),
              "Gym");
    EXPECT_EQ(labelOf(Value::Array{Dictionary{{"label", ""}}, Dictionary{{"label", "Work"}}}), "")
        << "a present empty label counts";
}

TEST_F(KTRVALocationTest, Labels_WithoutAnyThereIsNone) {
    EXPECT_EQ(labelOf(Value::Array{}), std::nullopt);
    EXPECT_EQ(labelOf(Value::Array{Dictionary{}, Dictionary{}}), std::nullopt);
    EXPECT_EQ(labelOf(nullptr), std::nullopt);
}

// The person of a handle.

TEST_F(KTRVALocationTest, Person_OfAnEmailHandleComesFromTheContacts) {
    addContact("7", "ann@example.com", std::nullopt);
    const auto made = KTRVALocation::locationWithHandle("ann@example.com", nullptr, std::nullopt);
    const VAPerson& found = *made->velaLocation()->friend_->object;
    EXPECT_EQ(found.fullName, "Ann Nakamura");
    EXPECT_EQ(found.firstName, "Ann");
    EXPECT_EQ(found.lastName, "Nakamura");
    EXPECT_EQ(found.identifier, "assistant:7");
    ASSERT_EQ(found.emails.size(), 1U);
    EXPECT_EQ(found.emails[0]->emailAddress, "ann@example.com");
    EXPECT_TRUE(found.phones.empty());
}

TEST_F(KTRVALocationTest, Person_OfAnyOtherHandleIsLookedUpByPhone) {
    addContact("7", std::nullopt, "07700 900123");
    const auto made = KTRVALocation::locationWithHandle("+447700900123", nullptr, std::nullopt);
    const VAPerson& found = *made->velaLocation()->friend_->object;
    EXPECT_EQ(found.fullName, "Ann Nakamura");
    ASSERT_EQ(found.phones.size(), 1U);
    EXPECT_EQ(found.phones[0]->number, "+447700900123");
    EXPECT_TRUE(found.emails.empty());
}

TEST_F(KTRVALocationTest, Person_WithoutAContactKeepsOnlyTheHandle) {
    const auto made = KTRVALocation::locationWithHandle("ann@example.com", nullptr, std::nullopt);
    const VAPerson& found = *made->velaLocation()->friend_->object;
    EXPECT_EQ(found.fullName, std::nullopt);
    EXPECT_EQ(found.firstName, std::nullopt);
    EXPECT_EQ(found.identifier, std::nullopt);
    EXPECT_EQ(made->friendName(), "ann@example.com");
}

TEST_F(KTRVALocationTest, Person_OfNoHandleIsAPersonWithoutANumber) {
    const auto made = KTRVALocation::locationWithHandle(std::nullopt, nullptr, std::nullopt);
    EXPECT_EQ(made->velaLocation()->friend_->data, std::nullopt);
    EXPECT_EQ(made->friendHandle(), std::nullopt);
    EXPECT_EQ(made->friendName(), "");
}

TEST_F(KTRVALocationTest, Person_AGivenOneIsNotLookedUp) {
    addContact("7", "ann@example.com", std::nullopt);
    KTRVALocation::locationWithHandle("ann@example.com", person({"a@b"}, {}), std::nullopt);
    EXPECT_EQ(contacts->fetches, 0);
}

// Who it is.

TEST_F(KTRVALocationTest, Name_IsTheFullNameUnlessItIsEmpty) {
    EXPECT_EQ(record(person({"a@b"}, {}, "Ann"))->friendName(), "Ann");
    EXPECT_EQ(record(person({"a@b"}, {}, ""))->friendName(), "a@b");
    EXPECT_EQ(record(person({}, {"+447700900123"}))->friendName(), "07700900123");
    EXPECT_EQ(nobody()->friendName(), "");
}

TEST_F(KTRVALocationTest, Handles_AreTheLastOfEachList_IsKept) {
    const auto made = record(person({"first@b", "last@b"}, {"1", "2"}));
    EXPECT_EQ(made->friendEmail(), "last@b");
    EXPECT_EQ(made->friendPhone(), "2");
}

TEST_F(KTRVALocationTest, Handles_TheEmailAddressGoesFirst) {
    const auto both = record(person({"a@b"}, {"+447700900123"}));
    EXPECT_EQ(both->friendHandle(), "a@b");
    EXPECT_EQ(both->friendHandlePretty(), "a@b");
    EXPECT_EQ(both->unformattedHandle(), "a@b");
    EXPECT_FALSE(both->isPhone());
}

TEST_F(KTRVALocationTest, Handles_ThePhoneNumberWithoutAnEmailAddress) {
    const auto phone = record(person({}, {"+44 7700 900123"}));
    EXPECT_EQ(phone->friendEmail(), std::nullopt);
    EXPECT_EQ(phone->friendHandle(), "+44 7700 900123");
    EXPECT_EQ(phone->friendHandlePretty(), "07700900123");
    EXPECT_EQ(phone->unformattedHandle(), "+447700900123");
    EXPECT_TRUE(phone->isPhone());
}

TEST_F(KTRVALocationTest, Handles_APresentEmptyAddressCounts_IsKept) {
    const auto made = record(person({""}, {"+447700900123"}));
    EXPECT_EQ(made->friendEmail(), "");
    EXPECT_EQ(made->friendHandle(), "");
    EXPECT_EQ(made->unformattedHandle(), "");
    EXPECT_FALSE(made->isPhone());
}

TEST_F(KTRVALocationTest, Handles_AnAddressObjectWithoutAddressIsNone) {
    const auto made = record(person({"a@b", std::nullopt}, {"5"}));
    EXPECT_EQ(made->friendEmail(), std::nullopt);
    EXPECT_EQ(made->friendHandle(), "5");
    EXPECT_TRUE(made->isPhone());
}

TEST_F(KTRVALocationTest, Handles_OfNobodyAreNone) {
    const auto made = nobody();
    EXPECT_EQ(made->friendEmail(), std::nullopt);
    EXPECT_EQ(made->friendPhone(), std::nullopt);
    EXPECT_EQ(made->friendHandle(), std::nullopt);
    EXPECT_EQ(made->friendHandlePretty(), "");
    EXPECT_EQ(made->unformattedHandle(), "");
    EXPECT_FALSE(made->isPhone());
}

TEST_F(KTRVALocationTest, Format_PrintsForDisplayByTheHomeCountry) {
    EXPECT_EQ(nobody()->formatPhoneNumber("+447700900123"), "07700900123");
    telephony->country = "us";
    EXPECT_EQ(nobody()->formatPhoneNumber("+447700900123"), "+44 7700900123");
    EXPECT_EQ(nobody()->formatPhoneNumber("voicemail"), "voicemail") << "what is no number stays as it is";
}

TEST_F(KTRVALocationTest, Unformat_KeepsDigitsAndPlusAlone) {
    EXPECT_EQ(nobody()->unformatPhoneNumber("+1 (555) 555-0100"), "+15555550100");
    EXPECT_EQ(nobody()->unformatPhoneNumber("(555) 555-0100 ext. 12"), "555555010012");
    EXPECT_EQ(nobody()->unformatPhoneNumber("tel ٠١+"), "٠١+");
    EXPECT_EQ(nobody()->unformatPhoneNumber("\xFF"
                                            "1"),
              "1");
    EXPECT_EQ(nobody()->unformatPhoneNumber(""), "");
}

}  // namespace
}  // namespace ktr::test
