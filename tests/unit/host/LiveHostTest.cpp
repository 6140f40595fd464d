// A live conversation over a transport that records: what is asked for on the wire, and what stays of a card.
#include <gtest/gtest.h>

#include <QEventLoop>
#include <QImage>
#include <QPainter>
#include <QTemporaryDir>
#include <QTimer>
#include <algorithm>
#include <filesystem>
#include <fstream>
#include <mutex>

#include "host/Host.h"
#include "host/scenario/ScenarioReader.h"
#include "linux/configuration/ConfigurationReader.h"
#include "linux/paint/QtCanvas.h"
#include "tests/support/EnvironmentVariable.h"
#include "tests/support/RecordingLogSink.h"
#include "tests/support/ServiceDoubles.h"

namespace ktr::test {

namespace {

using host::Host;

/// The two timers of a card fire after a tenth of a second.
constexpr const char* kSharing = R"({"kind": "VAKtrVisibilityView", "visible": true, "searchContext":
    "ktrServerContext://serverContext?minCallbackIntervalInMS=100&callbackTimeoutIntervalInMS=60000&"})";
constexpr const char* kHidden = R"({"kind": "VAKtrVisibilityView", "visible": false, "searchContext":
    "ktrServerContext://serverContext?minCallbackIntervalInMS=100&callbackTimeoutIntervalInMS=60000&"})";
constexpr const char* kFriends = R"({"kind": "VAKtrLocationSnippet", "proximity": "here", "searchContext":
    "ktrServerContext://serverContext?minCallbackIntervalInMS=100&callbackTimeoutIntervalInMS=60000&",
    "locations": [{"friend": {"data": "ann@harbour.example", "object":
        {"fullName": "Ann Marsh", "emails": [{"emailAddress": "ann@harbour.example"}]}}}]})";

}  // namespace

class LiveHostTest : public ::testing::Test {
  protected:
    LiveHostTest() : state("XDG_STATE_HOME", folder.filePath(QStringLiteral("state")).toUtf8().constData()) {
        configure(R"({"account": {"personId": "1000", "host": "service.example"},
                      "positions": {"source": "none"}, "language": "en-GB"})");
        host::HostSettings settings;
        settings.liveConfiguration = file();
        settings.follow(std::get<linux_::Configuration>(linux_::ConfigurationReader::readFile(file())));
        settings.width = 400.0;
        auto made = Host::make(settings, Host::Time::Running, KTR_PLUGIN_FILE);
        EXPECT_TRUE(std::holds_alternative<std::unique_ptr<Host>>(made)) << std::get<host::Failure>(made).line;
        host = std::move(std::get<std::unique_ptr<Host>>(made));
        real = host->platform()->httpTransport;
        record();
        bool ready = false;
        host->live()->start([&] { ready = true; });
        EXPECT_TRUE(runUntil([&] { return ready; }));
    }

    std::filesystem::path file() const { return folder.filePath(QStringLiteral("config.json")).toStdString(); }
    /// Replaced as an editor does it, so that nobody reads half of it.
    void configure(const std::string& text) const {
        const std::string beside = file().string() + ".new";
        std::ofstream(beside) << text;
        std::filesystem::rename(beside, file());
    }
    /// What the plugin sends goes to the double from now on.
    void record() { host->platform()->httpTransport = transport; }
    static bool runUntil(const std::function<bool()>& done, int milliseconds = 20000) {
        QEventLoop loop;
        QTimer tick;
        QObject::connect(&tick, &QTimer::timeout, [&] {
            if (done()) {
                loop.quit();
            }
        });
        QTimer::singleShot(milliseconds, &loop, &QEventLoop::quit);
        tick.start(5);
        loop.exec();
        return done();
    }
    static void run(int milliseconds) {
        runUntil([] { return false; }, milliseconds);
    }
    std::shared_ptr<host::TurnView> add(const std::string& snippet) {
        const auto read = host::ScenarioReader({0.0}, host::ScenarioReader::Clock::Present)
                              .readText(R"({"sentence": "Done.", "snippet": )" + snippet + "}", "test");
        EXPECT_TRUE(std::holds_alternative<host::Scenario>(read)) << std::get<documents::DocumentError>(read).text();
        EXPECT_FALSE(host->addTurn(std::get<host::Scenario>(read)));
        host->layOut(400.0);
        return host->conversation()->turns().back();
    }
    std::size_t shown() const {
        return static_cast<std::size_t>(
            std::count_if(transport->requests.begin(), transport->requests.end(),
                          [](const auto& request) { return request.path.ends_with("/showHideLocation"); }));
    }
    std::string described() const {
        std::string words;
        collect(platform::accessibilityTree(host->window(), false), words);
        return words;
    }
    static void collect(const platform::AccessibilityNode& node, std::string& words) {
        words += node.text.empty() ? "" : node.text + "\n";
        for (const auto& child : node.children) {
            collect(child, words);
        }
    }

    QTemporaryDir folder;
    EnvironmentVariable state;
    std::shared_ptr<FakeHttpTransport> transport = std::make_shared<FakeHttpTransport>();
    std::unique_ptr<Host> host;
    /// What the plugin would send through.
    std::shared_ptr<platform::HttpTransport> real;
};

