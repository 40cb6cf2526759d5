#pragma once

class QWidget;

namespace gw {

/// Shows the map tool's name and the program's version over a window until the user closes it.
void ShowAboutBox(QWidget& owner);

} // namespace gw
