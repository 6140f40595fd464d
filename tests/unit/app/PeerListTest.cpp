#include "app/voice/PeerList.h"

#include <gtest/gtest.h>

namespace ktr::test {

using app::PeerList;

TEST(PeerListTest, WithoutAList_OnlyThisMachineMayConnect) {
    const PeerList peers;
    for (const char* own : {"127.0.0.1", "127.3.2.1", "::1", "::ffff:127.0.0.1"}) {
        EXPECT_TRUE(peers.allows(QHostAddress(QString::fromLatin1(own)))) << own;
    }
    for (const char* other : {"192.168.1.20", "::ffff:192.168.1.20", "fe80::1", "0.0.0.0", "128.0.0.1"}) {
        EXPECT_FALSE(peers.allows(QHostAddress(QString::fromLatin1(other)))) << other;
    }
    EXPECT_FALSE(peers.allows(QHostAddress()));
}

TEST(PeerListTest, WhatIsOnTheList_MayAndItsNeighbourMayNot) {
    PeerList peers;
    EXPECT_EQ(peers.add("192.168.1.20"), "");
    EXPECT_EQ(peers.add("10.1.0.0/16"), "");
    EXPECT_EQ(peers.add("fd00::7"), "");
    for (const char* listed : {"192.168.1.20", "::ffff:192.168.1.20", "10.1.255.9", "fd00::7"}) {
        EXPECT_TRUE(peers.allows(QHostAddress(QString::fromLatin1(listed)))) << listed;
    }
    for (const char* other : {"192.168.1.21", "10.2.0.1", "fd00::8"}) {
        EXPECT_FALSE(peers.allows(QHostAddress(QString::fromLatin1(other)))) << other;
    }
}

TEST(PeerListTest, WhatIsNoAddress_IsRefusedWithAReason) {
    for (const char* text : {"", "kitchen", "192.168.1.20/33", "192.168.1.20/x", "1.2.3.4/0", "::/0", "0.0.0.0/0"}) {
        PeerList peers;
        EXPECT_NE(peers.add(text), "") << text;
        EXPECT_TRUE(peers.isEmpty()) << text;
    }
}

}  // namespace ktr::test
