#include "linux/device/DesktopSettings.h"

#include <sys/socket.h>
#include <sys/un.h>
#include <unistd.h>

#include <QDBusArgument>
#include <QDBusMetaType>
#include <QDBusVariant>
#include <chrono>
#include <fstream>
#include <functional>
#include <limits>
#include <map>
#include <memory>

#include "tests/support/TemporaryFolder.h"
#include "tests/support/qt/PrivateBus.h"

namespace ktr::test {

using linux_::DesktopSettings;

/// As the portal sends a colour.
struct PortalColor {
    double red = 0.0, green = 0.0, blue = 0.0;
};

QDBusArgument& operator<<(QDBusArgument& argument, const PortalColor& color) {
    argument.beginStructure();
    argument << color.red << color.green << color.blue;
    argument.endStructure();
    return argument;
}

const QDBusArgument& operator>>(const QDBusArgument& argument, PortalColor& color) {
    argument.beginStructure();
    argument >> color.red >> color.green >> color.blue;
    argument.endStructure();
    return argument;
}

class DesktopSettingsTest : public ::testing::Test {
  protected:
    DesktopSettingsTest() : service(bus.connect(QStringLiteral("portal"))) {}
    ~DesktopSettingsTest() override { PrivateBus::disconnect(QStringLiteral("portal")); }

    void startPortal() {
        fake = std::make_unique<FakeService>([this](const QDBusMessage& message, const QDBusConnection& connection) {
            const auto arguments = message.arguments();
            if (message.member() != QLatin1String("Read") || arguments.size() != 2) {
                return false;
            }
            asked.push_back(arguments[0].toString() + u' ' + arguments[1].toString());
            const auto found = settings.find(asked.back());
            if (found == settings.end()) {
                return connection.send(message.createErrorReply(QStringLiteral("org.freedesktop.portal.Error.NotFound"),
                                                                QStringLiteral("not found")));
            }
            const QVariant answer = found->second;
            if (beforeAnswer) {
                beforeAnswer(asked.back());
            }
            // As the portal has always answered: a variant in a variant.
            const QDBusVariant inner(answer);
            const bool sent =
                connection.send(message.createReply(QVariant::fromValue(QDBusVariant(QVariant::fromValue(inner)))));
            if (afterAnswer) {
                afterAnswer(asked.back());
            }
            return sent;
        });
        ASSERT_TRUE(service.registerVirtualObject(QStringLiteral("/org/freedesktop/portal/desktop"), fake.get()));
        ASSERT_TRUE(service.registerService(QStringLiteral("org.freedesktop.portal.Desktop")));
    }
    void change(const char* group, const char* key, const QVariant& value) {
        QDBusMessage signal = QDBusMessage::createSignal(QStringLiteral("/org/freedesktop/portal/desktop"),
                                                         QStringLiteral("org.freedesktop.portal.Settings"),
                                                         QStringLiteral("SettingChanged"));
        signal << QString::fromLatin1(group) << QString::fromLatin1(key) << QVariant::fromValue(QDBusVariant(value));
        ASSERT_TRUE(service.send(signal));
    }
    /// Says that what was asked for has become less.
    void lower(const QString& what) {
        change(qPrintable(what.section(u' ', 0, 0)), qPrintable(what.section(u' ', 1)),
               what == kScale ? QVariant(1.25) : QVariant(0u));
    }
    std::unique_ptr<DesktopSettings> start(const char* desktop) {
        places.desktop = QString::fromLatin1(desktop);
        places.configuration = folder.path();
        places.gsettings = QString::fromStdString((folder.path() / "gsettings").string());
        auto made = std::make_unique<DesktopSettings>(places);
        made->setChanged([this] { ++changes; });
        return made;
    }
    /// A program in gsettings' place that prints this.
    void writeGsettings(const std::string& line) {
        const auto file = folder.path() / "gsettings";
        std::ofstream(file) << "#!/bin/sh\n[ \"$*\" = 'get org.gnome.desktop.interface text-scaling-factor' ] && echo '"
                            << line << "'\n";
        std::filesystem::permissions(file, std::filesystem::perms::owner_all);
    }
    static void pass(int milliseconds) {
        const QDeadlineTimer deadline(milliseconds);
        while (!deadline.hasExpired()) {
            QCoreApplication::processEvents(QEventLoop::AllEvents | QEventLoop::WaitForMoreEvents, 20);
        }
    }

