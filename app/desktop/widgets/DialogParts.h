#pragma once

#include <QString>

namespace gw {

// Properties that all dialogs share, so that they look the same. Lengths are device-independent pixels.

inline constexpr int kDialogMargin = 16;
inline constexpr int kDialogSpacing = 8;
inline constexpr int kButtonWidth = 84; ///< minimum

/// Names a widget for scripts, tests and accessibility. Returns the widget.
template <class Widget>
Widget* Named(Widget* widget, const char* name, const QString& accessibleName)
{
    widget->setObjectName(QLatin1String(name));
    widget->setAccessibleName(accessibleName);
    return widget;
}

} // namespace gw
