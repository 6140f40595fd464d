#pragma once

#include <QSize>
#include <filesystem>
#include <functional>
#include <memory>
#include <string>

#include "app/window/ConversationWindow.h"
#include "tests/support/EnvironmentVariable.h"
#include "tests/support/TemporaryFolder.h"

#include <gtest/gtest.h>

namespace ktr::app {

/// A live window with the real plugin, on a configuration and folders of its own.
class LiveWindowFixture : public ::testing::Test {
  protected:
    /// Nobody answers at this account's service, and nobody has signed in; the page that says so is closed. `members`
    /// follow those of the configuration.
    void openWindow(QSize size = {400, 780}, const std::string& members = R"(, "language": "en-GB")");
    /// The window of this configuration, which is not looked at before it is read.
    void openWindowOf(const std::string& configuration, QSize size);
    void TearDown() override;
    /// Adds what a scenario's text shows.
    void addTurn(const std::string& scenario);
    /// Whether it comes about while events are answered, for as long as nobody waits.
    static bool eventually(const std::function<bool()>& condition, int milliseconds = 20000);

    test::TemporaryFolder folder;
    test::EnvironmentVariable data{"XDG_DATA_HOME", (folder.path() / "data").c_str()};
    test::EnvironmentVariable state{"XDG_STATE_HOME", (folder.path() / "state").c_str()};
    const std::filesystem::path file = folder.path() / "ktr" / "config.json";
    linux_::DesktopOpener desktop{QString(), [](const std::string&) { return false; }};
    std::unique_ptr<host::Host> host;
    std::unique_ptr<ConversationWindow> window;
};

}  // namespace ktr::app
