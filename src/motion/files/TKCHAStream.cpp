#include "TKCHAStream.h"

#include "CBoneMesh.h"
#include "CCHAReader.h"
#include "CHTrack.h"
#include "CKeyframeControl.h"
#include "MotionNode.h"

namespace gw {

bool TKCHAStream::Load(const std::string& path)
{
    m_kRecord.Clear();
    if (!ReadLines(path))
        return false;
    TKCHFile file;
    return CCHAReader(lines, file, m_kRecord).Read() && BuildAnimatedTree(file);
}

bool TKCHAStream::WriteFile(const std::string&)
{
    return m_kRecord.Fail(EFailure::UnknownFormat);
}

// The motion ends one frame before the header's last number, as it always has.
bool TKCHAStream::BuildAnimatedTree(TKCHFile& file)
{
    motionRoot = new CNode;
    const float frequency = 1.0f / static_cast<float>(file.dataFrameRate);
    BuildNodes(*file.FirstRoot(), *motionRoot, [&](TKCHSegment& segment, CNode& node) {
        AttachCHTrack(node, file, segment, frequency).m_fEndTime = static_cast<float>(file.endFrame) - 1.0f;
        AddBoneShape(file, segment, node);
    });
    return true;
}

void TKCHAStream::AddBoneShape(const TKCHFile&, const TKCHSegment& segment, CNode& node)
{
    AttachBone(node, segment.name, segment.children.size(), segment.length, boneMeshes);
}

} // namespace gw
