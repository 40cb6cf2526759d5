#include "CTargetBones.h"

#include "BodyTree.h"
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
    const CNode* const child = node ? FirstChild(*node) : nullptr;
    return child ? Vec3Normalized(RestLocal(*child).Translation()) : kVec3UnitY;
}

} // namespace gw
