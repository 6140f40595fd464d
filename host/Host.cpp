#include "host/Host.h"

#include <QCoreApplication>
#include <QDateTime>

#include "host/ClockText.h"
#include "host/Environment.h"
#include "host/PluginFinder.h"
#include "platform/assistant/AssistantSettings.h"
#include "platform/assistant/Localization.h"
#include "platform/assistant/VASnippet.h"
#include "platform/base/Clock.h"
#include "platform/base/Format.h"

namespace ktr::host {

using platform::Platform;

namespace {

/// Deferred work that is due within this time belongs to the picture; later steps of a scenario do not. Seconds.
constexpr double kIdleHorizon = 1.0;

}  // namespace

std::variant<std::unique_ptr<Host>, Failure> Host::make(const HostSettings& settings, Time time,
                                                        const std::string& pluginPath) {
    std::unique_ptr<Host> host(new Host);
    host->settings_ = settings;
    auto made = Environment::make(settings, time == Time::Virtual);
    if (const auto* failure = std::get_if<Failure>(&made)) {
        return *failure;
    }
    auto& environment = std::get<Environment>(made);
    host->platform_ = environment.platform;
    host->virtualTime_ = environment.virtualTime;
    host->live_ = std::move(environment.live);
    Platform::install(host->platform_);
    auto plugin = Plugin::load(PluginFinder::find(pluginPath));
    if (const auto* reason = std::get_if<std::string>(&plugin)) {
        return Failure{ExitCode::Plugin, *reason};
    }
    host->plugin_ = std::move(std::get<std::unique_ptr<Plugin>>(plugin));
    host->delegate_ = std::make_shared<HostDelegate>(
        std::make_shared<platform::Bundle>(host->platform_->localization->hostBundleIdentifier()));
    host->window_ = platform::create<platform::Window>(&platform::Window::initWithFrame, platform::Rect{});
    host->conversation_ = platform::create<ConversationView>(&ConversationView::initWithFrame, platform::Rect{});
    host->window_->addSubview(host->conversation_);
    return host;
}

Host::~Host() {
    if (conversation_) {
        for (const auto& turn : conversation_->turns()) {
            if (const auto& controller = turn->card()->controller()) {
                controller->viewWillDisappear(false);
            }
        }
    }
    // Views and controllers come from the plugin, and all of them use the platform.
    conversation_.reset();
    window_.reset();
    delegate_.reset();
    if (live_) {
        // Commands under way end now, and what they leave behind runs while everything that it uses is still there:
        // work that waits in a loop and owns that loop would keep both for ever.
        live_.reset();
        platform_->httpTransport.reset();
        QCoreApplication::sendPostedEvents();
    }
    plugin_.reset();
    if (Platform::installed() == platform_) {
        Platform::install(nullptr);
    }
}

bool Host::rightToLeft() const {
    return platform_->assistant->languageIsRightToLeft();
}

std::string Host::text(const std::string& key) const {
    const auto& localization = *platform_->localization;
    return localization.text(key, localization.hostBundleIdentifier());
}

std::string Host::clockFace(platform::Date moment) const {
    const int offset = live_ ? QDateTime::currentDateTime().offsetFromUtc() : settings_.offsetSeconds;
    return clockText(moment, offset, settings_.language, settings_.region);
}

void Host::setTimes(TurnTexts& texts, const std::string& clockFace) const {
    texts.shortTime = clockFace;
    texts.longTime = platform::formatted(text("TODAY"), {platform::FormatArgument(clockFace)});
}

TurnTexts Host::textsOf(const Scenario& scenario) const {
    TurnTexts texts;
    const documents::IsoTime asked =
        scenario.clock.value_or(documents::IsoTime{settings_.start, settings_.offsetSeconds});
    setTimes(texts, clockText(asked.date, asked.offsetSeconds, settings_.language, settings_.region));
    texts.question = scenario.question.text(settings_.language);
    texts.sentence = scenario.sentence.text(settings_.language);
    return texts;
}

bool Host::addCard(TurnView& turn, const Scenario& scenario) {
    const auto controller = plugin_->factory().viewControllerForSnippet(scenario.snippet);
    if (!controller) {
        return false;
    }
    const auto sharing = std::dynamic_pointer_cast<platform::VAKtrVisibilityView>(scenario.snippet);
    if (sharing) {
        endEarlierSharing(controller);
    }
    saysHidden_ = sharing && !sharing->visible;
    controller->setDelegate(delegate_);
    turn.setController(controller);
    return true;
}

void Host::endEarlierSharing(const std::shared_ptr<platform::HostSnippetViewController>& controller) {
    if (const auto earlier = sharing_.lock()) {
        earlier->viewWillDisappear(false);
    }
    sharing_ = controller;
}

std::optional<Failure> Host::addTurn(const Scenario& scenario) {
    auto turn = platform::create<TurnView>(&TurnView::initWithFrame, platform::Rect{});
    turn->setTexts(textsOf(scenario));
    conversation_->addTurn(turn);
    if (scenario.snippet && !addCard(*turn, scenario)) {
        conversation_->removeTurn(turn);
        return Failure{ExitCode::NotDrawn, scenario.file + ": the plugin draws no such answer: a " + scenario.kind};
    }
    return std::nullopt;
}

std::shared_ptr<TurnView> Host::addQuestion(const std::string& question) {
    auto turn = platform::create<TurnView>(&TurnView::initWithFrame, platform::Rect{});
    TurnTexts texts;
    setTimes(texts, clockFace(platform_->clock->now()));
    texts.question = question;
    turn->setTexts(texts);
    conversation_->addTurn(turn);
    return turn;
}

void Host::answer(TurnView& turn, const Scenario& answer) {
    std::string sentence = answer.sentence.text(settings_.language);
    const bool drawn = answer.snippet && addCard(turn, answer);
    if (!drawn && sentence.empty()) {
        sentence = text("ANSWER_NOT_SHOWN");
    }
    turn.setSentence(sentence);
}

double Host::layOut(double width) {
    const double height = conversation_->layOut(width);
    window_->setFrame({0.0, 0.0, width, height});
    window_->layoutIfNeeded();
    return height;
}

double Host::settle(double width) {
    layOut(width);
    if (virtualTime_) {
        virtualTime_->advance(settings_.runSeconds);
        virtualTime_->runUntilIdle(kIdleHorizon);
    }
    return layOut(width);
}

}  // namespace ktr::host
