#include "DialogPlace.h"

#include "CPlatform.h"
#include "WindowPlacement.h"

#include <QGuiApplication>
#include <QScreen>
#include <QWidget>
#include <algorithm>
#include <cstdint>

namespace gw {

namespace {

constexpr const char* kSetting = "DialogPos";

// In 64 bits, since a setting may hold any numbers.
bool HasSize(const WindowPlacement& placement, const QSize& size)
{
    return int64_t{placement.right} - placement.left == size.width() &&
           int64_t{placement.bottom} - placement.top == size.height();
}

bool IsOnScreen(const QRect& rect)
{
    const auto meets = [&](const QScreen* screen) { return screen->availableGeometry().intersects(rect); };
    return std::ranges::any_of(QGuiApplication::screens(), meets);
}

} // namespace

std::optional<QPoint> ReadDialogPlace(const CPlatform& platform, const QSize& size)
{
    WindowPlacement placement;
    if (!ScanPlacement(platform.ReadSetting(kSetting), placement) || !HasSize(placement, size))
        return std::nullopt;
    const QPoint corner(placement.left, placement.top);
    return IsOnScreen({corner, size}) ? std::optional(corner) : std::nullopt;
}

void WriteDialogPlace(CPlatform& platform, const QWidget& window)
{
    if (window.isMinimized() || window.isMaximized())
        return;
    WindowPlacement placement;
    placement.minimisedX = placement.minimisedY = placement.maximisedX = placement.maximisedY = -1; // none
    placement.left = window.x();
    placement.top = window.y();
    placement.right = window.x() + window.width();
    placement.bottom = window.y() + window.height();
    platform.WriteSetting(kSetting, PlacementText(placement));
}

} // namespace gw
