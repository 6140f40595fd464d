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

    /// Signs otto's browser in.
    void signIn() {
        ASSERT_TRUE(store_->addSignIn(otto_, "link", kNow));
        const std::string answer = exchange(
            "POST /me/in HTTP/1.1\r\nHost: localhost\r\nConnection: close\r\nSec-Fetch-Site: same-origin\r\n"
            "Content-Type: application/x-www-form-urlencoded\r\nContent-Length: 9\r\n\r\nlink=link");
        std::smatch found;
        ASSERT_TRUE(std::regex_search(answer, found, std::regex("Set-Cookie: ([^;]+);"))) << answer;
        cookie_ = found[1];
    }
    /// A page of otto's, but for what is drawn by lot for the browser.
    std::string page(const std::string& path) const {
        const std::string answer = exchange(
            "GET " + path + " HTTP/1.1\r\nHost: localhost\r\nConnection: close\r\nCookie: " + cookie_ + "\r\n\r\n");
        EXPECT_EQ(answer.rfind("HTTP/1.1 200 OK\r\n", 0), 0U) << path << answer.substr(0, 300);
        return std::regex_replace(answer, std::regex("\r\nDate: [^\r]*|value=\"[0-9a-f]{32}\""), "");
    }

  private:
    std::string exchange(const std::string& request) const {
        const RawClient client(service_->port());
        client.send(request);
        return client.read("(never)");
    }
    std::string send(const std::string& path, const std::string& secret, const std::string& body) const {
        const std::string answer = exchange(
            "POST " + path + " HTTP/1.1\r\nHost: localhost\r\nConnection: close\r\nAuthorization: " +
            BasicCredentials{"otto", secret}.header() +
            "\r\nX-Orcha-Seek-API-Ver: 4.0\r\nX-Orcha-AuthScheme: Forever\r\nContent-Type: application/json\r\n"
            "Content-Length: " +
            std::to_string(body.size()) + "\r\n\r\n" + body);
        EXPECT_EQ(answer.rfind("HTTP/1.1 200 OK\r\n", 0), 0U) << answer.substr(0, 300);
        return std::regex_replace(answer, std::regex("\r\nDate: [^\r]*"), "");
    }

    std::shared_ptr<Store> store_;
    std::unique_ptr<Service> service_;
    std::atomic<std::int64_t> now_ = kBegin;
    std::int64_t otto_ = 0;
    std::string cookie_;
};

/// Two services that tell otto the same of everybody.
struct Worlds {
    World one;
    World other;
    std::vector<std::pair<std::int64_t, std::int64_t>> people;  ///< in the one, in the other

    static std::string handle(std::size_t person) { return "\"p" + std::to_string(100 + person) + "@x.example\""; }
    std::string allHandles() const {
        std::string all;
        for (std::size_t i = 0; i < people.size(); ++i) {
            all += (i == 0 ? "" : ",") + handle(i);
        }
        return all;
    }
    /// What otto may see of a person; none where the two are not alike.
    std::optional<std::optional<server::Seen>> seen(std::size_t person, std::int64_t now) {
        const auto mine = Visibility::visible(*one.store().sharing(one.otto(), people[person].first), now);
        const auto yours = Visibility::visible(*other.store().sharing(other.otto(), people[person].second), now);
        using Alike = std::optional<std::optional<server::Seen>>;
        return mine == yours ? Alike(std::in_place, mine) : Alike();
    }
    void setNow(std::int64_t now) {
        one.setNow(now);
        other.setNow(now);
    }
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

    /// A third at each precision but for named places; every eighth is hidden here and a stranger there.
    void populate(Worlds& worlds) {
        for (std::size_t i = 0; i < kPeople; ++i) {
            const std::string name = "p" + std::to_string(100 + i);
            const auto [mine, yours] = worlds.people.emplace_back(worlds.one.add(name), worlds.other.add(name));
            const auto precision = static_cast<Precision>(i % 3);
            const auto fixes = history(precision);
            worlds.one.share(mine, precision);
            worlds.one.keep(mine, fixes);
            if (i % 8 == 7) {
                ASSERT_TRUE(worlds.one.store().setHidden(mine, true, kNow));
                worlds.other.keep(yours, fixes);
                continue;
            }
            worlds.other.share(yours, precision);
            // Of the past nothing is seen at exact precision.
            worlds.other.keep(yours,
                              precision == Precision::Exact ? std::vector<Fix>{fixes.back()} : alike(fixes, precision));
        }
    }

    static constexpr std::size_t kPeople = 240;
    std::mt19937_64 random_{20261122};
};

TEST_F(ServicePropertyTest, HistoriesThatLookAlike_GiveTheSameBytes) {
    Worlds worlds;
    populate(worlds);
    worlds.setNow(kNow);
    int seen = 0;
    for (std::size_t i = 0; i < kPeople; ++i) {
        const auto what = worlds.seen(i, kNow);
        ASSERT_TRUE(what) << i;
        seen += *what ? 1 : 0;
        ASSERT_EQ(worlds.one.ask(Worlds::handle(i)), worlds.other.ask(Worlds::handle(i))) << i;
    }
    EXPECT_GT(seen, kPeople / 2) << "else nothing was tried";
    EXPECT_EQ(worlds.one.ask(worlds.allHandles()), worlds.other.ask(worlds.allHandles()));
    for (int turn = 0; turn < 3; ++turn) {
        EXPECT_EQ(worlds.one.post(kNow + turn), worlds.other.post(kNow + turn)) << turn;
    }
    // And what is seen does change the bytes.
    worlds.one.keep(worlds.people.front().first, {{kNow - 1, kNow - 1, 51.0, 8.0, 12.0}});
    EXPECT_NE(worlds.one.ask(worlds.allHandles()), worlds.other.ask(worlds.allHandles()));
}

TEST_F(ServicePropertyTest, WhileTheyLookAlike_AnswersTheirIntervalsAndThePagesAreTheSameBytes) {
    Worlds worlds;
    populate(worlds);
    worlds.setNow(kNow);
    worlds.one.signIn();
    worlds.other.signIn();
    int asked = 0;
    for (std::int64_t now = kNow; now < kNow + 7200; now += 487) {
        worlds.setNow(now);
        std::string alike;
        for (std::size_t i = 0; i < kPeople; ++i) {
            // As time goes on, what came in the present slot comes to count; of them nothing is said here.
            if (worlds.seen(i, now)) {
                alike += (alike.empty() ? "" : ",") + Worlds::handle(i);
                ++asked;
            }
        }
        const std::string answer = worlds.one.ask(alike);
        EXPECT_NE(answer.find("\"minCallbackIntervalInMS\""), std::string::npos) << answer.substr(0, 300);
        ASSERT_EQ(answer, worlds.other.ask(alike)) << now;
        for (const char* path : {"/me", "/me/looks", "/me/fences", "/me/places", "/me/settings"}) {
            ASSERT_EQ(worlds.one.page(path), worlds.other.page(path)) << path << now;
        }
    }
    EXPECT_GT(asked, 15 * static_cast<int>(kPeople) / 3) << "else little was tried";
}

}  // namespace ktr::test
