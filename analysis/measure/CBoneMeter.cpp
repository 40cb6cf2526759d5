#include "CBoneMeter.h"

#include "BoneMeshQueries.h"
#include "CBoneMesh.h"
#include "CNode.h"
#include "Directions.h"

namespace gw {

// Posing a tree updates the world matrices of its nodes, but not of the meshes.
Vec3 CBoneDirection::Present() const
{
    const Mat4& joint = m_pkJoint->m_kWorldMatrix;
    if (m_pkEnd)
        return Vec3Normalized(m_pkEnd->m_kWorldMatrix.Translation() - joint.Translation());
    const CBoneMesh* mesh = FindBoneMesh(*m_pkJoint);
    return Vec3Normalized((mesh ? mesh->m_kMatrix * joint : joint).Row(1));
}

CBoneMeter::CBoneMeter(const BonePair& pair, const BoneEnds& ends)
    : m_kSource(*ends.sourceStart, ends.source), m_kTarget(*pair.target, ends.target)
{
}

void CBoneMeter::Add()
{
    m_fLastError = AngleBetween(m_kSource.Present(), m_kTarget.Present());
    if (m_fLastError > m_kErrors.Largest())
        m_iLargestFrame = m_iFrame;
    m_kErrors.Add(m_fLastError);
    ++m_iFrame;
}

void CBoneMeter::Write(BoneMeasures& bone) const
{
    bone.measured = true;
    bone.meanError = m_kErrors.Mean();
    bone.largestError = m_kErrors.Largest();
    bone.largestFrame = m_iLargestFrame;
}

} // namespace gw
