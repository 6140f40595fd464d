#include "server/page/PeoplesPage.h"

#include "documents/JsonReader.h"
#include "platform/base/Json.h"
#include "server/answers/CommandRequest.h"
#include "server/http/BasicCredentials.h"
#include "server/page/PageAnswer.h"
#include "server/page/PlainPage.h"
#include "server/rules/WallClock.h"
#include "server/store/Secret.h"

namespace ktr::server {

namespace {

constexpr const char* kLinkField = "link";

/// What a session's forms carry. It is made of the session's secret, and tells nothing of it.
std::string tokenOf(const std::string& session) {
    constexpr char kDigits[] = "0123456789abcdef";
    std::string token;
    for (const char byte : Secret::hash("form " + session).substr(0, 16)) {
        token += kDigits[static_cast<unsigned char>(byte) / 16];
        token += kDigits[static_cast<unsigned char>(byte) % 16];
    }
    return token;
}

HttpResponse saying(int status, const PageLanguage& language, const char* title, const char* more, bool leadsBack) {
    return PageAnswer::html(status, PlainPage::sayingHtml(language, language.text(title),
                                                          more == nullptr ? "" : language.text(more), leadsBack));
}

}  // namespace

PeoplesPage::PeoplesPage(Setup setup) : setup_(std::move(setup)), own_(setup_.store) {
    thread_ = std::thread([this] { work(); });
}

PeoplesPage::~PeoplesPage() {
    {
        const std::lock_guard<std::mutex> lock(mutex_);
        ending_ = true;
    }
    wake_.notify_all();
    thread_.join();
}

void PeoplesPage::answer(const HttpRequest& request, HttpReply reply) {
    {
        const std::lock_guard<std::mutex> lock(mutex_);
        if (waiting_.size() < kMostWaiting) {
            waiting_.emplace_back(PageRequest::read(request), std::move(reply));
            wake_.notify_all();
            return;
        }
    }
    const PageLanguage language("en", "UTC");
    HttpResponse response = saying(503, language, "NOT_KEPT", nullptr, false);
    response.headers.emplace_back("Retry-After", "5");
    reply.send(std::move(response));
}

void PeoplesPage::work() {
    for (;;) {
        std::unique_lock<std::mutex> lock(mutex_);
        wake_.wait(lock, [this] { return ending_ || !waiting_.empty(); });
        if (waiting_.empty()) {
            return;
        }
        const PageRequest request = std::move(waiting_.front().first);
        const HttpReply reply = std::move(waiting_.front().second);
        waiting_.pop_front();
        lock.unlock();
        double delay = 0.0;
        HttpResponse response = answerTo(request, delay);
        if (delay > 0.0) {
            setup_.later(delay, [reply, response] { reply.send(response); });
        } else {
            reply.send(std::move(response));
        }
    }
}

HttpResponse PeoplesPage::signIn(const PageRequest& request, const PageLanguage& language, double& delay) {
    if (!request.isOwn) {
        return saying(403, language, "NOT_FROM_HERE", nullptr, false);
    }
    const std::string link = request.field(kLinkField);
    const auto session = Secret::make();
    switch (session && !link.empty() ? setup_.store.signIn(link, *session, setup_.now()) : SignIn::Spent) {
        case SignIn::Done: {
            HttpResponse response = PageAnswer::seeOther("/me");
            PageAnswer::setCookie(response, PageAnswer::kSession, *session, Store::kBrowserLasts);
            return response;
        }
        case SignIn::Spent:
            delay = setup_.delays.afterFailure(request.peer, FailureDelays::Clock::now());
            return saying(403, language, "LINK_SPENT", nullptr, false);
        case SignIn::Failed:
            break;
    }
    return saying(503, language, "NOT_KEPT", nullptr, false);
}

HttpResponse PeoplesPage::signProgramIn(const PageRequest& request, double& delay) {
    const auto read = documents::JsonReader::read(request.document);
    const auto* value = std::get_if<platform::Value>(&read);
    const auto* members = value != nullptr ? value->dictionary() : nullptr;
    const auto* link = members != nullptr ? members->find(kLinkField) : nullptr;
    if (link == nullptr || link->string() == nullptr) {
        return refusal(400, "expected a JSON object with a link");
    }
    const auto secret = Secret::make();
    std::string person;
    switch (secret ? setup_.store.signProgramIn(*link->string(), *secret, setup_.now(), person) : SignIn::Failed) {
        case SignIn::Done: {
            const platform::Dictionary answer{{"statusCode", 200}, {"person", person}, {"secret", *secret}};
            HttpResponse response = HttpResponse::json(200, platform::writeJson(answer));
            response.headers.emplace_back("Cache-Control", "no-store");
            return response;
        }
        case SignIn::Spent:
            delay = setup_.delays.afterFailure(request.peer, FailureDelays::Clock::now());
            return refusal(403, "the link was used before, has ended, or never was");
        case SignIn::Failed:
            break;
    }
    return refusal(503, "the store cannot be written");
}

HttpResponse PeoplesPage::answerTo(const PageRequest& request, double& delay) {
    const std::int64_t now = setup_.now();
    const std::string tag = PageLanguage::choose(request.language, request.accepted);
    const PageLanguage plain(tag, "UTC");
    if (request.is({"in"}) && !request.document.empty()) {
        return signProgramIn(request, delay);
    }
    if (request.is({"in"})) {
        return request.posts
                   ? signIn(request, plain, delay)
                   : PageAnswer::html(200, PlainPage::linkHtml(plain, request.query.find(kLinkField).value_or("")));
    }
    bool failed = false;
    const auto browser = request.session.empty() ? std::nullopt : setup_.store.browserOf(request.session, now, failed);
    const auto person = browser ? setup_.store.person(browser->person) : std::nullopt;
    if (failed || (browser && !person)) {
        return saying(503, plain, "NOT_KEPT", nullptr, true);
    }
    if (!browser) {
        return PageAnswer::html(403, PlainPage::signedOutHtml(plain));
    }
    const std::string token = tokenOf(request.session);
    if (request.posts && (!request.isOwn || !sameSecret(request.field("token"), token))) {
        return saying(403, plain, "NOT_FROM_HERE", nullptr, true);
    }
    const PageLanguage language(tag, person->zone.empty() ? WallClock::machineZone() : person->zone);
    const PageContext context{language, token, setup_.store.present(now), person->name,
                              person->handles.empty() ? person->name : person->handles.front()};
    const std::uint64_t failures = setup_.store.readFailures();
    HttpResponse response = own_.answer(request, {context, *browser, *person});
    // "Nobody sees you" would be said by a list that could not be read.
    return setup_.store.readFailures() == failures ? std::move(response)
                                                   : saying(503, language, "NOT_KEPT", nullptr, true);
}

}  // namespace ktr::server
