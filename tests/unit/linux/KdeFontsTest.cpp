#include "linux/device/KdeFonts.h"

#include <gtest/gtest.h>
#include <sys/stat.h>

#include <fstream>

#include "tests/support/TemporaryFolder.h"

namespace ktr::linux_ {

TEST(KdeFontsTest, SizeOfTheGeneralFont_IsTheScale) {
    EXPECT_EQ(KdeFonts::textScale("[General]\nfont=Noto Sans,13,-1,5,50,0,0,0,0,0\n", ""), 1.3);
    EXPECT_EQ(KdeFonts::textScale(
                  "[KDE]\nfont=X,40\n[General]\nColorScheme=Dark\nfont=Noto Sans,10.5,-1\n[WM]\nfont=X,30", ""),
              1.05);
}

TEST(KdeFontsTest, ResolutionForFonts_Multiplies) {
    EXPECT_NEAR(KdeFonts::textScale("[General]\nfont=Noto Sans,12,-1\n", "[General]\nforceFontDPI=144\n").value_or(0.0),
                1.8, 1e-9);
    EXPECT_EQ(KdeFonts::textScale("", "[General]\nforceFontDPI=192\n"), 2.0);
    EXPECT_EQ(KdeFonts::textScale("[General]\nfont=Noto Sans,12,-1\n", "[General]\nforceFontDPI=0\n"), 1.2)
        << "0: as the screen has it";
}

TEST(KdeFontsTest, NothingUsable_IsNone) {
    for (const char* text :
         {"", "[General]\n", "font=Noto Sans,12", "[General]\nfont=Noto Sans\n", "[General]\nfont=Noto Sans,-1,18\n",
          "[General]\nfont=Noto Sans,twelve\n", "[General]\nfont=Noto Sans,inf\n", "[General]\nfont=Noto Sans,9999\n",
          "[General]\nfontX=Noto Sans,12\n", "[General]"}) {
        EXPECT_FALSE(KdeFonts::textScale(text, "")) << text;
    }
}

TEST(KdeFontsTest, Files_AreReadWhateverTheyAre) {
    const test::TemporaryFolder folder;
    EXPECT_FALSE(KdeFonts::textScale(folder.path())) << "not there";
    ASSERT_EQ(::mkfifo((folder.path() / "kdeglobals").c_str(), 0600), 0);
    EXPECT_FALSE(KdeFonts::textScale(folder.path())) << "a pipe is not waited for";
    std::filesystem::remove(folder.path() / "kdeglobals");
    std::filesystem::create_directory(folder.path() / "kcmfontsrc");
    std::ofstream(folder.path() / "kdeglobals") << "[General]\nfont=Noto Sans,15,-1\n";
    EXPECT_EQ(KdeFonts::textScale(folder.path()), 1.5);
}

}  // namespace ktr::linux_
