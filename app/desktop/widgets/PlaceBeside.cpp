#include "PlaceBeside.h"

#include <QScreen>
#include <QWidget>
#include <algorithm>

namespace gw {

namespace {

// The window manager adds borders and a title bar when the window is shown, so their size is a guess.
constexpr int kGap = 4;
constexpr int kTitleHeight = 32;

} // namespace

void PlaceBeside(QWidget& window, QWidget& other)
{
    const QRect screen = other.screen()->availableGeometry();
    const QRect taken = other.frameGeometry();
    const int needed = window.width() + 2 * kGap;
    const int lowest = screen.bottom() - window.height() - kTitleHeight;
    const int y = std::max(std::min(taken.top(), lowest), screen.top());
    if (taken.right() + needed <= screen.right())
        window.move(taken.right() + kGap, y);
    else if (taken.left() - needed >= screen.left())
        window.move(taken.left() - needed + kGap, y);
    else if (taken.width() + needed <= screen.width())
    {
        other.move(screen.right() - needed - taken.width(), taken.top());
        window.move(screen.right() - needed + kGap, y);
    }
}

} // namespace gw
