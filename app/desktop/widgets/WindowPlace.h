#pragma once

#include <QPoint>
#include <QSize>
#include <optional>
#include <string>

class QWidget;

namespace gw {

class CPlatform;

/// Returns a window's stored position, if it is on a screen and, unless `size` is empty, was stored with that
/// size.
std::optional<QPoint> ReadWindowPlace(const CPlatform& platform, const std::string& setting,
                                      const QSize& size = {});
/// Stores a window's position, unless it is minimized or maximized.
void WriteWindowPlace(CPlatform& platform, const std::string& setting, const QWidget& window);

} // namespace gw
