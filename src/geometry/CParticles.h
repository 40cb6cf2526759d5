#pragma once

#include "CGeometry.h"

namespace gw {

/// One particle of a system but for its place, which is a world point of the geometry.
struct Particle
{
    Vec3 m_kVelocity = kVec3Zero;
    float m_fLife = -1.0f; ///< time left; below 0 it is dead
    float m_fSize = 0.0f;  ///< 0 when dead
    std::array<float, 4> m_afColor{};

    bool IsLive() const { return m_fLife >= 0.0f; }
};

/// A geometry whose world points are particles. A control gives birth to them and moves them; an update
/// leaves the world points as they stand.
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

    /// Makes room for particles up to a count, within the capacity and kMostSlots; what is there stays. All
    /// of the capacity at once would let a few bytes of a file take any memory.
    void MakeRoom(size_t count);
    /// The particles that there is room for, each with its world point.
    std::span<Particle> Particles() { return m_kParticles; }

    int32_t m_iParticleCount = 0; ///< capacity, as stored
    int32_t m_iActiveCount = 0;   ///< particles alive; not stored
    uint32_t m_uiStoredValue = 0; ///< stored and copied only

    /// Particles of all systems together.
    static constexpr size_t kMostSlots = size_t{1} << 18;

private:
    std::vector<Particle> m_kParticles;
};

} // namespace gw
