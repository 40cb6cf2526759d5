#include "CHTrack.h"

#include "CKeyframeControl.h"
#include "MotionNode.h"
#include "TKCHFile.h"

#include <algorithm>
#include <iterator>
#include <utility>

namespace gw {

CKeyframeControl& AttachCHTrack(CNode& node, const TKCHFile& file, TKCHSegment& segment, float frequency)
{
    node.SetName(segment.name.c_str());
    const Vec3 rest = segment.positions.empty() ? kVec3Zero : segment.positions.front();
    CKeyframeControl& track = AttachTrack(node, file.frameCount, frequency, Mat4Compose(kMat3Identity, rest));
    const std::vector<Mat3> matrices = std::move(segment.matrices);
    track.m_kRotationKeys.reserve(matrices.size());
    const auto toQuat = [](const Mat3& matrix) { return QuatFromMat3(matrix); };
    std::ranges::transform(matrices, std::back_inserter(track.m_kRotationKeys), toQuat);
    track.m_kPositionKeys = std::move(segment.positions);
    track.m_kScaleKeys.assign(matrices.size(), kVec3One);
    return track;
}

} // namespace gw
