#include "server/outbox/EventStreams.h"

#include <gtest/gtest.h>

#include <deque>
#include <future>

#include "server/http/HttpStream.h"

namespace ktr::test {

using server::Device;
using server::DeviceKind;
using server::EventStreams;
using server::Fence;
using server::FenceCircle;
using server::FenceOutcome;
using server::Grant;
using server::HttpStream;
using server::Precision;
using server::Store;

/// Otto is told when ann arrives. What is done later is done when the test says so; time stands.
class EventStreamsTest : public ::testing::Test {
  protected:
    static constexpr std::int64_t kNow = 1763760000;

    EventStreamsTest() {
        std::string complaint;
        store = Store::open(server::StoreAddress::inMemory(), true, complaint);
        for (const char* name : {"ann", "otto"}) {
            store->addPerson(name, {}, kNow);
        }
        ann = store->personNamed("ann")->id;
        const std::int64_t otto = store->personNamed("otto")->id;
        store->addDevice(ann, DeviceKind::Phone, "ann's", "", kNow);
        store->addDevice(otto, DeviceKind::Reader, "otto's", "", kNow);
        bool failed = false;
        phone = store->deviceOf("ann's", failed)->id;
        reader = *store->deviceOf("otto's", failed);
        Grant grant{Precision::Exact, kNow - 20000, std::nullopt};
        grant.fences = true;
        store->grant(ann, otto, grant);
        std::promise<FenceOutcome> set;
        store->setFence({otto, ann, {"", FenceCircle{50.2, -3.1, 150.0}}, true, false}, kNow,
                        [&](FenceOutcome outcome, const Fence&) { set.set_value(outcome); });
        EXPECT_EQ(set.get_future().get(), FenceOutcome::Set);
        streams = std::make_unique<EventStreams>(
            EventStreams::Setup{*store, [] { return kNow; },
                                [this](double seconds, std::function<void()> work) {
                                    const std::lock_guard<std::mutex> lock(mutex);
                                    (seconds > 0.0 ? beats : soon).push_back(std::move(work));
                                }});
        runs(soon);
    }
    void runs(std::deque<std::function<void()>>& what) {
        for (;;) {
            std::function<void()> work;
            {
                const std::lock_guard<std::mutex> lock(mutex);
                if (what.empty()) {
                    return;
                }
                work = std::move(what.front());
                what.pop_front();
            }
            work();
            if (&what == &beats) {
                return;
            }
        }
    }
    /// She leaves and arrives so many times: two fixes a minute apart, and one.
    void crosses(int times) {
        for (int i = 0; i < times; ++i) {
            for (const double latitude : {50.21, 50.21, 50.2}) {
                time += 60;
                store->keep(phone, ann, {{time, time, latitude, -3.1, 10.0}}, time, nullptr);
            }
        }
        store->finish();
        runs(soon);
    }

    std::mutex mutex;
    std::deque<std::function<void()>> soon;
    std::deque<std::function<void()>> beats;
    std::unique_ptr<Store> store;
    std::int64_t ann = 0;
    std::int64_t phone = 0;
    std::int64_t time = kNow - 18000;
    Device reader;
    std::unique_ptr<EventStreams> streams;
};

TEST_F(EventStreamsTest, ReaderThatTakesNothing_KeepsLittle_AndIsToldAndLetGo) {
    const auto stream = streams->open(reader, 0).stream;
    runs(soon);
    crosses(90);
    EXPECT_EQ(streams->size(), 1U);
    runs(beats);
    EXPECT_EQ(streams->slowReaders(), 0U) << "it has time until the next beat";
    runs(beats);
    EXPECT_EQ(streams->slowReaders(), 1U);
    EXPECT_EQ(streams->size(), 0U);
    EXPECT_EQ(stream->take(), "event: ended\ndata: {\"why\":\"too slow\"}\n\n");
    EXPECT_TRUE(stream->isFinished());
}

TEST_F(EventStreamsTest, ReaderThatTakesThemInTime_GetsAll_FewAtOnce) {
    const auto stream = streams->open(reader, 0).stream;
    runs(soon);
    crosses(90);
    std::string all;
    std::size_t most = 0;
    for (std::string piece = stream->take(); !piece.empty(); piece = stream->take()) {
        most = std::max(most, piece.size());
        all += piece;
        EXPECT_EQ(stream->take(), "") << "it has gone out";
        runs(soon);
    }
    EXPECT_LT(most, HttpStream::kMost / 4);
    for (int i = 1; i <= 90; ++i) {
        EXPECT_NE(all.find("id: " + std::to_string(i) + "\n"), std::string::npos) << i;
    }
    runs(beats);
    EXPECT_EQ(stream->take(), ":\n\n");
}

TEST_F(EventStreamsTest, ReaderThatIsGone_IsForgotten) {
    const auto stream = streams->open(reader, 0).stream;
    stream->abandon();
    runs(beats);
    EXPECT_EQ(streams->size(), 0U);
    EXPECT_EQ(streams->slowReaders(), 0U);
}

}  // namespace ktr::test
