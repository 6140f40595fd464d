#include <cstddef>
#include <cstdint>
#include <string_view>

#include "documents/JsonReader.h"
#include "platform/base/Utf8.h"
#include "plugin/VAKTRMultipleLocationsSnippetController.h"
#include "plugin/VAKTRVisibilityController.h"
#include "service/GetLocationsCmd.h"
#include "service/KTRVAUtils.h"
#include "service/ShowHideLocationCmd.h"
#include "tests/fuzz/DictionaryMaker.h"
#include "tests/fuzz/Require.h"
#include "tests/support/FakeHost.h"
#include "tests/support/Friends.h"
#include "tests/support/PlatformTest.h"

// Anything as the service's answer, on its way to the rows: a body of any bytes when the first byte is even, else an
// object of any shape. The next six bits choose the way: a whole snippet costs twenty times what a command does, so
// that one answer in 64 goes each of the two ways through one.

namespace {

using namespace ktr;
using ktr::fuzz::require;
using platform::Value;

/// A platform of doubles outside any test.
class World : public test::PlatformTest {
  public:
    World() = default;
    void TestBody() override {}
};

platform::HttpAnswer answerOf(const std::uint8_t* data, std::size_t size) {
    platform::HttpAnswer answer;
    answer.status = 200;
    if (size == 0) {
        return answer;
    }
    if (data[0] % 2 == 1) {
        answer.json = Value(fuzz::DictionaryMaker(data + 1, size - 1).answer());
        return answer;
    }
    auto read = ktr::documents::JsonReader::read({reinterpret_cast<const char*>(data + 1), size - 1});
    if (auto* value = std::get_if<Value>(&read)) {
        answer.json = std::move(*value);
    }
    return answer;
}

/// The command by itself.
void checkCommand(World& world, const platform::HttpAnswer& answer) {
    const auto command = platform::create<GetLocationsCmd>(&GetLocationsCmd::init);
    command->setFriends(GetLocationsCmd::Persons{
        std::dynamic_pointer_cast<platform::VAPerson>(test::friendByEmail("Ann", "ann@example.org")->friend_->object),
        std::dynamic_pointer_cast<platform::VAPerson>(test::friendByPhone("Bob", "020 7946 0018")->friend_->object)});
    platform::KTServerInteractionController().sendCommand(command, nullptr);
    world.transport->answer(answer);
    world.time->runPosted();
    const bool isObject = answer.json && answer.json->dictionary() != nullptr;
    require(command->wasSuccessful() == isObject, "an object is what success is");
    const auto result = command->result();
    require(result.has_value() == isObject, "an object has a result");
    for (const ResultItem& item : result.value_or(ServiceResult())) {
        const auto* location = std::get_if<std::shared_ptr<platform::VAKtrLocation>>(&item);
        require(location != nullptr && *location != nullptr, "a result is friends");
        (*location)->description();
    }
    const double interval = command->minCallbackInterval();
    require(interval - interval == 0.0, "an interval is a number");
    if (const auto& url = command->contextIdentifierURL()) {
        require(!KTRVAUtils::contextDictionaryForURL(*url).contains("authToken"), "no secret goes into the context");
    }
}

/// The same answer in a snippet that is on screen.
void checkSnippet(World& world, const platform::HttpAnswer& answer) {
    using Controller = VAKTRMultipleLocationsSnippetController;
    constexpr double kPollInterval = 5.0;
    const auto host = std::make_shared<test::FakeHost>();
    const auto controller = platform::create<Controller>(
        &Controller::initWithCueObject,
        test::proximitySnippet(
            {test::friendByEmail("Ann", "ann@example.org"), test::friendByPhone("Bob", "020 7946 0018")},
            "clientId=c-1&minCallbackIntervalInMS=5000&callbackTimeoutIntervalInMS=60000&"));
    controller->setDelegate(host);
    controller->desiredHeightForWidth(375.0);
    world.time->advance(kPollInterval);
    require(world.transport->waiting.size() == 1, "the snippet asks");
    world.transport->answer(answer);
    world.time->runPosted();
    for (const auto& record : controller->locations()) {
        record->friendName();
        record->friendLocation(true);
        record->distanceFromLocation(world.position(51.0, -1.0));
    }
    const double height = controller->desiredHeightForWidth(375.0);
    require(height > 0.0 && height < 1e6, "a height is a height");
    controller->viewWillDisappear(false);
}

/// The answer to a command about the user's own sharing, by itself and on screen.
void checkSharing(World& world, const platform::HttpAnswer& answer) {
    const auto command = platform::create<ShowHideLocationCmd>(&ShowHideLocationCmd::init);
    command->setCurrentLocation(world.position(51.0, -1.0));
    platform::KTServerInteractionController().sendCommand(command, nullptr);
    world.transport->answer(answer);
    world.time->runPosted();
    const bool isObject = answer.json && answer.json->dictionary() != nullptr;
    const auto result = command->result();
    require(result.has_value() && result->size() == (isObject ? 2U : 0U), "an answer and a record, or nothing");
    if (const auto& url = command->contextIdentifierURL()) {
        require(!KTRVAUtils::contextDictionaryForURL(*url).contains("authToken"), "no secret goes into the context");
    }

    using Controller = VAKTRVisibilityController;
    constexpr double kPollInterval = 5.0;
    const auto snippet = std::make_shared<platform::VAKtrVisibilityView>();
    snippet->visible = true;
    snippet->searchContext = platform::Url(
        "ktrServerContext://serverContext?minCallbackIntervalInMS=5000&callbackTimeoutIntervalInMS=60000&");
    const auto controller = platform::create<Controller>(&Controller::initWithCueObject, snippet);
    const auto host = std::make_shared<test::FakeHost>();
    controller->setDelegate(host);
    controller->desiredHeightForWidth(375.0);
    world.time->advance(kPollInterval);
    require(world.transport->waiting.size() == 1, "the user's place is told");
    world.transport->answer(answer);
    world.time->runPosted();
    require((controller->myLocation() != nullptr) == (isObject || host->heightChanges.empty()), "the newest record");
    require(controller->friends().size() <= 1, "the user alone");
    const double height = controller->desiredHeightForWidth(375.0);
    require(height > 0.0 && height < 1e6, "a height is a height");
    controller->viewWillDisappear(false);
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    const platform::HttpAnswer answer = answerOf(data, size);
    World world;
    switch (size == 0 ? 0 : data[0] >> 1 & 63) {
        case 0:
            checkSnippet(world, answer);
            break;
        case 1:
            checkSharing(world, answer);
            break;
        default:
            checkCommand(world, answer);
    }
    return 0;
}
