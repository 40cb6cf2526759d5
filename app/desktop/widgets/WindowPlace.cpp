#include "WindowPlace.h"

#include "CPlatform.h"
#include "WindowPlacement.h"

#include <QGuiApplication>
#include <QScreen>
#include <QWidget>
#include <algorithm>
#include <cstdint>

namespace gw {

namespace {

constexpr int kHeadHeight = 30; // pixels that must be reachable to move a window with the mouse

// In 64 bits, because a setting can contain any numbers.
bool HasSize(const WindowPlacement& placement, const QSize& size)
{
    return int64_t{placement.right} - placement.left == size.width() &&
           int64_t{placement.bottom} - placement.top == size.height();
}

// Returns whether the middle of the window's title bar is on a screen.
bool IsReachable(const WindowPlacement& placement)
{
    const int64_t middle = (int64_t{placement.left} + placement.right) / 2;
    const QPoint head(static_cast<int>(middle), placement.top);
    const auto holds = [&](const QScreen* screen) {
        return screen->availableGeometry().adjusted(0, 0, 0, -kHeadHeight).contains(head);
    };
    return std::ranges::any_of(QGuiApplication::screens(), holds);
}

} // namespace

std::optional<QPoint> ReadWindowPlace(const CPlatform& platform, const std::string& setting,
                                      const QSize& size)
{
    WindowPlacement placement;
    if (!ScanPlacement(platform.ReadSetting(setting), placement) || !IsReachable(placement) ||
        (!size.isEmpty() && !HasSize(placement, size)))
        return std::nullopt;
    return QPoint(placement.left, placement.top);
}

void WriteWindowPlace(CPlatform& platform, const std::string& setting, const QWidget& window)
{
    if (window.isMinimized() || window.isMaximized())
        return;
    WindowPlacement placement;
    // not used
    placement.minimisedX = placement.minimisedY = placement.maximisedX = placement.maximisedY = -1;
    placement.left = window.x();
    placement.top = window.y();
    placement.right = window.x() + window.width();
    placement.bottom = window.y() + window.height();
    platform.WriteSetting(setting, PlacementText(placement));
}

} // namespace gw
