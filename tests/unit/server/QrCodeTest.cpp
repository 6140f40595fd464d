#include "server/page/QrCode.h"

#include <gtest/gtest.h>

namespace ktr::test {

using server::QrCode;

TEST(QrCodeTest, HasItsThreeFinders) {
    const auto code = QrCode::of("https://home.example/me/in?link=7kq2m9xd41tvp0hb6r7kq2m9xd");
    ASSERT_TRUE(code);
    EXPECT_EQ((code->side - 17) % 4, 0);
    const int last = code->side - 7;
    for (const auto& [row, column] : {std::pair(0, 0), std::pair(0, last), std::pair(last, 0)}) {
        for (int i = 0; i < 7; ++i) {
            EXPECT_TRUE(code->at(row, column + i));
            EXPECT_TRUE(code->at(row + i, column));
            EXPECT_EQ(code->at(row + 1, column + i), i == 0 || i == 6);
        }
    }
}

TEST(QrCodeTest, PathCoversExactlyTheBlackModules) {
    const auto code = QrCode::of("a");
    ASSERT_TRUE(code);
    std::size_t covered = 0;
    const std::string path = code->path();
    for (std::size_t at = path.find('h'); at != std::string::npos; at = path.find("h", at + 1)) {
        if (path[at + 1] != '-') {
            covered += std::stoul(path.substr(at + 1));
        }
    }
    std::size_t black = 0;
    for (const bool module : code->black) {
        black += module ? 1 : 0;
    }
    EXPECT_EQ(covered, black);
    EXPECT_GT(black, 100U);
}

TEST(QrCodeTest, NoneForWhatDoesNotFit) {
    EXPECT_FALSE(QrCode::of(""));
    EXPECT_FALSE(QrCode::of(std::string("a\0b", 3)));
    EXPECT_FALSE(QrCode::of(std::string(5000, 'a')));
}

}  // namespace ktr::test
