#include <QEventLoop>
#include <QTemporaryDir>
#include <QTimer>
#include <fstream>
#include <variant>

#include "host/Environment.h"
#include "platform/map/MapPictureSource.h"
#include "tests/support/PlatformTest.h"

namespace ktr::host {

class LiveMapsTest : public test::PlatformTest {
  protected:
    void SetUp() override {
        PlatformTest::SetUp();
        stateBefore = qgetenv("XDG_STATE_HOME");
        qputenv("XDG_STATE_HOME", folder.filePath(QStringLiteral("state")).toUtf8());
        configure("{}");
        HostSettings settings;
        settings.language = "en";
        settings.region = "en";
        settings.liveConfiguration = path();
        auto made = Environment::make(settings, false);
        ASSERT_TRUE(std::holds_alternative<Environment>(made)) << std::get<Failure>(made).line;
        environment = std::make_unique<Environment>(std::move(std::get<Environment>(made)));
        platform::Platform::install(environment->platform);
        runUntil([&](const auto& done) { environment->live->start(done); });
    }
    void TearDown() override {
        platform::Platform::install(nullptr);
        environment = nullptr;
        stateBefore.isEmpty() ? qunsetenv("XDG_STATE_HOME") : qputenv("XDG_STATE_HOME", stateBefore);
        PlatformTest::TearDown();
    }
    std::string path() const { return folder.filePath(QStringLiteral("config.json")).toStdString(); }
    void configure(const std::string& text) const { std::ofstream(path()) << text; }
    /// Runs the loop until `work` has called what it is given.
    static void runUntil(const std::function<void(std::function<void()>)>& work) {
        QEventLoop loop;
        bool isDone = false;
        work([&] {
            isDone = true;
            loop.quit();
        });
        QTimer::singleShot(20000, &loop, &QEventLoop::quit);
        if (!isDone) {
            loop.exec();
        }
        EXPECT_TRUE(isDone);
    }

    QTemporaryDir folder;
    QByteArray stateBefore;
    std::unique_ptr<Environment> environment;
};

TEST_F(LiveMapsTest, AMapThatIsConfiguredLater_IsDrawnFromThenOn) {
    std::shared_ptr<void> observed;
    runUntil([&](const auto& done) {
        observed = environment->platform->maps->observeChanges(done);
        configure(R"({"maps": {"sources": [{"file": "later.mbtiles"}]}})");
    });
    EXPECT_EQ(environment->live->problem(), "");
}

}  // namespace ktr::host
