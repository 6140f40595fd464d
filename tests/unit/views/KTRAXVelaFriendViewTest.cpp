#include "views/accessibility/KTRAXVelaFriendView.h"

#include <algorithm>
#include <limits>

#include "platform/ui/Window.h"
#include "tests/support/BackgroundLoop.h"
#include "tests/support/Friends.h"
#include "tests/support/PlatformTest.h"

namespace ktr {

using namespace platform;
using test::placed;
using test::placedFriend;

namespace {

struct UserPosition : CurrentLocationDelegate {
    std::shared_ptr<PlatformLocation> position;
    std::shared_ptr<PlatformLocation> currentLocation() const override { return position; }
};

struct ResizeCounter : FriendViewDelegate {
    int count = 0;
    void viewNeedsResize() override { ++count; }
};

constexpr const char* kBundle = "org.ktr.snippets";
constexpr const char* kGenerating = "Generating image for AX view.";
constexpr const char* kGenerated = "Image generated - 1";

}  // namespace

class KTRAXVelaFriendViewTest : public test::PlatformTest {
  protected:
    KTRAXVelaFriendViewTest() {
        localization->set(kBundle, "LOCATING", "Looking...");
        localization->set(kBundle, "NO_LOCATION", "Not found");
        localization->set(kBundle, "LOCATED_NOW", "Now");
        localization->set(kBundle, "LOCATED_MINUTES", "%@ min ago");
        localization->set(kBundle, "_$!<home>!$_", "Home");
        device->category = ContentSizeCategory::AX3;
        user_->position = position(51.001, -1.0);
    }

    std::shared_ptr<KTRAXVelaFriendView> makeRow(double width = 640.0) {
        auto row = create<KTRAXVelaFriendView>(&KTRAXVelaFriendView::initWithFrame, Rect{0.0, 0.0, width, 0.0});
        row->setCurrentLocationDelegate(user_);
        row->setViewDelegate(host_);
        return row;
    }
    static std::shared_ptr<VAKtrLocation> ann() {
        auto object = placedFriend("Ann", "ann@example.org");
        object->locationDate = kNoon - 300.0;
        return object;
    }
    static std::shared_ptr<KTRVALocation> record(const std::shared_ptr<VAKtrLocation>& object) {
        return KTRVALocation::locationWithVelaLocation(object);
    }
    std::shared_ptr<KTRAXVelaFriendView> rowFor(const std::shared_ptr<VAKtrLocation>& object, double width = 640.0) {
        auto row = makeRow(width);
        row->setLocation(record(object));
        return row;
    }
    /// Lays a row out by itself, as high as it wants to be.
    static void layOut(const std::shared_ptr<View>& row, double width) {
        const double height = row->systemLayoutSizeFitting({width, 0.0}, 1000.0, 1.0).height;
        row->setFrame({0.0, 0.0, width, height});
        row->layoutIfNeeded();
    }
    /// Puts a loop whose background work waits in the platform's place.
    std::shared_ptr<test::BackgroundLoop> makeBackgroundWait() {
        auto loop = std::make_shared<test::BackgroundLoop>(Date{kNoon});
        platform->mainLoop = loop;
        return loop;
    }
    std::vector<std::string> lines() const {
        auto texts = log->texts(LogLevel::Debug);
        std::erase_if(texts, [](const std::string& text) {
            return text.find("mage ge") == std::string::npos && text.find("ing image") == std::string::npos;
        });
        return texts;
    }

