#pragma once

#include <QString>

namespace gw {

// What all dialogs share, so that they look like one program. Lengths are the toolkit's own pixels, which
// follow the scale of the screen.

inline constexpr int kDialogMargin = 16;
inline constexpr int kDialogSpacing = 8;
inline constexpr int kButtonWidth = 84; ///< at least

/// Names a widget for scripts and tests, and for those who cannot see it. Answers the widget.
template <class Widget>
Widget* Named(Widget* widget, const char* name, const QString& accessibleName)
{
    widget->setObjectName(QLatin1String(name));
    widget->setAccessibleName(accessibleName);
    return widget;
}

} // namespace gw
