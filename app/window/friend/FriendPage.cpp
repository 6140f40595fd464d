#include "app/window/friend/FriendPage.h"

#include <QClipboard>
#include <QEvent>
#include <QGuiApplication>
#include <algorithm>
#include <cmath>

#include "host/links/FriendLinks.h"
#include "platform/base/Format.h"
#include "platform/base/LengthFormatter.h"
#include "platform/contacts/MonogramMaker.h"

namespace ktr::app {

using host::FriendLinks;
using host::KnownFriends;
using platform::VAKtrLocation;

namespace {

constexpr int kEdge = 12;
constexpr int kSheetBeside = 332;  ///< its width where it stands at the start
constexpr int kBesideFrom = 700;   ///< the width, where the window is lower than …
constexpr int kBesideBelow = 480;
constexpr int kAlwaysBesideFrom = 900;
constexpr int kZoomAboveSheet = 38;
constexpr int kBackToSheet = 8;
constexpr double kMostSheet = 0.62;  ///< of the height, below the map
constexpr int kCopied = 2000;        ///< milliseconds
constexpr double kFace = 54.0;
constexpr double kPinFace = 89.0;

bool hasPlace(const VAKtrLocation& location) {
    return location.latitude && location.longitude &&
           isValid(platform::Coordinate{*location.latitude, *location.longitude});
}

QString qt(const std::string& text) {
    return QString::fromStdString(text);
}

}  // namespace

FriendPage::FriendPage(host::Host& host, KnownFriends::Known known, Asks asks, Open open,
                       std::function<void()> getStreets)
    : host_(host),
      known_(std::move(known)),
      isAsked_(asks == Asks::AtOnce),
      open_(std::move(open)),
      getStreets_(std::move(getStreets)),
      map_(new FriendMap(this)),
      sheet_(new FriendSheet(this)),
      leave_(new MapControls(this)),
      back_(&leave_->add(Icon::Back, IconButton::Tone::Pine)),
      zoom_(new MapControls(this)),
      closer_(&zoom_->add(Icon::More, IconButton::Tone::Ink)),
      further_(&zoom_->add(Icon::Less, IconButton::Tone::Ink)),
      again_(new Button(Button::Kind::Quiet, {}, Icon::None, this)) {
    back_->setPressed([this] { leave(); });
    closer_->setPressed([this] { map_->step(true); });
    further_->setPressed([this] { map_->step(false); });
    again_->setPressed([this] {
        map_->showPin();
        map_->setFocus(Qt::OtherFocusReason);
    });
    again_->hide();
    map_->setChanged([this] { mapChanged(); });
    sheet_->streets().action().setPressed([this] { getStreets_(); });
    sheet_->row().setChanged([this] { takeNewest(); });
    copied_.setSingleShot(true);
    copied_.setInterval(kCopied);
    connect(&copied_, &QTimer::timeout, this, [this] { chooseActions(); });
    setTabOrder(back_, sheet_);
    setTabOrder(sheet_, map_);
    setTabOrder(map_, closer_);
    setTabOrder(closer_, further_);
}

FriendPage::~FriendPage() {
    letGo();
}

QString FriendPage::name() const {
    return qt(KnownFriends::nameOf(*known_.location));
}

QString FriendPage::text(const char* key) const {
    return qt(host_.text(key));
}

QString FriendPage::textWith(const char* key, const std::string& argument) const {
    return qt(platform::formatted(host_.text(key), {platform::FormatArgument(argument)}));
}

void FriendPage::letGo() {
    takeNewest();
    sheet_->row().letGo();
    map_->letGo();
}

void FriendPage::refreshed() {
    build();
}

void FriendPage::lookChanged() {
    map_->setColors(colors(), look().isStill);
}

void FriendPage::build() {
    sheet_->row().letGo();
    map_->build();
    const auto contact = KnownFriends::contactOf(*known_.location);
    const auto& faces = host_.platform()->avatarImages;
    map_->setPin({faces ? faces->avatarForContact(contact, kPinFace) : nullptr,
                  contact && (contact->thumbnailImageData || contact->imageData)});
    setTexts();
    sheet_->setPerson(
        name(), isAsked_ ? textWith("FRIEND_NOT_SEEN", KnownFriends::shortNameOf(*known_.location)) : QString(),
        std::dynamic_pointer_cast<const linux_::QtImage>(faces ? faces->avatarForContact(contact, kFace) : nullptr));
    if (isAsked_) {
        ask();
    }
    showPlace();
    chooseActions();
    place();
}

void FriendPage::setTexts() {
    const std::string friendName = KnownFriends::shortNameOf(*known_.location);
    setAccessibleName(name());
    back_->setName(text("PAGE_BACK"));
    closer_->setName(text("MAP_CLOSER"));
    further_->setName(text("MAP_FURTHER"));
    map_->setAccessibleName(textWith("MAP_SPOKEN", friendName));
    again_->setWords(textWith("FRIEND_SHOW", friendName));
    sheet_->streets().setTexts(text("MAP_NO_STREETS"), text("MAP_GET_STREETS"));
    sheet_->setOffer(isAsked_ ? QString() : textWith("FRIEND_WHERE", friendName), [this] {
        isAsked_ = true;
        build();
    });
}

/// The row is a list of one: a list has no map of its own.
void FriendPage::ask() {
    auto snippet = std::make_shared<platform::VAKtrLocationSnippet>();
    snippet->locations = std::make_shared<const platform::LocationList>(platform::LocationList{known_.location});
    snippet->proximity = "";
    snippet->searchContext = known_.context;
    if (const auto controller = host_.controllerFor(snippet)) {
        sheet_->row().show(controller);
    }
}

bool FriendPage::asksAbout(const std::vector<std::string>& handles) const {
    const auto own = KnownFriends::handlesOf(*known_.location);
    return isAsked_ && !handles.empty() && std::all_of(handles.begin(), handles.end(), [&](const std::string& handle) {
               return std::find(own.begin(), own.end(), handle) != own.end();
           });
}

void FriendPage::mapChanged() {
    again_->setVisible(map_->isTouched() && map_->place());
    sheet_->setLacksStreets(getStreets_ && map_->lacksStreets());
}

void FriendPage::takeNewest() {
    const auto& controller = sheet_->row().controller();
    const auto newest =
        controller ? std::dynamic_pointer_cast<platform::VAKtrLocationSnippet>(controller->currentSnippet()) : nullptr;
    const auto& locations = newest ? newest->locations : nullptr;
    if (!locations || locations->empty() || !locations->front() || locations->front() == known_.location) {
        return;
    }
    auto location = locations->front();
    if (!location->friend_) {
        // Whom nothing more is said of is still the friend of this page.
        location = std::static_pointer_cast<VAKtrLocation>(location->copy());
        location->friend_ = known_.location->friend_;
    }
    known_.location = location;
    if (newest->searchContext) {
        known_.context = newest->searchContext;
    }
    showPlace();
    chooseActions();
}

void FriendPage::showPlace() {
    const VAKtrLocation& location = *known_.location;
    const bool isThere = isAsked_ && hasPlace(location) && sheet_->row().controller() != nullptr;
    if (isThere) {
        map_->setPlace(FriendMap::Place{{*location.latitude, *location.longitude}, location.accuracy});
    } else {
        map_->setPlace(std::nullopt);
    }
    sheet_->setLines(isThere ? whereWords() : QString(), isThere ? howExactlyWords() : QString());
    if (isThere != sheet_->hasPlace()) {
        sheet_->setHasPlace(isThere);
    }
    mapChanged();
    place();
}

QString FriendPage::whereWords() const {
    const VAKtrLocation& location = *known_.location;
    QString words;
    for (const auto& part : {location.street, location.city}) {
        if (part && !part->empty()) {
            words += (words.isEmpty() ? QString() : QStringLiteral(", ")) + qt(*part);
        }
    }
    return words;
}

QString FriendPage::howExactlyWords() const {
    const double metres = known_.location->accuracy.value_or(0.0);
    const auto& lengths = host_.platform()->lengths;
    if (!(metres > 0.0) || !lengths) {
        return {};
    }
    constexpr double kFew = 15.0;
    constexpr double kTens = 100.0;
    constexpr double kHundreds = 1000.0;
    if (metres <= kFew) {
        return text("HOW_FEW");
    }
    const double unit = metres <= kTens ? 10.0 : metres <= kHundreds ? 100.0 : 1000.0;
    const double rounded = std::ceil(metres / unit) * unit;
    return textWith(metres <= kHundreds ? "HOW_WITHIN" : "HOW_NEAR",
                    lengths->textForMetres(rounded, platform::LengthWidth::Spoken));
}

void FriendPage::chooseActions() {
    const VAKtrLocation& location = *known_.location;
    const auto contact = KnownFriends::contactOf(location);
    const auto [call, write] = FriendLinks::waysTo(contact.get(), KnownFriends::handleOf(location));
    std::vector<FriendSheet::Action> actions;
    const auto add = [&](Icon icon, const char* key, const std::string& url, const char* nobody) {
        actions.push_back({icon, text(key), [this, url, nobody] { open_(url, nobody); }});
    };
    if (call) {
        add(Icon::Call, "FRIEND_CALL", *call, "CALL_NOBODY");
    }
    if (write) {
        add(Icon::Write, "FRIEND_WRITE", *write, "WRITE_NOBODY");
    }
    copyAction_ = -1;
    if (map_->place()) {
        add(Icon::OpenInMaps, "FRIEND_MAPS",
            FriendLinks::place(map_->place()->coordinate, KnownFriends::nameOf(location)), "PLACE_NOBODY");
        copyAction_ = static_cast<int>(actions.size());
        const bool isCopied = copied_.isActive();
        actions.push_back({Icon::Copy, text(isCopied ? "FRIEND_COPIED" : "FRIEND_COPY"), [this] { copyPlace(); }});
    }
    sheet_->setActions(actions);
}

void FriendPage::copyPlace() {
    const QString where = whereWords();
    const QString place = qt(FriendLinks::placeText(map_->place()->coordinate));
    QGuiApplication::clipboard()->setText(where.isEmpty() ? place : where + QStringLiteral(" (") + place + u')');
    copied_.start();
    if (auto* action = sheet_->action(static_cast<std::size_t>(copyAction_))) {
        action->setWords(text("FRIEND_COPIED"));
    }
}

void FriendPage::resizeEvent(QResizeEvent*) {
    place();
}

bool FriendPage::event(QEvent* event) {
    if (event->type() == QEvent::LayoutRequest) {
        place();
        return true;
    }
    return Page::event(event);
}

void FriendPage::place() {
    const bool isBeside = width() >= kAlwaysBesideFrom || (width() >= kBesideFrom && height() < kBesideBelow);
    const int across = isBeside ? kSheetBeside : width() - 2 * kEdge;
    const int wanted = sheet_->shapeHeight(across);
    // The way back stays above it.
    const int belowBack = height() - 2 * kEdge - leave_->naturalWidth() - kBackToSheet;
    const int most = isBeside ? height() - 2 * kEdge : std::min(static_cast<int>(height() * kMostSheet), belowBack);
    const int high = std::clamp(wanted, 1, std::max(most, 1));
    const QRect upright(kEdge, isBeside ? kEdge : height() - kEdge - high, across, high);
    const QRect sheet = mirrored(upright).toRect();
    map_->setGeometry(rect());
    sheet_->placeShape(sheet);
    placeControls(upright, isBeside);
}

void FriendPage::placeControls(const QRect& sheet, bool isBeside) {
    const int side = leave_->naturalWidth();
    const int start = isBeside ? sheet.right() + 1 + kEdge : kEdge;
    const int zoomHigh = zoom_->shapeHeight(side);
    const int end = width() - kEdge - side;
    const int zoomTop = isBeside ? kEdge : std::max(sheet.y() - kZoomAboveSheet - zoomHigh, kEdge);
    // Where there is no room for both below each other, the way back stays.
    const bool fits = isBeside ? height() >= zoomHigh + 2 * kEdge : zoomTop + zoomHigh + kEdge <= sheet.y();
    zoom_->setVisible(fits);
    const auto put = [this](Block& block, const QRect& rect) { block.placeShape(mirrored(rect).toRect()); };
    put(*leave_, {start, kEdge, side, side});
    put(*zoom_, {end, zoomTop, side, zoomHigh});
    const int againAcross = std::min(again_->naturalWidth(), width() - 2 * kEdge);
    const int againHigh = again_->shapeHeight(againAcross);
    const int middle = isBeside ? (sheet.right() + width()) / 2 : width() / 2;
    const int againTop = isBeside ? height() - kEdge - againHigh - kEdge : sheet.y() - kEdge - againHigh;
    put(*again_, {middle - againAcross / 2, againTop, againAcross, againHigh});
    const QRect free = isBeside ? QRect(sheet.right() + 1, 0, width() - sheet.right() - 1, height())
                                : QRect(0, 0, width(), std::max(sheet.y(), 1));
    std::vector<QRect> taken = {mirrored(sheet).toRect(), leave_->geometry()};
    if (fits) {
        taken.push_back(zoom_->geometry());
    }
    map_->setFree(mirrored(free).toRect(), taken);
}

}  // namespace ktr::app
