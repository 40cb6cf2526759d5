#include "CTargetBones.h"

#include "CNode.h"
#include "CPoseSampler.h"

namespace gw {

Mat3 CTargetBones::RestTurn(std::string_view bone) const
{
    const CNode* node = m_kNames.Find(bone);
    return node ? NormalizedRows(RestWorld(*node)) : kMat3Identity;
}

Vec3 CTargetBones::ChildAxis(std::string_view bone) const
{
    const CNode* node = m_kNames.Find(bone);
    for (size_t i = 0; node && i < node->GetChildCount(); ++i)
    {
        if (const CNode* child = RecordCast<CNode>(node->ChildAt(i)))
            return Vec3Normalized(RestLocal(*child).Translation());
    }
    return kVec3UnitY;
}

} // namespace gw
