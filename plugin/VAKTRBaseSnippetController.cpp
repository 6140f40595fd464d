#include "plugin/VAKTRBaseSnippetController.h"

#include <utility>

#include "model/KTRVATheme.h"
#include "model/LogCategory.h"
#include "model/PluginBundle.h"
#include "platform/base/MainLoop.h"
#include "platform/base/Platform.h"
#include "platform/layout/PinnedEdges.h"
#include "platform/map/MapLocationManager.h"
#include "service/ContextValues.h"
#include "service/KTRVAUtils.h"
#include "views/accessibility/KTRAXVelaFriendView.h"

namespace ktr {

using platform::Platform;
using platform::StackView;

namespace {

constexpr double kMillisecondsASecond = 1000.0;

}  // namespace

VAKTRBaseSnippetController::~VAKTRBaseSnippetController() {
    if (refreshController_) {
        refreshController_->cancelTimer();
        refreshController_->setDelegate({});
    }
}

bool VAKTRBaseSnippetController::initWithCueObject(const std::shared_ptr<platform::VASnippet>& snippet) {
    if (!init()) {
        return false;
    }
    LogCategory_Unspecified()->line("snippet: %@", snippet);
    snippet_ = snippet;
    if (const auto located = std::dynamic_pointer_cast<platform::VAKtrLocationSnippet>(snippet)) {
        setLocations(located->locations);
        proximity_ = located->proximity;
    }
    if (snippet && snippet->searchContext) {
        LogCategory_Unspecified()->line("searchContext: %@", *snippet->searchContext);
        contextDict_ = KTRVAUtils::contextDictionaryForURL(*snippet->searchContext);
        clientId_ = ContextValues::text(*contextDict_, "clientId");
    }
    setDefaultViewInsets({});
    return true;
}

void VAKTRBaseSnippetController::setDelegate(const std::shared_ptr<platform::SnippetHostDelegate>& delegate) {
    HostSnippetViewController::setDelegate(delegate);
    if (!delegate) {
        return;
    }
    // A host may drop the controller while it is being asked.
    const auto self = platform::strong(this);
    const auto bundle = delegate->effectiveBundleForLocation(*this);
    if (const auto maps = platform::shared<platform::MapLocationManager>()) {
        maps->setEffectiveBundle(bundle);
    }
    const auto refresher = platform::create<RefreshController>(&RefreshController::initWithBundle, bundle);
    // The new one is in place when the old one goes: its teardown still tells this controller.
    auto old = std::exchange(refreshController_, refresher);
    refresher->setDelegate(platform::weak(this));
    old.reset();
    if (contextDict_) {
        refreshInterval_ = ContextValues::number(*contextDict_, "minCallbackIntervalInMS") / kMillisecondsASecond;
        timeoutInterval_ = ContextValues::number(*contextDict_, "callbackTimeoutIntervalInMS") / kMillisecondsASecond;
        refresher->beginTimerWithRefresh(refreshInterval_, timeoutInterval_);
    }
}

void VAKTRBaseSnippetController::loadView() {
    containerView_ = platform::create<StackView>(&StackView::initWithFrame, platform::Rect{});
    containerView_->setTranslatesAutoresizingMaskIntoConstraints(false);
    containerView_->setAxis(StackView::Axis::Vertical);
    if (KTRVelaBaseView::accessibilitySizeIsActive()) {
        // These rows are measured larger than their images are: what is left is each row's own, not the last one's.
        containerView_->setDistribution(StackView::Distribution::FillEvenly);
    }
    setView(containerView_);
}

void VAKTRBaseSnippetController::updateViewConstraints() {
    const auto pinned = view();
    if (const auto parent = pinned ? pinned->superview() : nullptr) {
        using platform::LayoutAttribute;
        platform::pinEdges(
            *pinned, *parent,
            {LayoutAttribute::Top, LayoutAttribute::Left, LayoutAttribute::Right, LayoutAttribute::Bottom});
    }
    HostSnippetViewController::updateViewConstraints();
}

void VAKTRBaseSnippetController::viewWillAppear(bool animated) {
    HostSnippetViewController::viewWillAppear(animated);
    if (const auto refresher = refreshController_) {
        refresher->beginTimerWithRefresh(refreshInterval_, timeoutInterval_);
    }
    startReloadTimer();
}

void VAKTRBaseSnippetController::startReloadTimer() {
    const auto installed = Platform::installed();
    if (!installed || !installed->mainLoop) {
        return;
    }
    // A timer that was held before goes on: only what is held when the view disappears is stopped. It does not keep
    // the controller, and stops itself at the first firing after the controller, or the platform, is gone.
    const auto itself = std::make_shared<std::weak_ptr<platform::Timer>>();
    reloadTimer_ = installed->mainLoop->schedule(kReloadInterval, true, [target = platform::weak(this), itself] {
        if (const auto self = target.lock(); self && Platform::installed()) {
            self->reloadData();
        } else if (const auto timer = itself->lock()) {
            timer->invalidate();
        }
    });
    *itself = reloadTimer_;
}

void VAKTRBaseSnippetController::viewWillDisappear(bool animated) {
    HostSnippetViewController::viewWillDisappear(animated);
    if (const auto refresher = refreshController_) {
        refresher->cancelTimer();
    }
    if (reloadTimer_) {
        reloadTimer_->invalidate();
        reloadTimer_ = nullptr;
    }
}

double VAKTRBaseSnippetController::desiredHeightForWidth(double width) {
    currentWidth_ = width;
    if (!containerView_) {
        return 0.0;
    }
    if (containerView_->window()) {
        containerView_->layoutIfNeeded();
    }
    constexpr double priority = 750.0;
    constexpr double compressed = platform::kCompressedFittingExtent;
    return containerView_->systemLayoutSizeFitting({compressed, compressed}, priority, priority).height;
}

std::shared_ptr<platform::HeaderItem> VAKTRBaseSnippetController::sashItem() {
    return std::make_shared<platform::HeaderItem>(AssistantLocalizedString("APPLICATION_NAME"),
                                                  KTRVATheme::themeImageNamed("appIcon_dyn"));
}

std::shared_ptr<platform::AssistantObject> VAKTRBaseSnippetController::currentSnippet() const {
    const auto made = std::dynamic_pointer_cast<platform::VAKtrLocationSnippet>(snippet_);
    if (!made) {
        return nullptr;
    }
    auto now = std::make_shared<platform::VAKtrLocationSnippet>();
    now->searchContext = made->searchContext;
    now->proximity = proximity_;
    now->locations = sourceLocations_;
    return now;
}

void VAKTRBaseSnippetController::reloadData() {}

void VAKTRBaseSnippetController::locationsUpdated(const std::shared_ptr<const ServiceResult>& result) {
    const auto objects = std::make_shared<platform::LocationList>();
    if (result) {
        objects->reserve(result->size());
        for (const ResultItem& item : *result) {
            const auto* location = std::get_if<std::shared_ptr<platform::VAKtrLocation>>(&item);
            objects->push_back(location != nullptr ? *location : nullptr);
        }
    }
    setLocations(objects);
    reloadData();
    viewNeedsResize();
}

std::shared_ptr<KTRVelaFriendView> VAKTRBaseSnippetController::makeFriendRow(bool axSize) const {
    using platform::create;
    const platform::Rect frame{0.0, 0.0, currentWidth_, 0.0};
    std::shared_ptr<KTRVelaFriendView> row;
    if (axSize) {
        row = create<KTRAXVelaFriendView>(&KTRAXVelaFriendView::initWithFrame, frame);
    } else {
        row = create<KTRVelaFriendView>(&KTRVelaFriendView::initWithFrame, frame);
    }
    row->setTranslatesAutoresizingMaskIntoConstraints(false);
    return row;
}

void VAKTRBaseSnippetController::refreshCancelled() {
    refreshingCancelled_ = true;
}

void VAKTRBaseSnippetController::viewNeedsResize() {
    if (const auto host = delegate()) {
        host->heightDidChange(*this, true);
    }
}

void VAKTRBaseSnippetController::handleURL(const platform::Url& url) {
    openURL(url);
}

void VAKTRBaseSnippetController::openURL(const platform::Url& url) {
    if (const auto host = delegate()) {
        host->openUrl(*this, url, [url](bool opened) {
            if (!opened) {
                LogCategory_Unspecified()->write(platform::LogLevel::Error, "Unable to open url: %@", url);
            }
        });
    }
}

void VAKTRBaseSnippetController::setLocations(const std::shared_ptr<const platform::LocationList>& locations) {
    if (locations == sourceLocations_) {
        return;
    }
    sourceLocations_ = locations;
    Locations records;
    if (locations) {
        records.reserve(locations->size());
        for (const auto& object : *locations) {
            records.push_back(KTRVALocation::locationWithVelaLocation(object));
        }
    }
    locations_ = std::move(records);
}

std::vector<std::shared_ptr<platform::VAPerson>> VAKTRBaseSnippetController::friends() const {
    std::vector<std::shared_ptr<platform::VAPerson>> persons;
    for (const auto& record : locations_) {
        const auto object = record->velaLocation();
        if (object && object->friend_ && object->friend_->object) {
            persons.push_back(object->friend_->object);
        }
    }
    return persons;
}

std::shared_ptr<KTRVALocation> VAKTRBaseSnippetController::disambiguatedLocation() const {
    // Always the first one, with or without a coordinate; later ones are deliberately not looked at.
    return locations_.empty() ? nullptr : locations_.front();
}

}  // namespace ktr
