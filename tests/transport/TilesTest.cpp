#include <QBuffer>
#include <QImage>
#include <atomic>
#include <chrono>
#include <condition_variable>
#include <mutex>

#include "linux/maps/HttpsPictures.h"
#include "linux/maps/MapDrawer.h"
#include "linux/maps/PictureGround.h"
#include "tests/support/TemporaryFolder.h"
#include "tests/transport/TransportTest.h"

namespace ktr::test {

using linux_::HttpsPictures;
using tiles::TileKey;

namespace {

const std::string kPng = "\x89PNG\r\n\x1a\n not read here";

}  // namespace

/// Tiles from servers of this process.
class TilesTest : public TransportTest {
  protected:
    HttpsPictures::Settings tileSettings() const {
        HttpsPictures::Settings made;
        made.url = server->url("/base/{z}/{x}/{y}.png?key=a");
        made.attribution = "© Somebody";
        made.cacheFolder = folder.path() / "tiles";
        made.cacheBytes = 1 << 20;
        made.certificateFiles = {certificates->authority().toStdString()};
        return made;
    }
    void open() { open(tileSettings()); }
    void open(HttpsPictures::Settings made) {
        pictures.reset();
        pictures = std::make_unique<HttpsPictures>(std::move(made));
        pictures->setChangeHandler([this] {
            const std::lock_guard lock(mutex);
            ++changes;
            arrived.notify_all();
        });
    }
    bool waitForChange(int wanted = 1) {
        std::unique_lock lock(mutex);
        return arrived.wait_for(lock, std::chrono::seconds(30), [&] { return changes >= wanted; });
    }
    /// Until the server has had this many requests.
    bool waitForRequests(std::size_t wanted) const {
        const auto deadline = std::chrono::steady_clock::now() + std::chrono::seconds(30);
        while (server->requests().size() < wanted) {
            if (std::chrono::steady_clock::now() > deadline) {
                return false;
            }
            std::this_thread::yield();
        }
        return true;
    }
    static std::string text(const linux_::TilePictures::Answer& answer) {
        return answer.data ? std::string(answer.data->begin(), answer.data->end()) : std::string("none");
    }