TEST_F(LiveHostTest, SharingCard_SendsOnItsTimers) {
    add(kSharing);
    EXPECT_TRUE(runUntil([&] { return shown() > 0; }));
}

TEST_F(LiveHostTest, WishThatIsSent_LeavesNothingOfTheSharingBefore) {
    const auto turn = add(kSharing);
    std::weak_ptr<platform::HostSnippetViewController> controller = turn->card()->controller();
    std::weak_ptr<platform::View> view = turn->card()->controller()->view();
    host->endSharing();
    EXPECT_TRUE(controller.expired());
    // Its avatar is assigned a tenth of a second after the row was filled, which keeps the row until then.
    run(500);
    EXPECT_EQ(shown(), 0U) << "neither timer of the earlier card";
    EXPECT_TRUE(view.expired());
}

// What a card had on its way, or still hands over, goes to nobody.
TEST_F(LiveHostTest, WishThatIsSent_ClosesTheWayOfWhatShowsTheUser) {
    const auto failureOfSharing = [this] {
        platform::HttpRequest request;
        request.path = "/qloxservice/friends/va/showHideLocation";
        std::optional<platform::HttpFailure> failure;
        std::mutex mutex;
        real->send(request, [&](const platform::HttpAnswer& answer) {
            const std::lock_guard<std::mutex> lock(mutex);
            failure = answer.failure;
        });
        runUntil([&] {
            const std::lock_guard<std::mutex> lock(mutex);
            return failure.has_value();
        });
        return failure;
    };
    add(kSharing);
    EXPECT_EQ(failureOfSharing(), platform::HttpFailure::BadRequest) << "it has no host, but is on its way";
    host->endSharing();
    EXPECT_EQ(failureOfSharing(), platform::HttpFailure::Cancelled);
}

TEST_F(LiveHostTest, NewerAnswerAboutSharing_EndsTheOneBefore) {
    add(kSharing);
    const auto newer = add(kHidden);
    EXPECT_NE(newer->card()->controller(), nullptr);
    run(500);
    EXPECT_EQ(shown(), 0U);
}

TEST_F(LiveHostTest, Still_KeepsPictureWordsAndAWayToOnesOwnPage) {
    const auto turn = add(kSharing);
    const auto height = turn->card()->content()->frame().height;
    ASSERT_GT(height, 200.0);
    const std::string words = described();
    host->endSharing();
    host->layOut(400.0);
    ASSERT_NE(turn->card()->still(), nullptr);
    EXPECT_EQ(turn->card()->content()->frame().height, height);
    EXPECT_NE(described().find("Friends can see where you are"), std::string::npos) << described();

    std::vector<std::string> opened;
    host->delegate().open = [&](const platform::Url& url) {
        opened.push_back(url.text());
        return true;
    };
    const auto tree = platform::accessibilityTree(turn->card(), false);
    std::function<void(const platform::AccessibilityNode&)> press = [&](const auto& node) {
        if (node.pressable) {
            EXPECT_TRUE(platform::accessibilityPress(node));
        }
        for (const auto& child : node.children) {
            press(child);
        }
    };
    press(tree);
    ASSERT_EQ(opened.size(), 2U) << "the row and the map";
    EXPECT_EQ(opened[0], opened[1]);
    EXPECT_EQ(opened[0].rfind("wayloc://friend/", 0), 0U) << opened[0];
}

