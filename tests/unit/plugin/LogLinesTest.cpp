#include <functional>

#include "model/ContactsUtilities.h"
#include "plugin/KTRSnippetControllerFactory.h"
#include "plugin/VAKTRMultipleLocationsSnippetController.h"
#include "tests/support/FakeHost.h"
#include "tests/support/Friends.h"
#include "tests/support/PlatformTest.h"
#include "views/accessibility/KTRAXVelaFriendView.h"

namespace ktr {

using namespace platform;
using test::placedFriend;
using test::proximitySnippet;

namespace {

std::shared_ptr<VAKTRMultipleLocationsSnippetController> makeController() {
    return create<VAKTRMultipleLocationsSnippetController>(
        &VAKTRMultipleLocationsSnippetController::initWithCueObject,
        proximitySnippet({placedFriend("Ann", "ann@example.org")}, "incomplete=1&"));
}

void openWithHostThatCannot() {
    const auto host = std::make_shared<test::FakeHost>();
    host->opens = false;
    const auto controller = makeController();
    controller->setDelegate(host);
    controller->openURL(Url("wayloc://friends/"));
}

std::shared_ptr<KTRVelaFriendView> friendRow() {
    auto row = create<KTRVelaFriendView>(&KTRVelaFriendView::initWithFrame, Rect{});
    row->setLocation(KTRVALocation::locationWithVelaLocation(placedFriend("Ann", "ann@example.org")));
    return row;
}

void fillRowWithDistance() {
    const auto host = std::make_shared<test::FakeHost>();
    const auto controller = makeController();
    controller->setDelegate(host);
    controller->desiredHeightForWidth(320.0);
}

std::shared_ptr<KTRAXVelaFriendView> largeRow() {
    std::dynamic_pointer_cast<test::FakeDevice>(Platform::installed()->device)->category = ContentSizeCategory::AX1;
    auto row = create<KTRAXVelaFriendView>(&KTRAXVelaFriendView::initWithFrame, Rect{0.0, 0.0, 320.0, 0.0});
    row->updateView();
    std::dynamic_pointer_cast<VirtualTime>(Platform::installed()->mainLoop)->runPosted();
    return row;
}

struct LineCase {
    const char* name;
    LogLevel level;
    const char* format;
    const char* text;
    std::function<void()> provoke;
};

}  // namespace

/// Each line of the rows and controllers, with its level, format and arguments.
class LogLinesTest : public test::PlatformTest, public ::testing::WithParamInterface<LineCase> {};

TEST_P(LogLinesTest, IsWritten) {
    const LineCase& expected = GetParam();
    if (expected.level == LogLevel::Error) {
        expectErrorLine(expected.text);
    }
    locationManagers->cached = position(51.001, -1.0);
    expected.provoke();
    int found = 0;
    for (const auto& line : log->lines()) {
        if (line.format == expected.format) {
            ++found;
            EXPECT_EQ(line.level, expected.level);
            EXPECT_EQ(line.text, expected.text);
            EXPECT_EQ(line.subsystem, "org.ktr.snippets");
            EXPECT_EQ(line.category, "_");
        }
    }
    EXPECT_EQ(found, 1);
}

INSTANTIATE_TEST_SUITE_P(
    Plugin, LogLinesTest,
    ::testing::Values(
        LineCase{"Unrecognized", LogLevel::Default, "Unrecognized snippet CueObject passed to %@: %@",
                 "Unrecognized snippet CueObject passed to KTRSnippetControllerFactory: (null)",
                 [] { KTRSnippetControllerFactory().viewControllerForSnippet(nullptr); }},
        LineCase{"Snippet", LogLevel::Default, "snippet: %@", "snippet: (null)",
                 [] { create<VAKTRBaseSnippetController>(&VAKTRBaseSnippetController::initWithCueObject, nullptr); }},
        LineCase{"SearchContext", LogLevel::Default, "searchContext: %@",
                 "searchContext: ktrServerContext://serverContext?incomplete=1&", [] { makeController(); }},
        LineCase{"UnableToOpen", LogLevel::Error, "Unable to open url: %@", "Unable to open url: wayloc://friends/",
                 openWithHostThatCannot},
        LineCase{"OpeningUrl", LogLevel::Default, "Opening URL: %@", "Opening URL: wayloc://friend/ann@example.org",
                 [] { friendRow()->viewTouched(); }},
        LineCase{"OpeningUrlForHandle", LogLevel::Default, "Opening URL: %@ for friend handle: %@",
                 "Opening URL: wayloc://friend/ann@example.org for friend handle: ann@example.org",
                 [] { friendRow()->urlForTouch(); }},
        LineCase{"Distance", LogLevel::Debug, "Distance calculated: %@ for friend: %@ (Unit:%li)",
                 "Distance calculated: 111 m for friend: Ann (Unit:0)", fillRowWithDistance},
        LineCase{"PersonFound", LogLevel::Debug, "VAPerson found: %@", "VAPerson found: <VAPerson (null)>",
                 [] { KTRVALocation::locationWithHandle("ann@example.org", nullptr, std::nullopt); }},
        LineCase{"ContactNotFound", LogLevel::Error, "Could not find contact for assistant ID %@ : %@",
                 "Could not find contact for assistant ID assistant:nobody : no contact with this identifier",
                 [] { ContactsUtilities::contactForAssistantId("assistant:nobody"); }},
        LineCase{"GeneratingImage", LogLevel::Debug, "Generating image for AX view.", "Generating image for AX view.",
                 [] { largeRow(); }},
        LineCase{"ImageGenerated", LogLevel::Debug, "Image generated - %i", "Image generated - 1", [] { largeRow(); }},
        LineCase{"EstimatedHeight", LogLevel::Debug, "Calculating estimated height", "Calculating estimated height",
                 [] { largeRow()->estimagedHeightForView(); }}),
    [](const auto& tested) { return std::string(tested.param.name); });

}  // namespace ktr
