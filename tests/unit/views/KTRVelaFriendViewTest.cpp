#include "views/KTRVelaFriendView.h"

#include "platform/ui/Window.h"
#include "tests/support/Friends.h"
#include "tests/support/PlatformTest.h"

// What the row shows and does; its rectangles are in KTRVelaFriendViewLayoutTest.cpp.

namespace ktr {

using namespace platform;
using test::contactWith;
using test::friendByEmail;
using test::friendByPhone;
using test::placed;
using test::placedFriend;

namespace {

struct UserPosition : CurrentLocationDelegate {
    std::shared_ptr<PlatformLocation> position;
    std::shared_ptr<PlatformLocation> currentLocation() const override { return position; }
};

constexpr const char* kBundle = "org.ktr.snippets";

}  // namespace

class KTRVelaFriendViewTest : public test::PlatformTest {
  protected:
    KTRVelaFriendViewTest() {
        localization->set(kBundle, "LOCATING", "Looking...");
        localization->set(kBundle, "NO_LOCATION", "Not found");
        localization->set(kBundle, "ACCESSIBILITY_AT_LABEL", "At %@");
        localization->set(kBundle, "ACCESSIBILITY_DISTANCE", "%@ away");
        localization->set(kBundle, "ACCESSIBILITY_ROW_PARTS", "%1$@; %2$@");
        localization->set(kBundle, "LOCATED_NOW", "Now");
        localization->set(kBundle, "ACCESSIBILITY_LOCATED_NOW", "Located now");
        localization->set(kBundle, "LOCATED_MINUTES", "%@ min ago");
        localization->set(kBundle, "ACCESSIBILITY_LOCATED_MINUTES", "Located %@ minutes ago");
        localization->set(kBundle, "_$!<home>!$_", "Home");
        user_->position = position(51.001, -1.0);
    }

    std::shared_ptr<KTRVelaFriendView> makeRow() {
        auto row = create<KTRVelaFriendView>(&KTRVelaFriendView::initWithFrame, Rect{0.0, 0.0, 320.0, 0.0});
        row->setCurrentLocationDelegate(user_);
        return row;
    }
    static std::shared_ptr<KTRVALocation> record(const std::shared_ptr<VAKtrLocation>& object) {
        return KTRVALocation::locationWithVelaLocation(object);
    }
    std::shared_ptr<KTRVelaFriendView> rowFor(const std::shared_ptr<VAKtrLocation>& object) {
        auto row = makeRow();
        row->setLocation(record(object));
        return row;
    }

