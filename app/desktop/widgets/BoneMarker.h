#pragma once

#include <QIcon>

namespace gw {

/// Returns the marker of a bone in a tree from the numbers of its two images: normal and selected. Sharp at
/// every scale. Empty for unknown numbers.
QIcon BoneMarker(int image, int selectedImage);

} // namespace gw