// Whatever the desktop wished when its card went: it may wish for something else while the still is on screen.
TEST_F(LiveHostTest, Still_FollowsSchemeAndContrast) {
    const auto turn = add(kSharing);
    const auto look = [&](const platform::View& view, linux_::ColorScheme scheme, linux_::Contrast contrast) {
        QImage picture(400, 200, QImage::Format_RGB32);
        picture.fill(Qt::gray);
        QPainter painter(&picture);
        painter.setRenderHints(QPainter::Antialiasing | QPainter::TextAntialiasing | QPainter::SmoothPixmapTransform);
        linux_::QtCanvas canvas(painter, linux_::Palette::of(scheme, contrast));
        view.paint(canvas, {0.0, 0.0, 400.0, 200.0});
        return picture;
    };
    std::vector<QImage> looks;
    host->endSharing();
    host->layOut(400.0);
    const auto still = turn->card()->still();
    ASSERT_NE(still, nullptr);
    for (const auto scheme : {linux_::ColorScheme::Light, linux_::ColorScheme::Dark}) {
        for (const auto contrast : {linux_::Contrast::Normal, linux_::Contrast::High}) {
            looks.push_back(look(*still, scheme, contrast));
            EXPECT_EQ(std::count(looks.begin(), looks.end(), looks.back()), 1) << "each looks its own way";
        }
    }
    EXPECT_EQ(look(*still, linux_::ColorScheme::Light, linux_::Contrast::Normal), looks.front()) << "and back";
}

TEST_F(LiveHostTest, Still_GivesWayInANarrowConversation) {
    const auto turn = add(kSharing);
    const double height = turn->card()->content()->frame().height;
    host->endSharing();
    host->layOut(300.0);
    EXPECT_LT(turn->card()->content()->frame().height, height);
    host->layOut(900.0);
    EXPECT_EQ(turn->card()->content()->frame().height, height);
}

TEST_F(LiveHostTest, Remade_CardsAreOfTheLatestRecords) {
    const auto turn = add(kFriends);
    const auto before = turn->card()->controller();
    ASSERT_TRUE(runUntil([&] { return !transport->requests.empty(); }));
    transport->answer(
        {{"serverContext", platform::Dictionary{{"minCallbackIntervalInMS", 3600000}}},
         {"locations",
          platform::Dictionary{
              {"ann@harbour.example",
               platform::Dictionary{
                   {"location", platform::Dictionary{{"latitude", 50.2}, {"longitude", -3.1}, {"label", "Work"}}}}}}}});
    run(50);
    host->layOut(400.0);
    const std::string words = described();
    host::HostSettings settings = host->settings();
    settings.language = "de";
    bool isTold = false;
    host->setRemade([&] { isTold = true; });
    ASSERT_FALSE(host->remake(settings));
    EXPECT_TRUE(isTold);
    host->layOut(400.0);
    EXPECT_EQ(host->conversation()->turns().back(), turn);
    EXPECT_NE(turn->card()->controller(), before);
    EXPECT_EQ(turn->card()->still(), nullptr);
    EXPECT_NE(described(), words);
    EXPECT_NE(described().find("Freunde"), std::string::npos) << described();
    EXPECT_EQ(platform::Platform::installed(), host->platform());
}

TEST_F(LiveHostTest, Remade_SharingBecomesAStill) {
    const auto turn = add(kSharing);
    ASSERT_FALSE(host->remake(host->settings()));
    record();
    EXPECT_EQ(turn->card()->controller(), nullptr);
    EXPECT_NE(turn->card()->still(), nullptr);
    run(300);
    EXPECT_EQ(shown(), 0U);
}

