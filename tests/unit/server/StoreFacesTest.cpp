#include "tests/unit/server/StoreContract.h"

namespace ktr::test {

using server::CardState;
using server::SentCard;
using namespace std::string_literals;

class StoreFaces : public StoreContract {
  protected:
    bool keepFace(const std::string& picture) {
        return finished([&](auto done) { store_->keepFace(ann_, picture, done); });
    }
    const std::string picture_ = "\x89PNG\0picture"s;
};

TEST_P(StoreFaces, Face_ComesBackAsItWas_AndIsReplacedAndTakenAway) {
    EXPECT_EQ(store_->face(ann_), std::nullopt);
    ASSERT_TRUE(keepFace(picture_));
    EXPECT_EQ(store_->face(ann_), picture_);
    ASSERT_TRUE(keepFace("another"));
    EXPECT_EQ(store_->face(ann_), "another");
    ASSERT_TRUE(store_->setFace(ann_, picture_));
    open();
    EXPECT_EQ(store_->face(ann_), picture_);
    ASSERT_TRUE(store_->setFace(ann_, ""));
    EXPECT_EQ(store_->face(ann_), std::nullopt);
    EXPECT_EQ(store_->face(otto_), std::nullopt);
}

TEST_P(StoreFaces, HiddenPerson_GetsNoFaceFromAPhone) {
    ASSERT_TRUE(store_->setHidden(ann_, true, kNow));
    EXPECT_TRUE(keepFace(picture_)) << "nothing failed";
    EXPECT_EQ(store_->face(ann_), std::nullopt);
}

TEST_P(StoreFaces, Cards_AreKnownByDeviceAndFriend) {
    ASSERT_TRUE(store_->addDevice(otto_, server::DeviceKind::Phone, "otto's", "", kNow));
    ASSERT_TRUE(store_->addDevice(otto_, server::DeviceKind::Phone, "otto's other", "", kNow));
    bool failed = false;
    const auto phone = store_->deviceOf("otto's", failed)->id;
    const auto other = store_->deviceOf("otto's other", failed)->id;
    ASSERT_EQ(store_->cards(phone, otto_), (std::map<std::int64_t, CardState>{{ann_, {}}}));
    ASSERT_TRUE(keepFace(picture_));
    const SentCard sent{"h\0sh"s, kNow, kNow - 5};
    for (const auto& card : {SentCard{"old", 1, 2}, sent}) {
        ASSERT_TRUE(finished([&](auto done) { store_->noteCards(phone, {{ann_, card}}, done); }));
    }
    const auto cards = store_->cards(phone, otto_);
    EXPECT_EQ(cards.at(ann_).sent, sent);
    EXPECT_EQ(cards.at(ann_).faceHash.size(), 32U);
    EXPECT_EQ(store_->cards(other, otto_).at(ann_).sent, SentCard()) << "each phone by itself";
    EXPECT_TRUE(store_->cards(phone, mara_).empty()) << "nobody shares with her";
}

INSTANTIATE_TEST_SUITE_P(Sqlite, StoreFaces, ::testing::Values(false));
INSTANTIATE_TEST_SUITE_P(Postgres, StoreFaces, ::testing::Values(true));

}  // namespace ktr::test
