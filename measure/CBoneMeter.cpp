#include "CBoneMeter.h"

#include "CNode.h"

namespace gw {

void CDirectionMeter::Add()
{
    const Vec3 direction =
        Vec3Normalized(m_pkEnd->m_kWorldMatrix.Translation() - m_pkJoint->m_kWorldMatrix.Translation());
    if (m_iFrames >= 2)
        m_kBends.Add(Vec3Length(m_kBeforeLast - m_kLast * 2.0f + direction));
    m_kBeforeLast = m_kLast;
    m_kLast = direction;
    ++m_iFrames;
}

CBoneMeter::CBoneMeter(const BonePair& pair, const BoneEnds& ends)
    : m_kSource(*ends.sourceStart, *ends.source), m_kTarget(*pair.target, *ends.target)
{
}

void CBoneMeter::Add()
{
    m_kSource.Add();
    m_kTarget.Add();
    const double error = DegreesBetween(m_kSource.Direction(), m_kTarget.Direction());
    if (error > m_kErrors.Largest())
        m_iLargestFrame = m_iFrame;
    m_kErrors.Add(error);
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
