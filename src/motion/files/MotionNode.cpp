#include "MotionNode.h"

#include "CBoneMesh.h"
#include "CKeyframeControl.h"

#include <algorithm>

namespace gw {

bool MayBeName(std::string_view name)
{
    return name.size() <= kNameLimit && name.find('\0') == name.npos;
}

bool KeyTimesFit(int64_t frameCount, size_t nodeCount, size_t fileBytes, size_t anySize)
{
    // A row usually takes at least two bytes per node, so normal files are far below this.
    constexpr size_t kTimesPerByte = 4;
    const auto frames = static_cast<size_t>(std::max<int64_t>(frameCount, 0));
    return frames <= (fileBytes * kTimesPerByte + anySize) / std::max<size_t>(nodeCount, 1);
}

CKeyframeControl& AttachTrack(CNode& node, int frameCount, float frequency, const Mat4& restMatrix)
{
    auto* const track = new CKeyframeControl;
    node.AttachControl(track);
    track->m_fFrequency = frequency;
    track->m_fEndTime = static_cast<float>(frameCount) - 1.0f;
    track->m_kRestMatrix = restMatrix;
    track->m_bHasRestMatrix = true;
    track->m_kKeyTimes.resize(static_cast<size_t>(std::max(frameCount, 0)));
    for (size_t i = 0; i < track->m_kKeyTimes.size(); ++i)
        track->m_kKeyTimes[i] = static_cast<float>(i);
    return *track;
}

CBoneMesh& AttachBone(CNode& node, const std::string& name, size_t childCount, float length,
                      EBoneMeshes meshes)
{
    CBoneMesh* mesh = nullptr;
    if (childCount > 1)
        mesh = new CBoneNodeMesh;
    else
        mesh = new CBoneShapeMesh;
    node.AttachChild(mesh);
    mesh->SetName(name.c_str());
    if (meshes != EBoneMeshes::Empty)
        mesh->Build(length);
    else if (length > 0.0f)
        mesh->m_fLength = length;
    return *mesh;
}

CNode& AttachNode(CNode& parent)
{
    auto* const node = new CNode;
    parent.AttachChild(node);
    return *node;
}

} // namespace gw
