#pragma once

#include "CControl.h"
#include "Vec3.h"

#include <array>
#include <random>
#include <vector>

namespace gw {

class CParticles;
struct Particle;

/// The range of a start value for each axis.
struct ParticleRange
{
    Vec3 m_kMaximum = kVec3Zero;
    Vec3 m_kMinimum = kVec3Zero;

    /// Sets the range from two corners: the minimum and maximum per axis.
    void Set(const Vec3& a, const Vec3& b);
};

/// Creates and moves the particles of its target. Time only runs forward: an equal or earlier time does
/// nothing. Start values are random, in steps of one percent of their range.
class CParticleControl : public CControl
{
public:
    static const CRTTI ms_kRTTI;

    /// Seeds the generator from the clock.
    CParticleControl();
    CParticleControl(const CParticleControl& source);
    ~CParticleControl() override;
    const CRTTI* GetRTTI() const override { return &ms_kRTTI; }
    CObject* CreateClone() const override;
    void Fields(CFieldArchive& archive) override;
    uint64_t GetMemoryUsed() const override;
    /// Always returns false.
    bool Update(float time) override;
    bool UpdateTransform(float) override { return false; }

    /// Makes the following random numbers the same in every run.
    void Seed(uint32_t seed) { m_kRandom.seed(seed); }

    uint32_t m_uiCapacity = 0; ///< number of particles managed by this control
    float m_fGrowth = 0.0f;    ///< added to the size per 7 time units
    Vec3 m_kForceDirection{0.0f, 0.0f, -1.0f};
    float m_fForceStrength = 0.0f;         ///< added to the velocity per 7 time units
    Vec3 m_kDirection = kVec3Zero;         ///< added to every start velocity
    float m_fRate = 1.0f;                  ///< particles per time unit
    ParticleRange m_kPlace;                ///< start position, in the target's model space
    ParticleRange m_kVelocity;             ///< start velocity in world space, per 7 time units
    std::array<float, 4> m_afFirstColor{}; ///< colors lie between these two
    std::array<float, 4> m_afSecondColor{};
    ParticleRange m_kSpread;                ///< added to the start position
    float m_fLife = 150.0f;                 ///< life span in time units
    float m_fSize = 30.0f;                  ///< at birth
    std::array<uint32_t, 4> m_auiFurther{}; ///< stored and copied only

private:
    // The start values of a particle.
    struct Start
    {
        Vec3 m_kPlace = kVec3Zero;
        Vec3 m_kVelocity = kVec3Zero;
        Vec3 m_kSpread = kVec3Zero;
        float m_fGrowth = 0.0f;
        float m_fLife = 0.0f;
        std::array<float, 4> m_afColor{};
        float m_fSize = 0.0f;
    };

    void Step(float keyTime);
    size_t CountBirths(double elapsed, size_t free);
    void Emit(CParticles& target, size_t count);
    void Bear(CParticles& target, size_t index);
    void Move(CParticles& target, float elapsed);
    Start RandomStart();
    float Random(float maximum, float minimum);
    Vec3 Random(const ParticleRange& range);

    std::vector<Start> m_kStarts; // by particle index, up to the last one created here
    std::minstd_rand m_kRandom;
    float m_fPreviousTime = 0.0f;
    float m_fCurrentTime = 0.0f;
    double m_fCarry = 0.0; // fraction of a particle left over from the rate
};

} // namespace gw
