#include "CTrunkLine.h"

#include "BodyPose.h"
#include "BodyTree.h"

#include <algorithm>
#include <cmath>

namespace gw {

CTrunkLine::CTrunkLine(const std::array<CNode*, 2>& thighs, CNode* hips, CNode* top) : m_apkThighs(thighs)
{
    if (!thighs[0] || !thighs[1] || !hips || !top || hips == top || !IsAtOrBelow(top, hips))
        return;
    m_kSpine = NodesBetween(hips, top);
    m_kSpine.push_back(top);
}

std::vector<CNode*> CTrunkLine::Joints() const
{
    std::vector<CNode*> joints(m_apkThighs.begin(), m_apkThighs.end());
    joints.insert(joints.end(), m_kSpine.begin(), m_kSpine.end());
    return joints;
}

bool CTrunkLine::Read()
{
    m_kAcross = PlaceOf(*m_apkThighs[0]) - PlaceOf(*m_apkThighs[1]);
    m_kPoints.assign(1, PlaceOf(*m_apkThighs[1]) + m_kAcross * 0.5f);
    m_kArc.assign(1, 0.0);
    for (const CNode* joint : m_kSpine)
    {
        m_kArc.push_back(m_kArc.back() + Vec3Length(PlaceOf(*joint) - m_kPoints.back()));
        m_kPoints.push_back(PlaceOf(*joint));
    }
    return std::isfinite(m_kArc.back()) && m_kArc.back() > 0.0;
}

Vec3 CTrunkLine::At(double share) const
{
    const double along = share * m_kArc.back();
    const auto next = std::clamp<std::ptrdiff_t>(std::ranges::lower_bound(m_kArc, along) - m_kArc.begin(), 1,
                                                 static_cast<std::ptrdiff_t>(m_kArc.size()) - 1);
    const auto i = static_cast<size_t>(next);
    const double length = m_kArc[i] - m_kArc[i - 1];
    const double part = length > 0.0 ? (along - m_kArc[i - 1]) / length : 0.0;
    return m_kPoints[i - 1] + (m_kPoints[i] - m_kPoints[i - 1]) * static_cast<float>(part);
}

} // namespace gw
