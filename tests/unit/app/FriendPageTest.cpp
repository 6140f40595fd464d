#include "app/window/friend/FriendPage.h"

#include <QApplication>
#include <QClipboard>
#include <QDeadlineTimer>
#include <QKeyEvent>
#include <QMouseEvent>
#include <QPointingDevice>
#include <QTouchEvent>
#include <QWheelEvent>
#include <algorithm>
#include <iterator>
#include <memory>
#include <mutex>

#include "app/window/ConversationWindow.h"
#include "app/window/friend/FriendsPage.h"
#include "app/window/friend/SelfPage.h"
#include "platform/map/MapsApplication.h"
#include "platform/map/Mercator.h"
#include "tests/unit/app/TestHost.h"

#include <gtest/gtest.h>

namespace ktr::app {

namespace {

using host::LinkPolicy;

/// A window on demo scenarios with the real plugin; the desktop opens nothing, or everything.
class FriendPageTest : public ::testing::Test {
  public:
    void open(const std::vector<std::string>& names, const std::string& language = "en-GB", int width = 400,
              int height = 700, bool isDark = false,
              platform::ContentSizeCategory textSize = platform::ContentSizeCategory::L) {
        host::HostOptions options;
        options.dark = isDark;
        options.textSize = textSize;
        options.language = language;
        host = testHost(options, demoScenarios(names), host::Host::Time::Running);
        ASSERT_TRUE(host);
        desktop = std::make_unique<linux_::DesktopOpener>(QString(), [log = log](const std::string& url) {
            const std::lock_guard lock(log->mutex);
            log->opened.push_back(url);
            return log->opens;
        });
        window = std::make_unique<ConversationWindow>(*host);
        window->openLinks(*desktop);
        window->pages().setMotion(host::MotionStyle::None);
        window->resize(width, height);
        window->show();
        settle();
    }
    void TearDown() override {
        window.reset();
        desktop.reset();
        host.reset();
    }
    static void settle() {
        for (int i = 0; i < 5; ++i) {
            QApplication::processEvents();
        }
    }
    static bool eventually(const std::function<bool()>& condition) {
        const QDeadlineTimer deadline(10000);
        while (!condition() && !deadline.hasExpired()) {
            QApplication::processEvents(QEventLoop::AllEvents | QEventLoop::WaitForMoreEvents, 20);
        }
        return condition();
    }
    FriendPage* page() const { return dynamic_cast<FriendPage*>(window->pages().current()); }
    static platform::Coordinate middleOf(const FriendPage& page) {
        return page.map().shown().coordinateAt({200.0, 200.0});
    }
    void mouse(QEvent::Type type, QPointF at) const {
        QWidget* map = &page()->map();
        const bool move = type == QEvent::MouseMove;
        QMouseEvent event(type, at, map->mapToGlobal(at), move ? Qt::NoButton : Qt::LeftButton,
                          type == QEvent::MouseButtonRelease ? Qt::NoButton : Qt::LeftButton, Qt::NoModifier);
        QApplication::sendEvent(map, &event);
    }
    void touch(QEvent::Type type, const std::vector<QPointF>& at) {
        QWidget* map = &page()->map();
        const auto state = type == QEvent::TouchBegin    ? QEventPoint::Pressed
                           : type == QEvent::TouchUpdate ? QEventPoint::Updated
                                                         : QEventPoint::Released;
        QList<QEventPoint> points;
        for (std::size_t i = 0; i < at.size(); ++i) {
            points.append(QEventPoint(static_cast<int>(i), state, at[i], map->mapToGlobal(at[i])));
        }
        QTouchEvent event(type, &finger, Qt::NoModifier, points);
        QApplication::sendEvent(map, &event);
    }

