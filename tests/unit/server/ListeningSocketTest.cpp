#include "server/http/ListeningSocket.h"

#include <grp.h>
#include <gtest/gtest.h>
#include <sys/mman.h>
#include <sys/stat.h>
#include <unistd.h>

#include <filesystem>
#include <optional>
#include <string>

#include "tests/support/RawClient.h"
#include "tests/support/TemporaryFolder.h"

namespace ktr::test {

using server::ListeningSocket;

class ListeningSocketTest : public ::testing::Test {
  protected:
    std::optional<ListeningSocket> make(const std::string& path, const std::string& group = "") {
        complaint_.clear();
        return ListeningSocket::at({path, group}, complaint_);
    }
    unsigned modeOf(const std::string& path) const {
        struct stat facts {};
        return ::lstat(path.c_str(), &facts) == 0 && S_ISSOCK(facts.st_mode) ? facts.st_mode & 0777U : 0U;
    }

    TemporaryFolder folder_;
    const std::string path_ = (folder_.path() / "http.sock").string();
    std::string complaint_;
};

TEST_F(ListeningSocketTest, Socket_IsItsOwnersAlone_AndGoesWithItsOwner) {
    {
        const auto socket = make(path_);
        ASSERT_TRUE(socket) << complaint_;
        EXPECT_EQ(modeOf(path_), 0600U);
        EXPECT_TRUE(socket->isFile());
        EXPECT_TRUE(socket->isLocal());
        EXPECT_EQ(socket->port(), 0);
        EXPECT_TRUE(RawClient(path_).connected());
    }
    EXPECT_TRUE(std::filesystem::is_empty(folder_.path())) << "neither the socket nor what it was made as stays";
}

TEST_F(ListeningSocketTest, Group_MayConnect_AnUnknownOneIsSaid) {
    const struct group* own = ::getgrgid(::getegid());
    ASSERT_NE(own, nullptr);
    const auto socket = make(path_, own->gr_name);
    ASSERT_TRUE(socket) << complaint_;
    EXPECT_EQ(modeOf(path_), 0660U);
    EXPECT_FALSE(make((folder_.path() / "other").string(), "no such group"));
    EXPECT_EQ(complaint_, "no such group: there is no such group");
}

TEST_F(ListeningSocketTest, SocketOfAnEndedProcess_IsReplaced_OneThatIsServedIsNot) {
    const auto first = make(path_);
    ASSERT_TRUE(first);
    EXPECT_FALSE(make(path_));
    EXPECT_EQ(complaint_, path_ + ": is served by another process");
    const std::string moved = path_ + ".left";
    std::filesystem::rename(path_, moved);
    {
        const auto left = make(path_);
        ASSERT_TRUE(left);
        // As after a kill: the file stays.
        std::filesystem::create_hard_link(path_, path_ + ".2");
    }
    EXPECT_FALSE(RawClient(path_ + ".2").connected());
    const auto again = make(path_ + ".2");
    EXPECT_TRUE(again) << complaint_;
    EXPECT_TRUE(RawClient(path_ + ".2").connected());
}

TEST_F(ListeningSocketTest, WhatIsNoSocket_IsLeftAsItIs) {
    folder_.write("http.sock", "a file");
    EXPECT_FALSE(make(path_));
    EXPECT_EQ(complaint_, path_ + ": is there already, and no socket");
    EXPECT_EQ(TemporaryFolder::read(path_), "a file");
    std::filesystem::create_directory(folder_.path() / "folder");
    EXPECT_FALSE(make((folder_.path() / "folder").string()));
    ASSERT_EQ(::mkfifo((folder_.path() / "pipe").c_str(), 0600), 0);
    EXPECT_FALSE(make((folder_.path() / "pipe").string()));
}

TEST_F(ListeningSocketTest, FolderThatOthersMayWrite_TooLongAPath_AndNoFolder_AreSaid) {
    const std::string open = (folder_.path() / "open").string();
    std::filesystem::create_directory(open);
    ::chmod(open.c_str(), 0777);
    EXPECT_FALSE(make(open + "/http.sock"));
    EXPECT_NE(complaint_.find("others may write"), std::string::npos) << complaint_;
    EXPECT_FALSE(make((folder_.path() / std::string(120, 'x')).string()));
    EXPECT_NE(complaint_.find("at most 90 bytes"), std::string::npos) << complaint_;
    EXPECT_FALSE(make((folder_.path() / "missing" / "http.sock").string()));
    EXPECT_FALSE(complaint_.empty());
}

TEST_F(ListeningSocketTest, FileOfItsNameThatIsAnothers_StaysWhenItGoes) {
    {
        const auto socket = make(path_);
        ASSERT_TRUE(socket);
        std::filesystem::remove(path_);
        folder_.write("http.sock", "another's");
    }
    EXPECT_EQ(TemporaryFolder::read(path_), "another's");
}

TEST_F(ListeningSocketTest, AddressOfTheNetwork_IsNotLocal) {
    const auto everywhere = ListeningSocket::onAddress("0.0.0.0", 0, complaint_);
    const auto loopback = ListeningSocket::onAddress("127.0.0.1", 0, complaint_);
    ASSERT_TRUE(everywhere && loopback) << complaint_;
    EXPECT_FALSE(everywhere->isLocal());
    EXPECT_TRUE(loopback->isLocal());
    EXPECT_FALSE(loopback->isFile());
    EXPECT_GT(loopback->port(), 0);
}

TEST_F(ListeningSocketTest, InheritedDescriptor_HasToTakeConnections) {
    auto made = make(path_);
    ASSERT_TRUE(made);
    const int copy = ::dup(made->descriptor());
    const auto inherited = ListeningSocket::inherited(copy, complaint_);
    ASSERT_TRUE(inherited) << complaint_;
    EXPECT_TRUE(inherited->isFile());
    const int file = ::memfd_create("x", 0);
    EXPECT_FALSE(ListeningSocket::inherited(file, complaint_));
    EXPECT_NE(complaint_.find("takes no connections"), std::string::npos);
    ::close(file);
}

}  // namespace ktr::test
