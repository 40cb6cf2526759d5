#pragma once

namespace gw {

class CKeyframeControl;
class CNode;
struct TKCHFile;
struct TKCHSegment;

/// Gives a node the name of its segment and a track of its frames, which leave the segment. The rest pose is
/// the first position, unturned.
CKeyframeControl& AttachCHTrack(CNode& node, const TKCHFile& file, TKCHSegment& segment, float frequency);

} // namespace gw
