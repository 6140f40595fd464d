#include <gtest/gtest.h>

#include <algorithm>

#include "host/Host.h"
#include "host/HostOptions.h"
#include "host/conversation/Measures.h"
#include "host/scenario/ScenarioReader.h"
#include "platform/base/VirtualTime.h"
#include "platform/layout/LayoutTypes.h"
#include "platform/text/TextImage.h"
#include "platform/ui/ImageView.h"

namespace ktr::test {

using host::Host;
using platform::ContentSizeCategory;
using platform::Rect;
using platform::TextImage;

namespace {

constexpr ContentSizeCategory kSizes[] = {ContentSizeCategory::AX1, ContentSizeCategory::AX2, ContentSizeCategory::AX3,
                                          ContentSizeCategory::AX4, ContentSizeCategory::AX5};
constexpr double kWidths[] = {280.0, 320.0, 400.0, 800.0};

using Found = std::vector<std::shared_ptr<platform::ImageView>>;

/// The views that show texts, from the top down.
void collect(const std::shared_ptr<platform::View>& view, Found& found) {
    if (const auto image = std::dynamic_pointer_cast<platform::ImageView>(view);
        image && image->contentMode() != platform::ContentMode::ScaleToFill) {
        found.push_back(image);
    }
    for (const auto& subview : view->presentedSubviews()) {
        collect(subview, found);
    }
}

}  // namespace

/// Answers in very large text, with the real plugin and real fonts.
class LargeTextTest : public ::testing::Test {
  protected:
    void open(const std::string& name, ContentSizeCategory size, double width) {
        host = nullptr;
        host::HostSettings settings;
        auto read = host::ScenarioReader({0.0}).readFile(KTR_SOURCE_DIR "/resources/scenarios/" + name + ".json");
        ASSERT_TRUE(std::holds_alternative<host::Scenario>(read));
        host::HostOptions options;
        options.textSize = size;
        options.width = width;
        auto decided = host::HostSettings::decide(options, {std::get<host::Scenario>(read)}, {{790171200.0}, 0});
        ASSERT_TRUE(std::holds_alternative<host::HostSettings>(decided));
        auto made = Host::make(std::get<host::HostSettings>(decided), Host::Time::Virtual, KTR_PLUGIN_FILE);
        host = std::move(std::get<std::unique_ptr<Host>>(made));
        ASSERT_FALSE(host->addTurn(std::get<host::Scenario>(read)));
        host->settle(width);
    }
    Found texts() const {
        Found found;
        collect(card()->content(), found);
        return found;
    }
    /// Rows are measured ten points wider than they are rendered: a long word then fits a full line that it does not
    /// fit in the picture, stands below the avatar, and its row wants more than it needs. That room is everybody's.
    bool someRowIsMeasuredALineHigher() const {
        const double width = card()->content()->frame().width;
        const auto& controller = card()->controller();
        const double rows =
            controller->view()->systemLayoutSizeFitting({width, 0.0}, platform::kRequiredPriority, 1.0).height;
        constexpr double kLowestLine = 30.0;
        const double usual = 10.0 * static_cast<double>(texts().size());
        return controller->desiredHeightForWidth(width) > rows + usual + kLowestLine - 1.0;
    }
    const std::shared_ptr<host::CardView>& card() const { return host->conversation()->turns().back()->card(); }
    static std::shared_ptr<TextImage> imageOf(const platform::ImageView& view) {
        return std::dynamic_pointer_cast<TextImage>(view.image());
    }

