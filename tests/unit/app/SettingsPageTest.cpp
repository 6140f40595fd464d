// The page with settings in a live window: what each writes, how it comes back, and how it looks. KTR_GALLERY names a
// folder for pictures.
#include "app/window/settings/SettingsPage.h"

#include <QApplication>
#include <QDeadlineTimer>
#include <QDir>
#include <QDragEnterEvent>
#include <QDropEvent>
#include <QImage>
#include <QMimeData>
#include <QUrl>
#include <filesystem>
#include <fstream>
#include <memory>

#include "app/window/checkup/CheckUpPage.h"
#include "app/window/settings/ChoicePage.h"
#include "app/window/settings/MapPage.h"
#include "host/Resources.h"
#include "linux/configuration/ConfigurationFile.h"
#include "linux/configuration/ConfigurationReader.h"
#include "tests/support/qt/PrivateBus.h"
#include "tests/unit/app/LiveWindowFixture.h"

#include <gtest/gtest.h>

namespace ktr::app {

namespace {

using linux_::Configuration;
using platform::ContentSizeCategory;

class SettingsPageTest : public LiveWindowFixture {
  protected:
    void open(const std::string& members = "", QSize size = {400, 780}) {
        std::filesystem::create_directories(token.parent_path());
        std::ofstream(token) << "s3cret\n";
        std::ofstream(file).close();
        for (const auto& one : {file, token}) {
            std::filesystem::permissions(one, std::filesystem::perms::owner_read | std::filesystem::perms::owner_write);
        }
        openWindowOf(R"({"account": {"personId": "mara@brin.example", "host": "127.0.0.1:9", "userName": "Mara Lind"},)"
                     R"( "addressBooks": false, "positions": {"source": "none"}, "language": "en-GB")" +
                         members + "}",
                     size);
        window->start({}, {});
        ASSERT_TRUE(eventually([this] { return host->live()->isSignedIn(); }));
        window->settings()->press();
        ASSERT_NE(page(), nullptr);
        settle();
    }
    SettingsPage* page() const { return dynamic_cast<SettingsPage*>(window->pages().current()); }
    static void settle() {
        for (int i = 0; i < 5; ++i) {
            QApplication::processEvents();
        }
    }
    Configuration written() const {
        const auto read = linux_::ConfigurationReader::readFile(file);
        const auto* configuration = std::get_if<Configuration>(&read);
        return configuration == nullptr ? Configuration() : *configuration;
    }
    void keep(const char* name) {
        if (const QString where = qEnvironmentVariable("KTR_GALLERY"); !where.isEmpty()) {
            settle();
            QImage picture(window->size() * 2, QImage::Format_RGB32);
            picture.setDevicePixelRatio(2.0);
            window->render(&picture);
            EXPECT_TRUE(picture.save(
                QDir(where).filePath(QLatin1String("settings-") + QLatin1String(name) + QLatin1String(".png"))));
        }
    }
    static QString nameOf(const QWidget& row) { return row.accessibleName(); }

