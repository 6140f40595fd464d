#include <algorithm>
#include <cmath>
#include <functional>
#include <limits>
#include <random>
#include <utility>

#include "platform/ui/Window.h"
#include "plugin/VAKTRMultipleLocationsSnippetController.h"
#include "tests/support/FakeHost.h"
#include "tests/support/Friends.h"
#include "tests/support/PlatformTest.h"
#include "tests/support/Results.h"

namespace ktr {

using namespace platform;
using test::FakeHost;
using test::friendByEmail;
using test::listOf;
using test::placed;
using test::placedFriend;
using test::proximitySnippet;

using Controller = VAKTRMultipleLocationsSnippetController;

namespace {

constexpr double kNaN = std::numeric_limits<double>::quiet_NaN();
constexpr double kInfinity = std::numeric_limits<double>::infinity();

/// A host that does what it likes while it is being told something.
struct UnrulyHost : FakeHost {
    std::function<void()> whenAskedForBundle;
    std::function<void()> whenHeightChanges;
    std::function<void()> whenOpening;

    std::shared_ptr<Bundle> effectiveBundleForLocation(HostSnippetViewController& controller) override {
        if (whenAskedForBundle) {
            whenAskedForBundle();
        }
        return FakeHost::effectiveBundleForLocation(controller);
    }
    void heightDidChange(HostSnippetViewController& controller, bool pinTopOfSnippet) override {
        FakeHost::heightDidChange(controller, pinTopOfSnippet);
        if (whenHeightChanges) {
            std::exchange(whenHeightChanges, nullptr)();
        }
    }
    void openUrl(HostSnippetViewController& controller, const Url& url, std::function<void(bool)> completion) override {
        if (whenOpening) {
            whenOpening();
        }
        FakeHost::openUrl(controller, url, std::move(completion));
    }
};

/// A manager that, while it is being stopped, tells the whole process that the user has moved.
struct NoisyManager : test::FakeLocationManager {
    void stopUpdatingLocation() override {
        FakeLocationManager::stopUpdatingLocation();
        if (const auto installed = Platform::installed()) {
            installed->notificationCenter->post({kCurrentLocationUpdatedNotification, nullptr});
        }
        updating = true;
        deliver(test::PlatformTest::position(10.0, 10.0));
        updating = false;
    }
};

struct NoisyManagers : LocationManagerFactory {
    std::shared_ptr<PlatformLocationManager> makeManager(const std::shared_ptr<Bundle>&) override {
        return std::make_shared<NoisyManager>();
    }
};

/// Texts, and something that happens while one is looked up.
struct TalkingLocalization : test::FakeLocalization {
    mutable std::function<void()> whenAsked;
    std::string text(const std::string& key, const std::string& bundle, const std::optional<std::string>& table,
                     const std::optional<std::string>& defaultValue) const override {
        if (whenAsked) {
            std::exchange(whenAsked, nullptr)();
        }
        return FakeLocalization::text(key, bundle, table, defaultValue);
    }
};

}  // namespace

/// What a careless host, a hostile service and the end of everything do to a snippet.
class VAKTRMultipleLocationsSnippetControllerAdverseTest : public test::PlatformTest {
  protected:
    std::shared_ptr<Controller> makeController(LocationList locations,
                                               std::optional<std::string> context = std::nullopt) {
        auto controller =
            create<Controller>(&Controller::initWithCueObject, proximitySnippet(std::move(locations), context));
        controller->setDelegate(host_);
        return controller;
    }
    static std::shared_ptr<VAKtrLocation> ann() { return placedFriend("Ann", "ann@example.org"); }
    static std::shared_ptr<VAKtrLocation> bo() { return placedFriend("Bo", "bo@example.org"); }
    static std::shared_ptr<VAKtrLocation> numbered(int number) {
        return placedFriend("Friend " + std::to_string(number), std::to_string(number) + "@example.org");
    }
    static LocationList numberedUpTo(int count) {
        LocationList all;
        for (int i = 0; i < count; ++i) {
            all.push_back(numbered(i));
        }
        return all;
    }
    static void layOut(const std::shared_ptr<Controller>& controller, double width) {
        const double height = controller->desiredHeightForWidth(width);
        controller->view()->setFrame({0.0, 0.0, width, height});
        controller->view()->layoutIfNeeded();
    }