    std::unique_ptr<Host> host;
};

TEST_F(LargeTextTest, EveryAnswer_StandsWholeBesideItsAvatarAndWithinItsCard) {
    for (const char* name : {"dinner", "right-to-left", "long-names", "single", "fence-leaving", "sharing-visible",
                             "sharing-hidden", "names-japanese", "names-devanagari", "strangers"}) {
        for (const auto size : kSizes) {
            for (const double width : kWidths) {
                SCOPED_TRACE(std::string(name) + " at " + std::to_string(static_cast<int>(size)) + ", " +
                             std::to_string(width));
                open(name, size, width);
                const Rect content = card()->content()->frameInRoot();
                const auto shown = texts();
                ASSERT_FALSE(shown.empty());
                for (const auto& view : shown) {
                    const auto image = imageOf(*view);
                    ASSERT_NE(image, nullptr);
                    const Rect row = view->superview()->frameInRoot();
                    const Rect place = view->frameInRoot();
                    EXPECT_EQ(image->size().width, place.width);
                    EXPECT_GE(place.height, image->size().height);
                    const double below = row.maxY() - (place.y + image->layout().lines().back().box.maxY());
                    EXPECT_GE(below, 10.0);
                    if (!someRowIsMeasuredALineHigher()) {
                        EXPECT_LE(below, 24.0);
                    }
                    EXPECT_LE(row.maxY(), content.maxY() + 0.01) << "cut off";
                    // The avatar, with room beside it.
                    const bool rtl = host->rightToLeft();
                    const Rect avatar = {rtl ? row.maxX() - 69.0 : row.x + 15.0, row.y + 10.0, 54.0, 54.0};
                    for (const auto& line : image->layout().lines()) {
                        const Rect box = line.box.offsetBy(place.x, place.y);
                        EXPECT_FALSE(box.intersects(avatar));
                        EXPECT_GE(line.box.x, 0.0);
                        EXPECT_LE(line.box.maxX(), image->size().width + 0.01);
                        EXPECT_LE(line.box.maxY(), image->size().height + 0.01);
                    }
                }
            }
        }
    }
}

TEST_F(LargeTextTest, Card_IsAsHighAsWhatItsControllerWantsOrAsItsRowsAre) {
    for (const char* name : {"dinner", "single", "fence-leaving"}) {
        open(name, ContentSizeCategory::AX3, 400.0);
        const double desired = card()->controller()->desiredHeightForWidth(376.0);
        const double rows = card()
                                ->controller()
                                ->view()
                                ->systemLayoutSizeFitting({376.0, 0.0}, platform::kRequiredPriority, 1.0)
                                .height;
        EXPECT_DOUBLE_EQ(card()->content()->frame().height, std::max(desired, rows)) << name;
        EXPECT_DOUBLE_EQ(card()->frame().height, host::measures::kLargeHeaderHeight + std::max(desired, rows)) << name;
    }
}

TEST_F(LargeTextTest, Card_UnfoldsWhenItsRowsHaveTheirImages) {
    host::HostSettings settings;
    settings.textSize = ContentSizeCategory::AX1;
    auto made = Host::make(settings, Host::Time::Virtual, KTR_PLUGIN_FILE);
    host = std::move(std::get<std::unique_ptr<Host>>(made));
    auto read = host::ScenarioReader({0.0}).readFile(KTR_SOURCE_DIR "/resources/scenarios/dinner.json");
    ASSERT_FALSE(host->addTurn(std::get<host::Scenario>(read)));
    host->layOut(400.0);
    EXPECT_EQ(card()->frame().height, host::measures::kLargeHeaderHeight);
    EXPECT_FALSE(card()->isOutdated());
    const auto time = std::dynamic_pointer_cast<platform::VirtualTime>(host->platform()->mainLoop);
    ASSERT_TRUE(time);
    time->runPosted();
    EXPECT_TRUE(card()->isOutdated()) << "the rows have their images";
    host->layOut(400.0);
    EXPECT_GT(card()->frame().height, host::measures::kLargeHeaderHeight + 300.0);
    EXPECT_FALSE(card()->isOutdated());
}

TEST_F(LargeTextTest, Card_WithoutImages_UnfoldsAfterAQuarterOfASecond) {
    host::HostSettings settings;
    settings.textSize = ContentSizeCategory::AX1;
    auto made = Host::make(settings, Host::Time::Virtual, KTR_PLUGIN_FILE);
    host = std::move(std::get<std::unique_ptr<Host>>(made));
    auto read = host::ScenarioReader({0.0}).readFile(KTR_SOURCE_DIR "/resources/scenarios/single.json");
    ASSERT_FALSE(host->addTurn(std::get<host::Scenario>(read)));
    host->layOut(400.0);
    EXPECT_EQ(card()->frame().height, host::measures::kLargeHeaderHeight);
    // Rows that wait on, whatever is rendered.
    const auto time = std::dynamic_pointer_cast<platform::VirtualTime>(host->platform()->mainLoop);
    for (const auto& view : texts()) {
        view->setImage(nullptr);
        view->awaitImage();
    }
    time->schedule(0.2, false, [this] {
        for (const auto& view : texts()) {
            view->awaitImage();
        }
    });
    time->advance(0.24);
    for (const auto& view : texts()) {
        view->awaitImage();
    }
    host->layOut(400.0);
    EXPECT_EQ(card()->frame().height, host::measures::kLargeHeaderHeight);
    time->advance(0.02);
    EXPECT_TRUE(card()->isOutdated());
    host->layOut(400.0);
    EXPECT_GT(card()->frame().height, host::measures::kLargeHeaderHeight + 219.0);
}

TEST_F(LargeTextTest, OwnRow_TellsNobody_AndItsCardIsOutdatedAllTheSame) {
    host::HostSettings settings;
    settings.textSize = ContentSizeCategory::AX2;
    auto made = Host::make(settings, Host::Time::Virtual, KTR_PLUGIN_FILE);
    host = std::move(std::get<std::unique_ptr<Host>>(made));
    auto read = host::ScenarioReader({0.0}).readFile(KTR_SOURCE_DIR "/resources/scenarios/sharing-visible.json");
    ASSERT_FALSE(host->addTurn(std::get<host::Scenario>(read)));
    host->layOut(400.0);
    const auto time = std::dynamic_pointer_cast<platform::VirtualTime>(host->platform()->mainLoop);
    time->runPosted();
    host->window()->layoutIfNeeded();
    EXPECT_TRUE(card()->isOutdated());
    host->layOut(400.0);
    EXPECT_FALSE(card()->isOutdated());
    EXPECT_GT(card()->frame().height, host::measures::kLargeHeaderHeight + 219.0 + 100.0);
}

TEST_F(LargeTextTest, OrdinaryText_IsNeverFolded) {
    open("dinner", ContentSizeCategory::XXXL, 400.0);
    EXPECT_TRUE(texts().empty());
    EXPECT_GT(card()->frame().height, 200.0);
}

}  // namespace ktr::test
