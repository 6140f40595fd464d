#include "host/Host.h"

#include <QCoreApplication>
#include <QDateTime>
#include <algorithm>
#include <utility>

#include "host/ClockText.h"
#include "host/PluginFinder.h"
#include "linux/maps/DesktopMapsApplication.h"
#include "platform/assistant/AssistantSettings.h"
#include "platform/assistant/Localization.h"
#include "platform/assistant/VASnippet.h"
#include "platform/base/Clock.h"
#include "platform/base/Format.h"
#include "platform/base/LogArea.h"
#include "platform/base/Region.h"
#include "platform/client/FriendLocationRestrictions.h"

namespace ktr::host {

using platform::Platform;

namespace {

/// Deferred work that is due within this time belongs to the picture; later steps of a scenario do not. Seconds.
constexpr double kIdleHorizon = 1.0;
constexpr int kMostRounds = 3;

}  // namespace

std::variant<std::unique_ptr<Host>, Failure> Host::make(const HostSettings& settings, Time time,
                                                        const std::string& pluginPath) {
    std::unique_ptr<Host> host(new Host);
    host->settings_ = settings;
    host->pluginPath_ = PluginFinder::find(pluginPath);
    auto made = Environment::make(settings, time == Time::Virtual);
    if (const auto* failure = std::get_if<Failure>(&made)) {
        return *failure;
    }
    host->environment_ = std::move(std::get<Environment>(made));
    Platform::install(host->platform());
    if (auto failure = host->loadPlugin()) {
        return *failure;
    }
    host->delegate_ = std::make_shared<HostDelegate>(
        std::make_shared<platform::Bundle>(host->platform()->localization->hostBundleIdentifier()));
    // What a plugin wants to see on a map goes the way of all its links: there is one policy for what they open.
    host->platform()->mapsApplication = std::make_shared<linux_::DesktopMapsApplication>(
        [delegate = std::weak_ptr<HostDelegate>(host->delegate_)](const std::string& url) {
            const auto asked = delegate.lock();
            return asked && asked->open && asked->open(platform::Url(url));
        });
    host->window_ = platform::create<platform::Window>(&platform::Window::initWithFrame, platform::Rect{});
    host->conversation_ = platform::create<ConversationView>(&ConversationView::initWithFrame, platform::Rect{});
    host->window_->addSubview(host->conversation_);
    if (host->live()) {
        host->followFiles();
    }
    return host;
}

void Host::followFiles() {
    live()->setOutdated([this] { configurationChanged(); });
    environment_.userContacts->follow([this](const Environment::Contacts& contacts) {
        HostSettings now = settings_;
        now.follow(live()->configuration());
        remakeOrSay(now, &contacts);
    });
}

void Host::configurationChanged() {
    const bool isMoreThanContacts = live()->takeConfiguration();
    HostSettings now = settings_;
    now.follow(live()->configuration());
    if (now.contacts != settings_.contacts) {
        // Other files: what they hold is there when they have been read.
        environment_.userContacts->setPaths(now.contacts);
        now.contacts = settings_.contacts;
    }
    if (std::exchange(settings_.addressBooks, now.addressBooks) != now.addressBooks) {
        environment_.userContacts->setUsesBooks(now.addressBooks);
    }
    if (isMoreThanContacts) {
        remakeOrSay(now, nullptr);
    }
}

void Host::askAgain() {
    // A copy: what is decided now becomes what it was decided of.
    remakeOrSay(HostSettings(settings_), nullptr);
}

void Host::remakeOrSay(const HostSettings& settings, const Environment::Contacts* contacts) {
    if (const auto failure = remake(settings, contacts)) {
        platform::areaLog(platform::LogArea::Host)
            .write(platform::LogLevel::Error, "what has changed is not used: %@",
                   platform::FormatArgument(failure->line).shown());
    }
}

std::optional<Failure> Host::loadPlugin() {
    auto plugin = Plugin::load(pluginPath_);
    if (const auto* reason = std::get_if<std::string>(&plugin)) {
        return Failure{ExitCode::Plugin, *reason};
    }
    plugin_ = std::move(std::get<std::unique_ptr<Plugin>>(plugin));
    return std::nullopt;
}

Host::~Host() {
    environment_.userContacts.reset();
    // Views and controllers come from the plugin, and all of them use the platform.
    for (const Turn& turn : turns_) {
        turn.view->card()->letGo();
    }
    turns_.clear();
    conversation_.reset();
    window_.reset();
    delegate_.reset();
    if (environment_.live) {
        // Commands under way end now, and what they leave behind runs while everything that it uses is still there:
        // work that waits in a loop and owns that loop would keep both for ever.
        environment_.live.reset();
        platform()->httpTransport.reset();
        QCoreApplication::sendPostedEvents();
    }
    plugin_.reset();
    // What cannot be kept is said while there is a log. There is no platform where one could not be made.
    if (platform()) {
        platform()->preferences.reset();
    }
    if (Platform::installed() == platform()) {
        Platform::install(nullptr);
    }
}

bool Host::rightToLeft() const {
    return platform()->assistant->languageIsRightToLeft();
}

std::string Host::text(const std::string& key) const {
    const auto& localization = *platform()->localization;
    return localization.text(key, localization.hostBundleIdentifier());
}

std::string Host::number(std::int64_t number) const {
    return platform()->decimalNumbers->plainStringFromInteger(number);
}

std::string Host::clockFace(platform::Date moment) const {
    const int offset = live() ? QDateTime::currentDateTime().offsetFromUtc() : settings_.offsetSeconds;
    return clockText(moment, offset, settings_.language, settings_.region);
}

std::vector<std::shared_ptr<platform::AssistantObject>> Host::snippets() const {
    std::vector<std::shared_ptr<platform::AssistantObject>> snippets;
    for (auto turn = turns_.rbegin(); turn != turns_.rend(); ++turn) {
        const auto controller = turn->view->card()->controller();
        const auto newest = controller ? controller->currentSnippet() : nullptr;
        if (newest || turn->scenario.snippet) {
            snippets.push_back(newest ? newest : turn->scenario.snippet);
        }
    }
    return snippets;
}

std::shared_ptr<platform::HostSnippetViewController> Host::controllerFor(
    const std::shared_ptr<platform::AssistantObject>& snippet) const {
    auto controller = plugin_ && !isRestricted() ? plugin_->factory().viewControllerForSnippet(snippet) : nullptr;
    if (controller) {
        controller->setDelegate(delegate_);
    }
    return controller;
}

bool Host::isRestricted() const {
    const auto& restrictions = platform()->restrictions;
    return restrictions && (restrictions->isFriendLocationRestricted() || !restrictions->isFriendLocationAllowed());
}

TurnTexts Host::textsOf(const Turn& turn) const {
    TurnTexts texts;
    texts.shortTime = clockText(turn.asked.date, turn.asked.offsetSeconds, settings_.language, settings_.region);
    texts.longTime = platform::formatted(text("TODAY"), {platform::FormatArgument(texts.shortTime)});
    texts.question = turn.scenario.question.text(settings_.language);
    texts.sentence = turn.scenario.sentence.text(settings_.language);
    return texts;
}

bool Host::addCard(Turn& turn) {
    const auto controller = plugin_ ? plugin_->factory().viewControllerForSnippet(turn.scenario.snippet) : nullptr;
    if (!controller) {
        return false;
    }
    const auto sharing = std::dynamic_pointer_cast<platform::VAKtrVisibilityView>(turn.scenario.snippet);
    if (sharing) {
        endSharing();
        sharing_ = turn.view;
        if (live() && sharing->visible) {
            live()->openSharing();
        }
    }
    saysHidden_ = sharing && !sharing->visible;
    controller->setDelegate(delegate_);
    turn.view->setController(controller);
    return true;
}

bool Host::show(Turn& turn) {
    TurnTexts texts = textsOf(turn);
    const bool isRefused = turn.scenario.snippet && isRestricted();
    const bool isDrawn = turn.scenario.snippet && !isRefused && (turn.view->card()->still() || addCard(turn));
    if (isRefused) {
        texts.sentence = text("ANSWER_RESTRICTED");
    } else if (turn.isAnswered && !isDrawn && texts.sentence.empty()) {
        texts.sentence = text("ANSWER_NOT_SHOWN");
    }
    turn.view->setTexts(texts);
    return isDrawn || isRefused || !turn.scenario.snippet;
}

void Host::endSharing() {
    if (live()) {
        live()->closeSharing();
    }
    const auto earlier = std::exchange(sharing_, {}).lock();
    if (!earlier || !earlier->card()->controller()) {
        return;
    }
    if (live()) {
        makeStill(*earlier);
    } else {
        // Without a service nothing of it can leave: it just goes on no more.
        earlier->card()->setOnScreen(false);
    }
}

void Host::tellWhatIsSeen(const std::function<bool(const TurnView&)>& isSeen) {
    const auto newest = std::find_if(turns_.rbegin(), turns_.rend(),
                                     [](const Turn& turn) { return turn.view->card()->controller() != nullptr; });
    for (auto turn = newest; turn != turns_.rend(); ++turn) {
        const auto& card = turn->view->card();
        const bool isShown = turn == newest || isSeen(*turn->view);
        const bool shares = std::dynamic_pointer_cast<platform::VAKtrVisibilityView>(turn->scenario.snippet) != nullptr;
        if (!isShown || !shares) {
            card->setOnScreen(isShown);
        }
    }
}

std::optional<platform::Url> Host::pageOf(const platform::AccessibilityNode& link) const {
    std::optional<platform::Url> page;
    const auto open = std::exchange(delegate_->open, [&page](const platform::Url& url) {
        page = url;
        return true;
    });
    platform::accessibilityPress(link);
    delegate_->open = open;
    return page;
}

namespace {

/// The first of a tree that can be pressed; none when nothing can.
const platform::AccessibilityNode* firstLink(const platform::AccessibilityNode& node) {
    if (node.pressable) {
        return &node;
    }
    for (const auto& child : node.children) {
        if (const auto* link = firstLink(child)) {
            return link;
        }
    }
    return nullptr;
}

}  // namespace

void Host::makeStill(TurnView& turn) {
    const auto& card = turn.card();
    const auto& content = card->content();
    content->layoutIfNeeded();
    const auto tree = platform::accessibilityTree(content, rightToLeft());
    // The row comes first, and leads to the user's own page.
    const auto* link = firstLink(tree);
    const auto page = link != nullptr ? pageOf(*link) : std::nullopt;
    const auto open = [delegate = std::weak_ptr<HostDelegate>(delegate_)](const platform::Url& url) {
        if (const auto opener = delegate.lock(); opener && opener->open) {
            opener->open(url);
        }
    };
    const auto still = StillView::of(content, settings_.scale, rightToLeft(), page, open);
    card->letGo();
    card->setStill(still);
}

void Host::letCardsGo() {
    endSharing();
    for (Turn& turn : turns_) {
        if (const auto controller = turn.view->card()->controller()) {
            if (auto snippet = controller->currentSnippet()) {
                turn.scenario.snippet = std::move(snippet);
            }
            turn.view->card()->letGo();
        }
    }
    if (live()) {
        live()->cancelCommands();
    }
}

std::optional<Failure> Host::remake(const HostSettings& settings, const Environment::Contacts* contacts) {
    // What is under way may hold on to it a little longer than its place lasts.
    const auto earlier = platform();
    if (auto failure = environment_.remake(settings, contacts)) {
        return failure;
    }
    if (remaking_) {
        remaking_();
    }
    settings_ = settings;
    letCardsGo();
    plugin_.reset();
    Platform::install(nullptr);
    Platform::install(platform());
    auto failure = loadPlugin();
    const bool saidHidden = saysHidden_;
    for (Turn& turn : turns_) {
        turn.view->renew();
        show(turn);
    }
    saysHidden_ = saidHidden;
    if (remade_) {
        remade_();
    }
    return failure;
}

std::optional<Failure> Host::addTurn(const Scenario& scenario) {
    Turn turn;
    turn.view = platform::create<TurnView>(&TurnView::initWithFrame, platform::Rect{});
    turn.scenario = scenario;
    turn.asked = scenario.clock.value_or(documents::IsoTime{settings_.start, settings_.offsetSeconds});
    conversation_->addTurn(turn.view);
    if (!show(turn)) {
        conversation_->removeTurn(turn.view);
        return Failure{ExitCode::NotDrawn, scenario.file + ": the plugin draws no such answer: a " + scenario.kind};
    }
    turns_.push_back(std::move(turn));
    return std::nullopt;
}

std::shared_ptr<TurnView> Host::addQuestion(const std::string& question) {
    Turn turn;
    turn.view = platform::create<TurnView>(&TurnView::initWithFrame, platform::Rect{});
    turn.scenario.question = LocalizedText(question);
    turn.asked = {platform()->clock->now(), QDateTime::currentDateTime().offsetFromUtc()};
    show(turn);
    conversation_->addTurn(turn.view);
    turns_.push_back(turn);
    return turn.view;
}

void Host::answer(TurnView& view, const Scenario& answer) {
    const auto turn = std::find_if(turns_.begin(), turns_.end(), [&](const Turn& t) { return t.view.get() == &view; });
    if (turn == turns_.end()) {
        return;
    }
    LocalizedText question = std::move(turn->scenario.question);
    turn->scenario = answer;
    turn->scenario.question = std::move(question);
    turn->isAnswered = true;
    if (!show(*turn)) {
        platform::areaLog(platform::LogArea::Host)
            .write(platform::LogLevel::Error, "the plugin draws no such answer: a %@",
                   platform::FormatArgument(answer.kind).shown());
    }
}

void Host::takeAnswerBack(TurnView& view) {
    const auto turn = std::find_if(turns_.begin(), turns_.end(), [&](const Turn& t) { return t.view.get() == &view; });
    if (turn != turns_.end()) {
        LocalizedText question = std::move(turn->scenario.question);
        turn->scenario = Scenario();
        turn->scenario.question = std::move(question);
        turn->isAnswered = false;
        view.setTexts(textsOf(*turn));
        view.setOffers({});
    }
}

void Host::removeTurn(TurnView& view) {
    const auto turn = std::find_if(turns_.begin(), turns_.end(), [&](const Turn& t) { return t.view.get() == &view; });
    if (turn != turns_.end()) {
        turn->view->card()->letGo();
        conversation_->removeTurn(turn->view);
        turns_.erase(turn);
    }
}

double Host::layOut(double width) {
    const double height = conversation_->layOut(width);
    window_->setFrame({0.0, 0.0, width, height});
    window_->layoutIfNeeded();
    return height;
}

double Host::settle(double width) {
    layOut(width);
    if (environment_.virtualTime) {
        environment_.virtualTime->advance(settings_.runSeconds);
        // What a layout leads to, such as a map's picture at its new size, is waited for too, and may lead to another.
        for (int round = 0; round < kMostRounds; ++round) {
            environment_.virtualTime->runUntilIdle(kIdleHorizon);
            layOut(width);
        }
    }
    return layOut(width);
}

}  // namespace ktr::host
