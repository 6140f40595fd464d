#include "host/live/LiveConversation.h"

#include <algorithm>
#include <utility>

#include "host/conversation/CutText.h"
#include "host/scenario/ScenarioReader.h"
#include "platform/assistant/VASnippet.h"
#include "platform/base/Clock.h"
#include "platform/base/MainLoop.h"

namespace ktr::host {

namespace {

/// How long the status line says that a position is looked for, seconds.
constexpr double kFindingPosition = 20.0;

std::string trimmed(const std::string& text) {
    constexpr const char* kBlanks = " \t\r\n";
    const auto first = text.find_first_not_of(kBlanks);
    if (first == std::string::npos) {
        return "";
    }
    return beginningOf(text.substr(first, text.find_last_not_of(kBlanks) - first + 1),
                       LiveConversation::kLongestQuestion);
}

}  // namespace

LiveConversation::LiveConversation(Host& host) : host_(host), requests_([&host] { return host.platform(); }) {}

std::shared_ptr<LiveConversation> LiveConversation::make(Host& host) {
    std::shared_ptr<LiveConversation> live(new LiveConversation(host));
    host.live()->setChanged([weak = std::weak_ptr<LiveConversation>(live)] {
        if (const auto self = weak.lock()) {
            self->tellChanged();
        }
    });
    return live;
}

platform::Date LiveConversation::now() const {
    return host_.live()->evenClock().now();
}

void LiveConversation::tellChanged() {
    if (handlers_.changed) {
        handlers_.changed();
    }
}

void LiveConversation::start(std::vector<Scenario> scenarios) {
    scenarios_ = std::move(scenarios);
    host_.live()->start([weak = weak_from_this()] {
        if (const auto self = weak.lock()) {
            self->accountRead();
        }
    });
}

void LiveConversation::accountRead() {
    ready_ = true;
    for (const Scenario& scenario : std::exchange(scenarios_, {})) {
        if (auto failure = host_.addTurn(scenario)) {
            failure_ = std::move(failure);
            continue;
        }
        shown(false);
        if (handlers_.asked) {
            handlers_.asked(*host_.conversation()->turns().back());
        }
    }
    sendNext();
    tellChanged();
}

void LiveConversation::ask(const std::string& text) {
    const std::string question = trimmed(text);
    if (question.empty()) {
        return;
    }
    const auto turn = host_.addQuestion(question);
    if (handlers_.asked) {
        handlers_.asked(*turn);
    }
    ++asking_;
    askedAt_ = now();
    waiting_.push_back({turn, question, std::nullopt, nullptr});
    sendNext();
    tellChanged();
}

void LiveConversation::wishToBeSeen(std::optional<bool> isSeen, std::function<void(const Sharing&)> said) {
    waiting_.push_back({{}, {}, isSeen, std::move(said)});
    sendNext();
}

void LiveConversation::whoShares(std::function<void(const std::vector<Sharer>&)> told) {
    if (!ready_) {
        // Nobody is signed in before the account is read: this waits behind a question that does.
        wishToBeSeen(std::nullopt, [weak = weak_from_this(), told = std::move(told)](const Sharing&) {
            if (const auto self = weak.lock()) {
                self->whoShares(told);
            }
        });
        return;
    }
    requests_.send("friends", {}, [told = std::move(told)](const ask::ServiceReply& reply) {
        const platform::Value* listed = reply.body.find("friends");
        const auto* friends = listed != nullptr ? listed->array() : nullptr;
        std::vector<Sharer> sharers;
        for (const platform::Value& one : friends != nullptr ? *friends : platform::Value::Array()) {
            const platform::Dictionary* members = one.dictionary();
            const auto text = [members](const char* name) {
                const platform::Value* member = members != nullptr ? members->find(name) : nullptr;
                return member != nullptr && member->string() != nullptr ? *member->string() : std::string();
            };
            if (!text("handle").empty()) {
                sharers.push_back({text("name"), text("handle")});
            }
        }
        told(sharers);
    });
}

void LiveConversation::tryNow() {
    // What it answers counts as a sign of life, whatever is in it.
    requests_.send("getlocations", {{"handles", platform::Value::Array()}}, [](const ask::ServiceReply&) {});
    host_.askAgain();
}

void LiveConversation::sendNext() {
    if (!ready_ || underWay_ || waiting_.empty()) {
        return;
    }
    const Waiting asked = std::move(waiting_.front());
    waiting_.pop_front();
    underWay_ = true;
    if (host_.isRestricted()) {
        Scenario refusal;
        refusal.sentence = LocalizedText(host_.text("ANSWER_RESTRICTED"));
        host_.platform()->mainLoop->post([weak = weak_from_this(), asked, refusal] {
            if (const auto self = weak.lock()) {
                asked.said ? self->receiveWish(asked, {ask::ServiceReply::Failure::Refused})
                           : self->receive(asked, refusal);
            }
        });
        return;
    }
    if (!asked.said || asked.isSeen) {
        // Whatever the question is: it may be a wish to hide, which only the assistant can tell.
        host_.endSharing();
    }
    if (asked.said) {
        sendWish(asked);
        return;
    }
    // The assistant's client ends before the loop does, and what it posts after this has gone does nothing.
    platform::MainLoop* const mainLoop = host_.platform()->mainLoop.get();
    host_.live()->assistant().ask(asked.question, [weak = weak_from_this(), mainLoop, asked](auto answer) {
        mainLoop->post([weak, asked, answer = std::move(answer)] {
            if (const auto self = weak.lock()) {
                self->receive(asked, self->read(answer));
            }
        });
    });
}

void LiveConversation::sendWish(const Waiting& asked) {
    const char* const wish = !asked.isSeen ? "read" : *asked.isSeen ? "share" : "hide";
    requests_.send("sharing", {{"wish", wish}}, [weak = weak_from_this(), asked](const ask::ServiceReply& reply) {
        if (const auto self = weak.lock()) {
            self->receiveWish(asked, reply);
        }
    });
}

void LiveConversation::receiveWish(const Waiting& asked, const ask::ServiceReply& reply) {
    underWay_ = false;
    const platform::Value* hidden = reply.body.find("hidden");
    const auto isHidden = hidden != nullptr ? hidden->boolean() : std::nullopt;
    Sharing sharing{std::nullopt, reply.failure};
    if (isHidden) {
        sharing.isSeen = !*isHidden;
    } else if (reply.failure == ask::ServiceReply::Failure::None) {
        sharing.failure = ask::ServiceReply::Failure::Unreachable;
    }
    asked.said(sharing);
    sendNext();
    tellChanged();
}

void LiveConversation::receive(const Waiting& asked, const Scenario& answer) {
    underWay_ = false;
    if (--asking_ == 0) {
        askedAt_.reset();
    }
    if (const auto turn = asked.turn.lock()) {
        host_.answer(*turn, answer);
        if (!turn->card()->hidden()) {
            shown(true);
        }
        if (handlers_.answered) {
            handlers_.answered(*turn);
        }
    }
    sendNext();
    tellChanged();
}

Scenario LiveConversation::read(const linux_::AssistantClient::Answer& answer) {
    failure_.reset();
    Scenario scenario;
    assistant_ = ServiceWatch::troubleOf(answer.failure, answer.status, answer.hasBody());
    assistantEnded_ = now();
    if (!answer.hasBody()) {
        failure_ = Failure{ExitCode::Failure, "the assistant cannot be asked: " + answer.reason};
        const bool isSignedIn = host_.live()->isSignedIn() && assistant_ != ServiceWatch::Trouble::SignedOut;
        const char* sentence = isSignedIn                   ? "ANSWER_UNREACHABLE"
                               : host_.live()->isUnusable() ? "STATUS_UNREADABLE"
                                                            : "ANSWER_SIGN_IN";
        scenario.sentence = LocalizedText(host_.text(sentence));
        return scenario;
    }
    auto read = ScenarioReader(host_.platform()->clock->now(), ScenarioReader::Clock::Present)
                    .readText(answer.body, "the assistant's answer");
    if (const auto* error = std::get_if<documents::DocumentError>(&read)) {
        failure_ = Failure{ExitCode::Failure, error->text()};
        return scenario;
    }
    return std::get<Scenario>(std::move(read));
}

void LiveConversation::shown(bool wasAsked) {
    shownAt_ = now();
    wasAsked_ = wasAsked;
    if (positions_ || !host_.live()->looksForPosition()) {
        return;
    }
    positions_ = host_.platform()->locationManagers->makeManager(nullptr);
    positions_->setDelegate(weak_from_this());
    positions_->setDesiredAccuracy(platform::kLocationAccuracyNearestTenMeters);
    findingPosition_ = positions_->location() == nullptr;
    if (findingPosition_) {
        positions_->startUpdatingLocation();
    }
}

void LiveConversation::didUpdateLocations(platform::PlatformLocationManager& manager,
                                          const platform::PlatformLocations&) {
    manager.stopUpdatingLocation();
    findingPosition_ = false;
    tellChanged();
}

LiveStatus::Facts LiveConversation::facts() const {
    LiveStatus::Facts facts;
    facts.ready = ready_;
    facts.signedIn = host_.live()->isSignedIn();
    facts.hasAccount = host_.live()->configuration().account.has_value();
    facts.unusable = host_.live()->isUnusable();
    facts.asking = askedAt_;
    facts.assistant = assistant_;
    facts.assistantEnded = assistantEnded_;
    facts.shown = shownAt_;
    facts.wasAsked = wasAsked_;
    facts.now = now();
    facts.findingPosition =
        findingPosition_ && shownAt_ &&
        facts.now.secondsSinceReferenceDate - shownAt_->secondsSinceReferenceDate < kFindingPosition;
    facts.hidden = host_.saysHidden();
    facts.service = host_.live()->service().notes();
    return facts;
}

std::optional<double> LiveConversation::statusChangesIn() const {
    const auto known = facts();
    auto first = LiveStatus::changesIn(known);
    if (known.findingPosition) {
        const double end = shownAt_->secondsSinceReferenceDate + kFindingPosition;
        const double left = end - known.now.secondsSinceReferenceDate;
        first = std::min(first.value_or(left), left);
    }
    return first;
}

LiveStatus LiveConversation::status() const {
    return LiveStatus::of(facts(), {[this](const std::string& key) { return host_.text(key); },
                                    [this](platform::Date moment) {
                                        return host_.clockFace(host_.live()->evenClock().onTheOther(moment));
                                    },
                                    [this](std::int64_t number) { return host_.number(number); }});
}

}  // namespace ktr::host
