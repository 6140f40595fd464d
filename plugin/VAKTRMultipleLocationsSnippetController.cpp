#include "plugin/VAKTRMultipleLocationsSnippetController.h"

#include <string>
#include <string_view>
#include <unordered_map>
#include <unordered_set>
#include <utility>

#include "model/PluginBundle.h"
#include "service/ContextValues.h"

namespace ktr {

using platform::create;
using platform::View;

namespace {

using Views = std::vector<std::shared_ptr<View>>;

/// While there is nothing to measure, such as when friends are being located; points.
constexpr double kHeightOfNothing = 90.0;

/// No handle begins with a NUL character.
std::string keyWithoutHandle(std::size_t ordinal) {
    return std::string(1, '\0') + std::to_string(ordinal);
}

}  // namespace

bool VAKTRMultipleLocationsSnippetController::initWithCueObject(const std::shared_ptr<platform::VASnippet>& snippet) {
    if (!VAKTRBaseSnippetController::initWithCueObject(snippet)) {
        return false;
    }
    if (contextDict()) {
        displayShowAllRow_ = ContextValues::boolean(*contextDict(), "incomplete");
    }
    return true;
}

void VAKTRMultipleLocationsSnippetController::loadView() {
    VAKTRBaseSnippetController::loadView();
    singleLabelView_ = create<KTRVelaSingleLabelView>(&KTRVelaSingleLabelView::initWithFrame,
                                                      platform::Rect{0.0, 0.0, currentWidth(), 0.0});
    singleLabelView_->setUrlHandler(platform::weak(this));
    singleLabelView_->setIsShowAll(displayShowAllRow_);
    containerView()->addArrangedSubview(singleLabelView_);
    reloadData();
}

void VAKTRMultipleLocationsSnippetController::reloadData() {
    VAKTRBaseSnippetController::reloadData();
    createFriendViews();
    if (showLocatingFriends() && singleLabelView_) {
        // The end of refreshing shows at the next reload only: nothing redraws when it is reported.
        singleLabelView_->setLabelText(
            AssistantLocalizedString(refreshingCancelled() ? "NO_FRIENDS_FOUND" : "LOCATING_FRIENDS"));
    }
}

bool VAKTRMultipleLocationsSnippetController::showLocatingFriends() const {
    for (const auto& record : locations()) {
        if (record->hasCoordinate()) {
            return false;
        }
    }
    return true;
}

bool VAKTRMultipleLocationsSnippetController::isSearching() const {
    return !refreshingCancelled() && showLocatingFriends();
}

VAKTRBaseSnippetController::Locations VAKTRMultipleLocationsSnippetController::proximityLocationsWithCoordinates()
    const {
    Locations known;
    for (const auto& record : locations()) {
        if (record->hasCoordinate()) {
            known.push_back(record);
        }
    }
    return known;
}

std::shared_ptr<KTRVelaFriendView> VAKTRMultipleLocationsSnippetController::makeFriendView() {
    auto row = makeFriendRow(KTRVelaBaseView::accessibilitySizeIsActive());
    row->setViewDelegate(platform::weak(this));
    row->setUrlHandler(platform::weak(this));
    row->setCurrentLocationDelegate(refreshController());
    return row;
}

bool VAKTRMultipleLocationsSnippetController::refillSameRows(const Locations& known) {
    const auto container = containerView();
    if (displayShowAllRow_ || !container || known.size() != arranged_.size() ||
        known.size() != container->arrangedSubviews().size()) {
        return false;
    }
    for (std::size_t i = 0; i < known.size(); ++i) {
        const auto& handle = known[i]->friendHandle();
        if (!handle || *handle != arranged_[i].first || container->arrangedSubviews()[i] != arranged_[i].second) {
            return false;
        }
    }
    // What is asked while a row is filled may lead back here.
    ArrangedRows rows = std::exchange(arranged_, {});
    for (std::size_t i = 0; i < known.size(); ++i) {
        rows[i].second->setLocation(known[i]);
        rows[i].second->setSeparatorEnabled(i + 1 < known.size());
    }
    if (arranged_.empty()) {
        arranged_ = std::move(rows);
    }
    return true;
}

void VAKTRMultipleLocationsSnippetController::createFriendViews() {
    const Locations known = proximityLocationsWithCoordinates();
    if (known.empty()) {
        showMessage();
        return;
    }
    if (refillSameRows(known)) {
        return;
    }
    // A handle that comes again has one row, which stands, and is filled, at its last place: what the earlier places
    // would show of it is never seen.
    std::vector<std::string> keys;
    keys.reserve(known.size());
    std::unordered_map<std::string_view, std::size_t> lastPlaces;
    lastPlaces.reserve(known.size());
    std::size_t withoutHandle = 0;
    for (std::size_t i = 0; i < known.size(); ++i) {
        auto handle = known[i]->friendHandle();
        keys.push_back(handle ? *std::move(handle) : keyWithoutHandle(withoutHandle++));
        lastPlaces[keys.back()] = i;
    }
    FriendViews views;
    views.reserve(lastPlaces.size());
    ArrangedRows arranged;
    arranged.reserve(lastPlaces.size());
    Views rows;
    rows.reserve(lastPlaces.size());
    for (std::size_t i = 0; i < known.size(); ++i) {
        if (lastPlaces[keys[i]] != i) {
            continue;
        }
        auto row = rowForKey(keys[i]);
        row->setLocation(known[i]);
        row->setSeparatorEnabled(i + 1 < known.size() || displayShowAllRow_);
        rows.push_back(row);
        arranged.emplace_back(keys[i], row);
        views.emplace(keys[i], std::move(row));
    }
    const FriendViews earlier = std::exchange(friendViews_, std::move(views));
    arranged_ = std::move(arranged);
    if (displayShowAllRow_ && singleLabelView_) {
        singleLabelView_->setLabelText(AssistantLocalizedString("SHOW_ALL"));
        singleLabelView_->setIsShowAll(true);
    }
    arrange(std::move(rows), earlier);
}

void VAKTRMultipleLocationsSnippetController::showMessage() {
    if (!singleLabelView_ || !containerView()) {
        return;
    }
    // In this order: the text that follows another role keeps that role's alignment until it is set again.
    singleLabelView_->setLabelText(AssistantLocalizedString("LOCATING_FRIENDS"));
    singleLabelView_->setIsShowAll(false);
    // The rows leave the arrangement only; they wait in the tree for the friends to be known again.
    containerView()->setArrangedSubviews({singleLabelView_});
}

std::shared_ptr<KTRVelaFriendView> VAKTRMultipleLocationsSnippetController::rowForKey(const std::string& key) {
    const auto found = friendViews_.find(key);
    return found == friendViews_.end() ? makeFriendView() : found->second;
}

void VAKTRMultipleLocationsSnippetController::arrange(Views rows, const FriendViews& earlier) {
    const auto container = containerView();
    if (displayShowAllRow_ && singleLabelView_) {
        rows.push_back(singleLabelView_);
    }
    // The same friends as before, in the same order: nothing comes or goes.
    if (!container || (earlier.size() == friendViews_.size() && rows == container->arrangedSubviews())) {
        return;
    }
    // Rows whose friends are gone leave the tree, wherever they wait; so does whatever else stands in the arrangement.
    std::unordered_set<std::shared_ptr<View>> surplus(container->arrangedSubviews().begin(),
                                                      container->arrangedSubviews().end());
    for (const auto& [key, row] : earlier) {
        surplus.insert(row);
    }
    for (const auto& view : rows) {
        surplus.erase(view);
    }
    container->setArrangedSubviews(rows);
    container->removeSubviews({surplus.begin(), surplus.end()});
}

double VAKTRMultipleLocationsSnippetController::desiredHeightForWidth(double width) {
    setCurrentWidth(width);
    if (!containerView()) {
        loadView();
    }
    if (containerView()->window()) {
        containerView()->layoutIfNeeded();
    }
    // Rows that are kept while friends are being located again count, though they are not shown.
    double height = 0.0;
    if (locations().empty() || displayShowAllRow_) {
        height = singleLabelView_ ? singleLabelView_->estimagedHeightForView() : 0.0;
    }
    if (!locations().empty()) {
        for (const auto& [handle, row] : friendViews_) {
            height += row->estimagedHeightForView();
        }
    }
    return height == 0.0 ? kHeightOfNothing : height;
}

}  // namespace ktr