    std::shared_ptr<UserPosition> user_ = std::make_shared<UserPosition>();
};

TEST_F(KTRVelaFriendViewTest, Filled_ShowsPlaceNameAgeAndDistance) {
    auto object = placedFriend("Ann", "ann@example.org");
    object->locationDate = kNoon - 300.0;
    const auto row = rowFor(object);
    EXPECT_EQ(row->locationLabel()->text(), "Springfield");
    EXPECT_EQ(row->locationLabel()->accessibilityLabel(), "At Springfield");
    EXPECT_EQ(row->nameLabel()->text(), "Ann");
    EXPECT_EQ(row->timeLabel()->text(), "5 min ago");
    EXPECT_EQ(row->timeLabel()->accessibilityLabel(), "Located 5 minutes ago");
    EXPECT_EQ(row->distanceLabel()->text(), "111 m");
    EXPECT_EQ(row->distanceLabel()->accessibilityLabel(), "111 m away");
}

TEST_F(KTRVelaFriendViewTest, NewRow_AwaitsFreshLocation) {
    const auto row = makeRow();
    EXPECT_TRUE(row->isRefreshingLocation());
    EXPECT_FALSE(row->separatorEnabled());
    EXPECT_FALSE(row->isVisibility());
    EXPECT_FALSE(row->constraintSetupCompleted());
    EXPECT_EQ(row->location(), nullptr);
}

TEST_F(KTRVelaFriendViewTest, Place_UnknownWhileRefreshing_ReadsLocating) {
    EXPECT_EQ(rowFor(friendByEmail("Ann", "ann@example.org"))->locationLabel()->text(), "Looking...");
}

TEST_F(KTRVelaFriendViewTest, Place_UnknownAfterRefreshing_ReadsNoLocation) {
    const auto row = makeRow();
    row->setIsRefreshingLocation(false);
    row->setLocation(record(friendByEmail("Ann", "ann@example.org")));
    EXPECT_EQ(row->locationLabel()->text(), "Not found");
}

TEST_F(KTRVelaFriendViewTest, Place_DefaultLabel_IsLocalized) {
    auto object = placedFriend("Ann", "ann@example.org");
    object->label = "_$!<home>!$_";
    const auto row = rowFor(object);
    EXPECT_EQ(row->locationLabel()->text(), "Home");
    EXPECT_EQ(row->locationLabel()->accessibilityLabel(), "At Home");
}

TEST_F(KTRVelaFriendViewTest, Place_UpperCaseDefaultLabel_ShowsRaw_IsKept) {
    auto object = placedFriend("Ann", "ann@example.org");
    object->label = "_$!<HOME>!$_";
    EXPECT_EQ(rowFor(object)->locationLabel()->text(), "_$!<HOME>!$_");
}

TEST_F(KTRVelaFriendViewTest, Place_OwnLabel_ShowsAsItStands) {
    auto object = placedFriend("Ann", "ann@example.org");
    object->label = "Mum's";
    EXPECT_EQ(rowFor(object)->locationLabel()->text(), "Mum's");
}

TEST_F(KTRVelaFriendViewTest, Place_CoordinateLost_StaleTextIsNotSpoken) {
    const auto row = rowFor(placedFriend("Ann", "ann@example.org"));
    ASSERT_TRUE(row->locationLabel()->accessibilityLabel().has_value());
    row->setLocation(record(friendByEmail("Ann", "ann@example.org")));
    EXPECT_FALSE(row->locationLabel()->accessibilityLabel().has_value());
    EXPECT_EQ(row->locationLabel()->accessibilityText(), "Looking...");
}

TEST_F(KTRVelaFriendViewTest, Age_DateMissingZeroOrNegative_IsEmpty) {
    for (const std::optional<double> date : {std::optional<double>(), std::optional(0.0), std::optional(-1.0)}) {
        auto object = placedFriend("Ann", "ann@example.org");
        object->locationDate = date;
        const auto row = rowFor(object);
        EXPECT_EQ(row->timeLabel()->text(), "");
        EXPECT_EQ(row->timeLabel()->accessibilityLabel(), "");
    }
}

TEST_F(KTRVelaFriendViewTest, Distance_Visibility_StaysEmpty) {
    const auto row = makeRow();
    row->setIsVisibility(true);
    row->setLocation(record(placedFriend("Ann", "ann@example.org")));
    EXPECT_EQ(row->distanceLabel()->text(), "");
    EXPECT_EQ(row->distanceLabel()->accessibilityLabel(), "");
}

TEST_F(KTRVelaFriendViewTest, Distance_NobodyKnowsWhereTheUserIs_IsEmpty) {
    user_->position = nullptr;
    EXPECT_EQ(rowFor(placedFriend("Ann", "ann@example.org"))->distanceLabel()->text(), "");
    user_.reset();
    const auto row = rowFor(placedFriend("Ann", "ann@example.org"));
    EXPECT_EQ(row->currentLocationDelegate(), nullptr);
    EXPECT_EQ(row->distanceLabel()->text(), "");
    EXPECT_EQ(distances->asked, 0);
}

TEST_F(KTRVelaFriendViewTest, Name_OfNobody_IsEmpty) {
    const auto row = rowFor(placed(std::make_shared<VAKtrLocation>(), 51.0, -1.0));
    EXPECT_EQ(row->nameLabel()->text(), "");
}

TEST_F(KTRVelaFriendViewTest, Notification_AnySender_UpdatesTheDistance) {
    const auto row = rowFor(placedFriend("Ann", "ann@example.org"));
    user_->position = position(51.002, -1.0);
    platform->notificationCenter->post({"ktrCurrentLocationUpdated", std::make_shared<test::FakeImage>()});
    EXPECT_EQ(row->distanceLabel()->text(), "222 m");
}

TEST_F(KTRVelaFriendViewTest, Notification_BeforeLocation_FillsWithNothing) {
    const auto row = makeRow();
    platform->notificationCenter->post({"ktrCurrentLocationUpdated", nullptr});
    for (const auto& label : {row->nameLabel(), row->locationLabel(), row->timeLabel(), row->distanceLabel()}) {
        EXPECT_EQ(label->text(), "");
    }
}

TEST_F(KTRVelaFriendViewTest, DroppedRow_HearsNothingMore) {
    auto row = makeRow();
    EXPECT_EQ(platform->notificationCenter->observerCount(), 1u);
    row.reset();
    EXPECT_EQ(platform->notificationCenter->observerCount(), 0u);
}

TEST_F(KTRVelaFriendViewTest, SameRecordAgain_FillsAnew) {
    auto object = placedFriend("Ann", "ann@example.org");
    object->locationDate = kNoon;
    const auto row = rowFor(object);
    EXPECT_EQ(row->timeLabel()->text(), "Now");
    time->advance(300.0);
    row->setLocation(row->location());
    EXPECT_EQ(row->timeLabel()->text(), "5 min ago");
}

TEST_F(KTRVelaFriendViewTest, SameTextsAgain_ShapeNothing) {
    const auto window = create<Window>(&Window::initWithFrame, Rect{0.0, 0.0, 320.0, 500.0});
    const auto row = rowFor(placedFriend("Ann", "ann@example.org"));
    window->addSubview(row);
    row->setFrame({0.0, 0.0, 320.0, row->estimagedHeightForView()});
    window->layoutIfNeeded();
    const int shaped = textEngine->count();
    row->updateView();
    row->estimagedHeightForView();
    window->layoutIfNeeded();
    EXPECT_EQ(textEngine->count(), shaped);
}

// The avatar

TEST_F(KTRVelaFriendViewTest, Avatar_HandleWithAt_IsLookedUpByEmail) {
    const auto ann = contactWith("ann", "ann@example.org", "");
    contacts->contacts = {contactWith("other", "", "555 0100 99"), ann};
    auto object = friendByEmail("Ann", "ann@example.org");
    auto phone = std::make_shared<VAPhone>();
    phone->number = "555 0100 99";
    object->friend_->object->phones = {phone};
    const auto row = rowFor(object);
    time->advance(0.1);
    EXPECT_EQ(row->avatarViewController()->contacts(), std::vector{ann});
}

TEST_F(KTRVelaFriendViewTest, Avatar_AnyOtherHandle_IsLookedUpByPhone) {
    const auto other = contactWith("other", "", "555 0100 99");
    contacts->contacts = {contactWith("ann", "ann@example.org", ""), other};
    auto object = friendByPhone("Ann", "555 0100 99");
    auto email = std::make_shared<VAEmail>();
    email->emailAddress = "ann@example.org";
    object->friend_->object->emails = {email};
    const auto row = rowFor(object);
    time->advance(0.1);
    EXPECT_EQ(row->avatarViewController()->contacts(), std::vector{other});
}

TEST_F(KTRVelaFriendViewTest, Avatar_ServiceHandleDecides_NotThePersonsAddresses) {
    contacts->contacts = {contactWith("ann", "ann@example.org", "")};
    auto object = friendByEmail("Ann", "ann@example.org");
    object->friend_->data = "555 0100 99";
    const auto row = rowFor(object);
    time->advance(0.1);
    // By phone, and the person has none.
    ASSERT_EQ(row->avatarViewController()->contacts().size(), 1u);
    EXPECT_TRUE(row->avatarViewController()->contacts().front()->isEmpty());
}

TEST_F(KTRVelaFriendViewTest, Avatar_LookupIsAtOnce_AssignmentATenthOfASecondLater) {
    const auto ann = contactWith("ann", "ann@example.org", "");
    contacts->contacts = {ann};
    const auto row = rowFor(friendByEmail("Ann", "ann@example.org"));
    EXPECT_EQ(contacts->fetches, 1);
    contacts->contacts = {};
    time->advance(0.09);
    EXPECT_TRUE(row->avatarViewController()->contacts().empty());
    time->advance(0.02);
    EXPECT_EQ(row->avatarViewController()->contacts(), std::vector{ann});
    EXPECT_EQ(contacts->fetches, 1);
}

TEST_F(KTRVelaFriendViewTest, Avatar_UnknownContact_IsOneEmptyContact) {
    const auto row = rowFor(friendByEmail("Ann", "ann@example.org"));
    time->advance(0.1);
    ASSERT_EQ(row->avatarViewController()->contacts().size(), 1u);
    EXPECT_TRUE(row->avatarViewController()->contacts().front()->isEmpty());
}

TEST_F(KTRVelaFriendViewTest, Avatar_SameContactAgain_AsksForNoStep) {
    const auto ann = contactWith("ann", "ann@example.org", "");
    const auto row = rowFor(friendByEmail("Ann", "ann@example.org"));
    time->advance(0.1);
    const std::size_t timers = time->pendingTimers();
    row->updateView();
    EXPECT_EQ(time->pendingTimers(), timers) << "nobody, again";
    contacts->contacts = {ann};
    row->updateView();
    EXPECT_EQ(time->pendingTimers(), timers + 1);
    // One that is on its way is no reason to rest: another may overtake what is shown.
    contacts->contacts = {};
    row->updateView();
    EXPECT_EQ(time->pendingTimers(), timers + 2);
    time->advance(0.1);
    EXPECT_TRUE(row->avatarViewController()->contacts().front()->isEmpty());
    contacts->contacts = {ann};
    row->updateView();
    time->advance(0.1);
    row->updateView();
    EXPECT_EQ(time->pendingTimers(), timers);
    EXPECT_EQ(row->avatarViewController()->contacts(), std::vector{ann});
    EXPECT_EQ(contacts->fetches, 6) << "the look-up is at once, each time";
}

TEST_F(KTRVelaFriendViewTest, Avatar_AnotherAvatarController_IsGivenTheContact) {
    const auto row = rowFor(friendByEmail("Ann", "ann@example.org"));
    time->advance(0.1);
    const auto other = std::make_shared<ContactAvatarController>();
    row->setAvatarViewController(other);
    row->updateView();
    time->advance(0.1);
    EXPECT_EQ(other->contacts().size(), 1u);
}

TEST_F(KTRVelaFriendViewTest, Avatar_DeferredStepKeepsRowAlive) {
    auto row = rowFor(friendByEmail("Ann", "ann@example.org"));
    const auto avatar = row->avatarViewController();
    const std::weak_ptr<KTRVelaFriendView> kept = row;
    row.reset();
    time->advance(0.05);
    EXPECT_FALSE(kept.expired());
    time->advance(0.1);
    EXPECT_TRUE(kept.expired());
    EXPECT_EQ(avatar->contacts().size(), 1u);
}

TEST_F(KTRVelaFriendViewTest, Avatar_FilledTwice_LastOneStays) {
    const auto ann = contactWith("ann", "ann@example.org", "");
    const auto bo = contactWith("bo", "bo@example.org", "");
    contacts->contacts = {ann, bo};
    const auto row = rowFor(friendByEmail("Ann", "ann@example.org"));
    row->setLocation(record(friendByEmail("Bo", "bo@example.org")));
    time->advance(0.2);
    EXPECT_EQ(row->avatarViewController()->contacts(), std::vector{bo});
}

// Separator

TEST_F(KTRVelaFriendViewTest, Separator_FollowsTheFlag) {
    const auto row = makeRow();
    row->setSeparatorEnabled(true);
    EXPECT_TRUE(row->separatorEnabled());
    EXPECT_FALSE(row->separatorView()->hidden());
    row->setSeparatorEnabled(false);
    EXPECT_FALSE(row->separatorEnabled());
    EXPECT_TRUE(row->separatorView()->hidden());
}

TEST_F(KTRVelaFriendViewTest, Separator_ShownUntilTheFlagIsSet_IsKept) {
    const auto row = makeRow();
    EXPECT_FALSE(row->separatorEnabled());
    EXPECT_FALSE(row->separatorView()->hidden());
}

// Accessibility text sizes

TEST_F(KTRVelaFriendViewTest, AccessibilitySize_HasNoSubviewsAndFillingDoesNothing) {
    device->category = ContentSizeCategory::AX1;
    const auto row = rowFor(placedFriend("Ann", "ann@example.org"));
    row->setSeparatorEnabled(true);
    EXPECT_TRUE(row->axSize());
    EXPECT_TRUE(row->subviews().empty());
    EXPECT_EQ(row->nameLabel(), nullptr);
    EXPECT_EQ(row->locationLabel(), nullptr);
    EXPECT_EQ(row->timeLabel(), nullptr);
    EXPECT_EQ(row->distanceLabel(), nullptr);
    EXPECT_EQ(row->friendIconView(), nullptr);
    EXPECT_EQ(row->separatorView(), nullptr);
    EXPECT_TRUE(row->separatorEnabled());
    EXPECT_EQ(row->estimagedHeightForView(), 0.0);
    // The avatar's controller is there all the same.
    time->advance(0.1);
    EXPECT_EQ(row->avatarViewController()->contacts().size(), 1u);
}

TEST_F(KTRVelaFriendViewTest, TextsOfAbsentLabels_GoNowhere) {
    const auto row = makeRow();
    row->setNameLabel(nullptr);
    row->setLocationLabel(nullptr);
    row->setTimeLabel(nullptr);
    row->setDistanceLabel(nullptr);
    row->setAvatarViewController(nullptr);
    row->setLocation(record(placedFriend("Ann", "ann@example.org")));
    time->advance(0.1);
    EXPECT_NE(row->location(), nullptr);
}

// Taps

TEST_F(KTRVelaFriendViewTest, Url_IsPrefixAndHandleAsItStands) {
    EXPECT_EQ(rowFor(friendByEmail("Ann", "a nn+%@example.org"))->urlForTouch()->text(),
              "wayloc://friend/a nn+%@example.org");
    EXPECT_EQ(rowFor(friendByPhone("Bo", "+1 (555) 555-0100"))->urlForTouch()->text(), "wayloc://friend/+15555550100");
}

TEST_F(KTRVelaFriendViewTest, Url_WithoutHandle_IsThePrefixAlone) {
    EXPECT_EQ(makeRow()->urlForTouch()->text(), "wayloc://friend/");
    EXPECT_EQ(rowFor(std::make_shared<VAKtrLocation>())->urlForTouch()->text(), "wayloc://friend/");
}

TEST_F(KTRVelaFriendViewTest, Tap_LogsTheRowsLineFirst) {
    const auto row = rowFor(friendByEmail("Ann", "ann@example.org"));
    log->clear();
    row->viewTouched();
    EXPECT_EQ(log->texts(LogLevel::Default),
              (std::vector<std::string>{
                  "Opening URL: wayloc://friend/ann@example.org for friend handle: ann@example.org",
                  "Opening URL: wayloc://friend/ann@example.org",
              }));
}

// Screen readers

TEST_F(KTRVelaFriendViewTest, Accessibility_RowIsOneLinkThatBeginsWithThePerson) {
    const auto window = create<Window>(&Window::initWithFrame, Rect{0.0, 0.0, 320.0, 500.0});
    auto object = placedFriend("Ann", "ann@example.org");
    object->locationDate = kNoon;
    const auto row = rowFor(object);
    window->addSubview(row);
    row->setFrame({0.0, 0.0, 320.0, row->estimagedHeightForView()});
    window->layoutIfNeeded();
    const auto tree = accessibilityTree(window, false);
    ASSERT_EQ(tree.children.size(), 1u);
    const auto& link = tree.children[0];
    EXPECT_EQ(link.role, AccessibilityRole::Link);
    EXPECT_TRUE(link.pressable);
    EXPECT_EQ(link.text, "Ann; At Springfield; 111 m away; Located now");
    EXPECT_TRUE(link.children.empty());
    row->setAccessibilityLabel("Friends can see where you are");
    EXPECT_EQ(row->accessibilityText(), "Ann; Friends can see where you are; At Springfield; 111 m away; Located now");
}

TEST_F(KTRVelaFriendViewTest, Accessibility_LargeRowSaysWhatThePlainOneSays) {
    auto object = placedFriend("Ann", "ann@example.org");
    object->locationDate = kNoon - 300.0;
    const auto unplaced = friendByEmail("Ann", "ann@example.org");
    for (const auto& shown : {object, unplaced}) {
        device->category = ContentSizeCategory::L;
        const auto plain = rowFor(shown);
        device->category = ContentSizeCategory::AX3;
        const auto large = rowFor(shown);
        ASSERT_EQ(large->nameLabel(), nullptr);
        EXPECT_EQ(large->accessibilityText(), plain->accessibilityText());
        EXPECT_TRUE(large->accessibilityText().starts_with("Ann; "));
        for (const auto& row : {plain, large}) {
            row->setIsVisibility(true);
            row->updateView();
        }
        EXPECT_EQ(large->accessibilityText(), plain->accessibilityText());
        EXPECT_EQ(large->accessibilityText().find("111 m"), std::string::npos);
    }
}

TEST_F(KTRVelaFriendViewTest, Accessibility_SubjectSaysWhatCanBeNews) {
    using Whereabouts = AccessibilitySubject::Whereabouts;
    auto object = placedFriend("Ann", "ann@example.org");
    object->locationDate = kNoon - 300.0;
    const auto row = rowFor(object);
    const auto subject = row->accessibilitySubject();
    ASSERT_TRUE(subject);
    EXPECT_EQ(subject->person, "Ann");
    EXPECT_EQ(subject->whereabouts, Whereabouts::Known);
    EXPECT_EQ(subject->place, "Springfield");
    EXPECT_EQ(subject->ageBand, 2);
    ASSERT_TRUE(subject->metres);
    EXPECT_NEAR(*subject->metres, 111.0, 1.0);
    EXPECT_EQ(subject->distance, "111 m away");

    const auto unplaced = rowFor(friendByEmail("Ann", "ann@example.org"));
    EXPECT_EQ(unplaced->accessibilitySubject()->whereabouts, Whereabouts::Sought);
    EXPECT_EQ(unplaced->accessibilitySubject()->place, "");
    EXPECT_FALSE(unplaced->accessibilitySubject()->metres);
    unplaced->setIsRefreshingLocation(false);
    EXPECT_EQ(unplaced->accessibilitySubject()->whereabouts, Whereabouts::Unknown);
    row->setIsVisibility(true);
    EXPECT_FALSE(row->accessibilitySubject()) << "the user hears no news of themselves";
}

}  // namespace ktr
