#pragma once

#include <QIcon>
#include <QString>

namespace gw {

/// An icon that is drawn from its SVG file at the very size and scale that are asked for, and dimmed where it
/// is disabled. A file that cannot be read gives an empty picture.
QIcon SvgIcon(const QString& path);

} // namespace gw