    const std::filesystem::path token = file.parent_path() / "token";
};

}  // namespace

TEST_F(SettingsPageTest, Page_SaysWhatTheConfigurationSays) {
    open(R"(, "colors": "dark", "distances": "miles")");
    EXPECT_EQ(nameOf(page()->account()), QStringLiteral("Mara Lind, 127.0.0.1:9"));
    EXPECT_EQ(nameOf(page()->chosenColors()), QStringLiteral("Colours, Dark"));
    EXPECT_EQ(nameOf(page()->distances()), QStringLiteral("Distances, Miles"));
    EXPECT_EQ(nameOf(page()->textSize()), QStringLiteral("Text size, Standard"));
    EXPECT_TRUE(nameOf(page()->language()).contains(QStringLiteral("English"))) << "the language's own name";
    EXPECT_FALSE(page()->books().isChecked());
    EXPECT_FALSE(page()->position().isChecked());
    EXPECT_TRUE(page()->whoSees().isHidden()) << "nobody said that the service has such a page";
    EXPECT_EQ(window->conversation().colors().scheme, linux_::ColorScheme::Dark);
    keep("dark");
}

TEST_F(SettingsPageTest, Choice_ActsAtOnce_IsWritten_AndComesBackToAsTheSystem) {
    open();
    page()->chosenColors().press();
    auto* choice = dynamic_cast<ChoicePage*>(window->pages().current());
    ASSERT_NE(choice, nullptr);
    EXPECT_TRUE(choice->row(0).isChecked());
    choice->row(2).press();
    EXPECT_TRUE(choice->row(2).isChecked());
    EXPECT_FALSE(choice->row(0).isChecked());
    keep("choice");
    EXPECT_TRUE(eventually([this] { return written().colors == Configuration::Colors::Dark; }));
    EXPECT_TRUE(eventually([this] { return window->conversation().colors().scheme == linux_::ColorScheme::Dark; }));
    choice->row(0).press();
    EXPECT_TRUE(eventually([this] { return written().colors == Configuration::Colors::System; }));
    std::ifstream stream(file);
    EXPECT_EQ(std::string(std::istreambuf_iterator<char>(stream), {}).find("colors"), std::string::npos);
    window->pages().back();
    EXPECT_EQ(nameOf(page()->chosenColors()), QStringLiteral("Colours, As the system"));
}

TEST_F(SettingsPageTest, TextSize_GrowsAtOnceAndIsKept_UpToTheLargest) {
    open();
    const auto buttons = page()->textSize().findChildren<IconButton*>();
    ASSERT_EQ(buttons.size(), 2);
    buttons[1]->press();
    EXPECT_EQ(host->settings().textSize, ContentSizeCategory::XL) << "nobody waits for the disk";
    EXPECT_TRUE(eventually([this] { return written().textSize == ContentSizeCategory::XL; }));
    EXPECT_EQ(nameOf(page()->textSize()), QStringLiteral("Text size, Large"));
    for (int i = 0; i < 9; ++i) {
        buttons[1]->press();
    }
    EXPECT_EQ(host->settings().textSize, ContentSizeCategory::AX5);
    EXPECT_FALSE(buttons[1]->isEnabled());
    EXPECT_TRUE(eventually([this] { return written().textSize == ContentSizeCategory::AX5; }));
    EXPECT_EQ(nameOf(page()->textSize()), QStringLiteral("Text size, Very large 5"));
    keep("largest");
}

TEST_F(SettingsPageTest, Switches_AreWrittenAndTurnedBack) {
    open();
    page()->books().press();
    page()->position().press();
    EXPECT_TRUE(page()->books().isChecked());
    EXPECT_TRUE(eventually([this] {
        return written().addressBooks && written().positions.source == Configuration::Positions::Source::GeoClue;
    }));
    page()->position().press();
    EXPECT_TRUE(eventually([this] { return written().positions.source == Configuration::Positions::Source::None; }));
}

TEST_F(SettingsPageTest, WhatCannotBeWritten_GoesBackAndIsSaid) {
    open();
    std::filesystem::remove(file.string() + ".lock");
    std::filesystem::create_directory(file.string() + ".lock");
    page()->books().press();
    EXPECT_TRUE(page()->books().isChecked());
    EXPECT_TRUE(eventually([this] { return !page()->books().isChecked(); }));
    EXPECT_EQ(window->notice().sentence(), QStringLiteral("Your settings can’t be saved on this computer."));
    keep("refused");
}

TEST_F(SettingsPageTest, SigningOut_TakesTheSecretAway_AndLeadsToThePageThatSignsIn) {
    open();
    page()->account().signOut().press();
    EXPECT_TRUE(eventually([this] { return !host->live()->isSignedIn(); }));
    EXPECT_FALSE(std::filesystem::exists(token));
    ASSERT_TRUE(written().account);
    EXPECT_EQ(written().account->personId, "mara@brin.example") << "it need not be typed again";
    EXPECT_TRUE(eventually([this] { return page() == nullptr && window->pages().isOpen(); }));
    EXPECT_FALSE(window->pages().current()->canBeLeft());
}

TEST_F(SettingsPageTest, Maps_AreAddedListedAndRemoved_AndWhatIsNoneIsSaid) {
    open();
    const auto maps = [this] { return page()->maps().rows().size(); };
    EXPECT_EQ(maps(), 2U) << "the world, and adding";
    const std::filesystem::path town = host::resourceFolder() / "maps" / "brinmouth.mbtiles";
    std::ofstream(folder.path() / "none.mbtiles") << "no map";
    page()->addMap(QString::fromStdString((folder.path() / "none.mbtiles").string()));
    EXPECT_TRUE(eventually(
        [this] { return window->notice().sentence() == QStringLiteral("This file isn’t a map that can be drawn."); }));
    page()->addMap(QString::fromStdString(town.string()));
    ASSERT_TRUE(eventually([&] { return maps() == 3; }));
    EXPECT_TRUE(nameOf(*page()->maps().rows()[0]).startsWith(QStringLiteral("Brinmouth, Streets, ")))
        << nameOf(*page()->maps().rows()[0]).toStdString();
    keep("maps");
    page()->maps().rows()[0]->press();
    auto* map = dynamic_cast<MapPage*>(window->pages().current());
    ASSERT_NE(map, nullptr);
    keep("map");
    map->remove().press();
    EXPECT_TRUE(eventually([&] { return page() != nullptr && maps() == 2; }));
    EXPECT_TRUE(std::filesystem::exists(town)) << "the file itself stays";
}

TEST_F(SettingsPageTest, AMapThatIsDropped_IsAdded_AndWhatIsNoFileIsNotTaken) {
    open();
    const auto drop = [this](const QUrl& url) {
        QMimeData carried;
        carried.setUrls({url});
        QDragEnterEvent enters({200, 200}, Qt::CopyAction, &carried, Qt::LeftButton, Qt::NoModifier);
        enters.setAccepted(false);
        QApplication::sendEvent(page(), &enters);
        if (enters.isAccepted()) {
            QDropEvent falls({200.0, 200.0}, Qt::CopyAction, &carried, Qt::LeftButton, Qt::NoModifier);
            QApplication::sendEvent(page(), &falls);
        }
        return enters.isAccepted();
    };
    EXPECT_FALSE(drop(QUrl(QStringLiteral("https://maps.example/town.mbtiles"))));
    EXPECT_TRUE(drop(QUrl::fromLocalFile(QString::fromStdString(folder.path().string()))));
    EXPECT_TRUE(eventually(
        [this] { return window->notice().sentence() == QStringLiteral("This file isn’t a map that can be drawn."); }));
    const auto town = host::resourceFolder() / "maps" / "brinmouth.mbtiles";
    EXPECT_TRUE(drop(QUrl::fromLocalFile(QString::fromStdString(town.string()))));
    EXPECT_TRUE(eventually([this] { return page()->maps().rows().size() == 3; }));
}

TEST_F(SettingsPageTest, CheckUpInAnyShape_ItsButtonsLeaveRoomForWhatItSays_AndCanBeReached) {
    for (const std::string size : {"L", "AX5"}) {
        for (const QSize& shape :
             {QSize(320, 200), QSize(400, 240), QSize(320, 420), QSize(400, 820), QSize(900, 200)}) {
            const std::string name = size + "-" + std::to_string(shape.width()) + "x" + std::to_string(shape.height());
            open(R"(, "textSize": ")" + size + '"', shape);
            page()->checkUp().press();
            auto* check = dynamic_cast<CheckUpPage*>(window->pages().current());
            ASSERT_NE(check, nullptr);
            window->activateWindow();
            check->copy().setFocus(Qt::TabFocusReason);
            settle();
            EXPECT_TRUE(check->copy().hasFocus()) << name;
            keep(("check-up-" + name).c_str());
            EXPECT_FALSE(check->title().visibleRegion().isEmpty()) << name;
            const auto placeOf = [check](const QWidget& widget) {
                return QRect(widget.mapTo(check, QPoint()), widget.size());
            };
            for (const Button* button : {&check->again(), &check->copy()}) {
                EXPECT_FALSE(button->visibleRegion()
                                 .boundingRect()
                                 .translated(placeOf(*button).topLeft())
                                 .intersects(check->bar()->geometry()))
                    << name;
                check->reveal(*button);
                EXPECT_TRUE(check->rect().contains(placeOf(*button).center())) << name;
                EXPECT_FALSE(button->visibleRegion().isEmpty()) << name;
            }
            // Larger and back again: whoever has the focus keeps it.
            window->resize(400, 820);
            settle();
            window->resize(shape);
            settle();
            EXPECT_TRUE(check->copy().hasFocus()) << name;
        }
    }
}

TEST_F(SettingsPageTest, CheckUp_TellsWhatIsWrong_EachOnceWithItsButton) {
    open();
    page()->checkUp().press();
    auto* check = dynamic_cast<CheckUpPage*>(window->pages().current());
    ASSERT_NE(check, nullptr);
    EXPECT_TRUE(check->isLooking());
    EXPECT_EQ(check->title().text(), QStringLiteral("Checking…"));
    ASSERT_TRUE(eventually([&] { return !check->isLooking(); }));
    keep("check-up");
    // Service and clock ask the same host, at which nobody listens.
    int unreachable = 0;
    for (Block* row : check->troubles().rows()) {
        unreachable +=
            nameOf(*row).startsWith(QStringLiteral("The service can’t be reached. Nothing answers at 127.0.0.1:9."))
                ? 1
                : 0;
    }
    EXPECT_EQ(unreachable, 1);
    QStringList fine;
    for (Block* row : check->fine().rows()) {
        fine << nameOf(*row);
    }
    EXPECT_TRUE(fine.contains(QStringLiteral("Account"))) << fine.join(u'|').toStdString();
    EXPECT_TRUE(fine.contains(QStringLiteral("Secret")));
    EXPECT_TRUE(check->title().text().contains(QStringLiteral("need"))) << check->title().text().toStdString();
    check->copy().press();
    EXPECT_EQ(check->copy().words(), QStringLiteral("Copied"));
    auto* first = dynamic_cast<TroubleRow*>(check->troubles().rows().front());
    ASSERT_NE(first, nullptr);
    EXPECT_EQ(first->button().words(), QStringLiteral("Try again"));
    first->button().press();
    EXPECT_TRUE(check->isLooking());
    EXPECT_TRUE(eventually([&] { return !check->isLooking(); }));
}

TEST_F(SettingsPageTest, Notifications_AreTheUsersServices_AndSaySoWhereThereAreNone) {
    test::PrivateBus bus;
    const test::EnvironmentVariable session("DBUS_SESSION_BUS_ADDRESS", bus.address().toUtf8().constData());
    open();
    const auto isCalled = [this](const char* name) {
        return eventually([&] { return nameOf(page()->notices()) == QString::fromUtf8(name); });
    };
    EXPECT_TRUE(isCalled("Notifications, Nothing can run in the background here."));
    EXPECT_FALSE(page()->notices().canBePressed());

    const QString manager = QStringLiteral("user-services");
    QDBusConnection service = bus.connect(manager);
    QString unitFile = QStringLiteral("disabled");
    test::FakeService fake([&unitFile](const QDBusMessage& message, const QDBusConnection& connection) {
        if (message.member() == QLatin1String("EnableUnitFiles")) {
            unitFile = QStringLiteral("enabled");
        } else if (message.member() == QLatin1String("DisableUnitFiles")) {
            unitFile = QStringLiteral("disabled");
        }
        return connection.send(message.member() == QLatin1String("GetUnitFileState") ? message.createReply(unitFile)
                                                                                     : message.createReply());
    });
    ASSERT_TRUE(service.registerVirtualObject(QStringLiteral("/org/freedesktop/systemd1"), &fake));
    ASSERT_TRUE(service.registerService(QStringLiteral("org.freedesktop.systemd1")));
    window->pages().closeAll();
    window->settings()->press();
    EXPECT_TRUE(isCalled("Notifications, When friends leave or arrive, as you asked."));
    EXPECT_TRUE(eventually([this] { return page()->notices().canBePressed(); }));
    EXPECT_FALSE(page()->notices().isChecked());
    page()->notices().press();
    EXPECT_TRUE(eventually([this] { return page()->notices().isChecked(); }));
    EXPECT_EQ(unitFile, QStringLiteral("enabled"));
    ASSERT_TRUE(eventually([this] { return page()->notices().canBePressed(); }));
    keep("notifications");
    page()->notices().press();
    EXPECT_TRUE(eventually([this] { return !page()->notices().isChecked(); }));
    EXPECT_EQ(unitFile, QStringLiteral("disabled"));
    window->pages().closeAll();
    settle();
    test::PrivateBus::disconnect(manager);
}

TEST_F(SettingsPageTest, NarrowWindows_RightToLeftAndTheLargestText_CutNothing) {
    open(R"(, "textSize": "AX5", "colors": "high-contrast")", {320, 780});
    keep("narrow-ax5");
    int rows = 0;
    for (const QWidget* widget : page()->findChildren<QWidget*>()) {
        const auto* row = dynamic_cast<const ListRow*>(widget);
        if (row != nullptr && row->isVisible()) {
            ++rows;
            EXPECT_LE(row->geometry().right(), row->parentWidget()->width()) << row->accessibleName().toStdString();
            EXPECT_GE(row->height(), row->shapeHeight(row->width())) << row->accessibleName().toStdString();
        }
    }
    EXPECT_GE(rows, 9);
    ASSERT_EQ(linux_::ConfigurationFile(file).change(
                  {{"language", platform::Value("ar")}, {"textSize", platform::Value("L")}, {"colors", std::nullopt}}),
              "");
    ASSERT_TRUE(eventually([this] { return page()->layoutDirection() == Qt::RightToLeft; }));
    settle();
    keep("arabic");
    EXPECT_EQ(page()->name(), QStringLiteral("الإعدادات"));
}

}  // namespace ktr::app