    static constexpr TileKey kTile{5, 10, 11};
    TemporaryFolder folder;
    std::mutex mutex;
    std::condition_variable arrived;
    int changes = 0;
    std::unique_ptr<HttpsPictures> pictures;
};

TEST_F(TilesTest, ATileIsFetchedOnce_AndSaysNothingOfTheUser) {
    serve(answering(200, "Cache-Control: max-age=600\r\nETag: \"v1\"\r\nSet-Cookie: a=b\r\n", kPng));
    open();
    auto first = pictures->tile(kTile, true);
    EXPECT_EQ(text(first), "none");
    EXPECT_TRUE(first.isComing);
    EXPECT_TRUE(pictures->tile(kTile, true).isComing);
    ASSERT_TRUE(waitForChange());
    const auto second = pictures->tile(kTile, true);
    EXPECT_EQ(text(second), kPng);
    EXPECT_FALSE(second.isComing);
    EXPECT_NE(second.version, first.version);

    ASSERT_EQ(server->requests().size(), 1U);
    const std::string head = server->requests()[0].head;
    EXPECT_EQ(head.substr(0, head.find("\r\n")), "GET /base/5/10/11.png?key=a HTTP/1.1");
    EXPECT_NE(head.find("User-Agent: ktr/"), std::string::npos);
    for (const char* field : {"Referer", "Cookie", "Authorization", "Mozilla", "If-"}) {
        EXPECT_EQ(head.find(field), std::string::npos) << head;
    }
    EXPECT_NE(head.find("Accept-Language: *"), std::string::npos) << head;
    // From the disk in the next run.
    open();
    EXPECT_EQ(text(pictures->tile(kTile, true)), kPng);
    EXPECT_EQ(server->requests().size(), 1U);
}

TEST_F(TilesTest, NotWanted_IsNotAskedFor) {
    serve(gladly());
    open();
    EXPECT_FALSE(pictures->tile(kTile, false).isComing);
    pictures.reset();
    EXPECT_EQ(server->connections(), 0);
}

TEST_F(TilesTest, AStaleTile_IsShownAndAskedAboutConditionally) {
    serve([](QSslSocket& socket, const TestServer::Request& request) {
        const bool isKnown = request.head.find("If-None-Match: \"v1\"") != std::string::npos &&
                             request.head.find("If-Modified-Since: Sun, 06 Nov 1994 08:49:37 GMT") != std::string::npos;
        if (isKnown) {
            answerWith(socket, 304, "Cache-Control: max-age=600\r\n", "");
        } else {
            answerWith(socket, 200,
                       "Cache-Control: max-age=0\r\nETag: \"v1\"\r\nLast-Modified: Sun, 06 Nov 1994 08:49:37 GMT\r\n",
                       kPng);
        }
    });
    open();
    pictures->tile(kTile, true);
    ASSERT_TRUE(waitForChange());
    // In this run it is not asked for again so soon; in the next one it is.
    EXPECT_EQ(text(pictures->tile(kTile, true)), kPng);
    EXPECT_EQ(server->requests().size(), 1U);
    open();
    const auto stale = pictures->tile(kTile, true);
    EXPECT_EQ(text(stale), kPng);
    EXPECT_FALSE(stale.isComing);
    ASSERT_TRUE(waitForRequests(2));
    // Its end is waited for, so that the answer has been read.
    const auto deadline = std::chrono::steady_clock::now() + std::chrono::seconds(30);
    linux_::TileStore store(folder.path() / "tiles", server->url("/base/{z}/{x}/{y}.png?key=a"), 1 << 20);
    const auto soon = std::chrono::system_clock::to_time_t(std::chrono::system_clock::now()) + 300;
    while (store.load(kTile)->expires < soon && std::chrono::steady_clock::now() < deadline) {
        std::this_thread::yield();
    }
    EXPECT_GE(store.load(kTile)->expires, soon);
    open();
    EXPECT_EQ(text(pictures->tile(kTile, true)), kPng);
    pictures.reset();
    EXPECT_EQ(server->requests().size(), 2U);
    EXPECT_EQ(changes, 1);
}

TEST_F(TilesTest, NoStore_IsKeptInMemoryOnly) {
    serve(answering(200, "Cache-Control: no-store\r\n", kPng));
    open();
    pictures->tile(kTile, true);
    ASSERT_TRUE(waitForChange());
    EXPECT_EQ(text(pictures->tile(kTile, true)), kPng);
    open();
    EXPECT_EQ(text(pictures->tile(kTile, false)), "none");
}

TEST_F(TilesTest, MissingTiles_AreNotAskedForAgain) {
    serve(answering(404, "", "none"));
    open();
    EXPECT_TRUE(pictures->tile(kTile, true).isComing);
    ASSERT_TRUE(waitForChange());
    EXPECT_FALSE(pictures->tile(kTile, true).isComing);
    pictures.reset();
    EXPECT_EQ(server->requests().size(), 1U);
}

TEST_F(TilesTest, AServerThatIsBusy_IsLeftAlone) {
    std::atomic<int> answers = 0;
    serve([&](QSslSocket& socket, const TestServer::Request&) {
        answerWith(socket, 429, "Retry-After: 120\r\n", "");
        ++answers;
    });
    open();
    EXPECT_TRUE(pictures->tile(kTile, true).isComing);
    const auto deadline = std::chrono::steady_clock::now() + std::chrono::seconds(30);
    while (log->texts().empty() && std::chrono::steady_clock::now() < deadline) {
        std::this_thread::yield();
    }
    ASSERT_EQ(log->texts().size(), 1U);
    EXPECT_NE(log->texts()[0].find("the server answered 429"), std::string::npos);
    // Other tiles wait as well: whoever asks after them, from the beginning, is heard first.
    for (int y = 0; y < 8; ++y) {
        pictures->tile({6, 1, y}, true);
    }
    for (int other = 1; other <= 4; ++other) {
        auto others = tileSettings();
        others.cacheFolder = folder.path() / std::to_string(other);
        HttpsPictures second(others);
        second.tile(kTile, true);
        while (answers < 1 + other && std::chrono::steady_clock::now() < deadline) {
            std::this_thread::yield();
        }
    }
    pictures.reset();
    EXPECT_EQ(server->requests().size(), 5U);
}

TEST_F(TilesTest, AServerThatBreaksOff_IsLeftAlone) {
    auto options = tls();
    options.refuses = true;
    serve(options, gladly());
    open();
    for (int turn = 0; turn < 4; ++turn) {
        for (int y = 0; y < 32; ++y) {
            pictures->tile({6, turn, y}, true);
        }
        const auto deadline = std::chrono::steady_clock::now() + std::chrono::seconds(30);
        while (log->texts().empty() && std::chrono::steady_clock::now() < deadline) {
            std::this_thread::yield();
        }
    }
    pictures.reset();
    // Two at a time, and then a pause that is longer than all of this, even where that takes a while.
    EXPECT_LE(server->connections(), 8);
    EXPECT_EQ(log->texts().size(), 1U);
}

TEST_F(TilesTest, Redirects_AreNotFollowed) {
    TestServer other(tls(), gladly());
    serve(answering(302, "Location: " + other.url("/5/10/11.png") + "\r\n", ""));
    open();
    pictures->tile(kTile, true);
    // The second tile's request comes after the first one's end.
    pictures->tile({5, 10, 12}, true);
    pictures->tile({5, 10, 13}, true);
    ASSERT_TRUE(waitForRequests(3));
    EXPECT_EQ(text(pictures->tile(kTile, true)), "none");
    pictures.reset();
    EXPECT_EQ(other.connections(), 0);
}

TEST_F(TilesTest, WhatIsNoPicture_IsNotKept) {
    serve(answering(200, "", "<html>Sign in</html>"));
    open();
    pictures->tile(kTile, true);
    ASSERT_TRUE(waitForRequests(1));
    pictures.reset();
    open();
    EXPECT_EQ(text(pictures->tile(kTile, false)), "none");
}

TEST_F(TilesTest, EndlessAnswers_AreCutOff) {
    std::atomic<bool> isCut = false;
    serve([&](QSslSocket& socket, const TestServer::Request&) {
        socket.write("HTTP/1.1 200 OK\r\nContent-Type: image/png\r\n\r\n\x89PNG\r\n\x1a\n");
        const QByteArray much(1 << 16, 'x');
        QObject::connect(&socket, &QSslSocket::disconnected, &socket, [&] { isCut = true; });
        QObject::connect(&socket, &QSslSocket::encryptedBytesWritten, &socket, [&socket, much] {
            if (socket.encryptedBytesToWrite() < (1 << 18)) {
                socket.write(much);
            }
        });
        socket.write(much);
    });
    open();
    pictures->tile(kTile, true);
    const auto deadline = std::chrono::steady_clock::now() + std::chrono::seconds(30);
    while (!isCut && std::chrono::steady_clock::now() < deadline) {
        std::this_thread::yield();
    }
    EXPECT_TRUE(isCut);
    EXPECT_EQ(text(pictures->tile(kTile, false)), "none");
    pictures.reset();
    server.reset();
}

TEST_F(TilesTest, AServerThatCannotProveWhoItIs_HearsNothing) {
    for (const char* kind : {"expired", "wrongname", "foreign", "selfsigned"}) {
        serve(tls(kind), gladly());
        open();
        pictures->tile(kTile, true);
        const auto deadline = std::chrono::steady_clock::now() + std::chrono::seconds(30);
        while (server->connections() == 0 && std::chrono::steady_clock::now() < deadline) {
            std::this_thread::yield();
        }
        EXPECT_GT(server->connections(), 0) << kind;
        pictures.reset();
        EXPECT_EQ(server->received(), "") << kind;
    }
}

TEST_F(TilesTest, TwoAtATime) {
    std::atomic<int> now = 0;
    std::atomic<int> most = 0;
    auto options = tls();
    options.connected = [&](QSslSocket& socket) {
        most = std::max<int>(most, ++now);
        QObject::connect(&socket, &QSslSocket::disconnected, &socket, [&] { --now; });
    };
    serve(options, answering(200, "Connection: close\r\n", kPng));
    open();
    for (int x = 0; x < 12; ++x) {
        pictures->tile({5, x, 0}, true);
    }
    ASSERT_TRUE(waitForRequests(12));
    pictures.reset();
    EXPECT_LE(most, 2);
    server.reset();
}

TEST_F(TilesTest, AMap_IsWholeOnceItsTilesHaveArrived) {
    QImage tile(256, 256, QImage::Format_RGB32);
    tile.fill(Qt::red);
    QByteArray png;
    QBuffer buffer(&png);
    buffer.open(QIODevice::WriteOnly);
    ASSERT_TRUE(tile.save(&buffer, "PNG"));
    serve(answering(200, "Cache-Control: max-age=600\r\n", png.toStdString()));
    open();
    const auto ground = std::make_shared<linux_::PictureGround>(std::move(pictures));
    int drawn = 0;
    ground->setChangeHandler([this] {
        const std::lock_guard lock(mutex);
        ++changes;
        arrived.notify_all();
    });
    platform::MapPictureRequest request;
    request.viewport = {{50.0, 10.0}, 5.0, {400.0, 219.0}};
    const auto draw = [&] {
        ++drawn;
        return linux_::MapDrawer::draw(request, {ground}, {});
    };
    auto picture = draw();
    EXPECT_FALSE(picture->isComplete);
    EXPECT_NE(picture->pixels.pixelColor(200, 110), QColor(Qt::red));
    while (!picture->isComplete && drawn < 50) {
        ASSERT_TRUE(waitForChange(drawn));
        picture = draw();
    }
    EXPECT_TRUE(picture->isComplete);
    EXPECT_EQ(picture->attribution, "© Somebody");
    for (const QPoint corner : {QPoint(0, 0), QPoint(399, 218), QPoint(200, 110)}) {
        EXPECT_EQ(picture->pixels.pixelColor(corner), QColor(Qt::red));
    }
}

TEST_F(TilesTest, EndingWhileTilesAreComing_IsQuick) {
    serve([](QSslSocket&, const TestServer::Request&) {});
    open();
    for (int x = 0; x < 100; ++x) {
        pictures->tile({7, x, 0}, true);
    }
    ASSERT_TRUE(waitForRequests(2));
    const auto start = std::chrono::steady_clock::now();
    pictures.reset();
    EXPECT_LT(std::chrono::steady_clock::now() - start, std::chrono::seconds(10));
    EXPECT_EQ(changes, 0);
}

}  // namespace ktr::test