    const QString kScale = QStringLiteral("org.gnome.desktop.interface text-scaling-factor");
    const QString kScheme = QStringLiteral("org.freedesktop.appearance color-scheme");
    const QString kContrast = QStringLiteral("org.freedesktop.appearance contrast");
    const QString kMotion = QStringLiteral("org.freedesktop.appearance reduced-motion");
    PrivateBus bus;
    QDBusConnection service;
    std::unique_ptr<FakeService> fake;
    std::map<QString, QVariant> settings;
    std::vector<QString> asked;
    /// Called with what was asked.
    std::function<void(const QString&)> beforeAnswer;
    std::function<void(const QString&)> afterAnswer;
    TemporaryFolder folder;
    DesktopSettings::Places places{{}, {}, bus.address(), {}};
    int changes = 0;
};

TEST_F(DesktopSettingsTest, Portal_IsReadOnGnomeAndPhoshAndAgainWhenTheWindowIsUsed) {
    settings = {{kScale, 1.5}, {kContrast, 1u}, {kMotion, 1u}};
    startPortal();
    for (const char* desktop : {"ubuntu:GNOME", "Phosh:GNOME", "phosh"}) {
        const auto read = start(desktop);
        EXPECT_FALSE(read->values().textScale) << "it does not wait for the bus";
        EXPECT_TRUE(eventually([&] {
            return read->values() == DesktopSettings::Values{1.5, std::nullopt, true, true};
        })) << desktop;
        settings = {{kScale, 2.0}, {kContrast, 0u}, {kMotion, 0u}};
        read->refresh();
        EXPECT_TRUE(eventually([&] {
            return read->values() == DesktopSettings::Values{2.0, std::nullopt, false, false};
        })) << desktop;
        settings = {{kScale, 1.5}, {kContrast, 1u}, {kMotion, 1u}};
    }
    EXPECT_GT(changes, 0);
}

TEST_F(DesktopSettingsTest, GnomesTextSize_CountsOnNoOtherDesktop) {
    settings = {{kScale, 1.5}, {kContrast, 1u}};
    startPortal();
    for (const char* desktop : {"KDE", "sway", ""}) {
        const auto read = start(desktop);
        EXPECT_TRUE(eventually([&] { return read->values().highContrast == true; })) << desktop;
        change("org.gnome.desktop.interface", "text-scaling-factor", 2.0);
        change("org.freedesktop.appearance", "contrast", 0u);
        EXPECT_TRUE(eventually([&] { return read->values().highContrast == false; })) << desktop;
        EXPECT_FALSE(read->values().textScale) << desktop;
    }
    EXPECT_EQ(std::count(asked.begin(), asked.end(), kScale), 0);
}

TEST_F(DesktopSettingsTest, ChangeRightBehindTheFirstAnswer_IsHeard) {
    settings = {{kScale, 1.5}, {kContrast, 1u}, {kMotion, 1u}};
    afterAnswer = [this](const QString& what) { lower(what); };
    startPortal();
    const auto read = start("GNOME");
    EXPECT_TRUE(eventually([&] {
        return read->values() == DesktopSettings::Values{1.25, std::nullopt, false, false};
    }));
    EXPECT_EQ(asked.size(), 5U) << "nothing was asked twice";
}

TEST_F(DesktopSettingsTest, AnswerThatAChangeOvertook_IsDropped) {
    settings = {{kScale, 1.5}, {kContrast, 1u}, {kMotion, 1u}};
    beforeAnswer = [this](const QString& what) { lower(what); };
    startPortal();
    const auto read = start("GNOME");
    EXPECT_TRUE(eventually([&] { return asked.size() == 5; }));
    pass(100);
    EXPECT_EQ(read->values(), (DesktopSettings::Values{1.25, std::nullopt, false, false}));
}

TEST_F(DesktopSettingsTest, ColourScheme_IsReadAndFollowed_AndNoPreferenceIsNone) {
    settings[kScheme] = 1u;
    startPortal();
    const auto desktop = start("GNOME");
    EXPECT_TRUE(eventually([&] { return desktop->values().dark == true; }));
    change("org.freedesktop.appearance", "color-scheme", 2u);
    EXPECT_TRUE(eventually([&] { return desktop->values().dark == false; }));
    change("org.freedesktop.appearance", "color-scheme", 0u);
    EXPECT_TRUE(eventually([&] { return !desktop->values().dark; }));
    change("org.freedesktop.appearance", "color-scheme", QStringLiteral("dark"));
    pass(100);
    EXPECT_FALSE(desktop->values().dark) << "a word is no scheme";
}

TEST_F(DesktopSettingsTest, Accent_IsReadAndFollowed_AndWhatIsNoColourIsNone) {
    qDBusRegisterMetaType<PortalColor>();
    const auto color = [](double red, double green, double blue) {
        return QVariant::fromValue(PortalColor{red, green, blue});
    };
    settings[QStringLiteral("org.freedesktop.appearance accent-color")] = color(0.2, 0.4, 1.0);
    startPortal();
    const auto desktop = start("GNOME");
    EXPECT_TRUE(eventually([&] { return desktop->values().accent == QColor(51, 102, 255); }));
    const double nan = std::numeric_limits<double>::quiet_NaN();
    for (const QVariant& none : {color(-1.0, -1.0, -1.0), color(0.5, 0.5, 1.01), color(nan, 0.5, 0.5),
                                 QVariant(QStringLiteral("#3366ff")), QVariant(0x3366ffu)}) {
        change("org.freedesktop.appearance", "accent-color", none);
        EXPECT_TRUE(eventually([&] { return !desktop->values().accent; }));
        change("org.freedesktop.appearance", "accent-color", color(0.0, 1.0, 0.0));
        EXPECT_TRUE(eventually([&] { return desktop->values().accent == QColor(0, 255, 0); }));
    }
}

TEST_F(DesktopSettingsTest, PortalWithoutTheKeys_LeavesDefaults) {
    startPortal();
    const auto read = start("GNOME");
    EXPECT_TRUE(eventually([&] { return asked.size() == 5; }));
    pass(100);
    EXPECT_EQ(read->values(), DesktopSettings::Values{});
    EXPECT_EQ(changes, 0);
}

TEST_F(DesktopSettingsTest, NoPortal_AsksGsettingsAndAgainWhenTheWindowIsUsed) {
    writeGsettings("1.25");
    const auto read = start("GNOME");
    EXPECT_TRUE(eventually([&] { return read->values().textScale == 1.25; }));
    writeGsettings("1.75");
    read->refresh();
    EXPECT_TRUE(eventually([&] { return read->values().textScale == 1.75; }));
}

TEST_F(DesktopSettingsTest, Nonsense_IsNone) {
    settings = {{kScale, QStringLiteral("large")}, {kContrast, QStringLiteral("yes")}, {kMotion, 7u}};
    startPortal();
    const auto read = start("GNOME");
    EXPECT_TRUE(eventually([&] { return read->values().reducedMotion.has_value(); }));
    EXPECT_EQ(read->values(), (DesktopSettings::Values{std::nullopt, std::nullopt, std::nullopt, false}));
    for (const double scale : {0.0, -1.0, 1e9}) {
        change("org.gnome.desktop.interface", "text-scaling-factor", scale);
    }
    change("org.freedesktop.appearance", "contrast", 1u);
    EXPECT_TRUE(eventually([&] { return read->values().highContrast == true; }));
    EXPECT_FALSE(read->values().textScale);
}

TEST_F(DesktopSettingsTest, KdesFont_IsReadAndFollowed) {
    const auto write = [&](const char* points) {
        const auto file = folder.path() / "new";
        std::ofstream(file) << "[General]\nfont=Noto Sans," << points << ",-1,5\n";
        std::filesystem::rename(file, folder.path() / "kdeglobals");
    };
    write("13");
    const auto read = start("KDE");
    EXPECT_TRUE(eventually([&] { return read->values().textScale == 1.3; }));
    write("20");
    EXPECT_TRUE(eventually([&] { return read->values().textScale == 2.0; }));
    write("10");
    EXPECT_TRUE(eventually([&] { return read->values().textScale == 1.0; }));
}

TEST_F(DesktopSettingsTest, BusThatNeverAnswers_DelaysNobody) {
    const auto path = folder.path() / "silent";
    const int silent = ::socket(AF_UNIX, SOCK_STREAM, 0);
    sockaddr_un address{};
    address.sun_family = AF_UNIX;
    path.string().copy(address.sun_path, sizeof(address.sun_path) - 1);
    ASSERT_EQ(::bind(silent, reinterpret_cast<const sockaddr*>(&address), sizeof(address)), 0);
    ASSERT_EQ(::listen(silent, 1), 0);
    places.busAddress = QStringLiteral("unix:path=") + QString::fromStdString(path.string());
    const auto begin = std::chrono::steady_clock::now();
    start("GNOME").reset();
    EXPECT_LT(std::chrono::steady_clock::now() - begin, std::chrono::seconds(1));
    // Lets the one who waits go.
    ::close(silent);
}

}  // namespace ktr::test
