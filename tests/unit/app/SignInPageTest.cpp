// The page for signing in: when it can be used, what it says of each trouble, and how it looks. KTR_GALLERY names a
// folder for pictures.
#include "app/window/pages/SignInPage.h"

#include <QApplication>
#include <QDeadlineTimer>
#include <QTcpServer>
#include <memory>

#include "tests/support/TemporaryFolder.h"
#include "tests/unit/app/TestHost.h"

#include <gtest/gtest.h>

namespace ktr::app {

namespace {

using linux_::ColorScheme;
using linux_::Palette;
using platform::ContentSizeCategory;

class KTRSignInPageTest : public ::testing::Test {
  protected:
    void open(const std::string& language = "en-GB", ContentSizeCategory size = ContentSizeCategory::L,
              const SignInPage::Before& before = {}, QSize window = {400, 780}) {
        page = nullptr;
        host = nullptr;
        host::HostOptions options;
        options.language = language;
        options.textSize = size;
        host = testHost(options);
        ASSERT_TRUE(host);
        page = std::make_unique<SignInPage>(
            *host,
            std::make_unique<linux_::SignIn>(std::filesystem::path(folder.path()) / "config.json",
                                             [](const std::string&, const std::string&, const std::string&,
                                                const std::atomic<bool>&, std::string& problem) {
                                                 problem = "locked";
                                                 return false;
                                             }),
            before);
        page->setLayoutDirection(host->rightToLeft() ? Qt::RightToLeft : Qt::LeftToRight);
        page->resize(window);
        page->setLook({&Palette::of(ColorScheme::Light), true});
        page->refresh();
        page->show();
        QApplication::processEvents();
    }
    void TearDown() override {
        page = nullptr;
        host = nullptr;
    }
    static void type(FormField& field, const QString& text) {
        field.edit().setText(text);
        Q_EMIT field.edit().textEdited(text);
    }
    void fill(const QString& address) {
        type(page->address(), address);
        type(page->person(), QStringLiteral("mara"));
        type(page->secret(), QStringLiteral("s3cret"));
    }
    /// Waits until it is no longer checking.
    void waitForTheEnd() {
        const QDeadlineTimer deadline(30000);
        while (page->cancel().isVisible() && !deadline.hasExpired()) {
            QApplication::processEvents(QEventLoop::WaitForMoreEvents, 50);
        }
    }
    void keep(const char* name) { keepPicture(*page, std::string("sign-in-") + name); }
    /// A port at which nobody listens.
    static QString nobody() {
        QTcpServer server;
        server.listen(QHostAddress::LocalHost);
        return QStringLiteral("127.0.0.1:%1").arg(server.serverPort());
    }

