#include "linux/device/DesktopActivation.h"

#include <QDBusConnectionInterface>
#include <memory>
#include <string>
#include <thread>
#include <vector>

#include "tests/support/qt/PrivateBus.h"

namespace ktr::test {

using linux_::DesktopActivation;

class DesktopActivationTest : public ::testing::Test {
  protected:
    std::unique_ptr<DesktopActivation> make(std::vector<std::string>& urls) {
        return std::make_unique<DesktopActivation>(
            bus.address(), DesktopActivation::Handlers{[&urls](const std::string& url) { urls.push_back(url); },
                                                       [this] { ++activated; }});
    }
    bool isOwned() {
        const QDBusConnection asker = bus.connect(QStringLiteral("activation-asker"));
        const bool owned = asker.interface()->isServiceRegistered(QString::fromLatin1(DesktopActivation::kName));
        PrivateBus::disconnect(QStringLiteral("activation-asker"));
        return owned;
    }
    /// As another process does: while this one's loop runs.
    bool handOver(const std::string& url) {
        bool taken = false;
        std::atomic<bool> done = false;
        std::thread other([&] {
            taken = DesktopActivation::handOver(bus.address(), url);
            done = true;
        });
        EXPECT_TRUE(eventually([&] { return done.load(); }));
        other.join();
        return taken;
    }

    PrivateBus bus;
    int activated = 0;
};

TEST_F(DesktopActivationTest, ALinkGoesToTheWindowThatIsThere) {
    std::vector<std::string> urls;
    const auto window = make(urls);
    ASSERT_TRUE(eventually([&] { return isOwned(); }));
    EXPECT_TRUE(handOver("wayloc://friend/ann@harbour.example"));
    EXPECT_EQ(urls, (std::vector<std::string>{"wayloc://friend/ann@harbour.example"}));
    EXPECT_EQ(activated, 1);
}

TEST_F(DesktopActivationTest, NoWindow_NobodyTakesIt) {
    EXPECT_FALSE(handOver("wayloc://friend/ann@harbour.example"));
    EXPECT_FALSE(DesktopActivation::handOver(QString(), "wayloc://friends/"));
    EXPECT_FALSE(DesktopActivation::handOver(QStringLiteral("unix:path=/nowhere/at-all"), "wayloc://friends/"));
}

TEST_F(DesktopActivationTest, TheFirstWindowKeepsTheName_UntilItGoes) {
    std::vector<std::string> first;
    std::vector<std::string> second;
    auto one = make(first);
    ASSERT_TRUE(eventually([&] { return isOwned(); }));
    const auto two = make(second);
    EXPECT_TRUE(handOver("wayloc://friends/"));
    EXPECT_EQ(first.size(), 1U);
    EXPECT_TRUE(second.empty());
    one.reset();
    EXPECT_TRUE(eventually([&] { return !isOwned(); }));
}

TEST_F(DesktopActivationTest, OfManyLinksAFewAreOpened_WrongCallsAreErrors) {
    std::vector<std::string> urls;
    const auto window = make(urls);
    ASSERT_TRUE(eventually([&] { return isOwned(); }));
    const QDBusConnection caller = bus.connect(QStringLiteral("activation-caller"));
    const auto call = [&](const char* member, const QVariantList& arguments) {
        QDBusMessage message = QDBusMessage::createMethodCall(
            QString::fromLatin1(DesktopActivation::kName), QStringLiteral("/org/ktr/ktr"),
            QStringLiteral("org.freedesktop.Application"), QString::fromLatin1(member));
        message.setArguments(arguments);
        const QDBusPendingCall pending = caller.asyncCall(message);
        EXPECT_TRUE(eventually([&] { return pending.isFinished(); }));
        return !pending.isError();
    };
    QStringList many;
    for (int i = 0; i < 1000; ++i) {
        many << QStringLiteral("wayloc://friend/%1").arg(i);
    }
    EXPECT_TRUE(call("Open", {many, QVariantMap()}));
    EXPECT_EQ(urls.size(), 8U);
    EXPECT_FALSE(call("Open", {QStringLiteral("wayloc://friends/")}));
    EXPECT_FALSE(call("Open", {}));
    EXPECT_FALSE(call("Hide", {QVariantMap()}));
    EXPECT_TRUE(call("Activate", {QVariantMap()}));
    EXPECT_EQ(urls.size(), 8U);
    EXPECT_EQ(activated, 2);
    PrivateBus::disconnect(QStringLiteral("activation-caller"));
}

}  // namespace ktr::test
