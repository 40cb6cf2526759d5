#pragma once

class QWidget;

namespace gw {

/// Moves a window that is not visible yet next to another one, without covering it: to the right, otherwise
/// to the left. If both sides are too narrow but the screen is not, moves the other window aside as far as
/// necessary. Does nothing if the screen has no room for both.
void PlaceBeside(QWidget& window, QWidget& other);

} // namespace gw
