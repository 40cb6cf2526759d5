#pragma once

#include <QMenu>

namespace gw {

class CGaitConvertFrame;

/// Creates the menu of the icon's corner: recent sources and the commands of a window menu. It deletes itself
/// when closed.
QMenu* MakeCornerMenu(CGaitConvertFrame& frame);

} // namespace gw