    std::shared_ptr<UserPosition> user_ = std::make_shared<UserPosition>();
    std::shared_ptr<ResizeCounter> host_ = std::make_shared<ResizeCounter>();
};

using Strings = std::vector<std::string>;

// The text

TEST_F(KTRAXVelaFriendViewTest, Text_IsNamePlaceAgeAndDistance) {
    const auto text = rowFor(ann())->attributedStringForView();
    const Font headline = preferredFont(TextStyle::Headline, ContentSizeCategory::AX3);
    const Font subheadline = preferredFont(TextStyle::Subheadline, ContentSizeCategory::AX3);
    const ParagraphStyle style = {TextAlignment::Left, LineBreakMode::WordWrapping, WritingDirection::LeftToRight};
    const std::vector<AttributedString::Run> expected = {{"Ann", headline, std::nullopt, style},
                                                         {"\n", headline, std::nullopt, style},
                                                         {"Springfield", subheadline, std::nullopt, style},
                                                         {" \u2014 5 min ago", subheadline, std::nullopt, style},
                                                         {"\n", subheadline, std::nullopt, style},
                                                         {"111 m", subheadline, std::nullopt, style}};
    EXPECT_EQ(text.runs(), expected);
}

TEST_F(KTRAXVelaFriendViewTest, Text_WithoutAFixDate_HasNeitherAgeNorDash) {
    auto object = ann();
    object->locationDate = 0.0;
    EXPECT_EQ(rowFor(object)->attributedStringForView().text(), "Ann\nSpringfield\n111 m");
    object->locationDate = std::nullopt;
    EXPECT_EQ(rowFor(object)->attributedStringForView().text(), "Ann\nSpringfield\n111 m");
}

TEST_F(KTRAXVelaFriendViewTest, Text_WithoutADistance_HasTwoLines) {
    user_->position = nullptr;
    EXPECT_EQ(rowFor(ann())->attributedStringForView().text(), "Ann\nSpringfield \u2014 5 min ago");
}

TEST_F(KTRAXVelaFriendViewTest, Text_OfNobody_IsTheLineBreakAlone) {
    EXPECT_EQ(makeRow()->attributedStringForView().text(), "\n");
}

TEST_F(KTRAXVelaFriendViewTest, Text_OfTheUsersOwnRow_HasADistanceWhenOneIsKnown_IsKept) {
    const auto row = rowFor(ann());
    row->setIsVisibility(true);
    EXPECT_EQ(row->attributedStringForView().text(), "Ann\nSpringfield \u2014 5 min ago\n111 m");
}

TEST_F(KTRAXVelaFriendViewTest, Text_WordsThePlaceByWhetherItIsAwaited) {
    auto object = test::friendByEmail("Ann", "ann@example.org");
    const auto row = rowFor(object);
    EXPECT_EQ(row->attributedStringForView().text(), "Ann\nLooking...");
    row->setIsRefreshingLocation(false);
    EXPECT_EQ(row->attributedStringForView().text(), "Ann\nNot found");
}

TEST_F(KTRAXVelaFriendViewTest, Text_OfADefaultLabel_IsItsLocalizedText) {
    auto object = ann();
    object->label = "_$!<home>!$_";
    EXPECT_EQ(rowFor(object)->attributedStringForView().runs().at(2).text, "Home");
}

TEST_F(KTRAXVelaFriendViewTest, RightToLeft_AlignsRightInTheInterfacesDirection) {
    assistant->rightToLeft = true;
    const auto row = rowFor(ann());
    const auto text = row->attributedStringForView();
    for (const auto& run : text.runs()) {
        EXPECT_EQ(run.paragraph.alignment, TextAlignment::Right);
        EXPECT_EQ(run.paragraph.writingDirection, WritingDirection::RightToLeft);
    }
    EXPECT_EQ(row->imageView()->contentMode(), ContentMode::TopRight);
    EXPECT_EQ(makeRow()->isRTLUI(), true);
}

TEST_F(KTRAXVelaFriendViewTest, Exclusion_LiesAtTheLeadingEdge) {
    EXPECT_EQ(makeRow(400.0)->exclusionPaths(), (std::vector<Rect>{{0.0, 0.0, 67.0, 54.0}}));
    EXPECT_EQ(makeRow(400.0)->imageView()->contentMode(), ContentMode::TopLeft);
    assistant->rightToLeft = true;
    EXPECT_EQ(makeRow(400.0)->exclusionPaths(), (std::vector<Rect>{{303.0, 0.0, 67.0, 54.0}}));
}

// The views

TEST_F(KTRAXVelaFriendViewTest, Views_AreAvatarImageAndSeparator_TheAvatarInFront) {
    const auto row = makeRow();
    EXPECT_EQ(row->subviews(),
              (std::vector<std::shared_ptr<View>>{row->imageView(), row->separatorView(), row->friendIconView()}));
    EXPECT_EQ(row->nameLabel(), nullptr);
    EXPECT_EQ(row->separatorView()->layerBackgroundColor(), Color::rgb(151.0 / 255.0, 158.0 / 255.0, 149.0 / 255.0));
    EXPECT_NE(row->renderer(), nullptr);
}

TEST_F(KTRAXVelaFriendViewTest, OrdinaryTextSize_SetsUpOnce) {
    device->category = ContentSizeCategory::L;
    const auto row = rowFor(ann());
    EXPECT_FALSE(row->axSize());
    EXPECT_EQ(row->subviews().size(), 3u);
    time->runPosted();
    EXPECT_NE(row->imageView()->image(), nullptr);
}

TEST_F(KTRAXVelaFriendViewTest, Separator_IsTheBasesOwn) {
    const auto row = makeRow();
    EXPECT_FALSE(row->separatorView()->hidden());
    row->setSeparatorEnabled(false);
    EXPECT_TRUE(row->separatorView()->hidden());
    row->setSeparatorEnabled(true);
    EXPECT_FALSE(row->separatorView()->hidden());
}

TEST_F(KTRAXVelaFriendViewTest, Layout_BeforeTheImage_HasAnImageViewWithoutHeight) {
    const auto row = rowFor(ann());
    layOut(row, 640.0);
    EXPECT_EQ(row->imageView()->frame(), (Rect{15.0, 10.0, 610.0, 0.0}));
    EXPECT_EQ(row->friendIconView()->frame(), (Rect{15.0, 10.0, 54.0, 54.0}));
    EXPECT_EQ(row->frame().height, 20.5);
}

TEST_F(KTRAXVelaFriendViewTest, Layout_WithTheImage_IsAsHighAsTheImage) {
    const auto row = rowFor(ann());
    time->runPosted();
    layOut(row, 640.0);
    const Size size = row->imageView()->image()->size();
    EXPECT_EQ(row->imageView()->frame(), (Rect{15.0, 10.0, 610.0, size.height}));
    EXPECT_EQ(row->frame().height, size.height + 20.5);
    EXPECT_EQ(row->separatorView()->frame(), (Rect{0.0, size.height + 20.0, 640.0, 0.5}));
    EXPECT_EQ(row->friendIconView()->frame(), (Rect{15.0, 10.0, 54.0, 54.0}));
}

TEST_F(KTRAXVelaFriendViewTest, Layout_RightToLeft_IsMirrored) {
    assistant->rightToLeft = true;
    const auto row = rowFor(ann());
    time->runPosted();
    layOut(row, 640.0);
    EXPECT_EQ(row->friendIconView()->frame(), (Rect{571.0, 10.0, 54.0, 54.0}));
    EXPECT_EQ(row->imageView()->frame().x, 15.0);
    // The exclusion, in the picture's coordinates, covers the avatar's place to its end.
    const Rect hole = row->exclusionPaths().at(0);
    EXPECT_EQ(hole.maxX(), 610.0);
    EXPECT_LE(hole.x + 15.0, 571.0);
}

TEST_F(KTRAXVelaFriendViewTest, Height_IsMeasuredWiderThanTheImage_IsKept) {
    const auto row = rowFor(ann());
    const double measured = row->sizeForText(row->attributedStringForView(), 620.0, row->exclusionPaths()).height;
    EXPECT_EQ(row->estimagedHeightForView(), measured + 30.5);
    EXPECT_TRUE(log->has(LogLevel::Debug, "Calculating estimated height"));
    time->runPosted();
    row->setFrame({0.0, 0.0, 320.0, 0.0});
    EXPECT_EQ(row->estimagedHeightForView(),
              row->sizeForText(row->attributedStringForView(), 300.0, row->exclusionPaths()).height + 30.5)
        << "measured though there is an image";
}

// The image

TEST_F(KTRAXVelaFriendViewTest, Filling_RendersInTheBackgroundAndShowsOnTheMainQueue) {
    const auto loop = makeBackgroundWait();
    const auto row = rowFor(ann());
    EXPECT_EQ(lines(), Strings{kGenerating});
    ASSERT_EQ(loop->waiting.size(), 1u);
    loop->run(0);
    EXPECT_EQ(row->imageView()->image(), nullptr) << "shown by the background itself";
    EXPECT_EQ(host_->count, 0);
    loop->runPosted();
    EXPECT_NE(row->imageView()->image(), nullptr);
    EXPECT_EQ(host_->count, 1);
    EXPECT_EQ(lines(), (Strings{kGenerating, kGenerated}));
}

TEST_F(KTRAXVelaFriendViewTest, Image_BeforeTheFirstLayout_IsAsWideAsTheRowWithoutItsMargins) {
    const auto row = rowFor(ann(), 500.0);
    time->runPosted();
    EXPECT_EQ(row->imageView()->image()->size().width, 470.0);
}

TEST_F(KTRAXVelaFriendViewTest, Image_FlowsAroundTheAvatarAndHasNoLimitOfLines) {
    auto object = ann();
    object->friend_->object->fullName = "Ann with a name of very many words that goes on and on and on and on";
    const auto row = rowFor(object, 320.0);
    time->runPosted();
    const auto image = std::dynamic_pointer_cast<TextImage>(row->imageView()->image());
    ASSERT_NE(image, nullptr);
    EXPECT_GT(image->layout().lines().size(), 8u);
    EXPECT_FALSE(image->layout().isTruncated());
    for (const auto& line : image->layout().lines()) {
        EXPECT_FALSE(line.box.intersects(row->exclusionPaths()[0]));
        EXPECT_GE(line.box.x, 5.0) << "the padding";
        EXPECT_LE(line.box.maxX(), 285.01);
    }
    EXPECT_EQ(image->layout().lines().front().box.x, 72.0);
    EXPECT_EQ(image->size().height, image->layout().usedSize().height);
}

TEST_F(KTRAXVelaFriendViewTest, Width_OfNothing_WaitsForTheFirstLayout) {
    for (const double width : {0.0, 30.0, -5.0, std::numeric_limits<double>::quiet_NaN()}) {
        const auto row = rowFor(ann(), width);
        time->runPosted();
        EXPECT_EQ(row->imageView()->image(), nullptr) << width;
        layOut(row, 400.0);
        time->runPosted();
        ASSERT_NE(row->imageView()->image(), nullptr) << width;
        EXPECT_EQ(row->imageView()->image()->size().width, 370.0);
    }
}

TEST_F(KTRAXVelaFriendViewTest, Width_ThatChanged_RendersAgainOncePerPass) {
    const auto loop = makeBackgroundWait();
    const auto row = rowFor(ann());
    layOut(row, 640.0);
    EXPECT_EQ(loop->waiting.size(), 1u) << "the same width";
    layOut(row, 500.0);
    layOut(row, 500.0);
    ASSERT_EQ(loop->waiting.size(), 2u);
    loop->run(0);
    loop->runPosted();
    EXPECT_EQ(row->imageView()->image()->size().width, 610.0) << "until the new one is there";
    loop->run(1);
    loop->runPosted();
    EXPECT_EQ(row->imageView()->image()->size().width, 470.0);
    layOut(row, 500.0);
    EXPECT_EQ(loop->waiting.size(), 2u);
}

TEST_F(KTRAXVelaFriendViewTest, OlderRendering_NeverReplacesANewerOne) {
    const auto loop = makeBackgroundWait();
    const auto row = rowFor(ann());
    auto moved = ann();
    moved->city = "Elsewhere";
    row->setLocation(record(moved));
    ASSERT_EQ(loop->waiting.size(), 2u);
    loop->run(1);
    loop->runPosted();
    const auto newer = row->imageView()->image();
    ASSERT_NE(newer, nullptr);
    loop->run(0);
    loop->runPosted();
    EXPECT_EQ(row->imageView()->image(), newer);
}

TEST_F(KTRAXVelaFriendViewTest, EveryFilling_TellsOneResize_AlsoWhenTheImageIsTheLastOne) {
    const auto row = rowFor(ann());
    time->runPosted();
    const auto image = row->imageView()->image();
    const int laidOut = textEngine->count();
    row->setLocation(row->location());
    time->runPosted();
    EXPECT_EQ(row->imageView()->image(), image);
    EXPECT_EQ(textEngine->count(), laidOut) << "rendered anew";
    platform->notificationCenter->post({kCurrentLocationUpdatedNotification, nullptr});
    time->runPosted();
    EXPECT_EQ(host_->count, 3);
    EXPECT_EQ(lines(), (Strings{kGenerating, kGenerated, kGenerating, kGenerated, kGenerating, kGenerated}));
    user_->position = position(51.002, -1.0);
    platform->notificationCenter->post({kCurrentLocationUpdatedNotification, nullptr});
    time->runPosted();
    EXPECT_NE(row->imageView()->image(), image);
}

TEST_F(KTRAXVelaFriendViewTest, NoTextEngine_IsNoImageAndTheResizeIsTold) {
    platform->textEngine = nullptr;
    const auto row = rowFor(ann());
    EXPECT_EQ(row->renderer(), nullptr);
    time->runPosted();
    EXPECT_EQ(row->imageView()->image(), nullptr);
    EXPECT_EQ(host_->count, 1);
    EXPECT_EQ(lines(), (Strings{kGenerating, "Image generated - 0"}));
}

TEST_F(KTRAXVelaFriendViewTest, RendererTakenAway_TheImageGoes) {
    const auto row = rowFor(ann());
    time->runPosted();
    row->setRenderer(nullptr);
    user_->position = nullptr;
    row->updateView();
    time->runPosted();
    EXPECT_EQ(row->imageView()->image(), nullptr);
    EXPECT_EQ(host_->count, 2);
}

TEST_F(KTRAXVelaFriendViewTest, RowGone_RenderingEndsSilently) {
    const auto loop = makeBackgroundWait();
    auto row = rowFor(ann());
    loop->advance(0.2);
    const std::weak_ptr<View> gone = row;
    row = nullptr;
    EXPECT_TRUE(gone.expired()) << "held by the rendering";
    loop->run(0);
    loop->runPosted();
    EXPECT_EQ(host_->count, 0);
    EXPECT_EQ(lines(), Strings{kGenerating});
}

TEST_F(KTRAXVelaFriendViewTest, PlatformGone_RenderingEndsSilently) {
    const auto loop = makeBackgroundWait();
    const auto row = rowFor(ann());
    const std::weak_ptr<Platform> gone = platform;
    Platform::install(nullptr);
    loop->run(0);
    loop->runPosted();
    EXPECT_EQ(row->imageView()->image(), nullptr);
    EXPECT_EQ(host_->count, 0);
    row->updateView();
    layOut(row, 300.0);
    EXPECT_EQ(loop->waiting.size(), 1u);
    EXPECT_EQ(platform.use_count(), 1) << "held by the rendering";
    Platform::install(platform);
}

TEST_F(KTRAXVelaFriendViewTest, Avatar_OneStepAFilling_AndTheImageDoesNotWaitForIt) {
    contacts->contacts = {test::contactWith("c1", "ann@example.org", "")};
    const auto row = rowFor(ann());
    time->runPosted();
    EXPECT_NE(row->imageView()->image(), nullptr);
    EXPECT_TRUE(row->avatarViewController()->contacts().empty());
    EXPECT_EQ(time->pendingTimers(), 1u);
    time->advance(0.1);
    ASSERT_EQ(row->avatarViewController()->contacts().size(), 1u);
    EXPECT_EQ(row->avatarViewController()->contacts()[0], contacts->contacts[0]);
    row->updateView();
    EXPECT_EQ(time->pendingTimers(), 0u) << "the same contact again";
    contacts->contacts = {test::contactWith("c2", "ann@example.org", "")};
    row->updateView();
    EXPECT_EQ(time->pendingTimers(), 1u);
}

TEST_F(KTRAXVelaFriendViewTest, Threads_ManyRowsAreRenderedAtOnce) {
    const auto loop = makeBackgroundWait();
    std::vector<std::shared_ptr<KTRAXVelaFriendView>> rows;
    for (int i = 0; i < 8; ++i) {
        rows.push_back(rowFor(ann(), 320.0 + i));
        rows.back()->updateView();
    }
    std::thread behind([&] { loop->runOnThreads(); });
    // Meanwhile the main thread goes on with other rows and other records.
    for (int i = 0; i < 8; ++i) {
        const auto other = create<KTRAXVelaFriendView>(&KTRAXVelaFriendView::initWithFrame, Rect{0, 0, 320, 0});
        EXPECT_FALSE(other->attributedStringForView().empty());
        rows[static_cast<std::size_t>(i)]->setFrame({0.0, 0.0, 500.0, 90.0});
        rows[static_cast<std::size_t>(i)]->setIsRefreshingLocation(false);
    }
    behind.join();
    loop->runPosted();
    for (std::size_t i = 0; i < rows.size(); ++i) {
        ASSERT_NE(rows[i]->imageView()->image(), nullptr);
        EXPECT_EQ(rows[i]->imageView()->image()->size().width, 290.0 + static_cast<double>(i));
    }
}

TEST_F(KTRAXVelaFriendViewTest, ScreenReader_HearsOneLinkAndNoImage) {
    localization->set(kBundle, "ACCESSIBILITY_AT_LABEL", "At %@");
    localization->set(kBundle, "ACCESSIBILITY_ROW_PARTS", "%1$@, %2$@");
    localization->set(kBundle, "ACCESSIBILITY_DISTANCE", "%@ away");
    localization->set(kBundle, "ACCESSIBILITY_LOCATED_MINUTES", "%@ minutes ago");
    const auto window = create<Window>(&Window::initWithFrame, Rect{0.0, 0.0, 640.0, 500.0});
    const auto row = rowFor(ann());
    time->advance(0.2);
    window->addSubview(row);
    layOut(row, 640.0);
    const auto tree = accessibilityTree(window, false);
    ASSERT_EQ(tree.children.size(), 1u);
    EXPECT_EQ(tree.children[0].role, AccessibilityRole::Link);
    EXPECT_EQ(tree.children[0].view.lock(), row);
    EXPECT_TRUE(tree.children[0].children.empty());
    EXPECT_EQ(tree.children[0].text, "Ann, At Springfield, 111 m away, 5 minutes ago");
}

}  // namespace ktr
