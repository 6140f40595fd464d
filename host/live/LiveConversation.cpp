#include "host/live/LiveConversation.h"

#include <algorithm>
#include <utility>

#include "host/conversation/CutText.h"
#include "host/live/AnswerOffers.h"
#include "host/scenario/ScenarioReader.h"
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

LiveConversation::LiveConversation(Host& host)
    : host_(host), requests_([&host] { return host.platform(); }), desk_(host) {}

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
    enqueue(turn, question);
}

void LiveConversation::askAgain(const std::weak_ptr<TurnView>& turn, const std::string& question) {
    const auto asked = turn.lock();
    if (!asked) {
        return;
    }
    host_.takeAnswerBack(*asked);
    asked->setProgress(TurnView::Progress::None);
    enqueue(asked, question);
    if (handlers_.waits) {
        handlers_.waits(*asked);
    }
}

void LiveConversation::enqueue(const std::shared_ptr<TurnView>& turn, const std::string& question) {
    askedAt_ = now();
    waiting_.push_back({turn, question, std::nullopt, nullptr, ++asked_});
    sendNext();
    showWaiting();
    tellChanged();
}

bool LiveConversation::isAsking() const {
    return (underWay_ && !underWay_->said) ||
           std::any_of(waiting_.begin(), waiting_.end(), [](const Waiting& one) { return !one.said; });
}

void LiveConversation::showWaiting() {
    if (patience_) {
        patience_->invalidate();
        patience_.reset();
    }
    if (!askedAt_ || !isAsking()) {
        return;
    }
    const double waited = now().secondsSinceReferenceDate - askedAt_->secondsSinceReferenceDate;
    const auto show = [&](const Waiting& asked) {
        const auto turn = asked.turn.lock();
        if (turn && waited >= kRingAfter) {
            turn->setProgress(TurnView::Progress::Asking);
            turn->setPatience(waited >= kSlowAfter ? host_.text("ASKING_SLOW") : "");
            if (handlers_.waits) {
                handlers_.waits(*turn);
            }
        }
    };
    if (underWay_) {
        show(*underWay_);
    }
    std::for_each(waiting_.begin(), waiting_.end(), show);
    if (waited >= kSlowAfter) {
        return;
    }
    const double next = waited < kRingAfter ? kRingAfter : kSlowAfter;
    patience_ = host_.platform()->mainLoop->schedule(next - waited, false, [weak = weak_from_this()] {
        if (const auto self = weak.lock()) {
            self->showWaiting();
        }
    });
}

bool LiveConversation::canStop() const {
    return isAsking() && !isWish_;
}

void LiveConversation::stop() {
    if (!canStop()) {
        return;
    }
    std::vector<Waiting> stopped;
    if (underWay_ && !underWay_->said) {
        stopped.push_back(*std::exchange(underWay_, std::nullopt));
    }
    const auto wishes =
        std::stable_partition(waiting_.begin(), waiting_.end(), [](const Waiting& one) { return one.said != nullptr; });
    stopped.insert(stopped.end(), wishes, waiting_.end());
    waiting_.erase(wishes, waiting_.end());
    askedAt_.reset();
    showWaiting();
    for (const Waiting& one : stopped) {
        if (const auto turn = one.turn.lock()) {
            host_.removeTurn(*turn);
        }
        if (handlers_.stopped) {
            handlers_.stopped(one.question);
        }
    }
    sendNext();
    tellChanged();
}

