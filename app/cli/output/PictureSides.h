#pragma once

#include "PictureMotion.h"

namespace gw {

/// Finds the body of a motion's skeleton, and sets the sides of its bones, the hips that show the way it
/// faces, and what is above the body, which is not drawn. With `turnsUpright`, also sets the axis that is
/// up. A skeleton without a body is left in the middle. `secondsPerFrame` is the tracks' frame time.
void FindPictureSides(PictureMotion& motion, bool turnsUpright, float secondsPerFrame);

} // namespace gw