TEST_F(LiveHostTest, ChangedAccount_CountsFromThenOn) {
    add(kFriends);
    ASSERT_TRUE(runUntil([&] { return !transport->requests.empty(); }));
    EXPECT_EQ(transport->requests.back().host, "service.example");
    bool isRemade = false;
    host->setRemade([&] {
        isRemade = true;
        record();
    });
    configure(R"({"account": {"personId": "2000", "host": "other.example"}, "positions": {"source": "none"},
                  "language": "en-GB"})");
    ASSERT_TRUE(runUntil([&] { return isRemade; }));
    transport->requests.clear();
    ASSERT_TRUE(runUntil([&] { return !transport->requests.empty(); }));
    EXPECT_EQ(transport->requests.back().host, "other.example");
}

TEST_F(LiveHostTest, ChangedToken_CountsFromThenOn) {
    add(kFriends);
    bool isRemade = false;
    host->setRemade([&] {
        isRemade = true;
        record();
    });
    const std::string token = (file().parent_path() / "token").string();
    std::ofstream(token + ".new") << "secret\n";
    std::filesystem::permissions(token + ".new", std::filesystem::perms::owner_read);
    std::filesystem::rename(token + ".new", token);
    ASSERT_TRUE(runUntil([&] { return isRemade; }));
    transport->requests.clear();
    ASSERT_TRUE(runUntil([&] { return !transport->requests.empty(); }));
    EXPECT_TRUE(transport->requests.back().headers.value("Authorization"));
}

TEST_F(LiveHostTest, ChangedLanguage_IsSpoken) {
    add(kFriends);
    bool isRemade = false;
    host->setRemade([&] { isRemade = true; });
    configure(R"({"account": {"personId": "1000", "host": "service.example"}, "positions": {"source": "none"},
                  "language": "de"})");
    ASSERT_TRUE(runUntil([&] { return isRemade; }));
    EXPECT_EQ(host->settings().language, "de");
    host->layOut(400.0);
    EXPECT_NE(described().find("Freunde"), std::string::npos) << described();
}

TEST_F(LiveHostTest, ChangedContacts_AreReadAgain) {
    const auto nameOfAnn = [this]() -> std::string {
        const auto found =
            host->platform()->contactStore->unifiedContactsMatchingEmailAddress("ann@harbour.example", {}).result;
        return found.empty() ? "" : found.front()->givenName;
    };
    const auto write = [this](const std::string& name) {
        std::ofstream(folder.filePath(QStringLiteral("cards.vcf")).toStdString())
            << "BEGIN:VCARD\r\nVERSION:3.0\r\nFN:" << name << " Marsh\r\nN:Marsh;" << name
            << ";;;\r\nEMAIL:ann@harbour.example\r\nEND:VCARD\r\n";
    };
    EXPECT_EQ(nameOfAnn(), "");
    write("Ann");
    const auto turn = add(kFriends);
    int remakes = 0;
    host->setRemade([&] { ++remakes; });
    configure(R"({"account": {"personId": "1000", "host": "service.example"}, "positions": {"source": "none"},
                  "language": "en-GB", "contacts": ["cards.vcf"]})");
    ASSERT_TRUE(runUntil([&] { return nameOfAnn() == "Ann"; }));
    EXPECT_EQ(remakes, 1) << "for another list of contacts the cards are made anew once";
    const auto before = turn->card()->controller();
    write("Anna");
    ASSERT_TRUE(runUntil([&] { return nameOfAnn() == "Anna"; }));
    EXPECT_NE(turn->card()->controller(), before);
}

TEST_F(LiveHostTest, AnswerThatThePluginDoesNotDraw_IsSaid) {
    const auto log = std::make_shared<RecordingLogSink>();
    host->platform()->logSink = log;
    const auto turn = host->addQuestion("Who am I?");
    const auto read = host::ScenarioReader({0.0}, host::ScenarioReader::Clock::Present)
                          .readText(R"({"sentence": "You.", "snippet": {"kind": "VAMirror"}})", "test");
    host->answer(*turn, std::get<host::Scenario>(read));
    EXPECT_NE(described().find("You."), std::string::npos);
    EXPECT_EQ(log->texts(platform::LogLevel::Error),
              std::vector<std::string>{"the plugin draws no such answer: a VAMirror"});
}