    std::shared_ptr<UnrulyHost> host_ = std::make_shared<UnrulyHost>();
};

using Strings = std::vector<std::string>;

TEST_F(VAKTRMultipleLocationsSnippetControllerAdverseTest, Widths_ThatAreNone_GiveAHeight) {
    const auto controller = makeController({ann(), bo()}, "incomplete=1&");
    for (const double width : {kNaN, kInfinity, -kInfinity, -1.0, 0.0, 1e300, -1e300, 1e-300}) {
        layOut(controller, width);
        EXPECT_TRUE(std::isfinite(controller->desiredHeightForWidth(width))) << width;
        EXPECT_GT(controller->desiredHeightForWidth(width), 0.0) << width;
    }
    layOut(controller, 320.0);
    EXPECT_EQ(controller->desiredHeightForWidth(320.0), 2.0 * 78.5 + 48.0);
    EXPECT_EQ(controller->containerView()->arrangedSubviews()[1]->frame(), (Rect{0.0, 78.5, 320.0, 78.5}));
}

TEST_F(VAKTRMultipleLocationsSnippetControllerAdverseTest, NumbersThatAreNone_AreDrawnAsUnknown) {
    locationManagers->cached = position(51.0, -1.0);
    LocationList all;
    int number = 0;
    for (const double odd : {kNaN, kInfinity, -kInfinity, 1e308, -1e308}) {
        auto object = numbered(number++);
        object->latitude = odd;
        object->longitude = odd;
        object->accuracy = odd;
        object->distance = odd;
        object->locationDate = odd;
        all.push_back(object);
    }
    const auto controller = makeController(all);
    layOut(controller, 320.0);
    EXPECT_EQ(controller->containerView()->arrangedSubviews().size(), all.size());
    // No age of what is no time.
    EXPECT_EQ(controller->friendViews().at("0@example.org")->timeLabel()->text(), "");
    EXPECT_EQ(controller->friendViews().at("0@example.org")->distanceLabel()->text(), "");
}

TEST_F(VAKTRMultipleLocationsSnippetControllerAdverseTest, Texts_EmptyHugeOrNoUtf8_AreDrawn) {
    const Strings odd = {"",
                         std::string(100'000, 'x'),
                         "\xFF\xFE\x80",
                         std::string("a\0b", 3),
                         std::string("\xE2\x80\xAE") + "gpj.exe",
                         "\xF0\x9F\x91\xA9\xE2\x80\x8D\xF0\x9F\x91\xA9\xE2\x80\x8D\xF0\x9F\x91\xA7",
                         "%@%1$@%s%n"};
    LocationList all;
    for (const std::string& text : odd) {
        auto object = placed(friendByEmail(text, text), 51.0, -1.0, text);
        object->stateCode = text + "!";
        all.push_back(object);
    }
    localization->set("org.ktr.snippets", "CITY_STATE_LABEL", "%@, %@");
    const auto controller = makeController(all);
    layOut(controller, 320.0);
    const auto shown = controller->containerView()->arrangedSubviews();
    ASSERT_EQ(shown.size(), odd.size());
    for (std::size_t i = 0; i < odd.size(); ++i) {
        const auto row = std::dynamic_pointer_cast<KTRVelaFriendView>(shown[i]);
        EXPECT_EQ(row->nameLabel()->text(), odd[i]);
        EXPECT_EQ(row->locationLabel()->text(), odd[i] + ", " + odd[i] + "!");
        EXPECT_EQ(row->urlForTouch()->text(), "wayloc://friend/" + odd[i]);
        EXPECT_EQ(row->frame().height, 78.5);
    }
    time->runUntilIdle(1.0);
}

TEST_F(VAKTRMultipleLocationsSnippetControllerAdverseTest, Lists_WithHoles_AreDrawn) {
    auto halfKnown = ann();
    halfKnown->friend_->object->emails = {nullptr};
    halfKnown->friend_->object->phones = {nullptr};
    auto nobody = bo();
    nobody->friend_ = nullptr;
    const auto controller = makeController({nullptr, halfKnown, nobody});
    layOut(controller, 320.0);
    EXPECT_EQ(controller->containerView()->arrangedSubviews().size(), 2u);
    EXPECT_EQ(controller->friends().size(), 1u);
    time->runUntilIdle(1.0);
}

TEST_F(VAKTRMultipleLocationsSnippetControllerAdverseTest, Host_DropsControllerWhileAskedForItsBundle) {
    auto controller =
        create<Controller>(&Controller::initWithCueObject, proximitySnippet({ann()}, "minCallbackIntervalInMS=2500&"));
    const std::weak_ptr<Controller> gone = controller;
    host_->whenAskedForBundle = [&] { controller = nullptr; };
    controller->setDelegate(host_);
    EXPECT_TRUE(gone.expired());
}

TEST_F(VAKTRMultipleLocationsSnippetControllerAdverseTest, Host_DropsControllerWhileItsHeightChanges) {
    auto controller = makeController({ann()});
    layOut(controller, 320.0);
    const std::weak_ptr<Controller> gone = controller;
    host_->whenHeightChanges = [&] { controller = nullptr; };
    controller->locationsUpdated(test::resultOf(listOf({bo()})));
    time->runUntilIdle(1.0);
    EXPECT_TRUE(gone.expired());
}

TEST_F(VAKTRMultipleLocationsSnippetControllerAdverseTest, Host_LeavesWhileItsHeightChanges) {
    const auto controller = makeController({ann()});
    layOut(controller, 320.0);
    host_->whenHeightChanges = [&] {
        controller->setDelegate(nullptr);
        controller->viewNeedsResize();
    };
    controller->locationsUpdated(test::resultOf(listOf({bo()})));
    EXPECT_EQ(host_->heightChanges.size(), 1u);
    EXPECT_EQ(controller->friendViews().count("bo@example.org"), 1u);
}

TEST_F(VAKTRMultipleLocationsSnippetControllerAdverseTest, Host_UpdatesAgainWhileTheHeightChanges) {
    const auto controller = makeController({ann()});
    layOut(controller, 320.0);
    host_->whenHeightChanges = [&] {
        controller->locationsUpdated(test::resultOf(listOf({numbered(1), numbered(2)})));
    };
    controller->locationsUpdated(test::resultOf(listOf({bo()})));
    EXPECT_EQ(controller->friendViews().size(), 2u);
    EXPECT_EQ(controller->containerView()->subviews().size(), 2u);
}

TEST_F(VAKTRMultipleLocationsSnippetControllerAdverseTest, Host_DropsControllerWhileATapIsOpened) {
    auto controller = makeController({ann()});
    layOut(controller, 320.0);
    const auto row = controller->friendViews().at("ann@example.org");
    host_->whenOpening = [&] { controller = nullptr; };
    row->viewTouched();
    EXPECT_EQ(host_->opened.size(), 1u);
    EXPECT_EQ(row->urlHandler(), nullptr);
    row->viewTouched();
    EXPECT_EQ(host_->opened.size(), 1u);
}

TEST_F(VAKTRMultipleLocationsSnippetControllerAdverseTest, Locations_ChangedWhileRowsAreFilled_EndWithTheNewOnes) {
    const auto talking = std::make_shared<TalkingLocalization>();
    platform->localization = talking;
    const auto controller = makeController({ann(), bo()});
    layOut(controller, 320.0);
    talking->whenAsked = [&] { controller->locationsUpdated(test::resultOf(listOf({numbered(1)}))); };
    controller->locationsUpdated(test::resultOf(listOf({friendByEmail("Cy", "cy@example.org"), ann(), numbered(2)})));
    controller->reloadData();
    EXPECT_EQ(controller->friendViews().size(), 1u);
    EXPECT_EQ(controller->containerView()->subviews().size(), 1u);
}

TEST_F(VAKTRMultipleLocationsSnippetControllerAdverseTest, ReloadTimer_DropsTheControllerItself) {
    const auto talking = std::make_shared<TalkingLocalization>();
    platform->localization = talking;
    // City and state are put together anew at each filling: the texts are asked.
    auto friendInState = ann();
    friendInState->stateCode = "SP";
    auto controller = makeController({friendInState});
    layOut(controller, 320.0);
    time->runUntilIdle(1.0);
    controller->viewWillAppear(false);
    const std::weak_ptr<Controller> gone = controller;
    talking->whenAsked = [&] { controller = nullptr; };
    time->advance(30.0);
    time->runUntilIdle(1.0);
    EXPECT_TRUE(gone.expired());
    time->advance(30.0);
    EXPECT_EQ(time->pendingTimers(), 0u);
}

TEST_F(VAKTRMultipleLocationsSnippetControllerAdverseTest, AvatarStep_OutlivesControllerAndHost) {
    auto controller = makeController({ann(), bo()});
    layOut(controller, 320.0);
    const std::weak_ptr<View> row = controller->friendViews().at("ann@example.org");
    controller = nullptr;
    host_ = nullptr;
    EXPECT_FALSE(row.expired());
    time->advance(0.1);
    EXPECT_TRUE(row.expired());
}

TEST_F(VAKTRMultipleLocationsSnippetControllerAdverseTest, NotificationWhileEverythingGoes_LeaksNothing) {
    platform->locationManagers = std::make_shared<NoisyManagers>();
    auto controller = makeController({ann(), bo()}, "incomplete=1&");
    layOut(controller, 320.0);
    const std::weak_ptr<View> row = controller->friendViews().at("ann@example.org");
    controller->setDelegate(host_);
    controller = nullptr;
    time->runUntilIdle(1.0);
    EXPECT_TRUE(row.expired());
}

TEST_F(VAKTRMultipleLocationsSnippetControllerAdverseTest, PlatformGone_WhatIsLeftRunsOutQuietly) {
    auto controller = makeController({ann(), bo()}, "incomplete=1&");
    layOut(controller, 320.0);
    controller->viewWillAppear(false);
    const auto row = controller->friendViews().at("ann@example.org");
    const auto manager = locationManagers->made.back();
    manager->deliver(position(51.0, -1.0));
    const std::weak_ptr<Controller> gone = controller;

    Platform::install(nullptr);
    time->advance(31.0);
    manager->deliver(position(52.0, -1.0));
    platform->notificationCenter->post({kCurrentLocationUpdatedNotification, nullptr});
    row->viewTouched();
    controller->viewNeedsResize();
    controller->viewWillDisappear(false);
    controller = nullptr;
    time->advance(31.0);
    EXPECT_TRUE(gone.expired());
    EXPECT_EQ(time->pendingTimers(), 0u);
    // An age or a place cannot be worded without a platform: what was shown stays.
    EXPECT_EQ(row->nameLabel()->text(), "Ann");
}

TEST_F(VAKTRMultipleLocationsSnippetControllerAdverseTest, ThousandsOfRows_ComeGoAndTurnRound) {
    constexpr int kCount = 5000;
    auto all = numberedUpTo(kCount);
    const auto controller = makeController(all, "incomplete=1&");
    layOut(controller, 320.0);
    EXPECT_EQ(controller->desiredHeightForWidth(320.0), kCount * 78.5 + 48.0);
    EXPECT_EQ(controller->containerView()->arrangedSubviews().back()->frame().maxY(), kCount * 78.5 + 48.0);
    const auto first = controller->friendViews().at("0@example.org");

    controller->locationsUpdated(test::resultOf(listOf({all.rbegin(), all.rend()})));
    EXPECT_EQ(controller->containerView()->arrangedSubviews()[kCount - 1], first);
    controller->locationsUpdated(test::resultOf(listOf(LocationList(kCount, all[0]))));
    EXPECT_EQ(controller->containerView()->arrangedSubviews().front(), first);
    EXPECT_EQ(controller->containerView()->subviews().size(), 2u);
    controller->locationsUpdated(test::resultOf(listOf({})));
    controller->locationsUpdated(test::resultOf(listOf(numberedUpTo(2))));
    EXPECT_EQ(controller->containerView()->subviews().size(), 3u);
}

/// The arrangement as one insertion after the other makes it, in names: rows by their handles, "label" for the label.
class Insertions {
  public:
    explicit Insertions(bool showAll) : showAll_(showAll) {}
    Strings arranged = {"label"};

    void update(const Strings& handles) {
        if (handles.empty()) {
            arranged = {"label"};
            return;
        }
        for (std::size_t i = 0; i < handles.size(); ++i) {
            insert(handles[i], i);
        }
        std::size_t count = handles.size();
        if (showAll_) {
            insert("label", count++);
        }
        arranged.resize(std::min(arranged.size(), count));
        // What is neither the row of a friend nor a wanted label leaves the tree.
        std::erase_if(arranged, [&](const std::string& name) {
            return name == "label" ? !showAll_ : std::find(handles.begin(), handles.end(), name) == handles.end();
        });
    }

  private:
    void insert(const std::string& name, std::size_t index) {
        std::erase(arranged, name);
        arranged.insert(arranged.begin() + static_cast<std::ptrdiff_t>(std::min(index, arranged.size())), name);
    }
    bool showAll_;
};

TEST_F(VAKTRMultipleLocationsSnippetControllerAdverseTest, AnySequenceOfUpdates_ArrangesAsInsertingOneByOneDoes) {
    std::mt19937 random(20260115);
    for (int sequence = 0; sequence < 60; ++sequence) {
        const bool showAll = sequence % 2 == 1;
        const auto controller = makeController({}, showAll ? "incomplete=1&" : "");
        controller->desiredHeightForWidth(320.0);
        Insertions expected(showAll);
        for (int step = 0; step < 12; ++step) {
            LocationList all;
            Strings handles;
            for (std::size_t i = random() % 6; i > 0; --i) {
                const std::string handle = std::string(1, static_cast<char>('a' + random() % 5)) + "@";
                const bool known = random() % 4 > 0;
                all.push_back(known ? placedFriend(handle, handle) : friendByEmail(handle, handle));
                if (known) {
                    handles.push_back(handle);
                }
            }
            controller->locationsUpdated(test::resultOf(listOf(all)));
            expected.update(handles);
            Strings shown;
            for (const auto& view : controller->containerView()->arrangedSubviews()) {
                const auto row = std::dynamic_pointer_cast<KTRVelaFriendView>(view);
                shown.push_back(row ? row->nameLabel()->text() : "label");
            }
            ASSERT_EQ(shown, expected.arranged) << "sequence " << sequence << ", step " << step;
            // Nothing that is not shown stays in the tree but the rows that wait for their friends to be known again.
            for (const auto& view : controller->containerView()->subviews()) {
                const auto row = std::dynamic_pointer_cast<KTRVelaFriendView>(view);
                ASSERT_TRUE(!row || controller->friendViews().contains(row->nameLabel()->text()));
            }
        }
    }
}

}  // namespace ktr
