#pragma once

namespace gw {

class CPicturePainter;

/// The painter of this machine, loaded at the first call; null where its module, or a library that it needs,
/// is not there.
CPicturePainter* LoadPicturePainter();

} // namespace gw
