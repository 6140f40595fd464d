#include "linux/paint/FontSetup.h"

#include <gtest/gtest.h>

#include <QFontDatabase>

#include "linux/paint/FontChoice.h"

namespace ktr::linux_ {

// The tests' own application runs with the pinned fonts.

TEST(FontSetupTest, PinnedFonts_AreTheOnlyOnes) {
    EXPECT_TRUE(QFontDatabase::hasFamily(FontChoice::baseFamily()));
    EXPECT_TRUE(QFontDatabase::hasFamily(QStringLiteral("Noto Sans CJK JP")));
    EXPECT_TRUE(QFontDatabase::hasFamily(QStringLiteral("Noto Color Emoji")));
    // Three names are Qt's own for whatever there is.
    const QStringList aliases = {QStringLiteral("Monospace"), QStringLiteral("Sans Serif"), QStringLiteral("Serif")};
    for (const QString& family : QFontDatabase::families()) {
        EXPECT_TRUE(family.startsWith(u"Noto ") || aliases.contains(family)) << family.toStdString();
    }
}

TEST(FontSetupTest, SystemMode_LoadsNothing) {
    const auto before = QFontDatabase::families();
    EXPECT_TRUE(FontSetup::load(FontSetup::Mode::System).empty());
    EXPECT_EQ(QFontDatabase::families(), before);
}

}  // namespace ktr::linux_