void LiveConversation::wishToBeSeen(std::optional<bool> isSeen, std::function<void(const Sharing&)> said) {
    waiting_.push_back({{}, {}, isSeen, std::move(said), ++asked_});
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
    requests_.send({"friends"}, [told = std::move(told)](const ask::ServiceReply& reply) {
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
    requests_.send({"getlocations", {{"handles", platform::Value::Array()}}}, [](const ask::ServiceReply&) {});
    host_.askAgain();
}

std::function<void(const LiveConversation::Reply&)> LiveConversation::whenAnswered(const Waiting& asked) {
    return [weak = weak_from_this(), asked](const Reply& reply) {
        const auto self = weak.lock();
        if (self && self->underWay_ && self->underWay_->number == asked.number) {
            self->receive(asked, reply);
        }
    };
}

void LiveConversation::sendNext() {
    if (!ready_ || underWay_ || waiting_.empty()) {
        return;
    }
    underWay_ = std::move(waiting_.front());
    waiting_.pop_front();
    const Waiting asked = *underWay_;
    if (host_.isRestricted()) {
        Reply refusal;
        refusal.scenario.sentence = LocalizedText(host_.text("ANSWER_RESTRICTED"));
        host_.platform()->mainLoop->post([weak = weak_from_this(), asked, answered = whenAnswered(asked), refusal] {
            if (const auto self = weak.lock(); self && asked.said) {
                self->receiveWish(asked, {ask::ServiceReply::Failure::Refused});
            } else {
                answered(refusal);
            }
        });
        return;
    }
    if (!asked.said || asked.isSeen) {
        // Whatever the question is: it may be a wish to hide, which is known when it is understood, or never.
        host_.endSharing();
    }
    if (asked.said) {
        sendWish(asked);
    } else if (host_.live()->hasAssistant()) {
        sendToAssistant(asked);
    } else {
        sendToEngine(asked);
    }
}

void LiveConversation::sendToEngine(const Waiting& asked) {
    desk_.ask(
        desk_.question(asked.question, true),
        [weak = weak_from_this(), answered = whenAnswered(asked), asked,
         platform = std::weak_ptr(host_.platform())](const ask::Answer& answer) {
            const auto self = weak.lock();
            if (!self || !self->underWay_ || self->underWay_->number != asked.number) {
                return;
            }
            if (answer.outcome == ask::Outcome::Unreachable && !self->isWish_ &&
                platform.lock() != self->host_.platform()) {
                // It ended with what it was asked on: what has changed meanwhile is no reason to answer nothing.
                return self->sendToEngine(asked);
            }
            answered(self->replyOf(asked, answer));
        },
        [weak = weak_from_this(), asked](const ask::Meaning& meaning) {
            const auto self = weak.lock();
            if (self && self->underWay_ && self->underWay_->number == asked.number) {
                self->isWish_ = ask::isPersonal(meaning.wish);
                self->tellChanged();
            }
        });
}

void LiveConversation::sendToAssistant(const Waiting& asked) {
    // It may be any wish.
    isWish_ = true;
    // The assistant's client ends before the loop does, and what it posts after this has gone does nothing.
    platform::MainLoop* const mainLoop = host_.platform()->mainLoop.get();
    host_.live()->assistant().ask(asked.question,
                                  [weak = weak_from_this(), mainLoop, answered = whenAnswered(asked)](auto answer) {
                                      mainLoop->post([weak, answered, answer = std::move(answer)] {
                                          if (const auto self = weak.lock()) {
                                              answered(self->read(answer));
                                          }
                                      });
                                  });
}

LiveConversation::Reply LiveConversation::replyOf(const Waiting& asked, const ask::Answer& answer) {
    failure_.reset();
    assistant_ = ServiceWatch::Trouble::None;
    assistantEnded_ = now();
    Reply reply{desk_.scenarioOf(answer)};
    reply.isFailure = answer.outcome == ask::Outcome::Unreachable;
    reply.wasUnderstood = answer.outcome != ask::Outcome::NotUnderstood;
    if (reply.isFailure || answer.outcome == ask::Outcome::NotSignedIn) {
        failure_ = Failure{ExitCode::Failure, reply.isFailure ? "the service gave no answer that can be used"
                                                              : "there is no account that the service knows"};
    }
    const auto whenThere = [weak = weak_from_this()](const auto& does) {
        return [weak, does](const auto&... argument) {
            if (const auto self = weak.lock()) {
                does(*self, argument...);
            }
        };
    };
    AnswerOffers::Does does;
    does.ask = whenThere([](LiveConversation& self, const std::string& question) { self.ask(question); });
    does.choose = whenThere(
        [turn = asked.turn](LiveConversation& self, const std::string& question) { self.askAgain(turn, question); });
    does.again = whenThere(
        [turn = asked.turn, question = asked.question](LiveConversation& self) { self.askAgain(turn, question); });
    does.signIn = handlers_.signIn;
    does.showFriends = handlers_.showFriends;
    does.open = handlers_.open;
    reply.offers = AnswerOffers::of(answer, host_, does);
    return reply;
}

void LiveConversation::sendWish(const Waiting& asked) {
    const char* const wish = !asked.isSeen ? "read" : *asked.isSeen ? "share" : "hide";
    requests_.send({"sharing", {{"wish", wish}}}, [weak = weak_from_this(), asked](const ask::ServiceReply& reply) {
        if (const auto self = weak.lock()) {
            self->receiveWish(asked, reply);
        }
    });
}

void LiveConversation::receiveWish(const Waiting& asked, const ask::ServiceReply& reply) {
    underWay_.reset();
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

void LiveConversation::receive(const Waiting& asked, const Reply& reply) {
    underWay_.reset();
    isWish_ = false;
    if (!isAsking()) {
        askedAt_.reset();
        showWaiting();
    }
    if (const auto turn = asked.turn.lock()) {
        turn->setPatience("");
        turn->setProgress(reply.isFailure ? TurnView::Progress::Failed : TurnView::Progress::None);
        host_.answer(*turn, reply.scenario);
        turn->setOffers(reply.offers);
        if (!turn->card()->hidden()) {
            shown(true);
        }
        if (handlers_.answered) {
            handlers_.answered(*turn);
        }
        if ((reply.isFailure || !reply.wasUnderstood) && handlers_.failed) {
            handlers_.failed(turn->question());
        }
    }
    sendNext();
    tellChanged();
}

LiveConversation::Reply LiveConversation::read(const linux_::AssistantClient::Answer& answer) {
    failure_.reset();
    Reply reply;
    assistant_ = ServiceWatch::troubleOf(answer.failure, answer.status, answer.hasBody());
    assistantEnded_ = now();
    if (!answer.hasBody()) {
        failure_ = Failure{ExitCode::Failure, "the assistant cannot be asked: " + answer.reason};
        const bool isSignedIn = host_.live()->isSignedIn() && assistant_ != ServiceWatch::Trouble::SignedOut;
        const char* sentence = isSignedIn                   ? "ANSWER_UNREACHABLE"
                               : host_.live()->isUnusable() ? "STATUS_UNREADABLE"
                                                            : "ANSWER_SIGN_IN";
        reply.scenario.sentence = LocalizedText(host_.text(sentence));
        reply.isFailure = isSignedIn;
        return reply;
    }
    auto read = ScenarioReader(host_.platform()->clock->now(), ScenarioReader::Clock::Present)
                    .readText(answer.body, "the assistant's answer");
    if (const auto* error = std::get_if<documents::DocumentError>(&read)) {
        failure_ = Failure{ExitCode::Failure, error->text()};
        return reply;
    }
    reply.scenario = std::get<Scenario>(std::move(read));
    return reply;
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
