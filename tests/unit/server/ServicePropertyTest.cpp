// Who sees what, drawn by lot and asked over the network: two services whose people have histories that may not be told
// apart answer with the same bytes.
#include <gtest/gtest.h>

#include <atomic>
#include <future>
#include <memory>
#include <random>
#include <regex>
#include <string>

#include "server/http/BasicCredentials.h"
#include "server/rules/Cell.h"
#include "server/service/Service.h"
#include "tests/support/RawClient.h"

namespace ktr::test {

using server::BasicCredentials;
using server::Cell;
using server::DeviceKind;
using server::Fix;
using server::Precision;
using server::Service;
using server::Store;
using server::Visibility;

namespace {

constexpr std::int64_t kNow = 1763760300;  // a third into a town slot
constexpr std::int64_t kBegin = kNow - 86400;

/// A service on this machine, with otto, who looks.
class World {
  public:
    World() {
        std::string complaint;
        store_ = Store::open(server::StoreAddress::inMemory(), true, complaint);
        otto_ = add("otto");
        store_->addDevice(otto_, DeviceKind::Reader, "ktr", "", kBegin);
        store_->addDevice(otto_, DeviceKind::Phone, "phone", "", kBegin);
        Service::Setup setup;
        setup.store = store_;
        setup.now = [this] { return now_.load(); };
        service_ = std::make_unique<Service>(std::move(setup));
        EXPECT_EQ(service_->start(), "");
    }
    ~World() { service_->stop(); }
    World(const World&) = delete;
    World& operator=(const World&) = delete;

    std::int64_t add(const std::string& name) {
        EXPECT_TRUE(store_->addPerson(name, {name + "@x.example"}, kBegin));
        return store_->personNamed(name)->id;
    }
    void share(std::int64_t person, Precision precision) {
        EXPECT_TRUE(store_->grant(person, otto_, {precision, kBegin, std::nullopt}));
    }
    void keep(std::int64_t person, std::vector<Fix> fixes) {
        std::promise<bool> written;
        store_->keep(0, person, std::move(fixes), kNow, [&](bool good) { written.set_value(good); });
        EXPECT_TRUE(written.get_future().get());
    }
    Store& store() { return *store_; }
    void setNow(std::int64_t now) { now_ = now; }
    std::int64_t otto() const { return otto_; }

    /// The whole answer, but for its date.
    std::string ask(const std::string& handles) const {
        return send(
            "/qloxservice/friends/va/getlocations", "ktr",
            R"({"clientContext":{},"handles":[)" + handles +
                R"(],"myLocation":{"latitude":50.0,"longitude":8.0},"loc":{"latitude":50.01,"longitude":8.0}})");
    }
    std::string post(std::int64_t time) const {
        return send("/pub", "phone",
                    R"({"_type":"location","lat":10,"lon":10,"acc":9,"tst":)" + std::to_string(time) + "}");
    }

  private:
    std::string send(const std::string& path, const std::string& secret, const std::string& body) const {
        const RawClient client(service_->port());
        client.send("POST " + path + " HTTP/1.1\r\nHost: localhost\r\nConnection: close\r\nAuthorization: " +
                    BasicCredentials{"otto", secret}.header() +
                    "\r\nX-Orcha-Seek-API-Ver: 4.0\r\nX-Orcha-AuthScheme: Forever\r\nContent-Type: application/json\r\n"
                    "Content-Length: " +
                    std::to_string(body.size()) + "\r\n\r\n" + body);
        const std::string answer = client.read("(never)");
        EXPECT_EQ(answer.rfind("HTTP/1.1 200 OK\r\n", 0), 0U) << answer.substr(0, 300);
        return std::regex_replace(answer, std::regex("\r\nDate: [^\r]*"), "");
    }

    std::shared_ptr<Store> store_;
    std::unique_ptr<Service> service_;
    std::atomic<std::int64_t> now_ = kBegin;
    std::int64_t otto_ = 0;
};

}  // namespace

class ServicePropertyTest : public ::testing::Test {
  protected:
    std::int64_t between(std::int64_t least, std::int64_t most) {
        return std::uniform_int_distribution<std::int64_t>(least, most)(random_);
    }
    double real(double least, double most) { return std::uniform_real_distribution<double>(least, most)(random_); }

