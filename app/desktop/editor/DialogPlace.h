#pragma once

#include <QPoint>
#include <QSize>
#include <optional>

class QWidget;

namespace gw {

class CPlatform;

/// Where the settings say that the editor stood, if it had this size there and the place is on a screen.
std::optional<QPoint> ReadDialogPlace(const CPlatform& platform, const QSize& size);
/// Keeps where a window stands, unless it is minimised or maximised.
void WriteDialogPlace(CPlatform& platform, const QWidget& window);

} // namespace gw
