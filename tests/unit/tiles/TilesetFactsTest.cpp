#include "tiles/TilesetFacts.h"

#include <gtest/gtest.h>
#include <libdeflate.h>

#include "tiles/Gunzip.h"

namespace ktr::tiles {

namespace {

enum class Packing { Gzip, Zlib };

std::string packed(const std::string& data, Packing packing) {
    auto* compressor = libdeflate_alloc_compressor(6);
    std::string out(libdeflate_gzip_compress_bound(compressor, data.size()) + 64, '\0');
    out.resize(packing == Packing::Gzip
                   ? libdeflate_gzip_compress(compressor, data.data(), data.size(), out.data(), out.size())
                   : libdeflate_zlib_compress(compressor, data.data(), data.size(), out.data(), out.size()));
    libdeflate_free_compressor(compressor);
    return out;
}

std::string text(const std::optional<platform::Bytes>& bytes) {
    return bytes ? std::string(bytes->begin(), bytes->end()) : std::string("none");
}

}  // namespace

TEST(TilesetFactsTest, Metadata_IsRead) {
    const auto facts = TilesetFacts::of({{"format", "PBF"},
                                         {"minzoom", "3"},
                                         {"maxzoom", "14"},
                                         {"bounds", "-180,-85.06, 180 , 85.06"},
                                         {"name", "Town"},
                                         {"attribution", "&copy; <a href=\"x>y\">Map   contributors</a>"}});
    EXPECT_EQ(facts.format, "pbf");
    EXPECT_EQ(facts.name, "Town");
    EXPECT_EQ(facts.coarsest, 3);
    EXPECT_EQ(facts.finest, 14);
    ASSERT_TRUE(facts.bounds.has_value());
    EXPECT_EQ(facts.bounds->left, 0.0);
    EXPECT_EQ(facts.bounds->right, 1.0);
    EXPECT_NEAR(facts.bounds->top, 0.0, 1e-9);
    EXPECT_NEAR(facts.bounds->bottom, 1.0, 1e-9);
}

TEST(TilesetFactsTest, Nonsense_IsLeftOut) {
    for (const char* bounds : {"", "1,2,3", "a,b,c,d", "10,50,5,55", "10,55,15,50", "nan,0,1,1", "1e999,0,1,1"}) {
        EXPECT_FALSE(TilesetFacts::of({{"bounds", bounds}}).bounds.has_value()) << bounds;
    }
    for (const char* level : {"", "x", "-1", "31", "99", "99999999999"}) {
        EXPECT_FALSE(TilesetFacts::of({{"minzoom", level}}).coarsest.has_value()) << level;
    }
}

TEST(TilesetFactsTest, Attribution_IsNeverEmpty) {
    EXPECT_EQ(TilesetFacts::of({}).attribution, "Offline map");
    EXPECT_EQ(TilesetFacts::of({{"name", "Town"}, {"attribution", "<p> </p>"}}).attribution, "Town");
}

TEST(TilesetFactsTest, PlainText_HasNoMarkup) {
    EXPECT_EQ(TilesetFacts::plainText("<a href='https://x'>&copy; Map contributors</a>"), "© Map contributors");
    EXPECT_EQ(TilesetFacts::plainText("&lt;b&gt; &amp;amp; it&#39;s"), "<b> &amp; it's");
    EXPECT_EQ(TilesetFacts::plainText("a\n\tb\x01"
                                      "c"),
              "a b c");
    EXPECT_EQ(TilesetFacts::plainText("<unclosed"), "");
    EXPECT_EQ(TilesetFacts::plainText(std::string(100'000, 'x')).size(), 120U);
}

TEST(GunzipTest, PackedAndPlain_AreRead) {
    const std::string data = "a tile, a tile, a tile, a tile";
    EXPECT_EQ(text(gunzip(packed(data, Packing::Gzip), 1000)), data);
    EXPECT_EQ(text(gunzip(packed(data, Packing::Zlib), 1000)), data);
    EXPECT_EQ(text(gunzip(data, 1000)), data);
    EXPECT_EQ(text(gunzip("", 1000)), "");
}

TEST(GunzipTest, Bomb_IsRefused) {
    const std::string bomb(std::size_t{8} << 20, '\0');
    for (const auto packing : {Packing::Gzip, Packing::Zlib}) {
        const std::string small = packed(bomb, packing);
        ASSERT_LT(small.size(), 20'000U);
        EXPECT_EQ(gunzip(small, std::size_t{1} << 20), std::nullopt);
        EXPECT_EQ(gunzip(small, bomb.size())->size(), bomb.size());
    }
    EXPECT_EQ(gunzip(std::string(2000, 'x'), 1999), std::nullopt);
}

TEST(GunzipTest, LyingSize_IsNoPromise) {
    std::string liar = packed("short", Packing::Gzip);
    for (std::size_t index = liar.size() - 4; index < liar.size(); ++index) {
        liar[index] = '\xFF';
    }
    EXPECT_EQ(gunzip(liar, 1 << 20), std::nullopt);
}

TEST(GunzipTest, Damaged_IsNone) {
    const std::string whole = packed("a tile, a tile, a tile, a tile", Packing::Gzip);
    for (std::size_t size = 18; size < whole.size(); ++size) {
        EXPECT_EQ(gunzip(std::string_view(whole).substr(0, size), 1000), std::nullopt) << size;
    }
}

}  // namespace ktr::tiles
