#include "views/KTRVelaFenceView.h"

#include "model/KTRVATheme.h"
#include "platform/ui/Window.h"
#include "tests/support/Friends.h"
#include "tests/support/PlatformTest.h"

// What the row shows and does; its rectangles are in KTRVelaFenceViewLayoutTest.cpp.

namespace ktr {

using namespace platform;
using test::contactWith;
using test::fenceOf;
using test::friendByEmail;
using test::friendByPhone;

namespace {

constexpr const char* kBundle = "org.ktr.snippets";
constexpr const char* kMessage = "Unable to open friend URL, no friend email exists";

}  // namespace

class KTRVelaFenceViewTest : public test::PlatformTest {
  protected:
    KTRVelaFenceViewTest() {
        localization->set(kBundle, "IMMEDIATE_LABEL", "At once");
        localization->set(kBundle, "LEAVING_LABEL", "When leaving %@");
        localization->set(kBundle, "ARRIVING_LABEL", "When arriving at %@");
        localization->set(kBundle, "LEAVING_LABEL_ABSOLUTE", "When leaving");
        localization->set(kBundle, "ARRIVING_LABEL_ABSOLUTE", "When arriving (100 %@)");
        localization->set(kBundle, "_$!<home>!$_", "Home");
    }

    static std::shared_ptr<KTRVelaFenceView> makeRow() {
        return create<KTRVelaFenceView>(&KTRVelaFenceView::initWithFrame, Rect{0.0, 0.0, 320.0, 100.0});
    }
    static std::shared_ptr<KTRVelaFenceView> rowFor(const std::shared_ptr<VAKtrGeoFence>& fence) {
        auto row = makeRow();
        row->setGeoFence(fence);
        return row;
    }
    static std::string sentence(const std::shared_ptr<VAKtrGeoFence>& fence) {
        return rowFor(fence)->fenceLabel()->text();
    }
    static std::shared_ptr<VAKtrGeoFence> annsFence(const std::optional<std::string>& trigger,
                                                    const std::optional<std::string>& label = std::nullopt,
                                                    const std::optional<std::string>& street = std::nullopt) {
        return fenceOf(friendByEmail("Ann", "ann@example.org")->friend_, trigger, label, street);
    }
    static constexpr const char* kLeaving = VAKtrGeoFenceTriggerOnDepartureValue;
    static constexpr const char* kImmediate = VAKtrGeoFenceTriggerImmediateValue;
};

TEST_F(KTRVelaFenceViewTest, NewRow) {
    const auto row = makeRow();
    EXPECT_TRUE(row->isRefreshingLocation());
    EXPECT_FALSE(row->separatorEnabled());
    EXPECT_FALSE(row->separatorView()->hidden());
    EXPECT_EQ(row->geoFence(), nullptr);
    EXPECT_EQ(row->distanceLabel(), nullptr);
    EXPECT_EQ(row->nameLabelLeadingConstraint(), nullptr);
    EXPECT_FALSE(row->constraintSetupCompleted());
    EXPECT_EQ(row->nameLabel()->text(), "");
    EXPECT_FALSE(row->fenceLabel()->hidden()) << "only filling hides it";
}

TEST_F(KTRVelaFenceViewTest, UnlikeAFriendsRow_ListensToNothing_IsKept) {
    const auto row = makeRow();
    EXPECT_EQ(platform->notificationCenter->observerCount(), 0U);
}

TEST_F(KTRVelaFenceViewTest, FontsAndColours) {
    const auto row = makeRow();
    EXPECT_EQ(row->nameLabel()->font(), preferredFont(TextStyle::Body));
    EXPECT_EQ(row->fenceLabel()->font(), preferredFont(TextStyle::Footnote));
    EXPECT_EQ(row->nameLabel()->textColor(), KTRVATheme::friendNameTextColor());
    EXPECT_EQ(row->fenceLabel()->textColor(), KTRVATheme::friendLocationTextColor());
    for (const auto& label : {row->nameLabel(), row->fenceLabel()}) {
        EXPECT_EQ(label->numberOfLines(), 1);
        EXPECT_EQ(label->lineBreakMode(), LineBreakMode::TruncatingTail);
    }
    EXPECT_EQ(row->separatorView()->layerBackgroundColor(), Color::rgb(151.0 / 255.0, 158.0 / 255.0, 149.0 / 255.0));
}

TEST_F(KTRVelaFenceViewTest, Icon_IsTheThemesLocationIndicator) {
    const auto image = std::make_shared<test::FakeImage>();
    images->named["org.ktr.snippets/location"] = image;
    EXPECT_EQ(makeRow()->geoFenceIconImageView()->image(), KTRVATheme::locationIndicator());
    EXPECT_NE(KTRVATheme::locationIndicator(), nullptr);
}

// The sentence

TEST_F(KTRVelaFenceViewTest, Immediate_SaysSoWhateverTheLocation) {
    EXPECT_EQ(sentence(annsFence(kImmediate)), "At once");
    EXPECT_EQ(sentence(annsFence(kImmediate, "_$!<home>!$_", "Quay")), "At once");
}

TEST_F(KTRVelaFenceViewTest, OwnLabel_ShowsAsItStands) {
    EXPECT_EQ(sentence(annsFence(kLeaving, "Mum's", "Quay")), "When leaving Mum's");
    EXPECT_EQ(sentence(annsFence("OnArrival", "Mum's", "Quay")), "When arriving at Mum's");
}

TEST_F(KTRVelaFenceViewTest, EveryOtherTrigger_IsArriving_IsKept) {
    for (const std::optional<std::string>& trigger :
         {std::optional<std::string>("OnArrival"), std::optional<std::string>("ondeparture"),
          std::optional<std::string>(""), std::optional<std::string>("Sometimes"), std::optional<std::string>()}) {
        EXPECT_EQ(sentence(annsFence(trigger, "Mum's")), "When arriving at Mum's");
    }
}

TEST_F(KTRVelaFenceViewTest, DefaultLabel_IsLookedUpInSmallLetters_IsKept) {
    EXPECT_EQ(sentence(annsFence(kLeaving, "_$!<home>!$_")), "When leaving Home");
    EXPECT_EQ(sentence(annsFence(kLeaving, "_$!<HOME>!$_")), "When leaving Home");
    EXPECT_EQ(sentence(annsFence("OnArrival", "_$!<Home>!$_")), "When arriving at Home");
    EXPECT_EQ(sentence(annsFence(kLeaving, "_$!<work>!$_")), "When leaving _$!<work>!$_") << "no text of its own";
}

TEST_F(KTRVelaFenceViewTest, NoLabel_StreetIsThePlace) {
    EXPECT_EQ(sentence(annsFence(kLeaving, std::nullopt, "Anchor Road")), "When leaving Anchor Road");
    EXPECT_EQ(sentence(annsFence("OnArrival", std::nullopt, "Anchor Road")), "When arriving at Anchor Road");
    EXPECT_EQ(sentence(annsFence(kLeaving, std::nullopt, "_$!<home>!$_")), "When leaving _$!<home>!$_")
        << "a street is no label";
}

TEST_F(KTRVelaFenceViewTest, EmptyLabel_IsAPlaceWithoutAName_IsKept) {
    EXPECT_EQ(sentence(annsFence(kLeaving, "", "Anchor Road")), "When leaving ");
}

TEST_F(KTRVelaFenceViewTest, NoPlace_AbsoluteSentenceAsItStands) {
    EXPECT_EQ(sentence(annsFence(kLeaving)), "When leaving");
    EXPECT_EQ(sentence(annsFence("OnArrival")), "When arriving (100 %@)") << "no format";
    const auto fence = annsFence(kLeaving);
    fence->location = nullptr;
    EXPECT_EQ(sentence(fence), "When leaving");
}

TEST_F(KTRVelaFenceViewTest, EmptySentence_IsHidden) {
    localization->set(kBundle, "IMMEDIATE_LABEL", "");
    const auto row = rowFor(annsFence(kImmediate));
    EXPECT_EQ(row->fenceLabel()->text(), "");
    EXPECT_TRUE(row->fenceLabel()->hidden());
    row->setGeoFence(annsFence(kLeaving));
    EXPECT_FALSE(row->fenceLabel()->hidden());
}

TEST_F(KTRVelaFenceViewTest, DistanceLabel_OfASubclass_IsShownAndHiddenWithItsText) {
    const auto row = makeRow();
    const auto label = create<Label>(&Label::initWithFrame, Rect{});
    row->setDistanceLabel(label);
    row->setGeoFence(annsFence(kImmediate));
    EXPECT_TRUE(label->hidden());
    label->setText("310 m");
    row->updateFenceView();
    EXPECT_FALSE(label->hidden());
}

// Names and handles

TEST_F(KTRVelaFenceViewTest, Name_FullNameElseHandleAsItStands) {
    EXPECT_EQ(rowFor(annsFence(kLeaving))->nameLabel()->text(), "Ann");
    const auto byEmail = fenceOf(friendByEmail("", "ann@example.org")->friend_, kLeaving);
    EXPECT_EQ(rowFor(byEmail)->nameLabel()->text(), "ann@example.org");
    byEmail->friend_->object->fullName = std::nullopt;
    EXPECT_EQ(rowFor(byEmail)->nameLabel()->text(), "ann@example.org");
}

TEST_F(KTRVelaFenceViewTest, Name_PhoneNumberIsNotFormatted_IsKept) {
    const auto row = rowFor(fenceOf(friendByPhone("", "02079460018")->friend_, kLeaving));
    EXPECT_EQ(row->nameLabel()->text(), "02079460018");
}

TEST_F(KTRVelaFenceViewTest, Handle_LastAddressBeforeLastNumber) {
    const auto person = friendByPhone("Ann", "555 0100 98")->friend_;
    person->object->phones.push_back(std::make_shared<VAPhone>());
    person->object->phones.back()->number = "555 0100 99";
    const auto row = rowFor(fenceOf(person, kLeaving));
    EXPECT_EQ(row->friendEmail(), std::nullopt);
    EXPECT_EQ(row->friendHandle(), "555 0100 99");
    for (const char* address : {"a@example.org", "b@example.org"}) {
        person->object->emails.push_back(std::make_shared<VAEmail>());
        person->object->emails.back()->emailAddress = address;
    }
    EXPECT_EQ(row->friendEmail(), "b@example.org");
    EXPECT_EQ(row->friendPhone(), "555 0100 99");
    EXPECT_EQ(row->friendHandle(), "b@example.org");
}

TEST_F(KTRVelaFenceViewTest, NobodyAtAll_EmptyName) {
    const auto nobody = std::make_shared<VAPersonAttribute>();
    EXPECT_EQ(rowFor(fenceOf(nobody, kLeaving))->nameLabel()->text(), "");
    nobody->object = std::make_shared<VAPerson>();
    EXPECT_EQ(rowFor(fenceOf(nobody, kLeaving))->nameLabel()->text(), "");
    nobody->object->emails = {nullptr};
    nobody->object->phones = {nullptr};
    EXPECT_EQ(rowFor(fenceOf(nobody, kLeaving))->friendName(), std::nullopt);
}

TEST_F(KTRVelaFenceViewTest, NoFence_NobodysArrivalAnywhereAndNoUrl) {
    const auto row = rowFor(nullptr);
    EXPECT_EQ(row->nameLabel()->text(), "");
    EXPECT_EQ(row->fenceLabel()->text(), "When arriving (100 %@)");
    EXPECT_EQ(row->urlForTouch(), std::nullopt);
    time->advance(0.1);
    EXPECT_EQ(contacts->fetches, 0);
    ASSERT_EQ(row->avatarViewController()->contacts().size(), 1U);
}

// The tap

TEST_F(KTRVelaFenceViewTest, Url_IsTheServiceHandle_LoggedAsIfItFailed_IsKept) {
    const auto fence = annsFence(kLeaving);
    fence->friend_->data = "Ann+x@Example.org";
    const auto row = rowFor(fence);
    log->clear();
    EXPECT_EQ(row->urlForTouch()->text(), "wayloc://friend/Ann+x@Example.org");
    ASSERT_EQ(log->lines().size(), 1U);
    EXPECT_EQ(log->lines()[0].level, LogLevel::Default);
    EXPECT_EQ(log->lines()[0].text, kMessage);
}

TEST_F(KTRVelaFenceViewTest, Url_NoHandle_IsNoneAndSilent_IsKept) {
    const auto fence = annsFence(kLeaving);
    fence->friend_->data = std::nullopt;
    const auto row = rowFor(fence);
    log->clear();
    EXPECT_EQ(row->urlForTouch(), std::nullopt);
    row->viewTouched();
    EXPECT_TRUE(log->lines().empty());
    fence->friend_ = nullptr;
    EXPECT_EQ(row->urlForTouch(), std::nullopt);
}

// The avatar

TEST_F(KTRVelaFenceViewTest, Avatar_HandleWithAt_IsLookedUpByTheLastEmail) {
    const auto ann = contactWith("ann", "ann@example.org", "");
    contacts->contacts = {contactWith("other", "", "555 0100 99"), ann};
    const auto row = rowFor(annsFence(kImmediate));
    EXPECT_TRUE(row->avatarViewController()->contacts().empty());
    time->advance(0.1);
    EXPECT_EQ(row->avatarViewController()->contacts(), std::vector{ann});
}

TEST_F(KTRVelaFenceViewTest, Avatar_AnyOtherHandle_IsLookedUpByPhone) {
    const auto other = contactWith("other", "", "555 0100 99");
    contacts->contacts = {contactWith("ann", "ann@example.org", ""), other};
    auto object = friendByPhone("Ann", "555 0100 99");
    object->friend_->object->emails.push_back(std::make_shared<VAEmail>());
    object->friend_->object->emails.back()->emailAddress = "ann@example.org";
    const auto row = rowFor(fenceOf(object->friend_, kLeaving));
    time->advance(0.1);
    EXPECT_EQ(row->avatarViewController()->contacts(), std::vector{other});
}

TEST_F(KTRVelaFenceViewTest, Avatar_NobodyFound_IsAnEmptyContact) {
    const auto row = rowFor(annsFence(kLeaving));
    time->advance(0.1);
    ASSERT_EQ(row->avatarViewController()->contacts().size(), 1U);
    EXPECT_EQ(row->avatarViewController()->contacts()[0]->identifier, "");
}

TEST_F(KTRVelaFenceViewTest, Avatar_StepKeepsTheRowUntilItRuns) {
    auto row = rowFor(annsFence(kLeaving));
    const std::weak_ptr<KTRVelaFenceView> dropped = row;
    row.reset();
    EXPECT_FALSE(dropped.expired());
    time->advance(0.1);
    EXPECT_TRUE(dropped.expired());
}

TEST_F(KTRVelaFenceViewTest, Separator_FollowsItsFlag) {
    const auto row = makeRow();
    row->setSeparatorEnabled(false);
    EXPECT_TRUE(row->separatorView()->hidden());
    row->setSeparatorEnabled(true);
    EXPECT_TRUE(row->separatorEnabled());
    EXPECT_FALSE(row->separatorView()->hidden());
}

TEST_F(KTRVelaFenceViewTest, AccessibilityTextSize_HasNoSubviews) {
    device->category = ContentSizeCategory::AX3;
    const auto row = rowFor(annsFence(kLeaving));
    EXPECT_TRUE(row->subviews().empty());
    EXPECT_EQ(row->nameLabel(), nullptr);
    row->setSeparatorEnabled(true);
    time->advance(0.1);
    EXPECT_EQ(row->friendName(), "Ann");
}

TEST_F(KTRVelaFenceViewTest, ReadAloud_LargeRowSaysWhatThePlainOneSays) {
    localization->set("org.ktr.snippets", "ACCESSIBILITY_ROW_PARTS", "%1$@; %2$@");
    const auto plain = rowFor(annsFence(kLeaving, "_$!<home>!$_"));
    device->category = ContentSizeCategory::AX3;
    const auto large = rowFor(annsFence(kLeaving, "_$!<home>!$_"));
    ASSERT_EQ(large->nameLabel(), nullptr);
    EXPECT_EQ(large->accessibilityText(), plain->accessibilityText());
    EXPECT_EQ(large->accessibilityText(), "Ann; When leaving Home");
}

TEST_F(KTRVelaFenceViewTest, ReadAloud_IsALinkOfNameAndSentence) {
    localization->set("org.ktr.snippets", "ACCESSIBILITY_ROW_PARTS", "%1$@; %2$@");
    const auto window = create<Window>(&Window::initWithFrame, Rect{0.0, 0.0, 320.0, 500.0});
    const auto fence = annsFence(kLeaving, "_$!<home>!$_");
    const auto row = rowFor(fence);
    window->addSubview(row);
    window->layoutIfNeeded();
    const auto node = accessibilityTree(window, false).children.at(0);
    EXPECT_EQ(node.role, AccessibilityRole::Link);
    EXPECT_EQ(node.text, "Ann; When leaving Home");
    EXPECT_TRUE(node.children.empty()) << "the row is one element";
    fence->friend_->data = std::nullopt;
    EXPECT_EQ(row->accessibilityRole(), AccessibilityRole::Text) << "nothing to open";
}

TEST_F(KTRVelaFenceViewTest, PlatformGone_KeepsWhatIsShown) {
    const auto row = rowFor(annsFence(kLeaving));
    Platform::install(nullptr);
    row->setGeoFence(nullptr);
    EXPECT_EQ(row->nameLabel()->text(), "Ann");
    Platform::install(platform);
}

}  // namespace ktr
