#include "app/window/WindowPlace.h"

#include <sys/stat.h>

#include <QWidget>
#include <fstream>

#include "tests/support/TemporaryFolder.h"

#include <gtest/gtest.h>

namespace ktr::app {

namespace {

class WindowPlaceTest : public ::testing::Test {
  protected:
    test::TemporaryFolder folder;
    std::filesystem::path file = folder.path() / "state" / "window";
};

TEST_F(WindowPlaceTest, AWindowComesBackAsLargeAsItWas) {
    const WindowPlace place(file);
    QWidget before;
    before.resize(433, 377);
    before.show();
    place.keep(before);
    QWidget after;
    after.resize(100, 100);
    place.restore(after);
    EXPECT_EQ(after.size(), QSize(433, 377));
}

TEST_F(WindowPlaceTest, NothingKept_OrNonsense_ChangesNothing) {
    const WindowPlace place(file);
    QWidget window;
    window.resize(250, 260);
    place.restore(window);
    std::filesystem::create_directories(file.parent_path());
    for (const std::string& nonsense : {std::string("zz"), std::string("400 300"), std::string("-5 -5 0 0 0 "),
                                        std::string("99999999 99999999 0 0 0 "),
                                        std::string("99999999999999999999 1 1 1 1"), std::string(1 << 20, '4')}) {
        std::ofstream(file) << nonsense;
        place.restore(window);
        EXPECT_EQ(window.size(), QSize(250, 260));
    }
    std::filesystem::remove(file);
    ASSERT_EQ(mkfifo(file.c_str(), 0600), 0);
    place.restore(window);
    EXPECT_EQ(window.size(), QSize(250, 260));
}

}  // namespace

}  // namespace ktr::app
