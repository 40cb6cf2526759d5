#include "CBoneMeter.h"

#include "BoneMeshQueries.h"
#include "CBoneMesh.h"
#include "CNode.h"
#include "Directions.h"

namespace gw {

// A posed tree has the world matrices of its nodes, and not those of the meshes.
Vec3 CDirectionMeter::Present() const
{
    const Mat4& joint = m_pkJoint->m_kWorldMatrix;
    if (m_pkEnd)
        return Vec3Normalized(m_pkEnd->m_kWorldMatrix.Translation() - joint.Translation());
    const CBoneMesh* mesh = FindBoneMesh(*m_pkJoint);
    return Vec3Normalized((mesh ? mesh->m_kMatrix * joint : joint).Row(1));
}

void CDirectionMeter::Add()
{
    const Vec3 direction = Present();
    if (m_iFrames >= 2)
        m_kBends.Add(Vec3Length(m_kBeforeLast - m_kLast * 2.0f + direction));
    m_kBeforeLast = m_kLast;
    m_kLast = direction;
    ++m_iFrames;
}

CBoneMeter::CBoneMeter(const BonePair& pair, const BoneEnds& ends)
    : m_kSource(*ends.sourceStart, ends.source), m_kTarget(*pair.target, ends.target)
{
}

void CBoneMeter::Add()
{
    m_kSource.Add();
    m_kTarget.Add();
    m_fLastError = AngleBetween(m_kSource.Direction(), m_kTarget.Direction());
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
    bone.sourceJitter = m_kSource.Jitter();
    bone.resultJitter = m_kTarget.Jitter();
}

} // namespace gw
