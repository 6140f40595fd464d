#include "linux/device/Buses.h"

#include <gtest/gtest.h>
#include <sys/socket.h>
#include <sys/un.h>
#include <unistd.h>

#include <chrono>
#include <cstring>
#include <string>
#include <thread>

#include "tests/support/EnvironmentVariable.h"
#include "tests/support/TemporaryFolder.h"

namespace ktr::test {

namespace {

using linux_::Buses;
using Greeting = Buses::Greeting;

}  // namespace

/// A socket in the place of a bus.
class BusesTest : public ::testing::Test {
  protected:
    void listen(int backlog = 8) {
        socket_ = ::socket(AF_UNIX, SOCK_STREAM | SOCK_CLOEXEC, 0);
        sockaddr_un place{};
        place.sun_family = AF_UNIX;
        std::strncpy(place.sun_path, path().c_str(), sizeof(place.sun_path) - 1);
        ASSERT_EQ(::bind(socket_, reinterpret_cast<const sockaddr*>(&place), sizeof(place)), 0);
        ASSERT_EQ(::listen(socket_, backlog), 0);
    }
    /// Takes one connection and says these words, each after something was heard.
    void say(std::vector<std::string> words) {
        speaker_ = std::thread([this, words = std::move(words)] {
            const int connection = ::accept(socket_, nullptr, nullptr);
            char heard[1024];
            for (const std::string& word : words) {
                if (::recv(connection, heard, sizeof(heard), 0) <= 0) {
                    break;
                }
                EXPECT_EQ(::send(connection, word.data(), word.size(), MSG_NOSIGNAL),
                          static_cast<ssize_t>(word.size()));
            }
            while (::recv(connection, heard, sizeof(heard), 0) > 0) {
            }
            ::close(connection);
        });
    }
    void TearDown() override {
        if (speaker_.joinable()) {
            speaker_.join();
        }
        if (socket_ >= 0) {
            ::close(socket_);
        }
    }
    std::string path() const { return (folder_.path() / "bus").string(); }
    std::string address() const { return "unix:path=" + path(); }
    template <class Work>
    static double secondsOf(Work work) {
        const auto begin = std::chrono::steady_clock::now();
        work();
        return std::chrono::duration<double>(std::chrono::steady_clock::now() - begin).count();
    }

    TemporaryFolder folder_;
    int socket_ = -1;
    std::thread speaker_;
};

TEST_F(BusesTest, OneThatAnswersHello_IsWell) {
    listen();
    say({"OK 0123456789abcdef0123456789abcdef\r\n", "l"});
    EXPECT_EQ(Buses::greet(address(), 20.0), Greeting::Answered);
}

TEST_F(BusesTest, OneThatTakesNobody_IsWell) {
    listen();
    say({"REJECTED EXTERNAL\r\n"});
    EXPECT_EQ(Buses::greet(address(), 20.0), Greeting::Answered);
}

TEST_F(BusesTest, OneThatSaysNothing_IsSilentInTime) {
    listen();
    Greeting greeting = Greeting::Unknown;
    EXPECT_LT(secondsOf([&] { greeting = Buses::greet(address(), 0.2); }), 5.0);
    EXPECT_EQ(greeting, Greeting::Silent);
}

TEST_F(BusesTest, OneThatFallsSilentAfterTheFirstWord_IsSilent) {
    listen();
    say({"OK 0123456789abcdef0123456789abcdef\r\n"});
    EXPECT_EQ(Buses::greet(address(), 0.2), Greeting::Silent);
}

TEST_F(BusesTest, OneThatHangsUp_IsNotWaitedFor) {
    listen();
    std::thread taker([this] { ::close(::accept(socket_, nullptr, nullptr)); });
    EXPECT_LT(secondsOf([&] { EXPECT_EQ(Buses::greet(address(), 20.0), Greeting::Refused); }), 10.0);
    taker.join();
}

TEST_F(BusesTest, NoSocket_IsRefused) {
    EXPECT_EQ(Buses::greet(address(), 20.0), Greeting::Refused);
}

TEST_F(BusesTest, Addresses_OfOtherKindsAreLeftAlone) {
    for (const char* other : {"", "tcp:host=localhost,port=1", "autolaunch:", "unix:", "unix:guid=1", "nonsense"}) {
        EXPECT_EQ(Buses::greet(other, 20.0), Greeting::Unknown) << other;
    }
}

TEST_F(BusesTest, Addresses_FirstThatIsThereCounts) {
    listen();
    say({"REJECTED EXTERNAL\r\n"});
    EXPECT_EQ(Buses::greet("unix:path=/nowhere/bus;unix:guid=0,path=" + path(), 20.0), Greeting::Answered);
}

TEST_F(BusesTest, SilentOnes_AreSwitchedOff) {
    listen();
    const EnvironmentVariable session("DBUS_SESSION_BUS_ADDRESS", address().c_str());
    const EnvironmentVariable system("DBUS_SYSTEM_BUS_ADDRESS", "unix:path=/nowhere/bus");
    const auto lines = Buses::switchOffSilent();
    ASSERT_EQ(lines.size(), 1U);
    EXPECT_NE(lines.front().find("session"), std::string::npos);
    EXPECT_NE(std::string(std::getenv("DBUS_SESSION_BUS_ADDRESS")), address());
    EXPECT_EQ(Buses::greet(std::getenv("DBUS_SESSION_BUS_ADDRESS")), Greeting::Unknown);
    EXPECT_STREQ(std::getenv("DBUS_SYSTEM_BUS_ADDRESS"), "unix:path=/nowhere/bus");
}

}  // namespace ktr::test
