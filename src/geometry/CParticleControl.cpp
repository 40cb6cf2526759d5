// Particle births and motion. Each update computes the elapsed time since the last one, ages and moves the
// living particles by it, and fills dead slots with new ones at the rate.

#include "CParticleControl.h"

#include "CFieldArchive.h"
#include "CParticles.h"

#include <algorithm>
#include <chrono>
#include <cmath>

namespace gw {

const CRTTI CParticleControl::ms_kRTTI{"CParticleControl", &CControl::ms_kRTTI};

namespace {

constexpr float kStepPerTime = 0.14285715f; // velocities and forces are per 7 time units
constexpr uint32_t kPercents = 100;

void RangeFields(CFieldArchive& archive, const char* maximum, const char* minimum, ParticleRange& range)
{
    archive.Vector(maximum, range.m_kMaximum);
    archive.Vector(minimum, range.m_kMinimum);
}

} // namespace

void ParticleRange::Set(const Vec3& a, const Vec3& b)
{
    m_kMaximum = {std::max(a.x, b.x), std::max(a.y, b.y), std::max(a.z, b.z)};
    m_kMinimum = {std::min(a.x, b.x), std::min(a.y, b.y), std::min(a.z, b.z)};
}

CParticleControl::CParticleControl()
    : m_kRandom(static_cast<uint32_t>(std::chrono::system_clock::now().time_since_epoch().count()))
{
}
CParticleControl::CParticleControl(const CParticleControl& source) = default;
CParticleControl::~CParticleControl() = default;

CObject* CParticleControl::CreateClone() const
{
    return new CParticleControl(*this);
}

void CParticleControl::Fields(CFieldArchive& archive)
{
    CControl::Fields(archive);
    archive.Unsigned("m_uiCapacity", m_uiCapacity);
    archive.Float("m_fGrowth", m_fGrowth);
    archive.Vector("m_kForceDirection", m_kForceDirection);
    archive.Float("m_fForceStrength", m_fForceStrength);
    archive.Vector("m_kDirection", m_kDirection);
    archive.Float("m_fRate", m_fRate);
    RangeFields(archive, "m_kPlace maximum", "m_kPlace minimum", m_kPlace);
    RangeFields(archive, "m_kVelocity maximum", "m_kVelocity minimum", m_kVelocity);
    archive.Row("m_afFirstColor", m_afFirstColor);
    archive.Row("m_afSecondColor", m_afSecondColor);
    RangeFields(archive, "m_kSpread maximum", "m_kSpread minimum", m_kSpread);
    archive.Float("m_fLife", m_fLife);
    archive.Float("m_fSize", m_fSize);
    archive.Row("m_auiFurther", m_auiFurther);
}

uint64_t CParticleControl::GetMemoryUsed() const
{
    return CControl::GetMemoryUsed() + 180 + m_kStarts.size() * sizeof(Start);
}

bool CParticleControl::Update(float time)
{
    if (!m_bActive)
        return false;
    m_fPreviousTime = std::exchange(m_fCurrentTime, time);
    Step(MapTime(time));
    return false;
}

void CParticleControl::Step(float keyTime)
{
    CParticles* target = RecordCast<CParticles>(GetTarget());
    const float elapsed = m_fCurrentTime - m_fPreviousTime;
    if (!target || !(elapsed > 0.0f) || !std::isfinite(elapsed) || keyTime < 0.0f)
        return;
    const size_t capacity =
        std::min<size_t>(m_uiCapacity, static_cast<size_t>(std::max(target->m_iParticleCount, 0)));
    const size_t active = static_cast<size_t>(std::max(target->m_iActiveCount, 0));
    Emit(*target, CountBirths(elapsed, capacity - std::min(capacity, active)));
    Move(*target, elapsed);
    ++target->m_uiChangeStamp;
}

// The fraction carries over to the next step, so that slow rates still produce particles.
size_t CParticleControl::CountBirths(double elapsed, size_t free)
{
    const double births = elapsed * static_cast<double>(m_fRate) + m_fCarry;
    if (!std::isfinite(births))
        return 0;
    const double whole = std::floor(births);
    m_fCarry = births - whole;
    return static_cast<size_t>(std::clamp(whole, 0.0, static_cast<double>(free)));
}

void CParticleControl::Emit(CParticles& target, size_t count)
{
    target.MakeRoom(static_cast<size_t>(std::max(target.m_iActiveCount, 0)) + count);
    const size_t room = std::min(target.Particles().size(), target.WorldXYZBuffer().size());
    for (size_t i = 0; i < room && count > 0; ++i)
    {
        if (target.Particles()[i].IsLive())
            continue;
        Bear(target, i);
        --count;
    }
}

void CParticleControl::Bear(CParticles& target, size_t index)
{
    const Start start = RandomStart();
    Particle& particle = target.Particles()[index];
    particle.m_kVelocity = start.m_kVelocity;
    particle.m_fLife = start.m_fLife;
    particle.m_fSize = start.m_fSize;
    particle.m_afColor = start.m_afColor;
    target.WorldXYZBuffer()[index] = TransformCoord(start.m_kPlace + start.m_kSpread, target.m_kWorldMatrix);
    if (m_kStarts.size() <= index)
        m_kStarts.resize(index + 1);
    m_kStarts[index] = start;
}

CParticleControl::Start CParticleControl::RandomStart()
{
    Start start;
    start.m_kPlace = Random(m_kPlace);
    start.m_kVelocity = Random(m_kVelocity) + m_kDirection;
    start.m_kSpread = Random(m_kSpread);
    start.m_fGrowth = m_fGrowth;
    start.m_fLife = m_fLife;
    for (size_t i = 0; i < start.m_afColor.size(); ++i)
        start.m_afColor[i] = Random(m_afFirstColor[i], m_afSecondColor[i]);
    start.m_fSize = m_fSize;
    return start;
}

float CParticleControl::Random(float maximum, float minimum)
{
    return static_cast<float>(m_kRandom() % kPercents) * 0.01f * (maximum - minimum) + minimum;
}

Vec3 CParticleControl::Random(const ParticleRange& range)
{
    const float x = Random(range.m_kMaximum.x, range.m_kMinimum.x);
    const float y = Random(range.m_kMaximum.y, range.m_kMinimum.y);
    return {x, y, Random(range.m_kMaximum.z, range.m_kMinimum.z)};
}

void CParticleControl::Move(CParticles& target, float elapsed)
{
    const float step = elapsed * kStepPerTime;
    const Vec3 force = m_kForceDirection * (step * m_fForceStrength);
    const std::span<Particle> particles = target.Particles();
    const std::span<Vec3> points = target.WorldXYZBuffer();
    target.m_iActiveCount = 0;
    for (size_t i = 0; i < std::min(particles.size(), points.size()); ++i)
    {
        Particle& particle = particles[i];
        if (!particle.IsLive())
            continue;
        particle.m_fLife -= elapsed;
        if (!particle.IsLive())
        {
            particle = {};
            points[i] = kVec3Zero;
            continue;
        }
        points[i] = points[i] + particle.m_kVelocity * step;
        particle.m_fSize += step * (i < m_kStarts.size() ? m_kStarts[i].m_fGrowth : 0.0f);
        particle.m_kVelocity = particle.m_kVelocity + force;
        ++target.m_iActiveCount;
    }
}

} // namespace gw
