#include "plugin/VAKTRMultipleLocationsSnippetController.h"

#include <algorithm>
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

/// What inserting row i at index i, one after the other, makes of an arrangement when a row comes twice: it moves to
/// its later place, and what stood behind it moves up.
Views insertedOneByOne(const Views& rows, Views arranged) {
    for (std::size_t i = 0; i < rows.size(); ++i) {
        std::erase(arranged, rows[i]);
        arranged.insert(arranged.begin() + static_cast<std::ptrdiff_t>(std::min(i, arranged.size())), rows[i]);
    }
    return arranged;
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
    auto row =
        create<KTRVelaFriendView>(&KTRVelaFriendView::initWithFrame, platform::Rect{0.0, 0.0, currentWidth(), 0.0});
    row->setViewDelegate(platform::weak(this));
    row->setUrlHandler(platform::weak(this));
    row->setCurrentLocationDelegate(refreshController());
    row->setTranslatesAutoresizingMaskIntoConstraints(false);
    return row;
}

void VAKTRMultipleLocationsSnippetController::createFriendViews() {
    const Locations known = proximityLocationsWithCoordinates();
    if (known.empty()) {
        showMessage();
        return;
    }
    FriendViews views;
    views.reserve(known.size());
    Views rows;
    rows.reserve(known.size());
    std::size_t withoutHandle = 0;
    for (std::size_t i = 0; i < known.size(); ++i) {
        const auto handle = known[i]->friendHandle();
        const std::string key = handle ? *handle : keyWithoutHandle(withoutHandle++);
        auto row = rowForKey(key, views);
        row->setLocation(known[i]);
        row->setSeparatorEnabled(i + 1 < known.size() || displayShowAllRow_);
        views[key] = row;
        rows.push_back(std::move(row));
    }
    const FriendViews earlier = std::exchange(friendViews_, std::move(views));
    if (displayShowAllRow_ && singleLabelView_) {
        singleLabelView_->setLabelText(AssistantLocalizedString("SHOW_ALL"));
        singleLabelView_->setIsShowAll(true);
    }
    arrange(rows, earlier);
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

std::shared_ptr<KTRVelaFriendView> VAKTRMultipleLocationsSnippetController::rowForKey(const std::string& key,
                                                                                      const FriendViews& views) {
    for (const FriendViews* rows : {static_cast<const FriendViews*>(&friendViews_), &views}) {
        if (const auto found = rows->find(key); found != rows->end()) {
            return found->second;
        }
    }
    return makeFriendView();
}

void VAKTRMultipleLocationsSnippetController::arrange(const Views& rows, const FriendViews& earlier) {
    const auto container = containerView();
    if (!container) {
        return;
    }
    const Views before = container->arrangedSubviews();
    // As many handles as rows: the rows stand one after the other, whatever stood there before.
    Views after = friendViews_.size() == rows.size() ? rows : insertedOneByOne(rows, before);
    const std::size_t wanted = rows.size() + (displayShowAllRow_ ? 1 : 0);
    if (displayShowAllRow_ && singleLabelView_) {
        std::erase(after, singleLabelView_);
        after.insert(after.begin() + static_cast<std::ptrdiff_t>(std::min(rows.size(), after.size())),
                     singleLabelView_);
    }
    after.resize(std::min(after.size(), wanted));

    // Rows whose friends are gone leave the tree, wherever they wait, and so does what is left over.
    std::unordered_set<std::shared_ptr<View>> surplus;
    const std::unordered_set<std::shared_ptr<View>> current(rows.begin(), rows.end());
    for (const auto& [key, row] : earlier) {
        if (!current.contains(row)) {
            surplus.insert(row);
        }
    }
    std::erase_if(after, [&](const auto& view) { return surplus.contains(view); });
    surplus.insert(before.begin(), before.end());
    for (const auto& view : after) {
        surplus.erase(view);
    }
    container->setArrangedSubviews(after);
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