    QPointingDevice finger{QStringLiteral("finger"),
                           1,
                           QInputDevice::DeviceType::TouchScreen,
                           QPointingDevice::PointerType::Finger,
                           QInputDevice::Capability::Position,
                           2,
                           0};
    std::unique_ptr<host::Host> host;
    std::unique_ptr<linux_::DesktopOpener> desktop;
    std::unique_ptr<ConversationWindow> window;
    /// What the desktop was asked to open, on threads of its own that may outlive a test.
    struct Log {
        std::mutex mutex;
        std::vector<std::string> opened;
        bool opens = true;
    };
    std::vector<std::string> opened() const {
        const std::lock_guard lock(log->mutex);
        std::vector<std::string> all = log->opened;
        std::sort(all.begin(), all.end());
        return all;
    }
    void setDesktopOpens(bool opens) const {
        const std::lock_guard lock(log->mutex);
        log->opens = opens;
    }
    std::shared_ptr<Log> log = std::make_shared<Log>();
};

TEST_F(FriendPageTest, ATapOnARowOpensItsFriend_WithThePluginsOwnRow) {
    open({"dinner"});
    EXPECT_TRUE(host->delegate().open(platform::Url("wayloc://friend/ann@harbour.example")));
    ASSERT_NE(page(), nullptr);
    EXPECT_EQ(page()->name(), QStringLiteral("Ann Marsh"));
    EXPECT_TRUE(page()->sheet().hasPlace());
    settle();
    EXPECT_NE(page()->sheet().row().accessibleName().indexOf(QStringLiteral("Ann Marsh")), -1);
    // One row: neither a second friend nor "Show all friends", which leads to where the user comes from.
    EXPECT_NEAR(page()->sheet().row().shapeHeight(376), 78, 1);
    ASSERT_TRUE(page()->map().place());
    const auto tip = page()->map().shown().pointFor(page()->map().place()->coordinate);
    EXPECT_NEAR(tip.x, 200.0, 1.0);
    EXPECT_GT(tip.y, 100.0);
    EXPECT_LT(tip.y, page()->sheet().geometry().top());
    EXPECT_TRUE(opened().empty());
}

TEST_F(FriendPageTest, TheWayBackLeadsToTheConversation) {
    open({"dinner"});
    host->delegate().open(platform::Url("wayloc://friend/ann@harbour.example"));
    ASSERT_TRUE(window->pages().isOpen());
    page()->back().press();
    EXPECT_FALSE(window->pages().isOpen());
    host->delegate().open(platform::Url("wayloc://friend/ann@harbour.example"));
    QKeyEvent escape(QEvent::KeyPress, Qt::Key_Escape, Qt::NoModifier);
    QApplication::sendEvent(&page()->map(), &escape);
    EXPECT_FALSE(window->pages().isOpen());
}

TEST_F(FriendPageTest, MouseWheelKeysAndButtonsMoveTheMap_AndShowBringsItBack) {
    open({"single"});
    host->delegate().open(platform::Url("wayloc://friend/ann@harbour.example"));
    ASSERT_NE(page(), nullptr);
    FriendMap& map = page()->map();
    const auto start = map.shown();
    EXPECT_FALSE(map.isTouched());
    mouse(QEvent::MouseButtonPress, {150.0, 150.0});
    mouse(QEvent::MouseMove, {190.0, 130.0});
    EXPECT_NEAR(start.pointFor(map.shown().centre).x, start.size.width / 2.0 - 40.0, 1e-6);
    EXPECT_NEAR(start.pointFor(map.shown().centre).y, start.size.height / 2.0 + 20.0, 1e-6);
    EXPECT_TRUE(map.isTouched());
    EXPECT_TRUE(page()->showAgain().isVisible());
    mouse(QEvent::MouseButtonRelease, {190.0, 130.0});
    const QPointF at(120.0, 90.0);
    const auto there = map.shown().coordinateAt({at.x(), at.y()});
    QWheelEvent wheel(at, map.mapToGlobal(at), {}, {0, 240}, Qt::NoButton, Qt::NoModifier, Qt::NoScrollPhase, false);
    QApplication::sendEvent(&map, &wheel);
    EXPECT_NEAR(map.shown().zoom, start.zoom + 1.0, 1e-9);
    EXPECT_NEAR(map.shown().pointFor(there).x, at.x(), 1e-6);
    const auto before = map.shown();
    QKeyEvent right(QEvent::KeyPress, Qt::Key_Right, Qt::NoModifier);
    QApplication::sendEvent(&map, &right);
    EXPECT_NEAR(before.pointFor(map.shown().centre).x, before.size.width / 2.0 + 60.0, 1e-6);
    map.setColors(linux_::Palette::of(linux_::ColorScheme::Light), true);
    map.step(false);
    ASSERT_TRUE(eventually([&] { return map.shown().zoom < before.zoom - 0.99; }));
    page()->showAgain().press();
    ASSERT_TRUE(eventually([&] { return map.shown() == start; }));
    EXPECT_FALSE(page()->showAgain().isVisible());
}

/// What a frame costs, without a clock: one painting of the map, and nothing laid out, asked or said.
TEST_F(FriendPageTest, ADraggedAndAZoomedFrame_PaintsTheMapOnce_AndLaysNothingOut) {
    open({"single"});
    host->delegate().open(platform::Url("wayloc://friend/ann@harbour.example"));
    ASSERT_TRUE(eventually([&] { return page()->sheet().row().controller()->view() != nullptr; }));
    FriendMap& map = page()->map();
    class Counts : public QObject {
      public:
        bool eventFilter(QObject* object, QEvent* event) override {
            paintings += object == map && event->type() == QEvent::Paint ? 1 : 0;
            const bool isLayout = event->type() == QEvent::LayoutRequest || event->type() == QEvent::Resize ||
                                  event->type() == QEvent::Move;
            layouts += isLayout ? 1 : 0;
            return false;
        }
        QObject* map = nullptr;
        int paintings = 0;
        int layouts = 0;
    } counts;
    counts.map = &map;
    mouse(QEvent::MouseButtonPress, {150.0, 150.0});
    // With the first frame the way back to the pin appears.
    mouse(QEvent::MouseMove, {152.0, 150.0});
    settle();
    qApp->installEventFilter(&counts);
    constexpr int kFrames = 30;
    for (int frame = 1; frame <= kFrames; ++frame) {
        const int before = counts.paintings;
        mouse(QEvent::MouseMove, {152.0 + 3.0 * frame, 150.0 + frame});
        ASSERT_TRUE(eventually([&] { return counts.paintings > before; })) << frame;
    }
    for (int frame = 0; frame < kFrames; ++frame) {
        const int before = counts.paintings;
        const QPointF at(120.0, 90.0);
        QWheelEvent wheel(at, map.mapToGlobal(at), {}, {0, frame % 20 < 10 ? 20 : -20}, Qt::NoButton, Qt::NoModifier,
                          Qt::NoScrollPhase, false);
        QApplication::sendEvent(&map, &wheel);
        ASSERT_TRUE(eventually([&] { return counts.paintings > before; })) << frame;
    }
    qApp->removeEventFilter(&counts);
    // A picture that comes from the workers meanwhile is a painting of its own: far fewer than frames.
    EXPECT_LE(counts.paintings, 2 * kFrames + kFrames / 2);
    EXPECT_EQ(counts.layouts, 0);
}

TEST_F(FriendPageTest, TwoFingersMakeTheMapLarger_AroundWhereTheyAre) {
    open({"single"});
    host->delegate().open(platform::Url("wayloc://friend/ann@harbour.example"));
    FriendMap& map = page()->map();
    const auto start = map.shown();
    const auto there = start.coordinateAt({150.0, 150.0});
    touch(QEvent::TouchBegin, {{100.0, 150.0}, {200.0, 150.0}});
    touch(QEvent::TouchUpdate, {{50.0, 150.0}, {250.0, 150.0}});
    EXPECT_NEAR(map.shown().zoom, start.zoom + 1.0, 1e-9);
    EXPECT_NEAR(map.shown().pointFor(there).x, 150.0, 1e-6);
    EXPECT_NEAR(map.shown().pointFor(there).y, 150.0, 1e-6);
    touch(QEvent::TouchEnd, {{50.0, 150.0}, {250.0, 150.0}});
    EXPECT_TRUE(map.isTouched());
}

TEST_F(FriendPageTest, CallWriteMapsAndCopy_AreMadeOfTheContactAndThePlace) {
    open({"single"});
    host->delegate().open(platform::Url("wayloc://friend/ann@harbour.example"));
    auto& sheet = page()->sheet();
    std::vector<QString> names;
    for (std::size_t i = 0; sheet.action(i) != nullptr; ++i) {
        names.push_back(sheet.action(i)->accessibleName());
        sheet.action(i)->press();
    }
    ASSERT_TRUE(eventually([&] { return opened().size() >= names.size() - 1; }));
    const auto urls = opened();
    ASSERT_GE(urls.size(), 2u);
    EXPECT_TRUE(urls[0].starts_with("geo:50.2")) << urls[0];
    EXPECT_EQ(urls[1], "mailto:ann@harbour.example");
    const QString copied = QApplication::clipboard()->text();
    EXPECT_NE(copied.indexOf(QStringLiteral("50.2")), -1) << copied.toStdString();
    EXPECT_EQ(sheet.action(names.size() - 1)->accessibleName(), QStringLiteral("Copied"));
}

TEST_F(FriendPageTest, WhereNobodyOpensAPlaceTheWindowSaysSo) {
    open({"single"});
    setDesktopOpens(false);
    host->delegate().open(platform::Url("wayloc://friend/ann@harbour.example"));
    window->open("https://brin.example/", LinkPolicy::From::Outside);
    ASSERT_TRUE(eventually([&] { return !window->notice().sentence().isEmpty(); }));
    EXPECT_EQ(window->notice().sentence(), QStringLiteral("No program on this computer opens links."));
}

TEST_F(FriendPageTest, NothingElseIsOpened_AndThatIsSaid) {
    open({"single"});
    EXPECT_FALSE(host->delegate().open(platform::Url("tel:+441632960018")));
    window->open("file:///etc/passwd", LinkPolicy::From::Outside);
    settle();
    EXPECT_TRUE(opened().empty());
    EXPECT_FALSE(window->pages().isOpen());
    EXPECT_EQ(window->notice().sentence(), QStringLiteral("This link isn’t opened here."));
}

TEST_F(FriendPageTest, APlaceThatAPluginOpensInMaps_GoesTheWayOfItsLinks_AlsoOnceThePlatformIsAnother) {
    open({"dinner"});
    const auto refused = QStringLiteral("This link isn’t opened here.");
    ASSERT_NE(host->platform()->mapsApplication, nullptr);
    EXPECT_FALSE(host->platform()->mapsApplication->open({{50.2104, -3.12}, "Ann"}));
    EXPECT_EQ(window->notice().sentence(), refused);
    host::HostSettings settings = host->settings();
    settings.language = "de";
    ASSERT_FALSE(host->remake(settings));
    ASSERT_NE(host->platform()->mapsApplication, nullptr);
    EXPECT_FALSE(host->platform()->mapsApplication->open({{50.2104, -3.12}, "Ann"}));
    EXPECT_NE(window->notice().sentence(), refused) << "the same in German";
    settle();
    EXPECT_TRUE(opened().empty());
}

TEST_F(FriendPageTest, ALinkFromOutside_ShowsAContactAndAsksOnlyOnATap) {
    open({"dinner"});
    window->open("wayloc://friend/ann@harbour.example", LinkPolicy::From::Outside);
    ASSERT_NE(page(), nullptr);
    EXPECT_EQ(page()->name(), QStringLiteral("Ann Marsh"));
    // No controller: nobody asks the service.
    EXPECT_EQ(page()->sheet().row().controller(), nullptr);
    EXPECT_FALSE(page()->sheet().hasPlace());
    EXPECT_FALSE(page()->map().place());
    window->open("wayloc://friend/nobody@brin.example", LinkPolicy::From::Outside);
    EXPECT_EQ(window->notice().sentence(), QStringLiteral("I don’t know who this link is about."));
    EXPECT_EQ(page()->name(), QStringLiteral("Ann Marsh"));
}

TEST_F(FriendPageTest, NoHandleLeadsToOnesOwnPage_TheListToAll) {
    open({"dinner"});
    host->delegate().open(platform::Url("wayloc://friend/(null)"));
    EXPECT_NE(dynamic_cast<SelfPage*>(window->pages().current()), nullptr);
    window->pages().back();
    host->delegate().open(platform::Url("wayloc://friends/"));
    EXPECT_NE(dynamic_cast<FriendsPage*>(window->pages().current()), nullptr);
    EXPECT_TRUE(opened().empty());
}

TEST_F(FriendPageTest, AFriendWithoutAPlaceHasNoPin_AndASentence) {
    open({"single-unknown"});
    host->delegate().open(platform::Url(
        "wayloc://friend/" + host::KnownFriends::handleOf(*host::KnownFriends(*host).all().front().location)));
    ASSERT_NE(page(), nullptr);
    EXPECT_FALSE(page()->map().place());
    EXPECT_FALSE(page()->sheet().hasPlace());
}

/// The circle and its words, as they are painted, whatever says where they should be.
TEST_F(FriendPageTest, WithoutAPlace_NothingLiesUnderTheSheet_OrTouchesAnything) {
    using platform::ContentSizeCategory;
    for (const auto size : {ContentSizeCategory::L, ContentSizeCategory::AX1, ContentSizeCategory::AX5}) {
        for (const auto& [language, shape] :
             {std::pair("en-GB", QSize(320, 200)), std::pair("de", QSize(320, 200)), std::pair("ar", QSize(400, 240)),
              std::pair("ja", QSize(320, 420)), std::pair("en-GB", QSize(400, 820)), std::pair("ar", QSize(900, 200)),
              std::pair("en-GB", QSize(900, 420)), std::pair("de", QSize(1600, 900))}) {
            const std::string name = std::string("no-place-") + language + "-" + std::to_string(shape.width()) + "x" +
                                     std::to_string(shape.height()) + "-" + std::to_string(static_cast<int>(size));
            open({"dinner"}, language, shape.width(), shape.height(), false, size);
            window->open("wayloc://friend/ann@harbour.example", LinkPolicy::From::Outside);
            ASSERT_NE(page(), nullptr) << name;
            settle();
            keepPicture(*window, name);
            QWidget& widget = page()->map();
            const QImage map = widget.grab().toImage().convertToFormat(QImage::Format_RGB32);
            const QRgb land = linux_::Palette::of(linux_::ColorScheme::Light).mapLand.rgb();
            QRegion painted;
            for (int y = 0; y < map.height(); ++y) {
                const auto* row = reinterpret_cast<const QRgb*>(map.constScanLine(y));
                const auto* end = row + map.width();
                const auto* first = std::find_if(row, end, [&](QRgb there) { return there != land; });
                if (first != end) {
                    const auto* last =
                        std::find_if(std::reverse_iterator(end), std::reverse_iterator(first), [&](QRgb there) {
                            return there != land;
                        }).base();
                    painted += QRect(static_cast<int>(first - row), y, static_cast<int>(last - first), 1);
                }
            }
            EXPECT_FALSE(painted.isEmpty()) << name << ": it says that there is no place";
            const QRect back = page()->back().parentWidget()->geometry();
            EXPECT_FALSE(painted.intersects(page()->sheet().geometry())) << name;
            EXPECT_FALSE(painted.intersects(back)) << name;
            EXPECT_FALSE(page()->sheet().geometry().intersects(back)) << name;
            EXPECT_FALSE(page()->zoom().isVisible() && painted.intersects(page()->zoom().geometry())) << name;
            TearDown();
        }
    }
}

TEST_F(FriendPageTest, AnotherPlatformTakesThePlaceOfThisOne_AndThePageGoesOn) {
    open({"dinner"});
    host->delegate().open(platform::Url("wayloc://friend/ann@harbour.example"));
    settle();
    host::HostSettings settings = host->settings();
    settings.language = "de";
    ASSERT_FALSE(host->remake(settings));
    settle();
    ASSERT_NE(page(), nullptr);
    EXPECT_TRUE(page()->sheet().hasPlace());
    EXPECT_EQ(page()->back().accessibleName(), QStringLiteral("Zurück"));
    page()->back().press();
    settle();
    ASSERT_FALSE(host->remake(settings));
}

/// Some of each; all of them, with a picture of each, where KTR_GALLERY names a folder.
TEST_F(FriendPageTest, EveryShape_HasEverythingInPlace) {
    const QSize shapes[] = {{320, 200}, {320, 640}, {400, 300}, {400, 800},
                            {844, 390}, {900, 200}, {900, 700}, {1600, 900}};
    const char* const languages[] = {"en-GB", "de", "ar", "ja"};
    const bool isGallery = qEnvironmentVariableIsSet("KTR_GALLERY");
    for (std::size_t i = 0; i < std::size(shapes) * std::size(languages) * 2; ++i) {
        const std::size_t shape = i / 8;
        const std::size_t language = i / 2 % 4;
        const bool isDark = i % 2 == 1;
        if (!isGallery && (language != shape % 4 || isDark != (shape % 3 == 0))) {
            continue;
        }
        const QSize size = shapes[shape];
        const std::string name = std::string("friend-") + languages[language] + "-" + std::to_string(size.width()) +
                                 "x" + std::to_string(size.height()) + (isDark ? "-dark" : "");
        open({"single"}, languages[language], size.width(), size.height(), isDark);
        host->delegate().open(platform::Url("wayloc://friend/ann@harbour.example"));
        ASSERT_NE(page(), nullptr);
        ASSERT_TRUE(eventually([&] { return page()->sheet().row().controller()->view() != nullptr; }));
        const QRect sheet = page()->sheet().geometry();
        const QRect whole = page()->rect();
        EXPECT_TRUE(whole.contains(sheet)) << name;
        EXPECT_TRUE(whole.contains(page()->back().parentWidget()->geometry()));
        EXPECT_FALSE(sheet.intersects(page()->back().parentWidget()->geometry())) << name;
        if (page()->zoom().isVisible()) {
            EXPECT_FALSE(sheet.intersects(page()->zoom().geometry())) << name;
            EXPECT_TRUE(whole.contains(page()->zoom().geometry()));
        }
        if (isGallery) {
            const QDeadlineTimer drawn(1200);
            while (!drawn.hasExpired()) {
                QApplication::processEvents(QEventLoop::AllEvents, 20);
            }
            keepPicture(*window, name);
        }
        TearDown();
    }
}

}  // namespace

}  // namespace ktr::app
