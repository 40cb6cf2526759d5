#pragma once

namespace gw {

class CKeyframeControl;
class CNode;
struct TKCHFile;
struct TKCHSegment;

/// Gives a node its segment's name and a track with its frames, which are moved out of the segment. The rest
/// pose is the first position, without rotation.
CKeyframeControl& AttachCHTrack(CNode& node, const TKCHFile& file, TKCHSegment& segment, float frequency);

} // namespace gw
