#pragma once

#include <QMenu>

namespace gw {

class CGaitConvertFrame;

/// The menu of the icon's corner: the sources that were opened last, and what a window menu offers. Deletes
/// itself when it is closed.
QMenu* MakeCornerMenu(CGaitConvertFrame& frame);

} // namespace gw
