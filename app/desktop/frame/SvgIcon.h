#pragma once

#include <QIcon>
#include <QString>

namespace gw {

/// Returns an icon that is drawn from its SVG file at the exact size and scale, and dimmed if disabled. An
/// unreadable file yields an empty picture.
QIcon SvgIcon(const QString& path);

} // namespace gw
