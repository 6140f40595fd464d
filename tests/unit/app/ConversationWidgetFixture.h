#pragma once

#include <QApplication>
#include <QKeyEvent>
#include <QMouseEvent>
#include <QPointingDevice>
#include <QTouchEvent>
#include <QWheelEvent>
#include <memory>
#include <string>
#include <vector>

#include "app/window/ConversationWidget.h"
#include "platform/base/Platform.h"
#include "platform/ui/Label.h"
#include "tests/unit/app/TestHost.h"

#include <gtest/gtest.h>

namespace ktr::app {

/// The demo scenario in a window, with the real plugin.
class KTRConversationWidgetTest : public ::testing::Test {
  public:
    void open(const std::vector<std::string>& names, int width = 400, int height = 700) {
        host::HostOptions options;
        options.dark = false;
        host = testHost(options, demoScenarios(names));
        ASSERT_TRUE(host);
        host->delegate().open = [this](const platform::Url& url) {
            opened.push_back(url.text());
            return true;
        };
        widget = std::make_unique<ConversationWidget>(*host);
        widget->resize(width, height);
        widget->show();
        QApplication::processEvents();
    }
    void TearDown() override {
        widget.reset();
        host.reset();
    }

    static std::shared_ptr<platform::Label> labelOf(const platform::View& within, const std::string& text) {
        for (const auto& view : within.subviews()) {
            auto label = std::dynamic_pointer_cast<platform::Label>(view);
            if (!label || !label->text().starts_with(text)) {
                label = labelOf(*view, text);
            }
            if (label) {
                return label;
            }
        }
        return nullptr;
    }

    void mouse(QEvent::Type type, QPointF at) {
        const bool move = type == QEvent::MouseMove;
        QMouseEvent event(type, at, widget->mapToGlobal(at), move ? Qt::NoButton : Qt::LeftButton,
                          type == QEvent::MouseButtonRelease ? Qt::NoButton : Qt::LeftButton, Qt::NoModifier);
        QApplication::sendEvent(widget.get(), &event);
    }
    void touch(QEvent::Type type, QPointF at) {
        const auto state = type == QEvent::TouchBegin    ? QEventPoint::Pressed
                           : type == QEvent::TouchUpdate ? QEventPoint::Updated
                                                         : QEventPoint::Released;
        QTouchEvent event(type, &finger, Qt::NoModifier, {QEventPoint(1, state, at, widget->mapToGlobal(at))});
        QApplication::sendEvent(widget.get(), &event);
    }
    void key(int code, Qt::KeyboardModifiers modifiers = Qt::NoModifier) {
        QKeyEvent event(QEvent::KeyPress, code, modifiers);
        QApplication::sendEvent(widget.get(), &event);
    }
    void wheel(int eighths, QPointF at = {200.0, 300.0}) {
        QWheelEvent event(at, widget->mapToGlobal(at), {}, {0, eighths}, Qt::NoButton, Qt::NoModifier,
                          Qt::NoScrollPhase, false);
        QApplication::sendEvent(widget.get(), &event);
    }
    /// The middle of a row in the widget's coordinates.
    QPointF row(const std::string& name) const {
        QPointF found(-1.0, -1.0);
        const auto visit = [&](const auto& self, const platform::AccessibilityNode& node) -> void {
            for (const auto& child : node.children) {
                if (child.text.find(name) != std::string::npos || node.text.find(name) != std::string::npos) {
                    const auto& frame = child.frame;
                    found = {frame.x + frame.width / 2.0, frame.y + frame.height / 2.0 - widget->scrolled()};
                }
                self(self, child);
            }
        };
        visit(visit, platform::accessibilityTree(host->window(), host->rightToLeft()));
        return found;
    }

    QPointingDevice finger{QStringLiteral("finger"),
                           1,
                           QInputDevice::DeviceType::TouchScreen,
                           QPointingDevice::PointerType::Finger,
                           QInputDevice::Capability::Position,
                           1,
                           0};
    std::unique_ptr<host::Host> host;
    std::unique_ptr<ConversationWidget> widget;
    std::vector<std::string> opened;
};

}  // namespace ktr::app