    /// The same slots and cells, at other times and places in them, as exactly as another phone; and more that came in
    /// the present slot.
    std::vector<Fix> alike(const std::vector<Fix>& fixes, Precision precision) {
        const std::int64_t length = Visibility::slotLength(precision);
        const double side = Visibility::cellSide(precision);
        std::vector<Fix> others;
        for (const Fix& fix : fixes) {
            Fix other = fix;
            other.time = other.heard = Visibility::slotOf(fix.time, length) * length + between(0, length - 1);
            other.latitude += real(-0.01, 0.01);
            other.longitude += real(-0.01, 0.01);
            other.accuracy = between(0, 1) == 0 ? std::nullopt : std::optional(real(1.0, 90.0));
            if (!(Cell::of(other.latitude, other.longitude, side) == Cell::of(fix.latitude, fix.longitude, side))) {
                other.latitude = fix.latitude;
                other.longitude = fix.longitude;
            }
            others.push_back(other);
        }
        const std::int64_t present = Visibility::slotOf(kNow, length) * length;
        others.push_back({between(present, kNow), kNow, real(-80.0, 80.0), 8.0, 5.0});
        others.push_back({present - between(0, 3600), between(present, kNow), real(-80.0, 80.0), 8.0, 5.0});
        return others;
    }
    /// One fix a slot, so that another time in it is the last as well.
    std::vector<Fix> history(Precision precision) {
        const std::int64_t length = std::max<std::int64_t>(Visibility::slotLength(precision), 60);
        std::vector<Fix> fixes;
        double longitude = 8.0;
        const bool moves = between(0, 2) != 0;
        for (std::int64_t slot = Visibility::slotOf(kNow, length) - between(3, 30);
             slot < Visibility::slotOf(kNow, length) - 1; slot += between(1, 2)) {
            longitude += moves ? real(0.0, 0.05) : 0.0;
            const std::int64_t time = slot * length + between(0, length - 1);
            fixes.push_back({time, time, 50.0, longitude, 12.0});
        }
        return fixes;
    }

    std::mt19937_64 random_{20261122};
};

TEST_F(ServicePropertyTest, HistoriesThatLookAlike_GiveTheSameBytes) {
    constexpr int kPeople = 240;
    World one;
    World other;
    std::string all;
    int seen = 0;
    std::vector<std::pair<std::int64_t, std::int64_t>> people;
    std::vector<Precision> precisions;
    for (int i = 0; i < kPeople; ++i) {
        const std::string name = "p" + std::to_string(100 + i);
        people.emplace_back(one.add(name), other.add(name));
        precisions.push_back(static_cast<Precision>(i % 3));
        all += (i == 0 ? "\"" : ",\"") + name + "@x.example\"";
        one.share(people.back().first, precisions.back());
        if (i % 8 != 7) {
            other.share(people.back().second, precisions.back());
        }
    }
    for (int i = 0; i < kPeople; ++i) {
        const auto [mine, yours] = people[static_cast<std::size_t>(i)];
        const Precision precision = precisions[static_cast<std::size_t>(i)];
        const auto fixes = history(precision);
        one.keep(mine, fixes);
        if (i % 8 == 7) {
            // Hidden here, a stranger there.
            ASSERT_TRUE(one.store().setHidden(mine, true, kNow));
            other.keep(yours, fixes);
        } else if (precision == Precision::Exact) {
            other.keep(yours, {fixes.back()});  // of the past nothing is seen
        } else {
            other.keep(yours, alike(fixes, precision));
        }
    }
    one.setNow(kNow);
    other.setNow(kNow);
    for (int i = 0; i < kPeople; ++i) {
        const auto [mine, yours] = people[static_cast<std::size_t>(i)];
        const auto what = Visibility::visible(*one.store().sharing(one.otto(), mine), kNow);
        ASSERT_EQ(Visibility::visible(*other.store().sharing(other.otto(), yours), kNow), what) << i;
        seen += what ? 1 : 0;
        const std::string handle = "\"p" + std::to_string(100 + i) + "@x.example\"";
        ASSERT_EQ(one.ask(handle), other.ask(handle)) << i;
    }
    EXPECT_GT(seen, kPeople / 2) << "else nothing was tried";
    EXPECT_EQ(one.ask(all), other.ask(all));
    for (int turn = 0; turn < 3; ++turn) {
        EXPECT_EQ(one.post(kNow + turn), other.post(kNow + turn)) << turn;
    }
    // And what is seen does change the bytes.
    one.keep(people.front().first, {{kNow - 1, kNow - 1, 51.0, 8.0, 12.0}});
    EXPECT_NE(one.ask(all), other.ask(all));
}

}  // namespace ktr::test
