#pragma once

#include "CControl.h"
#include "Vec3.h"

#include <array>
#include <random>
#include <vector>

namespace gw {

class CParticles;
struct Particle;

/// The values that each axis of a start value lies between.
struct ParticleRange
{
    Vec3 m_kMaximum = kVec3Zero;
    Vec3 m_kMinimum = kVec3Zero;

    /// Sorts two corners into the largest and the smallest value of each axis.
    void Set(const Vec3& a, const Vec3& b);
};

/// Gives birth to the particles of its target and moves them. Time runs forward only: a time that does not
/// change or goes back does nothing. Start values fall at random in steps of one percent; what a parameter
/// starts is told with each.
class CParticleControl : public CControl
{
public:
    static const CRTTI ms_kRTTI;

    /// The generator starts from the clock.
    CParticleControl();
    CParticleControl(const CParticleControl& source);
    ~CParticleControl() override;
    const CRTTI* GetRTTI() const override { return &ms_kRTTI; }
    CObject* CreateClone() const override;
    void Fields(CFieldArchive& archive) override;
    uint64_t GetMemoryUsed() const override;
    /// Always false.
    bool Update(float time) override;
    bool UpdateTransform(float) override { return false; }

    /// Makes what follows the same on every run.
    void Seed(uint32_t seed) { m_kRandom.seed(seed); }

    uint32_t m_uiCapacity = 0; ///< particles that this control looks after
    float m_fGrowth = 0.0f;    ///< what the size takes in 7 time units
    Vec3 m_kForceDirection{0.0f, 0.0f, -1.0f};
    float m_fForceStrength = 0.0f;         ///< what the velocity takes in 7 time units
    Vec3 m_kDirection = kVec3Zero;         ///< added to every start velocity
    float m_fRate = 1.0f;                  ///< particles per time unit
    ParticleRange m_kPlace;                ///< where a particle starts, in the target's model space
    ParticleRange m_kVelocity;             ///< its velocity in the world, per 7 time units
    std::array<float, 4> m_afFirstColor{}; ///< colours lie between the two
    std::array<float, 4> m_afSecondColor{};
    ParticleRange m_kSpread;                ///< added to the place where a particle starts
    float m_fLife = 150.0f;                 ///< time units from birth to death
    float m_fSize = 30.0f;                  ///< at birth
    std::array<uint32_t, 4> m_auiFurther{}; ///< stored and copied only

private:
    // What a particle started with.
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

    std::vector<Start> m_kStarts; // by particle, up to the last one born here
    std::minstd_rand m_kRandom;
    float m_fPreviousTime = 0.0f;
    float m_fCurrentTime = 0.0f;
    double m_fCarry = 0.0; // the part of a particle that the rate has not yet made whole
};

} // namespace gw