    test::TemporaryFolder folder;
    std::unique_ptr<host::Host> host;
    std::unique_ptr<SignInPage> page;
};

}  // namespace

TEST_F(KTRSignInPageTest, EmptyPage_IsNotReadyAndBeginsInTheFirstEmptyField) {
    open();
    EXPECT_FALSE(page->go().isEnabled());
    EXPECT_EQ(page->firstFocus(), &page->address().edit());
    EXPECT_FALSE(page->canBeLeft());
    keep("empty");
    fill(QStringLiteral("brin.example"));
    EXPECT_TRUE(page->go().isEnabled());
    type(page->secret(), QString());
    EXPECT_FALSE(page->go().isEnabled());
    EXPECT_EQ(page->secret().edit().echoMode(), QLineEdit::Password);
}

TEST_F(KTRSignInPageTest, LowWindow_ShowsTheFieldThatHasTheFocus_Whole) {
    for (const QSize& shape : {QSize(320, 200), QSize(400, 240), QSize(900, 200), QSize(320, 300), QSize(320, 419)}) {
        for (const char* language : {"en-GB", "de", "ar", "ja"}) {
            const std::string name =
                std::string(language) + "-" + std::to_string(shape.width()) + "x" + std::to_string(shape.height());
            open(language, ContentSizeCategory::L, {}, shape);
            keep(("low-" + name).c_str());
            const QLineEdit& edit = page->address().edit();
            EXPECT_EQ(edit.visibleRegion().boundingRect(), edit.rect()) << name;
        }
    }
}

TEST_F(KTRSignInPageTest, WhoWasSignedInBefore_IsFilledInAndOnlyThenItSaysAgain) {
    open("en-GB", ContentSizeCategory::L, {"brin.example", "mara"});
    EXPECT_EQ(page->address().text(), QStringLiteral("brin.example"));
    EXPECT_EQ(page->person().text(), QStringLiteral("mara"));
    EXPECT_EQ(page->firstFocus(), &page->secret().edit());
    const auto says = [this](const QString& part) {
        for (const QWidget* widget : page->findChildren<QWidget*>()) {
            if (dynamic_cast<const Words*>(widget) != nullptr && widget->isVisible() &&
                widget->accessibleName().contains(part)) {
                return true;
            }
        }
        return false;
    };
    EXPECT_TRUE(says(QStringLiteral("again")));
    open();
    EXPECT_FALSE(says(QStringLiteral("again")));
}

TEST_F(KTRSignInPageTest, NobodyThere_IsSaidAtTheAddressWhichStaysAndCanBeTriedAgain) {
    open();
    const QString gone = nobody();
    fill(gone);
    page->go().press();
    EXPECT_TRUE(page->cancel().isVisible());
    EXPECT_TRUE(page->address().edit().isReadOnly()) << "fields cannot be changed meanwhile";
    keep("checking");
    waitForTheEnd();
    EXPECT_TRUE(page->address().note().contains(gone)) << page->address().note().toStdString();
    EXPECT_EQ(page->secret().note(), QString());
    EXPECT_EQ(page->go().words(), QStringLiteral("Try again"));
    EXPECT_TRUE(page->go().isEnabled());
    EXPECT_EQ(page->secret().text(), QStringLiteral("s3cret"));
    EXPECT_FALSE(page->address().edit().isReadOnly());
    keep("unreachable");
    type(page->address(), QStringLiteral("brin.example"));
    EXPECT_EQ(page->address().note(), QString()) << "another address is not wrong yet";
    EXPECT_EQ(page->go().words(), QStringLiteral("Sign in"));
}

TEST_F(KTRSignInPageTest, PlainTextAddress_IsRefusedWithoutAsking) {
    open();
    QTcpServer server;
    ASSERT_TRUE(server.listen(QHostAddress::LocalHost));
    fill(QStringLiteral("http://127.0.0.1:%1").arg(server.serverPort()));
    page->go().press();
    waitForTheEnd();
    EXPECT_FALSE(page->address().note().isEmpty());
    EXPECT_FALSE(server.waitForNewConnection(200));
}

TEST_F(KTRSignInPageTest, Cancel_StopsAtOnceAndKeepsWhatWasTyped) {
    open();
    QTcpServer silent;
    ASSERT_TRUE(silent.listen(QHostAddress::LocalHost));
    fill(QStringLiteral("127.0.0.1:%1").arg(silent.serverPort()));
    page->go().press();
    ASSERT_TRUE(page->cancel().isVisible());
    page->cancel().press();
    EXPECT_FALSE(page->cancel().isVisible());
    EXPECT_TRUE(page->go().isEnabled());
    EXPECT_EQ(page->secret().text(), QStringLiteral("s3cret"));
    EXPECT_EQ(page->address().note(), QString());
}

TEST_F(KTRSignInPageTest, EveryWindow_ShowsAllOfItWithoutCuttingAndScrolls) {
    struct Case {
        const char* name;
        const char* language;
        ContentSizeCategory size;
        QSize window;
    };
    const Case cases[] = {{"wide", "de", ContentSizeCategory::L, {1000, 760}},
                          {"low", "de", ContentSizeCategory::L, {320, 240}},
                          {"rtl", "ar", ContentSizeCategory::L, {400, 780}},
                          {"japanese", "ja", ContentSizeCategory::L, {400, 780}},
                          {"ax3", "en-GB", ContentSizeCategory::AX3, {400, 780}}};
    for (const Case& one : cases) {
        open(one.language, one.size, {}, one.window);
        keep(one.name);
        EXPECT_GE(page->column().height(), page->column().shapeHeight(page->column().width())) << one.name;
        for (const QWidget* widget : page->findChildren<QWidget*>()) {
            const auto* block = dynamic_cast<const Block*>(widget);
            if (block != nullptr && block->isVisible()) {
                const QPoint at = block->mapTo(page.get(), block->shape().topLeft());
                EXPECT_GE(at.x(), 0) << one.name;
                EXPECT_LE(at.x() + block->shape().width(), one.window.width()) << one.name;
            }
        }
    }
}

TEST_F(KTRSignInPageTest, OneWhoHasALink_GivesNothingElse_AndComesBack) {
    open();
    EXPECT_FALSE(page->link().isVisible());
    EXPECT_EQ(page->otherWay().words(), QStringLiteral("I have a link"));
    page->otherWay().press();
    EXPECT_TRUE(page->link().isVisible());
    for (const FormField* field : {&page->address(), &page->person(), &page->secret()}) {
        EXPECT_FALSE(field->isVisible());
    }
    EXPECT_EQ(page->firstFocus(), &page->link().edit());
    EXPECT_FALSE(page->go().isEnabled());
    keep("link");
    type(page->link(), QStringLiteral("https://brin.example/somewhere"));
    EXPECT_TRUE(page->go().isEnabled());
    page->go().press();
    waitForTheEnd();
    EXPECT_EQ(page->link().note(), QStringLiteral("This isn’t a link for signing in."));
    page->otherWay().press();
    EXPECT_FALSE(page->link().isVisible());
    EXPECT_TRUE(page->address().isVisible());
    EXPECT_FALSE(page->go().isEnabled());
}

TEST_F(KTRSignInPageTest, LinkThatIsPastedIntoAnyField_IsMeantAsOne) {
    open();
    const QString link = QStringLiteral("https://") + nobody() + QStringLiteral("/me/in?link=4tvp0habc");
    type(page->person(), link);
    EXPECT_TRUE(page->link().isVisible());
    EXPECT_EQ(page->link().text(), link);
    EXPECT_EQ(page->person().text(), QString()) << "it would be shown there, and kept";
    EXPECT_TRUE(page->go().isEnabled());
    EXPECT_FALSE(page->cancel().isVisible()) << "nothing is asked before the press";
    page->go().press();
    keep("checking-link");
    waitForTheEnd();
    EXPECT_TRUE(page->link().note().contains(QStringLiteral("Nothing answers"))) << page->link().note().toStdString();
    EXPECT_FALSE(page->link().note().contains(QStringLiteral("4tvp0habc")));
    EXPECT_EQ(page->go().words(), QStringLiteral("Try again"));
}

}  // namespace ktr::app
