#include "linux/device/DesktopNotifier.h"

#include <QDBusArgument>
#include <memory>
#include <vector>

#include "tests/support/qt/PrivateBus.h"

namespace ktr::test {

using linux_::DesktopNotifier;

class DesktopNotifierTest : public ::testing::Test {
  protected:
    DesktopNotifierTest()
        : service(bus.connect(QStringLiteral("notifier-service"))),
          notifier(bus.connect(QStringLiteral("notifier")),
                   [this](const std::string& tag) { clicked.push_back(tag); }) {}
    ~DesktopNotifierTest() override {
        PrivateBus::disconnect(QStringLiteral("notifier"));
        PrivateBus::disconnect(QStringLiteral("notifier-service"));
    }
    void startPortal() {
        portal = std::make_unique<FakeService>([this](const QDBusMessage& message, const QDBusConnection& connection) {
            const auto arguments = message.arguments();
            if (message.member() != QLatin1String("AddNotification") ||
                message.signature() != QLatin1String("sa{sv}")) {
                return false;
            }
            const auto what = qdbus_cast<QVariantMap>(arguments[1]);
            shown.push_back(
                "portal " + arguments[0].toString().toStdString() + ": " +
                what.value(QStringLiteral("title")).toString().toStdString() + ", " +
                what.value(QStringLiteral("body")).toString().toStdString() + ", " +
                qdbus_cast<QStringList>(what.value(QStringLiteral("display-hint"))).join(u' ').toStdString());
            return connection.send(message.createReply());
        });
        ASSERT_TRUE(service.registerVirtualObject(kPortalPath, portal.get()));
        ASSERT_TRUE(service.registerService(QStringLiteral("org.freedesktop.portal.Desktop")));
    }
    void startServer() {
        server = std::make_unique<FakeService>([this](const QDBusMessage& message, const QDBusConnection& connection) {
            const auto arguments = message.arguments();
            if (message.member() != QLatin1String("Notify") || message.signature() != QLatin1String("susssasa{sv}i")) {
                return false;
            }
            numbers.push_back(arguments[1].toUInt());
            shown.push_back("server " + arguments[3].toString().toStdString() + ", " +
                            arguments[4].toString().toStdString());
            return connection.send(message.createReply(QVariant::fromValue(7U)));
        });
        ASSERT_TRUE(service.registerVirtualObject(kServerPath, server.get()));
        ASSERT_TRUE(service.registerService(QStringLiteral("org.freedesktop.Notifications")));
    }
    void show(const char* tag, const char* title, const char* body) {
        notifier.show({tag, title, body}, [this](bool good) { ends.push_back(good); });
        ASSERT_TRUE(eventually([&] { return !ends.empty(); }));
    }
    void emitFrom(const QString& path, const QString& interface, const QVariantList& arguments) {
        QDBusMessage signal = QDBusMessage::createSignal(path, interface, QStringLiteral("ActionInvoked"));
        signal.setArguments(arguments);
        ASSERT_TRUE(service.send(signal));
    }

    const QString kPortalPath = QStringLiteral("/org/freedesktop/portal/desktop");
    const QString kServerPath = QStringLiteral("/org/freedesktop/Notifications");
    PrivateBus bus;
    QDBusConnection service;
    std::unique_ptr<FakeService> portal;
    std::unique_ptr<FakeService> server;
    std::vector<std::string> shown;
    std::vector<std::uint32_t> numbers;  // that the server was given
    std::vector<std::string> clicked;
    std::vector<bool> ends;
    DesktopNotifier notifier;
};

TEST_F(DesktopNotifierTest, Portal_ShowsIt_UnderItsTag_AndHidesItOnTheLockScreen) {
    startPortal();
    startServer();
    show("ktr-1", "Ann", "Arrived: Home");
    EXPECT_EQ(shown, (std::vector<std::string>{"portal ktr-1: Ann, Arrived: Home, hide-content-on-lockscreen"}));
    EXPECT_EQ(ends, std::vector<bool>{true});
    emitFrom(kPortalPath, QStringLiteral("org.freedesktop.portal.Notification"),
             {QStringLiteral("ktr-1"), QStringLiteral("default"), QVariant(QVariantList())});
    ASSERT_TRUE(eventually([&] { return !clicked.empty(); }));
    EXPECT_EQ(clicked, std::vector<std::string>{"ktr-1"});
}

TEST_F(DesktopNotifierTest, WithoutAPortal_TheServerShowsIt_WithNothingToBeReadAsMarks) {
    startServer();
    show("ktr-2", "Ann", "Left: <b>Work</b>");
    EXPECT_EQ(shown, (std::vector<std::string>{"server Ann, Left: &lt;b&gt;Work&lt;/b&gt;"}));
    EXPECT_EQ(ends, std::vector<bool>{true});
    emitFrom(kServerPath, QStringLiteral("org.freedesktop.Notifications"), {8U, QStringLiteral("default")});
    emitFrom(kServerPath, QStringLiteral("org.freedesktop.Notifications"), {7U, QStringLiteral("default")});
    ASSERT_TRUE(eventually([&] { return !clicked.empty(); }));
    EXPECT_EQ(clicked, std::vector<std::string>{"ktr-2"}) << "not somebody else's";
}

TEST_F(DesktopNotifierTest, ServerIsGivenTheNumber_ByWhichItShowsOneOnce) {
    startServer();
    notifier.show({"ktr-4", "Ann", "Left: Work", 1802764289U}, [this](bool good) { ends.push_back(good); });
    ASSERT_TRUE(eventually([&] { return ends.size() == 1; }));
    notifier.show({"ktr-5", "Ann", "Left: Work"}, [this](bool good) { ends.push_back(good); });
    ASSERT_TRUE(eventually([&] { return ends.size() == 2; }));
    EXPECT_EQ(numbers, (std::vector<std::uint32_t>{1802764289U, 0U}));
}

TEST_F(DesktopNotifierTest, WithNeither_ItIsSaid) {
    show("ktr-3", "Ann", "Left: Work");
    ASSERT_TRUE(eventually([&] { return !ends.empty(); }));
    EXPECT_EQ(ends, std::vector<bool>{false});
}

}  // namespace ktr::test
