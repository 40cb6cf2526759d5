#pragma once

#include "CGeometry.h"

namespace gw {

/// A particle of a system, without its position, which is a world point of the geometry.
struct Particle
{
    Vec3 m_kVelocity = kVec3Zero;
    float m_fLife = -1.0f; ///< remaining life; dead if negative
    float m_fSize = 0.0f;  ///< 0 when dead
    std::array<float, 4> m_afColor{};

    bool IsLive() const { return m_fLife >= 0.0f; }
};

/// A geometry whose world points are particles. A control creates and moves them; an update does not touch
/// the world points.
class CParticles : public CGeometry
{
public:
    static const CRTTI ms_kRTTI;

    CParticles() = default;
    CParticles(const CParticles& source);
    ~CParticles() override;
    const CRTTI* GetRTTI() const override { return &ms_kRTTI; }
    CObject* CreateClone() const override;
    void Fields(CFieldArchive& archive) override;
    uint64_t GetMemoryUsed() const override;
    bool Update(float time) override;
    bool UpdateRange(uint32_t range, float time) override;

    /// Makes room for a number of particles, within the capacity and kMostSlots; existing ones are kept.
    /// Allocating the whole capacity at once would let a few bytes in a file take any amount of memory.
    void MakeRoom(size_t count);
    /// Returns the particle slots, each with its world point.
    std::span<Particle> Particles() { return m_kParticles; }

    int32_t m_iParticleCount = 0; ///< capacity, as stored
    int32_t m_iActiveCount = 0;   ///< living particles; not stored
    uint32_t m_uiStoredValue = 0; ///< stored and copied only

    /// Limit for the particles of all systems together.
    static constexpr size_t kMostSlots = size_t{1} << 18;

private:
    std::vector<Particle> m_kParticles;
};

} // namespace gw
