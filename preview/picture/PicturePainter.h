#pragma once

namespace gw {

class CPicturePainter;

/// Returns the painter, loaded at the first call; null if its module, or a library that it needs, is missing.
CPicturePainter* LoadPicturePainter();

} // namespace gw