TEST_F(LiveHostTest, Restricted_MakesNoCardAndSaysSo) {
    const auto turn = add(kFriends);
    bool isRemade = false;
    host->setRemade([&] {
        isRemade = true;
        record();
    });
    configure(R"({"account": {"personId": "1000", "host": "service.example"}, "positions": {"source": "none"},
                  "language": "en-GB", "restrictions": {"friendLocationRestricted": true}})");
    ASSERT_TRUE(runUntil([&] { return isRemade; }));
    transport->requests.clear();
    EXPECT_TRUE(host->isRestricted());
    EXPECT_EQ(turn->card()->controller(), nullptr);
    EXPECT_TRUE(turn->card()->hidden());
    EXPECT_EQ(add(kFriends)->card()->controller(), nullptr);
    EXPECT_NE(described().find("Friends’ locations are switched off on this device."), std::string::npos)
        << described();
    run(300);
    EXPECT_TRUE(transport->requests.empty());
}

TEST_F(LiveHostTest, CardScrolledAway_AsksOnceMoreWhenItIsBackAndRests) {
    const auto earlier = add(kFriends);
    const auto newest = add(kFriends);
    const auto asked = [this] { return transport->requests.size(); };
    ASSERT_TRUE(runUntil([&] { return asked() == 4; })) << "each card starts twice";
    host->tellWhatIsSeen([&](const host::TurnView& turn) { return &turn == newest.get(); });
    EXPECT_FALSE(earlier->card()->isOnScreen());
    const auto answer = [this] {
        const platform::Dictionary context{{"minCallbackIntervalInMS", 100}};
        transport->answer(platform::Dictionary{{"locations", platform::Dictionary{}}, {"serverContext", context}});
    };
    answer();
    answer();
    run(400);
    EXPECT_EQ(asked(), 4U) << "away: what comes is shown, and nothing more is asked";
    host->tellWhatIsSeen([](const host::TurnView&) { return true; });
    host->tellWhatIsSeen([](const host::TurnView&) { return true; });
    EXPECT_TRUE(runUntil([&] { return asked() == 5; })) << "back: once more";
    run(400);
    EXPECT_EQ(asked(), 5U);
}

TEST_F(LiveHostTest, NewestCard_LivesOnWhereverItStands) {
    add(kFriends);
    const auto newest = add(kFriends);
    host->tellWhatIsSeen([](const host::TurnView&) { return false; });
    EXPECT_TRUE(newest->card()->isOnScreen());
    EXPECT_FALSE(host->conversation()->turns().front()->card()->isOnScreen());
}

TEST_F(LiveHostTest, SharingCard_NeverAppearsTwice) {
    const auto sharing = add(kSharing);
    EXPECT_TRUE(runUntil([&] { return shown() > 0; }));
    add(kFriends);
    host->tellWhatIsSeen([](const host::TurnView&) { return false; });
    EXPECT_FALSE(sharing->card()->isOnScreen());
    run(300);
    const std::size_t before = shown();
    host->tellWhatIsSeen([](const host::TurnView&) { return true; });
    EXPECT_FALSE(sharing->card()->isOnScreen());
    run(400);
    EXPECT_EQ(shown(), before) << "it would share again";
}

// The whole way that the plugin's commands take: nothing leaves while nobody sees, but for one's friends' newest
// question.
TEST_F(LiveHostTest, UnseenConversation_HoldsWhatItsCardsAsk) {
    host->platform()->httpTransport = real;
    const auto answered = [this] { return host->live()->service().notes().failures; };
    host->live()->setSeen(false);
    add(kFriends);
    run(500);
    EXPECT_EQ(answered(), 0);
    EXPECT_EQ(host->live()->service().notes().underWay, 0);
    host->live()->setSeen(true);
    EXPECT_EQ(host->live()->service().notes().underWay, 1) << "one request for both starts";
}

}  // namespace ktr::test
