#pragma once

#include <gtest/gtest.h>

#include <future>
#include <regex>

#include "server/page/PeoplesPage.h"
#include "tests/support/TemporaryFolder.h"

namespace ktr::test {

/// The pages as a browser of Mara's meets them, on a real store.
class PageFixture : public ::testing::Test {
  protected:
    void SetUp() override {
        std::string complaint;
        store_ = server::Store::open({(folder_.path() / "data").string()}, true, complaint);
        ASSERT_TRUE(store_) << complaint;
        for (const char* name : {"Mara", "Lea", "Ann"}) {
            ASSERT_TRUE(store_->addPerson(name, {std::string(name) + "@x.example"}, now_));
        }
        mara_ = store_->personNamed("Mara")->id;
        lea_ = store_->personNamed("Lea")->id;
        ASSERT_TRUE(store_->setZone(mara_, "Europe/Berlin"));
        ASSERT_TRUE(store_->addDevice(mara_, server::DeviceKind::Phone, "phone", "", now_));
        page_ = std::make_unique<server::PeoplesPage>(
            server::PeoplesPage::Setup{*store_, [this] { return now_; }, delays_,
                                       [this](double seconds, const std::function<void()>& work) {
                                           delayed_ += seconds;
                                           work();
                                       }});
    }

    server::HttpResponse send(const server::HttpRequest& request) {
        std::promise<std::optional<server::HttpResponse>> answered;
        page_->answer(request, server::HttpReply([&](const std::optional<server::HttpResponse>& response) {
                          answered.set_value(response);
                      }));
        return answered.get_future().get().value_or(server::HttpResponse{0, {}, "", {}});
    }
    server::HttpRequest request(const std::string& method, const std::string& target, const std::string& body = "") {
        server::HttpRequest out;
        out.method = method;
        out.path = target.substr(0, target.find('?'));
        out.query = target.find('?') == std::string::npos ? "" : target.substr(target.find('?') + 1);
        out.body = body;
        out.peer = "192.0.2.7";
        out.headers = {{"Host", "home.example:8443"}};
        if (!cookie_.empty()) {
            out.headers.emplace_back("Cookie", cookie_);
        }
        if (method == "POST") {
            out.headers.emplace_back("Content-Type", "application/x-www-form-urlencoded");
            out.headers.emplace_back("Origin", "null");
            out.headers.emplace_back("Sec-Fetch-Site", "same-origin");
        }
        return out;
    }
    server::HttpResponse get(const std::string& target) { return send(request("GET", target)); }
    server::HttpResponse post(const std::string& target, const std::string& fields = "") {
        return send(request("POST", target, "token=" + token_ + "&" + fields));
    }
    static std::string headerOf(const server::HttpResponse& response, const std::string& name) {
        std::string all;
        for (const auto& [key, value] : response.headers) {
            all += key == name ? value : "";
        }
        return all;
    }
    /// Signs Mara in, as a browser does.
    void signIn() {
        ASSERT_TRUE(store_->addSignIn(mara_, "link", now_));
        const server::HttpResponse response = send(request("POST", "/me/in", "link=link"));
        ASSERT_EQ(response.status, 303);
        const std::string set = headerOf(response, "Set-Cookie");
        cookie_ = set.substr(0, set.find(';'));
        std::smatch found;
        const std::string body = get("/me").body;
        ASSERT_TRUE(std::regex_search(body, found, std::regex("name=\"token\" value=\"([0-9a-f]{32})\"")));
        token_ = found[1];
    }
    std::string address(const char* what = "") { return "/me/sees/" + std::to_string(lea_) + what; }
    std::optional<server::Grant> leasGrant() { return store_->sharing(lea_, mara_)->grant; }
    static bool has(const server::HttpResponse& response, const std::string& text) {
        return response.body.find(text) != std::string::npos;
    }

    TemporaryFolder folder_;
    std::unique_ptr<server::Store> store_;
    server::FailureDelays delays_;
    double delayed_ = 0.0;
    std::int64_t now_ = 1763760000;  // Friday 2025-11-21, 22:20 in Berlin
    std::int64_t mara_ = 0;
    std::int64_t lea_ = 0;
    std::string cookie_;
    std::string token_;
    std::unique_ptr<server::PeoplesPage> page_;
};

}  // namespace ktr::test
