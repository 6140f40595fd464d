#include "app/window/Greeting.h"

#include <QApplication>
#include <memory>

#include "tests/unit/app/TestHost.h"

#include <gtest/gtest.h>

namespace ktr::app {

namespace {

using linux_::ColorScheme;
using linux_::Palette;

class KTRGreetingTest : public ::testing::Test {
  protected:
    void open(const std::string& language, QSize size) {
        greeting = nullptr;
        host = nullptr;
        host::HostOptions options;
        options.language = language;
        host = testHost(options);
        ASSERT_TRUE(host);
        greeting = std::make_unique<Greeting>(*host);
        QPalette paper;
        paper.setColor(QPalette::Window, Palette::of(ColorScheme::Dark).window);
        greeting->setPalette(paper);
        greeting->setAutoFillBackground(true);
        greeting->setLayoutDirection(host->rightToLeft() ? Qt::RightToLeft : Qt::LeftToRight);
        greeting->resize(size);
        greeting->setLook({&Palette::of(ColorScheme::Dark), true});
        greeting->setHour(20);
        greeting->refresh();
        greeting->show();
        QApplication::processEvents();
    }
    void TearDown() override {
        greeting = nullptr;
        host = nullptr;
    }
    bool says(const QString& words) const {
        for (const QWidget* widget : greeting->findChildren<QWidget*>()) {
            if (widget->isVisible() && widget->accessibleName() == words) {
                return true;
            }
        }
        return false;
    }

    std::unique_ptr<host::Host> host;
    std::unique_ptr<Greeting> greeting;
};

}  // namespace

TEST_F(KTRGreetingTest, TappedQuestion_IsAskedAsItStands) {
    open("en-GB", {400, 660});
    std::vector<std::string> asked;
    greeting->setAsked([&asked](const std::string& question) { asked.push_back(question); });
    ASSERT_EQ(greeting->questions().size(), 3U);
    for (UnaskedQuestion* question : greeting->questions()) {
        question->press();
    }
    EXPECT_EQ(asked, (std::vector<std::string>{"Where are my friends?", "Who is near me?", "Hide my location"}));
}

TEST_F(KTRGreetingTest, Hour_DecidesTheGreeting) {
    open("en-GB", {400, 660});
    EXPECT_TRUE(says(QStringLiteral("Good evening.")));
    greeting->setHour(11);
    EXPECT_TRUE(says(QStringLiteral("Good morning.")));
    greeting->setHour(12);
    EXPECT_TRUE(says(QStringLiteral("Good afternoon.")));
}

TEST_F(KTRGreetingTest, EveryWindow_HasRoomForWhatItShows) {
    struct Case {
        const char* name;
        const char* language;
        QSize size;
        int questions;
    };
    const Case cases[] = {{"phone", "en-GB", {400, 660}, 3},
                          {"wide", "de", {1100, 600}, 3},
                          {"low", "de", {320, 310}, 3},
                          {"very-low", "en-GB", {320, 200}, 2},
                          {"rtl", "ar", {400, 660}, 3}};
    for (const Case& one : cases) {
        open(one.language, one.size);
        int seen = 0;
        for (const UnaskedQuestion* question : greeting->questions()) {
            if (question->isVisible()) {
                ++seen;
                const QRect at(question->mapTo(greeting.get(), QPoint(0, 0)), question->size());
                EXPECT_TRUE(greeting->rect().adjusted(-6, -6, 6, 6).contains(at)) << one.name;
            }
        }
        EXPECT_EQ(seen, one.questions) << one.name;
        keepPicture(*greeting, std::string("greeting-") + one.name);
    }
}

// The field takes its part of the window: what has no room above it is left out, and never cut.
TEST_F(KTRGreetingTest, AboveAField_NothingIsCut) {
    // With the status line below it, which low windows have not.
    const auto ofField = [](const QSize& window) { return window.height() < 240 ? 73 : 98; };
    for (const char* language : {"en-GB", "de", "ar", "ja"}) {
        for (const QSize size : {QSize(320, 200), QSize(400, 240), QSize(900, 200), QSize(320, 300), QSize(320, 420),
                                 QSize(320, 480), QSize(900, 420)}) {
            const std::string name =
                std::string(language) + " " + std::to_string(size.width()) + " x " + std::to_string(size.height());
            open(language, size);
            QWidget window;
            window.resize(size);
            greeting->setParent(&window);
            greeting->setGeometry(0, 0, size.width(), size.height() - ofField(size));
            greeting->show();
            window.show();
            QApplication::processEvents();
            int questions = 0;
            for (const QWidget* part : greeting->findChildren<QWidget*>()) {
                const bool isQuestion = dynamic_cast<const UnaskedQuestion*>(part) != nullptr;
                if (part->isVisible() && (isQuestion || !part->accessibleName().isEmpty())) {
                    questions += isQuestion ? 1 : 0;
                    const QRect at(part->mapTo(greeting.get(), QPoint(0, 0)), part->size());
                    EXPECT_TRUE(greeting->rect().adjusted(-6, -6, 6, 6).contains(at))
                        << name << ": " << part->accessibleName().toStdString() << ' ' << at.y() << ' ' << at.height();
                }
            }
            EXPECT_GE(questions, 1) << name;
            EXPECT_TRUE(size.height() < 420 || questions == 3) << name << " has room for all: " << questions;
            greeting->setParent(nullptr);
        }
    }
}

}  // namespace ktr::app
