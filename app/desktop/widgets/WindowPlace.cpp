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

constexpr int kHeadHeight = 30; // pixels that a mouse must reach to move a window

// In 64 bits, since a setting may hold any numbers.
bool HasSize(const WindowPlacement& placement, const QSize& size)
{
    return int64_t{placement.right} - placement.left == size.width() &&
           int64_t{placement.bottom} - placement.top == size.height();
}

// Whether the middle of the window's head is on a screen.
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
    placement.minimisedX = placement.minimisedY = placement.maximisedX = placement.maximisedY = -1; // none
    placement.left = window.x();
    placement.top = window.y();
    placement.right = window.x() + window.width();
    placement.bottom = window.y() + window.height();
    platform.WriteSetting(setting, PlacementText(placement));
}

} // namespace gw
