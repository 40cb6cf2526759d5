#include "HeldLeftKeys.h"

#include <QGuiApplication>

#if QT_CONFIG(xcb)
#include <X11/XKBlib.h>
#include <X11/Xlib.h>
#include <X11/keysym.h>
#endif

namespace gw {

#if QT_CONFIG(xcb)

namespace {

constexpr int kKeyCount = 256; // number of bits in the server's reply

std::set<EKey> HeldLeftKeys(Display* display)
{
    char held[kKeyCount / 8] = {};
    XQueryKeymap(display, held);
    std::set<EKey> keys;
    for (int code = 0; code < kKeyCount; ++code)
    {
        if (!(held[code / 8] & 1 << code % 8))
            continue;
        const KeySym symbol = XkbKeycodeToKeysym(display, static_cast<KeyCode>(code), 0, 0);
        if (symbol == XK_Control_L)
            keys.insert(EKey::LeftCtrl);
        if (symbol == XK_Shift_L)
            keys.insert(EKey::LeftShift);
    }
    return keys;
}

} // namespace

std::set<EKey> HeldLeftKeys()
{
    const auto* const server = qApp->nativeInterface<QNativeInterface::QX11Application>();
    Display* const display = server ? server->display() : nullptr;
    return display ? HeldLeftKeys(display) : std::set<EKey>();
}

#else

std::set<EKey> HeldLeftKeys()
{
    return {};
}

#endif

} // namespace gw
