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

}  // namespace ktr::app
