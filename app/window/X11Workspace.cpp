#include "app/window/X11Workspace.h"

#include <xcb/xcb.h>

#include <QGuiApplication>
#include <algorithm>
#include <cstdlib>
#include <cstring>
#include <memory>
#include <optional>
#include <span>
#include <utility>

namespace ktr::app {

namespace {

/// A window with this number stands on every workspace.
constexpr std::uint32_t kEverywhere = 0xFFFFFFFF;
constexpr std::uint32_t kMostStates = 64;

template <class Reply>
using Owned = std::unique_ptr<Reply, decltype(&std::free)>;

using Property = Owned<xcb_get_property_reply_t>;

Property propertyOf(xcb_connection_t* connection, std::uint32_t window, std::uint32_t name, std::uint32_t type) {
    const auto asked = xcb_get_property(connection, 0, window, name, type, 0, kMostStates);
    return {xcb_get_property_reply(connection, asked, nullptr), &std::free};
}

/// Its numbers; none where it is not set, or is something else.
std::span<const std::uint32_t> numbersOf(const Property& property) {
    constexpr int kBits = 32;
    if (!property || property->format != kBits) {
        return {};
    }
    return {static_cast<const std::uint32_t*>(xcb_get_property_value(property.get())),
            static_cast<std::size_t>(xcb_get_property_value_length(property.get())) / sizeof(std::uint32_t)};
}

}  // namespace

X11Workspace::X11Workspace(std::uint32_t window, std::function<void()> changed)
    : window_(window), changed_(std::move(changed)) {
    const auto* x11 = qGuiApp->nativeInterface<QNativeInterface::QX11Application>();
    connection_ = x11 != nullptr ? x11->connection() : nullptr;
    if (connection_ == nullptr) {
        return;
    }
    const Owned<xcb_query_tree_reply_t> tree(
        xcb_query_tree_reply(connection_, xcb_query_tree(connection_, window_), nullptr), &std::free);
    root_ = tree ? tree->root : 0;
    state_ = atom("_NET_WM_STATE");
    hidden_ = atom("_NET_WM_STATE_HIDDEN");
    desktop_ = atom("_NET_WM_DESKTOP");
    current_ = atom("_NET_CURRENT_DESKTOP");
    isShown_ = !isHidden() && !isElsewhere();
    QCoreApplication::instance()->installNativeEventFilter(this);
}

X11Workspace::~X11Workspace() {
    if (connection_ != nullptr && QCoreApplication::instance() != nullptr) {
        QCoreApplication::instance()->removeNativeEventFilter(this);
    }
}

std::uint32_t X11Workspace::atom(const char* name) const {
    const auto asked = xcb_intern_atom(connection_, 0, static_cast<std::uint16_t>(std::strlen(name)), name);
    const Owned<xcb_intern_atom_reply_t> reply(xcb_intern_atom_reply(connection_, asked, nullptr), &std::free);
    return reply ? reply->atom : 0;
}

bool X11Workspace::isHidden() const {
    const Property states = propertyOf(connection_, window_, state_, XCB_ATOM_ATOM);
    const auto numbers = numbersOf(states);
    return std::find(numbers.begin(), numbers.end(), hidden_) != numbers.end();
}

bool X11Workspace::isElsewhere() const {
    const auto numberOf = [this](std::uint32_t window, std::uint32_t name) -> std::optional<std::uint32_t> {
        const Property property = propertyOf(connection_, window, name, XCB_ATOM_CARDINAL);
        const auto numbers = numbersOf(property);
        return numbers.empty() ? std::nullopt : std::optional(numbers.front());
    };
    const auto own = numberOf(window_, desktop_);
    const auto shown = own ? numberOf(root_, current_) : std::nullopt;
    return own && shown && *own != kEverywhere && *own != *shown;
}

void X11Workspace::look() {
    const bool isShown = !isHidden() && !isElsewhere();
    if (std::exchange(isShown_, isShown) != isShown) {
        changed_();
    }
}

bool X11Workspace::nativeEventFilter(const QByteArray& type, void* message, qintptr* /*result*/) {
    if (type != "xcb_generic_event_t") {
        return false;
    }
    constexpr std::uint8_t kSentByClient = 0x80;
    const auto* event = static_cast<const xcb_generic_event_t*>(message);
    if ((event->response_type & ~kSentByClient) != XCB_PROPERTY_NOTIFY) {
        return false;
    }
    const auto* property = static_cast<const xcb_property_notify_event_t*>(message);
    if ((property->window == window_ && (property->atom == state_ || property->atom == desktop_)) ||
        (property->window == root_ && property->atom == current_)) {
        look();
    }
    return false;
}

}  // namespace ktr::app
