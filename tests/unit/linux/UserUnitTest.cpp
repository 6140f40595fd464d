#include "linux/device/UserUnit.h"

#include <algorithm>
#include <memory>
#include <set>
#include <vector>

#include "tests/support/PlatformTest.h"
#include "tests/support/qt/PrivateBus.h"

namespace ktr::test {

using linux_::UserUnit;
using State = UserUnit::State;

class UserUnitTest : public PlatformTest {
  protected:
    UserUnitTest() : service(bus.connect(QStringLiteral("user-manager"))) {}
    ~UserUnitTest() override {
        unit.reset();
        PrivateBus::disconnect(QStringLiteral("user-manager"));
    }

    void startManager() {
        fake = std::make_unique<FakeService>([this](const QDBusMessage& message, const QDBusConnection& connection) {
            const QString method = message.member();
            asked.push_back(method);
            if (refused.count(method) != 0) {
                return connection.send(
                    message.createErrorReply(QStringLiteral("org.freedesktop.DBus.Error.AccessDenied"), method));
            }
            const bool isEnabling = method == QLatin1String("EnableUnitFiles");
            if (isEnabling || method == QLatin1String("DisableUnitFiles")) {
                EXPECT_EQ(message.signature(), isEnabling ? QStringLiteral("asbb") : QStringLiteral("asb"));
                EXPECT_EQ(message.arguments().value(0).toStringList(),
                          QStringList{QStringLiteral("ktr-watch.service")});
                EXPECT_FALSE(message.arguments().value(1).toBool()) << "for this session alone";
                file = isEnabling ? QStringLiteral("enabled") : QStringLiteral("disabled");
            }
            if (method == QLatin1String("GetUnitFileState")) {
                return file.isEmpty() ? connection.send(message.createErrorReply(
                                            QStringLiteral("org.freedesktop.DBus.Error.FileNotFound"), method))
                                      : connection.send(message.createReply(file));
            }
            return connection.send(message.createReply());
        });
        ASSERT_TRUE(service.registerVirtualObject(QStringLiteral("/org/freedesktop/systemd1"), fake.get()));
        ASSERT_TRUE(service.registerService(QStringLiteral("org.freedesktop.systemd1")));
    }
    void open(const QString& address) {
        unit = std::make_unique<UserUnit>(address, QStringLiteral("ktr-watch.service"));
        unit->setChanged([this] { ++changes; });
    }
    bool comesTo(State state) {
        return eventually([this, state] { return unit->state() == state && !unit->isBusy(); });
    }

    PrivateBus bus;
    QDBusConnection service;
    std::unique_ptr<FakeService> fake;
    QString file = QStringLiteral("disabled");
    std::set<QString> refused;
    std::vector<QString> asked;
    std::unique_ptr<UserUnit> unit;
    int changes = 0;
};

TEST_F(UserUnitTest, SwitchedOn_IsEnabledForGoodAndStarted_AndSwitchedOffIsStoppedForGood) {
    startManager();
    open(bus.address());
    EXPECT_EQ(unit->state(), State::Unknown);
    ASSERT_TRUE(comesTo(State::Off));
    asked.clear();
    unit->setOn(true);
    unit->setOn(false);
    ASSERT_TRUE(comesTo(State::On)) << "a wish under way is not overtaken";
    EXPECT_EQ(asked, (std::vector<QString>{QStringLiteral("EnableUnitFiles"), QStringLiteral("Reload"),
                                           QStringLiteral("StartUnit"), QStringLiteral("GetUnitFileState")}));
    asked.clear();
    unit->setOn(false);
    ASSERT_TRUE(comesTo(State::Off));
    EXPECT_EQ(asked, (std::vector<QString>{QStringLiteral("DisableUnitFiles"), QStringLiteral("Reload"),
                                           QStringLiteral("StopUnit"), QStringLiteral("GetUnitFileState")}));
}

TEST_F(UserUnitTest, RefusedWish_ShowsWhatIs) {
    startManager();
    open(bus.address());
    ASSERT_TRUE(comesTo(State::Off));
    refused = {QStringLiteral("EnableUnitFiles")};
    const int before = changes;
    unit->setOn(true);
    EXPECT_TRUE(eventually([&] { return changes > before; }));
    EXPECT_EQ(unit->state(), State::Off);
    EXPECT_FALSE(unit->isBusy());
    EXPECT_EQ(std::count(asked.begin(), asked.end(), QStringLiteral("StartUnit")), 0);
}

TEST_F(UserUnitTest, NoBusNoManagerAndNoSuchService_AreNone) {
    open(QString());
    EXPECT_EQ(unit->state(), State::None);
    open(QStringLiteral("unix:path=/nonexistent"));
    EXPECT_TRUE(comesTo(State::None));
    open(bus.address());
    EXPECT_TRUE(comesTo(State::None)) << "nobody keeps the user's services";
    startManager();
    for (const char* said : {"", "masked", "static", "nonsense"}) {
        file = QString::fromLatin1(said);
        open(bus.address());
        EXPECT_TRUE(comesTo(State::None)) << said;
        unit->setOn(true);
        EXPECT_FALSE(unit->isBusy()) << said;
    }
}

}  // namespace ktr::test
