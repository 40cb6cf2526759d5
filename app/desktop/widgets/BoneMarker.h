#pragma once

#include <QIcon>

namespace gw {

/// The marker of a bone in a tree, by the numbers of its two images: as it is, and while it is selected.
/// Sharp at every scale. Empty for numbers that have no image.
QIcon BoneMarker(int image, int selectedImage);

} // namespace gw
