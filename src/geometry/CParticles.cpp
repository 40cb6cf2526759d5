#include "CParticles.h"

#include "CFieldArchive.h"

#include <algorithm>
#include <atomic>

namespace gw {

const CRTTI CParticles::ms_kRTTI{"CParticles", &CGeometry::ms_kRTTI};

namespace {

std::atomic<size_t> s_uiSlots = 0; // of all living particle systems

} // namespace

CParticles::CParticles(const CParticles& source)
    : CGeometry(source), m_iParticleCount(source.m_iParticleCount), m_iActiveCount(source.m_iActiveCount),
      m_uiStoredValue(source.m_uiStoredValue), m_kParticles(source.m_kParticles)
{
    s_uiSlots += m_kParticles.size();
}

CParticles::~CParticles()
{
    s_uiSlots -= m_kParticles.size();
}

CObject* CParticles::CreateClone() const
{
    return new CParticles(*this);
}

void CParticles::Fields(CFieldArchive& archive)
{
    CGeometry::Fields(archive);
    archive.Signed("m_iParticleCount", m_iParticleCount);
    archive.Unsigned("m_uiStoredValue", m_uiStoredValue);
}

uint64_t CParticles::GetMemoryUsed() const
{
    return CGeometry::GetMemoryUsed() + 28 + m_kParticles.size() * sizeof(Particle);
}

// The control has written the world points, so they are neither copied nor transformed again.
bool CParticles::Update(float time)
{
    m_bNormalsValid = false;
    m_bWorldValid = false;
    CSpatial::Update(time); // NOLINT(bugprone-parent-virtual-call): CGeometry would transform the points
    m_bNormalsValid = true;
    m_bWorldValid = true;
    return true;
}

bool CParticles::UpdateRange(uint32_t range, float time)
{
    CSpatial::UpdateRange(range, time); // NOLINT(bugprone-parent-virtual-call): as in Update
    m_bNormalsValid = true;
    m_bWorldValid = true;
    return true;
}

void CParticles::MakeRoom(size_t count)
{
    const size_t capacity = static_cast<size_t>(std::max(m_iParticleCount, 0));
    const size_t room = m_kParticles.size();
    const size_t free = kMostSlots - std::min(s_uiSlots.load(), kMostSlots);
    count = std::min({count, capacity, room + free});
    if (count <= room)
        return;
    m_kParticles.resize(count);
    s_uiSlots += count - room;
    GrowWorldPoints(count);
}

} // namespace gw
