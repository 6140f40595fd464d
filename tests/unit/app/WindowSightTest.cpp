// Whether anybody sees a window, and what a window does that nobody uses.
#include "app/window/WindowSight.h"

#include <gtest/gtest.h>
#include <sys/inotify.h>
#include <unistd.h>

#include <QApplication>
#include <QLineEdit>
#include <QTemporaryDir>
#include <QWidget>
#include <algorithm>
#include <array>
#include <fstream>
#include <memory>

#include "app/window/CaretRest.h"
#include "app/window/ConversationWindow.h"
#include "tests/support/EnvironmentVariable.h"
#include "tests/support/qt/EventLoops.h"

namespace ktr::test {

class WindowSightTest : public ::testing::Test {
  protected:
    WindowSightTest() {
        sight.setChanged([this] { told.push_back(sight.isSeen()); });
        window.show();
    }
    QWidget window;
    bool locked = false;
    app::WindowSight sight{window, [this] { return locked; }};
    std::vector<bool> told;
};

TEST_F(WindowSightTest, ShownWindow_IsSeenFromTheStart) {
    wakesIn(100);
    EXPECT_TRUE(sight.isSeen());
    EXPECT_TRUE(told.empty());
}

TEST_F(WindowSightTest, MinimisedOrHidden_IsNotSeen) {
    wakesIn(100);
    window.showMinimized();
    EXPECT_TRUE(eventually([&] { return !sight.isSeen(); }));
    window.showNormal();
    EXPECT_TRUE(eventually([&] { return sight.isSeen(); }));
    window.hide();
    EXPECT_TRUE(eventually([&] { return !sight.isSeen(); }));
    window.show();
    EXPECT_TRUE(eventually([&] { return sight.isSeen(); }));
    EXPECT_EQ(told, (std::vector<bool>{false, true, false, true}));
}

TEST_F(WindowSightTest, LockedSession_IsNotSeen) {
    wakesIn(100);
    locked = true;
    sight.look();
    EXPECT_FALSE(sight.isSeen());
    window.showMinimized();
    wakesIn(100);
    locked = false;
    sight.look();
    EXPECT_FALSE(sight.isSeen()) << "still minimised";
    window.showNormal();
    EXPECT_TRUE(eventually([&] { return sight.isSeen(); }));
}

class CaretRestTest : public ::testing::Test {
  protected:
    CaretRestTest() { QApplication::setCursorFlashTime(kTime); }
    ~CaretRestTest() override { QApplication::setCursorFlashTime(kTime); }
    static constexpr int kTime = 200;
};

TEST_F(CaretRestTest, CaretsRestWhenNobodyTypes_AndBlinkAtTheNextKey) {
    const auto rest = std::make_unique<app::CaretRest>(50);
    EXPECT_EQ(QApplication::cursorFlashTime(), kTime);
    EXPECT_TRUE(eventually([] { return QApplication::cursorFlashTime() == 0; }));
    QLineEdit edit;
    QKeyEvent key(QEvent::KeyPress, Qt::Key_A, Qt::NoModifier, QStringLiteral("a"));
    QApplication::sendEvent(&edit, &key);
    EXPECT_EQ(QApplication::cursorFlashTime(), kTime);
    EXPECT_TRUE(eventually([] { return QApplication::cursorFlashTime() == 0; })) << "and again";
}

TEST_F(CaretRestTest, End_GivesTheDesktopsTimeBack) {
    auto rest = std::make_unique<app::CaretRest>(20);
    EXPECT_TRUE(eventually([] { return QApplication::cursorFlashTime() == 0; }));
    rest.reset();
    EXPECT_EQ(QApplication::cursorFlashTime(), kTime);
}

/// The live window with an account whose service nobody asks: what is on screen asks nothing by itself.
/// Whether the system has watches to give, for each of those that follow files.
static bool hasWatches() {
    std::array<int, 8> descriptors{};
    std::generate(descriptors.begin(), descriptors.end(), [] { return inotify_init1(IN_CLOEXEC); });
    const bool all = std::find(descriptors.begin(), descriptors.end(), -1) == descriptors.end();
    std::for_each(descriptors.begin(), descriptors.end(), [](int descriptor) { ::close(descriptor); });
    return all;
}

class IdleWindowTest : public ::testing::Test {
  protected:
    IdleWindowTest() : state("XDG_STATE_HOME", folder.filePath(QStringLiteral("state")).toUtf8().constData()) {
        const std::string file = folder.filePath(QStringLiteral("config.json")).toStdString();
        std::ofstream(file) << R"({"positions": {"source": "none"}, "language": "en-GB"})";
        host::HostSettings settings;
        settings.liveConfiguration = file;
        settings.width = 400.0;
        auto made = host::Host::make(settings, host::Host::Time::Running, KTR_PLUGIN_FILE);
        host = std::move(std::get<std::unique_ptr<host::Host>>(made));
        window = std::make_unique<app::ConversationWindow>(*host);
        window->resize(400, 700);
        window->show();
        window->start({}, {});
        window->activateWindow();
        window->field()->edit().setFocus();
    }
    ~IdleWindowTest() override {
        window.reset();
        host.reset();
    }
    QTemporaryDir folder;
    EnvironmentVariable state;
    std::unique_ptr<host::Host> host;
    std::unique_ptr<app::ConversationWindow> window;
};

TEST_F(IdleWindowTest, WindowThatNobodyUses_DoesNotWake) {
    if (!hasWatches()) {
        GTEST_SKIP() << "other programs have used up the system's watches: files are looked at every few seconds";
    }
    EXPECT_TRUE(eventually([&] { return !window->status()->words().isEmpty(); })) << "the account is read";
    EXPECT_TRUE(eventually([] { return QApplication::cursorFlashTime() == 0; })) << "the caret rests";
    wakesIn(1000);
    EXPECT_LE(wakesIn(6000), 2) << "a status line or a caret that counts would make it six at least";
}

}  // namespace ktr::test
