#include "linux/device/DesktopOpener.h"

#include <QDBusArgument>
#include <QDBusObjectPath>
#include <atomic>
#include <memory>
#include <mutex>
#include <optional>
#include <vector>

#include "tests/support/qt/PrivateBus.h"

namespace ktr::test {

using linux_::DesktopOpener;

class DesktopOpenerTest : public ::testing::Test {
  protected:
    DesktopOpenerTest() : service(bus.connect(QStringLiteral("opener-portal"))) {}
    ~DesktopOpenerTest() override {
        opener.reset();
        PrivateBus::disconnect(QStringLiteral("opener-portal"));
    }

    /// A portal that answers each request with `response`, or never says what became of it.
    void startPortal(std::optional<uint> response) {
        fake = std::make_unique<FakeService>(
            [this, response](const QDBusMessage& message, const QDBusConnection& connection) {
                const auto arguments = message.arguments();
                if (message.member() != QLatin1String("OpenURI") || message.signature() != QLatin1String("ssa{sv}")) {
                    return false;
                }
                urls.push_back(arguments[1].toString().toStdString());
                const auto options = qdbus_cast<QVariantMap>(arguments[2]);
                const QString sender = message.service().mid(1).replace(QLatin1Char('.'), QLatin1Char('_'));
                const QString path = QStringLiteral("/org/freedesktop/portal/desktop/request/") + sender +
                                     QLatin1Char('/') + options.value(QStringLiteral("handle_token")).toString();
                if (response) {
                    QDBusMessage signal = QDBusMessage::createSignal(
                        path, QStringLiteral("org.freedesktop.portal.Request"), QStringLiteral("Response"));
                    signal << *response << QVariantMap();
                    connection.send(signal);
                }
                return connection.send(message.createReply(QVariant::fromValue(QDBusObjectPath(path))));
            });
        ASSERT_TRUE(service.registerVirtualObject(QStringLiteral("/org/freedesktop/portal/desktop"), fake.get()));
        ASSERT_TRUE(service.registerService(QStringLiteral("org.freedesktop.portal.Desktop")));
    }
    void makeOpener(const QString& address, bool handlerOpens) {
        opener = std::make_unique<DesktopOpener>(address, [this, handlerOpens](const std::string&) {
            ++handled;
            return handlerOpens;
        });
    }
    void open(const std::string& url) {
        opener->open(url, [this](bool opened) { ends.push_back(opened); });
    }

    PrivateBus bus;
    QDBusConnection service;
    std::unique_ptr<FakeService> fake;
    std::vector<std::string> urls;
    std::atomic<int> handled = 0;
    std::vector<bool> ends;
    std::unique_ptr<DesktopOpener> opener;
};

TEST_F(DesktopOpenerTest, ThePortalOpens_TheHandlersAreNotAsked) {
    startPortal(0U);
    makeOpener(bus.address(), false);
    open("https://brin.example/");
    ASSERT_TRUE(eventually([&] { return ends.size() == 1; }));
    open("geo:1,2");
    ASSERT_TRUE(eventually([&] { return ends.size() == 2; }));
    EXPECT_EQ(ends, (std::vector<bool>{true, true}));
    EXPECT_EQ(urls, (std::vector<std::string>{"https://brin.example/", "geo:1,2"}));
    EXPECT_EQ(handled, 0);
}

TEST_F(DesktopOpenerTest, WhoCalledItOffIsServed) {
    startPortal(1U);
    makeOpener(bus.address(), false);
    open("https://brin.example/");
    ASSERT_TRUE(eventually([&] { return !ends.empty(); }));
    EXPECT_TRUE(ends[0]);
    EXPECT_EQ(handled, 0);
}

TEST_F(DesktopOpenerTest, ThePortalHasNobody_TheHandlersAreAskedOnce) {
    startPortal(2U);
    makeOpener(bus.address(), true);
    open("geo:1,2");
    ASSERT_TRUE(eventually([&] { return !ends.empty(); }));
    EXPECT_TRUE(ends[0]);
    EXPECT_EQ(handled, 1);
}

TEST_F(DesktopOpenerTest, NoPortal_TheHandlersAreAsked) {
    makeOpener(bus.address(), true);
    open("geo:1,2");
    ASSERT_TRUE(eventually([&] { return !ends.empty(); }));
    EXPECT_TRUE(ends[0]);
    EXPECT_EQ(handled, 1);
}

TEST_F(DesktopOpenerTest, NeitherPortalNorHandler_NobodyOpens) {
    makeOpener(QString(), false);
    open("geo:1,2");
    ASSERT_TRUE(eventually([&] { return !ends.empty(); }));
    EXPECT_FALSE(ends[0]);
    EXPECT_EQ(handled, 1);
}

TEST_F(DesktopOpenerTest, NoBusAtItsAddress_TheHandlersAreAsked) {
    makeOpener(QStringLiteral("unix:path=/nowhere/at-all"), true);
    open("geo:1,2");
    ASSERT_TRUE(eventually([&] { return !ends.empty(); }));
    EXPECT_TRUE(ends[0]);
}

TEST_F(DesktopOpenerTest, GoneBeforeTheAnswer_IsToldNothing) {
    startPortal(std::nullopt);
    makeOpener(bus.address(), true);
    open("https://brin.example/");
    ASSERT_TRUE(eventually([&] { return !urls.empty(); }));
    opener.reset();
    QCoreApplication::processEvents();
    EXPECT_TRUE(ends.empty());
    EXPECT_EQ(handled, 0);
}

}  // namespace ktr::test
