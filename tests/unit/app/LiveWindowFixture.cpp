#include "tests/unit/app/LiveWindowFixture.h"

#include <QApplication>
#include <QDeadlineTimer>
#include <fstream>
#include <variant>

#include "host/scenario/ScenarioReader.h"
#include "linux/configuration/ConfigurationReader.h"

namespace ktr::app {

void LiveWindowFixture::openWindow(QSize size, const std::string& members) {
    openWindowOf(R"({"account": {"personId": "1000", "host": "127.0.0.1:9"}, "addressBooks": false,)"
                 R"( "positions": {"source": "none"})" +
                     members + "}",
                 size);
    bool isReady = false;
    host->live()->start([&isReady] { isReady = true; });
    ASSERT_TRUE(eventually([&isReady] { return isReady; }));
    window->pages().closeAll();
}

void LiveWindowFixture::openWindowOf(const std::string& configuration, QSize size) {
    LiveWindowFixture::TearDown();
    std::filesystem::create_directories(file.parent_path());
    std::ofstream(file) << configuration;
    const auto read = linux_::ConfigurationReader::readFile(file);
    ASSERT_TRUE(std::holds_alternative<linux_::Configuration>(read));
    auto settings =
        std::get<host::HostSettings>(host::HostSettings::decide({}, {}, {}, std::get<linux_::Configuration>(read)));
    settings.liveConfiguration = file;
    auto made = host::Host::make(settings, host::Host::Time::Running, KTR_PLUGIN_FILE);
    ASSERT_TRUE(std::holds_alternative<std::unique_ptr<host::Host>>(made)) << std::get<host::Failure>(made).line;
    host = std::move(std::get<std::unique_ptr<host::Host>>(made));
    window = std::make_unique<ConversationWindow>(*host);
    window->openLinks(desktop);
    window->pages().setMotion(host::MotionStyle::None);
    window->resize(size);
    window->show();
}

void LiveWindowFixture::TearDown() {
    window.reset();
    host.reset();
}

void LiveWindowFixture::addTurn(const std::string& scenario) {
    const auto read = host::ScenarioReader({0.0}, host::ScenarioReader::Clock::Present).readText(scenario, "test");
    ASSERT_TRUE(std::holds_alternative<host::Scenario>(read));
    ASSERT_FALSE(host->addTurn(std::get<host::Scenario>(read)));
    window->conversation().turnsChanged();
}

bool LiveWindowFixture::eventually(const std::function<bool()>& condition, int milliseconds) {
    const QDeadlineTimer deadline(milliseconds);
    while (!condition() && !deadline.hasExpired()) {
        QApplication::processEvents(QEventLoop::AllEvents | QEventLoop::WaitForMoreEvents, 20);
    }
    return condition();
}

}  // namespace ktr::app
