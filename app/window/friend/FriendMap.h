#pragma once

#include <QElapsedTimer>
#include <QTimer>
#include <functional>
#include <memory>
#include <optional>

#include "app/window/DragTrail.h"
#include "app/window/PlainWidget.h"
#include "app/window/friend/FriendPin.h"
#include "app/window/friend/MapCamera.h"
#include "linux/paint/Palette.h"
#include "platform/base/NotificationCenter.h"
#include "platform/map/MapBackdrop.h"
#include "platform/map/PlatformMapView.h"
#include "platform/ui/Window.h"

class QTouchEvent;

namespace ktr::app {

/// A large map around one pin, moved about in by finger, mouse, wheel and keys. The map follows the pin until somebody
/// has moved it. Main thread, with a platform installed from `build` to `letGo`.
class FriendMap : public PlainWidget {
  public:
    explicit FriendMap(QWidget* parent = nullptr);
    ~FriendMap() override;

    /// Makes the map of the installed platform; and lets go of all that is that platform's.
    void build();
    void letGo();

    struct Place {
        platform::Coordinate coordinate;  ///< WGS84
        std::optional<double> accuracy;   ///< metres
        bool operator==(const Place&) const = default;
    };
    void setPin(FriendPin::Looks looks);
    /// None: no pin and no circle.
    void setPlace(const std::optional<Place>& place);
    const std::optional<Place>& place() const { return place_; }
    /// The part of the map that nothing stands over, and what stands over the rest.
    void setFree(const QRect& free, const std::vector<QRect>& taken);
    void setColors(const linux_::Palette& palette, bool isStill);

    /// One step closer, or with false further away.
    void step(bool closer);
    /// Back to the pin, which it follows from then on.
    void showPin();
    /// Somebody has moved the map since the pin was shown.
    bool isTouched() const { return isTouched_; }
    bool isCoarsest() const { return camera_.isCoarsest(); }
    bool isFinest() const { return camera_.isFinest(); }
    /// There are no streets where the pin is, wherever the map has been moved to since.
    bool lacksStreets() const;
    const platform::MapViewport& shown() const { return camera_.shown(); }
    /// Called when `isTouched`, `isCoarsest`, `isFinest` or `lacksStreets` may have become another.
    void setChanged(std::function<void()> changed) { changed_ = std::move(changed); }

  protected:
    void paintEvent(QPaintEvent* event) override;
    void resizeEvent(QResizeEvent* event) override;
    void mousePressEvent(QMouseEvent* event) override;
    void mouseMoveEvent(QMouseEvent* event) override;
    void mouseReleaseEvent(QMouseEvent* event) override;
    void mouseDoubleClickEvent(QMouseEvent* event) override;
    void wheelEvent(QWheelEvent* event) override;
    void keyPressEvent(QKeyEvent* event) override;
    void focusInEvent(QFocusEvent* event) override;
    void focusOutEvent(QFocusEvent* event) override;
    bool event(QEvent* event) override;

  private:
    class Client;

    bool touch(QTouchEvent& event);
    void pan(QPointF by);
    void grab(QPointF at);
    void letFly();
    void zoom(double steps, QPointF at);
    void frame();
    void fit();
    void show(platform::PlatformMapView::Hand hand);
    void startMoving();
    void restSoon();
    void touched();
    void tell();
    void updateCircle();
    platform::Point pinPoint() const;
    double firstZoom() const;
    double nearZoom() const;
    void lookForStreets();
    void streetsLookedFor();
    void goFartherOut();
    double seconds() const { return static_cast<double>(clock_.nsecsElapsed()) * 1e-9; }

    std::shared_ptr<Client> client_;
    std::shared_ptr<platform::Window> window_;
    std::shared_ptr<platform::PlatformMapView> map_;
    std::shared_ptr<FriendPinDelegate> delegate_;
    std::shared_ptr<FriendPin> pin_;
    std::optional<Place> place_;
    platform::Coordinate onMap_;  ///< of the place, in the map's datum
    const linux_::Palette* palette_;
    bool isStill_ = false;
    QRect free_;
    MapCamera camera_;
    platform::NotificationCenter::Token streets_;
    std::optional<double> coarse_;  ///< the zoom at which a map without streets is first seen
    /// A few points around the pin from near, drawn for what they tell: the map may show another place, or be so far
    /// out that nobody looks for streets.
    std::unique_ptr<platform::MapBackdrop> spot_;
    bool lackedStreets_ = false;  ///< when that was looked at last
    bool isPlaced_ = false;       ///< the camera has been brought to the pin
    bool isTouched_ = false;
    bool isStepped_ = false;  ///< the scale was chosen by hand since then; the pin stays where it is
    bool isRingShown_ = false;
    QElapsedTimer clock_;
    QTimer frames_;
    QTimer rest_;
    std::optional<QPointF> held_;  ///< where the mouse is
    DragTrail trail_;
    QPointF velocity_;  ///< points a second, of a map that runs on
    double flungAt_ = 0.0;
    double steppedAt_ = 0.0;
    QPointF pinchAt_;
    double pinchSpan_ = 0.0;
    int fingers_ = 0;
    std::function<void()> changed_;
};

}  // namespace ktr::app
