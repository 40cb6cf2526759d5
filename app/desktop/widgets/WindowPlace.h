#pragma once

#include <QPoint>
#include <QSize>
#include <optional>
#include <string>

class QWidget;

namespace gw {

class CPlatform;

/// Where a setting says that a window stood, if that place is on a screen and, unless the size is empty, the
/// window had this size there.
std::optional<QPoint> ReadWindowPlace(const CPlatform& platform, const std::string& setting,
                                      const QSize& size = {});
/// Keeps where a window stands, unless it is minimised or maximised.
void WriteWindowPlace(CPlatform& platform, const std::string& setting, const QWidget& window);

} // namespace gw
