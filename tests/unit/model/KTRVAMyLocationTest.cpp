#include "model/KTRVAMyLocation.h"

#include "model/PluginBundle.h"
#include "tests/support/Friends.h"
#include "tests/support/PlatformTest.h"

namespace ktr::test {
namespace {

using platform::Dictionary;
using platform::VAKtrLocation;

class KTRVAMyLocationTest : public PlatformTest {
  protected:
    KTRVAMyLocationTest() {
        localization->set("org.ktr.snippets", "HIDDEN_LOCATION", "Hidden from friends");
        localization->set("org.ktr.snippets", "LOCATING", "Looking...");
        localization->set("org.ktr.snippets", "NO_LOCATION", "Not found");
        localization->set("org.ktr.snippets", "CITY_STATE_LABEL", "%1$@, %2$@");
    }

    static Dictionary place() {
        return Dictionary{{"location", Dictionary{{"latitude", 51.25},
                                                  {"longitude", -1.5},
                                                  {"horizontalAccuracy", 12.0},
                                                  {"timestamp", 1768478400000.0},
                                                  {"streetAddress", "Quay"},
                                                  {"address", Dictionary{{"locality", "Town"}, {"stateCode", "TN"}}}}}};
    }
    static std::shared_ptr<KTRVAMyLocation> fromAssistant(bool visible,
                                                          const std::shared_ptr<VAKtrLocation>& object = nullptr,
                                                          const std::optional<std::string>& email = std::nullopt) {
        return KTRVAMyLocation::myLocation(visible, object, email);
    }
    static std::shared_ptr<KTRVAMyLocation> fromService(bool visible, const std::optional<Dictionary>& dictionary,
                                                        const std::optional<std::string>& email = std::nullopt) {
        return KTRVAMyLocation::myLocation(visible, dictionary, email);
    }
};

TEST_F(KTRVAMyLocationTest, PreferredEmail_IsTheHandle) {
    const auto record = fromAssistant(true, nullptr, "work@example.org");
    EXPECT_TRUE(record->isVisible());
    EXPECT_EQ(record->velaLocation()->friend_->data, "work@example.org");
    EXPECT_EQ(record->friendEmail(), "work@example.org");
    EXPECT_FALSE(record->hasCoordinate());
    EXPECT_FALSE(record->username().has_value());
}

TEST_F(KTRVAMyLocationTest, NoPreferredEmail_AccountsUserNameIsTheHandle) {
    EXPECT_EQ(fromAssistant(true)->friendEmail(), "ann@example.org");
    EXPECT_EQ(fromService(false, place())->friendEmail(), "ann@example.org");
}

TEST_F(KTRVAMyLocationTest, EmptyPreferredEmail_CountsAsGiven) {
    const auto record = fromAssistant(true, nullptr, "");
    EXPECT_EQ(record->velaLocation()->friend_->data, "");
    EXPECT_EQ(record->friendEmail(), std::nullopt);
}

TEST_F(KTRVAMyLocationTest, UserNameThatIsAPhoneNumber_PersonIsLookedUpByPhone) {
    accounts->account->user = "020 7946 0018";
    const auto mine = contactWith("me", "ann@example.org", "020 7946 0018");
    mine->givenName = "Ann";
    contacts->contacts = {mine};
    const auto record = fromAssistant(false);
    EXPECT_TRUE(record->isPhone());
    EXPECT_EQ(record->friendPhone(), "020 7946 0018");
    EXPECT_EQ(record->friendName(), "Ann");
    EXPECT_EQ(record->velaLocation()->friend_->object->identifier, "assistant:me");
}

TEST_F(KTRVAMyLocationTest, NoAccount_ARecordOfNobody) {
    accounts->account = nullptr;
    const auto record = fromAssistant(true);
    EXPECT_EQ(record->friendName(), "");
    EXPECT_EQ(record->unformattedHandle(), "");
    EXPECT_EQ(record->friendLocation(false), "Looking...");
}

TEST_F(KTRVAMyLocationTest, Dictionary_FillsThePlace) {
    const auto record = fromService(true, place(), "work@example.org");
    EXPECT_EQ(record->velaLocation()->latitude, 51.25);
    EXPECT_EQ(record->velaLocation()->longitude, -1.5);
    EXPECT_EQ(record->velaLocation()->street, "Quay");
    EXPECT_EQ(record->friendLocation(true), "Town, TN");
    EXPECT_EQ(record->friendEmail(), "work@example.org");
}

TEST_F(KTRVAMyLocationTest, NoDictionary_PlaceStaysEmpty) {
    const auto record = fromService(true, std::nullopt);
    EXPECT_FALSE(record->hasCoordinate());
    EXPECT_EQ(record->friendLocation(true), "Not found");
    EXPECT_EQ(record->friendLocation(false), "Looking...");
}

TEST_F(KTRVAMyLocationTest, AssistantsObject_ReplacesTheDecodedOne) {
    const auto object = placedFriend("Bo", "bo@example.org");
    const auto record = fromAssistant(true, object, "work@example.org");
    EXPECT_EQ(record->velaLocation(), object);
    EXPECT_EQ(record->friendName(), "Bo");
    EXPECT_EQ(record->friendEmail(), "bo@example.org");
}

TEST_F(KTRVAMyLocationTest, Hidden_SaysSoWhateverThePlace) {
    EXPECT_EQ(fromService(false, place())->friendLocation(true), "Hidden from friends");
    EXPECT_EQ(fromService(false, place())->friendLocation(false), "Hidden from friends");
    auto object = placedFriend("Ann", "ann@example.org");
    object->label = "Home";
    EXPECT_EQ(fromAssistant(false, object)->friendLocation(true), "Hidden from friends");
    EXPECT_EQ(fromAssistant(true, object)->friendLocation(true), "Home");
}

TEST_F(KTRVAMyLocationTest, VisibleLater_ShowsThePlace) {
    const auto record = fromService(false, place());
    record->setIsVisible(true);
    EXPECT_EQ(record->friendLocation(true), "Town, TN");
    record->setUsername("ann");
    EXPECT_EQ(record->username(), "ann");
}

TEST_F(KTRVAMyLocationTest, PrettyTimestamp_IsNoneForEveryRecord_IsKept) {
    EXPECT_EQ(fromService(true, place())->prettyTimestamp(), std::nullopt);
    EXPECT_EQ(fromService(false, std::nullopt)->prettyTimestamp(), std::nullopt);
    EXPECT_EQ(fromAssistant(true, placedFriend("Ann", "ann@example.org"))->prettyTimestamp(), std::nullopt);
}

TEST_F(KTRVAMyLocationTest, Bundle_IsThePlugins) {
    EXPECT_EQ(KTRVAMyLocation::bundle(), PluginBundle::bundle());
}

}  // namespace
}  // namespace ktr::test
