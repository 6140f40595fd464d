#include "server/names/MessageCatalogue.h"

#include <gtest/gtest.h>

#include <map>

#include "tests/support/TemporaryFolder.h"

namespace ktr::server {

namespace {

/// As gettext's compiler writes it: both tables, sorted by the originals.
std::string compiled(const std::map<std::string, std::string>& texts, bool turned = false) {
    std::string out, strings;
    const auto number = [&](std::string& to, std::size_t value) {
        for (unsigned byte = 0; byte < 4; ++byte) {
            to += static_cast<char>(value >> (8 * (turned ? 3 - byte : byte)));
        }
    };
    const std::size_t count = texts.size(), first = 28 + 16 * count;
    std::string originals, translations;
    for (const auto& [original, translation] : texts) {
        number(originals, original.size());
        number(originals, first + strings.size());
        strings += original + '\0';
        number(translations, translation.size());
        number(translations, first + strings.size());
        strings += translation + '\0';
    }
    number(out, 0x950412de);
    for (const std::size_t value : {std::size_t{0}, count, std::size_t{28}, 28 + 8 * count, std::size_t{0}, first}) {
        number(out, value);
    }
    return out + originals + translations + strings;
}

const std::map<std::string, std::string> kTexts = {{"", "Content-Type: text/plain"},
                                                   {"Cologne", "Köln"},
                                                   {"Munich", "München"},
                                                   {"City in Egypt\x04"
                                                    "Cairo",
                                                    "Kairo"}};

}  // namespace

TEST(MessageCatalogueTest, Texts_AreFoundByContextAndText) {
    for (const bool turned : {false, true}) {
        const auto catalogue = MessageCatalogue::parse(compiled(kTexts, turned));
        ASSERT_TRUE(catalogue);
        EXPECT_EQ(catalogue->find("", "Munich"), "München");
        EXPECT_EQ(catalogue->find("", "Cologne"), "Köln");
        EXPECT_EQ(catalogue->find("City in Egypt", "Cairo"), "Kairo");
        EXPECT_EQ(catalogue->find("", "Cairo"), "");
        EXPECT_EQ(catalogue->find("", "Paris"), "");
    }
}

TEST(MessageCatalogueTest, AFileThatEndsEarlyOrPointsOutside_IsReadWithinItsBounds) {
    const std::string whole = compiled(kTexts);
    for (std::size_t size = 0; size < whole.size(); ++size) {
        // A block of its own size, so that a look beyond it is one beyond the heap's.
        if (const auto cut = MessageCatalogue::parse(std::string(whole.data(), size))) {
            EXPECT_LE(cut->find("", "Munich").size(), size);
        }
    }
    for (std::size_t at = 0; at < 60; ++at) {
        for (const char byte : {'\x7f', '\xff'}) {
            std::string damaged = whole;
            damaged[at] = byte;
            if (const auto catalogue = MessageCatalogue::parse(damaged)) {
                EXPECT_LE(catalogue->find("", "Munich").size(), whole.size());
            }
        }
    }
    EXPECT_FALSE(MessageCatalogue::parse(""));
    EXPECT_FALSE(MessageCatalogue::parse("GNU gettext"));
}

TEST(MessageCatalogueTest, WhatIsNoFile_IsNull) {
    const test::TemporaryFolder folder;
    EXPECT_FALSE(MessageCatalogue::read((folder.path() / "none.mo").string()));
    EXPECT_FALSE(MessageCatalogue::read(folder.path().string()));
    const auto file = folder.write("de.mo", compiled(kTexts));
    ASSERT_TRUE(MessageCatalogue::read(file.string()));
    EXPECT_EQ(MessageCatalogue::read(file.string())->find("", "Munich"), "München");
}

}  // namespace ktr::server
